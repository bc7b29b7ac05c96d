// SPDX-License-Identifier: MIT
#include "lex/spelling.h"

#include <array>
#include <cstddef>
#include <cstdint>

namespace umpre {
namespace {

using enum TokenKind;

constexpr std::size_t kLongestWord = 7;

// A word of up to eight bytes as a number.
[[nodiscard]] constexpr std::uint64_t packed(std::string_view word) noexcept {
    std::uint64_t bytes = 0;
    for (const char byte : word) {
        bytes = bytes << 8U | static_cast<unsigned char>(byte);
    }
    return bytes;
}

[[nodiscard]] bool isHexDigit(char byte) noexcept {
    const char lower = static_cast<char>(byte | 0x20);
    return isDigit(byte) || (lower >= 'a' && lower <= 'f');
}

[[nodiscard]] bool isEither(char byte, char lower) noexcept {
    return (byte | 0x20) == lower;
}

// Returns the end of the suffix that may stand at `at`: "u" or "l" or one of each, in any case.
[[nodiscard]] const char* suffixEnd(const char* at, bool& isUnsigned) noexcept {
    if (isEither(*at, 'u')) {
        isUnsigned = true;
        return isEither(at[1], 'l') ? at + 2 : at + 1;
    }
    if (isEither(*at, 'l')) {
        isUnsigned = isEither(at[1], 'u');
        return isUnsigned ? at + 2 : at + 1;
    }
    return at;
}

// The kinds of all bytes as tokens by themselves.
constexpr std::array<TokenKind, 256> kSingles = [] {
    std::array<TokenKind, 256> kinds{};
    kinds.fill(OTHER);
    for (const char byte : std::string_view("#(),?:|^&<>+-*/%!~")) {
        kinds[static_cast<unsigned char>(byte)] = static_cast<TokenKind>(byte);
    }
    return kinds;
}();

// Returns the kind of a punctuator of two characters, or OTHER if these are none.
[[nodiscard]] TokenKind kindOfPair(char first, char second) noexcept {
    if (second == '=') {
        switch (first) {
        case '=': return EQ;
        case '!': return NE;
        case '<': return LE;
        case '>': return GE;
        default: return OTHER;
        }
    }
    if (second != first) {
        return OTHER;
    }
    switch (first) {
    case '#': return PASTE;
    case '|': return OROR;
    case '&': return ANDAND;
    case '<': return LSHIFT;
    case '>': return RSHIFT;
    default: return OTHER;
    }
}

}  // namespace

TokenKind kindOfName(std::string_view name) noexcept {
    if (name.size() > kLongestWord) {
        return IDENTIFIER;
    }
    switch (packed(name)) {
    case packed("if"): return KW_IF;
    case packed("ifdef"): return KW_IFDEF;
    case packed("ifndef"): return KW_IFNDEF;
    case packed("else"): return KW_ELSE;
    case packed("elif"): return KW_ELIF;
    case packed("endif"): return KW_ENDIF;
    case packed("include"): return KW_INCLUDE;
    case packed("define"): return KW_DEFINE;
    case packed("undef"): return KW_UNDEF;
    case packed("line"): return KW_LINE;
    case packed("error"): return KW_ERROR;
    case packed("pragma"): return KW_PRAGMA;
    case packed("ident"): return KW_IDENT;
    case packed("defined"): return KW_DEFINED;
    default: return IDENTIFIER;
    }
}

Token numberAt(const char* at) noexcept {
    const char* end = at;
    TokenKind kind = INT_DEC;
    TokenKind unsignedKind = UINT_DEC;
    if (*at != '0') {
        while (isDigit(*end)) {
            ++end;
        }
    } else if (isEither(at[1], 'x') && isHexDigit(at[2])) {
        kind = INT_HEX;
        unsignedKind = UINT_HEX;
        for (end += 2; isHexDigit(*end);) {
            ++end;
        }
    } else {
        kind = INT_OCT;
        unsignedKind = UINT_OCT;
        while (*end >= '0' && *end <= '7') {
            ++end;
        }
    }
    bool isUnsigned = false;
    end = suffixEnd(end, isUnsigned);
    return {isUnsigned ? unsignedKind : kind, {at, static_cast<std::size_t>(end - at)}};
}

Token tokenAt(const char* at) noexcept {
    if (isNameStart(*at)) {
        const std::string_view name(at, static_cast<std::size_t>(nameEnd(at) - at));
        return {kindOfName(name), name};
    }
    if (isDigit(*at)) {
        return numberAt(at);
    }
    const TokenKind pair = kindOfPair(*at, at[1]);
    if (pair != OTHER) {
        return {pair, {at, 2}};
    }
    const bool isComment = *at == '/' && (at[1] == '/' || at[1] == '*');
    return {isComment ? OTHER : kSingles[static_cast<unsigned char>(*at)], {at, 1}};
}

}  // namespace umpre
