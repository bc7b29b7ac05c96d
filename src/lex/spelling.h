// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_SPELLING_H
#define UMPRE_LEX_SPELLING_H

#include <array>
#include <cstddef>
#include <string_view>

#include "lex/token.h"

namespace umpre {

// How tokens are spelled, for readers of bytes. Each function reads up to the first byte that does
// not belong to what it reads.

[[nodiscard]] constexpr bool isDigit(char byte) noexcept {
    return byte >= '0' && byte <= '9';
}

[[nodiscard]] constexpr bool isNameStart(char byte) noexcept {
    const char lower = static_cast<char>(byte | 0x20);
    return (lower >= 'a' && lower <= 'z') || byte == '_';
}

/// Tells whether a byte can go on in a name or a number.
[[nodiscard]] constexpr bool isWordByte(char byte) noexcept {
    return isNameStart(byte) || isDigit(byte);
}

[[nodiscard]] constexpr bool isBlankByte(char byte) noexcept {
    return byte == ' ' || byte == '\t' || byte == '\v' || byte == '\f';
}

/// Tells whether a byte ends a line, or begins a line end of two bytes.
[[nodiscard]] constexpr bool isLineEndByte(char byte) noexcept {
    return byte == '\n' || byte == '\r';
}

/// Tells whether a byte makes a comment of the slash before it. Without a branch: which of the two
/// it is cannot be predicted.
[[nodiscard]] constexpr bool isCommentSign(char byte) noexcept {
    return (static_cast<unsigned>(byte == '/') | static_cast<unsigned>(byte == '*')) != 0;
}

/// Tells whether a comment begins at `at`, behind which another byte can be read.
[[nodiscard]] constexpr bool beginsComment(const char* at) noexcept {
    return *at == '/' && isCommentSign(at[1]);
}

/// The same before `end`.
[[nodiscard]] constexpr bool beginsComment(const char* at, const char* end) noexcept {
    return end - at > 1 && beginsComment(at);
}

/// The same for a comment that ends with its line.
[[nodiscard]] constexpr bool beginsLineComment(const char* at, const char* end) noexcept {
    return end - at > 1 && *at == '/' && at[1] == '/';
}

inline constexpr std::array<bool, 256> kIsWordByte = [] {
    std::array<bool, 256> isWord{};
    for (std::size_t byte = 0; byte != isWord.size(); ++byte) {
        isWord[byte] = isWordByte(static_cast<char>(byte));
    }
    return isWord;
}();

/// Returns the first byte from `at` on that is no blank, or `end`.
[[nodiscard]] inline const char* skipBlankBytes(const char* at, const char* end) noexcept {
    while (at < end && isBlankByte(*at)) {
        ++at;
    }
    return at;
}

/// Returns the end of a name that begins at `at`, or of the rest of one.
[[nodiscard]] inline const char* nameEnd(const char* at) noexcept {
    while (kIsWordByte[static_cast<unsigned char>(*at)]) {
        ++at;
    }
    return at;
}

/// The same where 16 bytes behind each byte of the name can be read.
[[nodiscard]] const char* nameEndAhead(const char* at) noexcept;

/// Returns the kind of a name: that of a directive word or of `defined`, or IDENTIFIER.
[[nodiscard]] TokenKind kindOfName(std::string_view name) noexcept;

/// Returns the number that begins at `at` with a digit, as the number rules split it.
[[nodiscard]] Token numberAt(const char* at) noexcept;

/// Returns the token that begins at `at`: a name, a number or a punctuator. What begins anything
/// else, a comment or a literal too, is one byte of the kind OTHER.
[[nodiscard]] Token tokenAt(const char* at) noexcept;

}  // namespace umpre

#endif
