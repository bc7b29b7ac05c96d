// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_PLAIN_TEXT_H
#define UMPRE_LEX_PLAIN_TEXT_H

#include <array>
#include <cstddef>
#include <string_view>

#include "lex/spelling.h"

namespace umpre {

/// Returns the end of the number, literal or other byte that begins at `at`, before `end`; null if
/// that is more than text: a comment, a line end, a quote that is not closed, a zero byte.
[[nodiscard]] const char* unusualTokenEnd(const char* at, const char* end) noexcept;

/// What matters about a byte of text at the beginning of a token.
enum class TextByte : unsigned char {
    Plain,    ///< a token by itself, or part of one that needs no look at the others
    Unusual,  ///< quotes, slashes, backslashes, line ends, zero bytes
    Digit,    ///< begins a number
    Name,     ///< begins a name
};

inline constexpr std::array<TextByte, 256> kTextBytes = [] {
    std::array<TextByte, 256> bytes{};
    for (const char byte : std::string_view("\n\r\0\\/\"'", 7)) {
        bytes[static_cast<unsigned char>(byte)] = TextByte::Unusual;
    }
    for (std::size_t at = 0; at != bytes.size(); ++at) {
        const char byte = static_cast<char>(at);
        if (isWordByte(byte)) {
            bytes[at] = isDigit(byte) ? TextByte::Digit : TextByte::Name;
        }
    }
    return bytes;
}();

[[nodiscard]] constexpr TextByte textByte(char byte) noexcept {
    return kTextBytes[static_cast<unsigned char>(byte)];
}

}  // namespace umpre

#endif
