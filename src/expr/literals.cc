// SPDX-License-Identifier: MIT
//
// A character literal is read character by character; each shifts the value so far by eight bits
// and is added. A plain byte counts 0 to 255. An octal or hexadecimal escape is kept in a signed
// byte and extended to 32 bits, so '\377' is 4294967295 and unsigned while a plain byte 255 is 255.
#include "expr/literals.h"

#include <array>
#include <cstddef>
#include <limits>
#include <optional>

namespace umpre {
namespace {

using enum TokenKind;

// The value of a digit in any base up to 16, or 16 for what is none.
[[nodiscard]] std::uint32_t digitValue(char byte) noexcept {
    if (byte >= '0' && byte <= '9') {
        return static_cast<std::uint32_t>(byte - '0');
    }
    if (byte >= 'a' && byte <= 'f') {
        return static_cast<std::uint32_t>(byte - 'a') + 10;
    }
    if (byte >= 'A' && byte <= 'F') {
        return static_cast<std::uint32_t>(byte - 'A') + 10;
    }
    return 16;
}

[[nodiscard]] std::uint32_t numberIn(std::string_view digits, std::uint32_t base) noexcept {
    std::uint64_t value = 0;
    for (const char byte : digits) {
        const std::uint32_t digit = digitValue(byte);
        if (digit >= base) {
            break;
        }
        value = value * base + digit;
        if (value > std::numeric_limits<std::uint32_t>::max()) {
            return std::numeric_limits<std::uint32_t>::max();
        }
    }
    return static_cast<std::uint32_t>(value);
}

[[nodiscard]] std::optional<std::uint32_t> simpleEscape(char byte) noexcept {
    switch (byte) {
    case '"':
    case '\'':
    case '?':
    case '\\': return static_cast<std::uint32_t>(byte);
    case 'a': return 7;
    case 'b': return 8;
    case 't': return 9;
    case 'n': return 10;
    case 'v': return 11;
    case 'f': return 12;
    case 'r': return 13;
    default: return std::nullopt;
    }
}

// Reads the digits of an escape from `at` on, as many as there are, into eight bits.
[[nodiscard]] ExprValue escapedNumber(std::string_view text, std::size_t& at, std::uint32_t base) {
    std::uint32_t bits = 0;
    for (; digitValue(text[at]) < base; ++at) {
        bits = (bits * base + digitValue(text[at])) & 0xFFU;
    }
    return ExprValue::fromPattern((bits & 0x80U) != 0 ? bits | 0xFFFFFF00U : bits);
}

// Reads one character of a literal from `at` on. An escape that means nothing counts 0.
[[nodiscard]] ExprValue characterAt(std::string_view text, std::size_t& at) {
    const char first = text[at++];
    if (first != '\\') {
        return {static_cast<unsigned char>(first), true};
    }
    const char escape = text[at];
    if (digitValue(escape) < 8) {
        return escapedNumber(text, at, 8);
    }
    ++at;
    if (escape == 'x') {
        return escapedNumber(text, at, 16);
    }
    return {simpleEscape(escape).value_or(0), true};
}

}  // namespace

ExprValue integerValue(const Token& literal) noexcept {
    std::uint32_t pattern = 0;
    switch (literal.kind) {
    case INT_HEX:
    case UINT_HEX: pattern = numberIn(literal.text.substr(2), 16); break;
    case INT_OCT:
    case UINT_OCT: pattern = numberIn(literal.text, 8); break;
    default: pattern = numberIn(literal.text, 10); break;
    }
    const bool isUnsigned =
        literal.kind == UINT_DEC || literal.kind == UINT_OCT || literal.kind == UINT_HEX;
    return isUnsigned ? ExprValue{pattern, false} : ExprValue::fromPattern(pattern);
}

ExprValue characterValue(std::string_view literal, Reporter& reporter) {
    constexpr int kMostCharacters = 4;
    const std::size_t closing = literal.size() - 1;
    ExprValue value;
    std::size_t at = 1;
    for (int count = 0; at < closing; ++count) {
        if (count == kMostCharacters) {
            reporter.reportError("Too many characters in character literal");
            break;
        }
        const ExprValue character = characterAt(literal, at);
        value.value = (value.value << 8U) + character.value;
        value.isSigned = value.isSigned && character.isSigned;
    }
    return value;
}

}  // namespace umpre
