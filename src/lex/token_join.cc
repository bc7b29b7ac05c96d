// SPDX-License-Identifier: MIT
//
// Every token of more than one character goes on with characters of its own class, so what meets it
// matters only by its first character. Where the rules are involved (a number may take a suffix, or
// become hexadecimal), the answer is a "maybe".
#include "lex/token_join.h"

namespace umpre {
namespace {

using enum TokenKind;

[[nodiscard]] bool isWordByte(char byte) noexcept {
    const char lower = static_cast<char>(byte | 0x20);
    return (lower >= 'a' && lower <= 'z') || (byte >= '0' && byte <= '9') || byte == '_';
}

[[nodiscard]] bool isNumber(TokenKind kind) noexcept {
    return kind >= INT_DEC && kind <= UINT_HEX;
}

[[nodiscard]] bool isHexadecimal(TokenKind kind) noexcept {
    return kind == INT_HEX || kind == UINT_HEX;
}

// Tells whether a number may go on with this character: a digit, the "x" of a hexadecimal number,
// or a suffix.
[[nodiscard]] bool numberGoesOn(TokenKind kind, char byte) noexcept {
    const char lower = static_cast<char>(byte | 0x20);
    const bool isDigit = byte >= '0' && byte <= '9';
    const bool isHexLetter = lower >= 'a' && lower <= 'f';
    return isDigit || lower == 'u' || lower == 'l' || lower == 'x'
           || (isHexLetter && isHexadecimal(kind));
}

// Tells whether a punctuator of one character goes on with this one.
[[nodiscard]] bool punctuatorGoesOn(char left, char right) noexcept {
    switch (left) {
    case '/': return right == '/' || right == '*';
    case '<':
    case '>': return right == left || right == '=';
    case '&':
    case '|':
    case '#':
    case '=': return right == left;
    case '!': return right == '=';
    case '\\': return right == '\n' || right == '\r';
    default: return false;
    }
}

}  // namespace

bool mayJoin(const Token& left, const Token& right) noexcept {
    if (left.text.empty() || right.text.empty()) {
        return true;
    }
    const char next = right.text.front();
    if (isNumber(left.kind)) {
        return numberGoesOn(left.kind, next);
    }
    if (isName(left.kind) || left.kind == KW_DEFINED) {
        return isWordByte(next);
    }
    if (left.text.size() == 1) {
        return punctuatorGoesOn(left.text.front(), next);
    }
    return false;
}

}  // namespace umpre
