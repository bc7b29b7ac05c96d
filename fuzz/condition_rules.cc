// SPDX-License-Identifier: MIT
#include "condition_rules.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <vector>

#include "token_rules.h"

namespace umpre::fuzz {

using enum TokenKind;

namespace {

constexpr std::uint64_t kTwoTo32 = std::uint64_t{1} << 32U;
constexpr std::uint64_t kTwoTo31 = std::uint64_t{1} << 31U;

struct Fault {};

struct Value {
    std::uint64_t bits = 0;
    bool isSigned = true;

    [[nodiscard]] std::int64_t number() const {
        const auto plain = static_cast<std::int64_t>(bits);
        return isSigned && bits >= kTwoTo31 ? plain - static_cast<std::int64_t>(kTwoTo32) : plain;
    }
};

[[nodiscard]] Value ofBits(std::uint64_t bits) {
    return {bits, bits < kTwoTo31};
}

// The operators of each level, from the loosest to the tightest.
const std::array<std::vector<TokenKind>, 10> kLevels{{{OROR},
                                                      {ANDAND},
                                                      {BAR},
                                                      {CARET},
                                                      {AMPERSAND},
                                                      {EQ, NE},
                                                      {LESS, GREATER, LE, GE},
                                                      {LSHIFT, RSHIFT},
                                                      {PLUS, MINUS},
                                                      {STAR, SLASH, PERCENT}}};

[[nodiscard]] std::uint64_t divided(TokenKind operation, const Value& left, const Value& right) {
    // Both are taken as what they are together: unsigned, unless both are signed.
    const bool isSigned = left.isSigned && right.isSigned;
    const std::int64_t a = Value{left.bits, isSigned}.number();
    const std::int64_t b = Value{right.bits, isSigned}.number();
    if (b == 0 || (isSigned && a / b == static_cast<std::int64_t>(kTwoTo31))) {
        throw Fault();
    }
    return static_cast<std::uint64_t>(operation == SLASH ? a / b : a % b) % kTwoTo32;
}

[[nodiscard]] bool isTrue(TokenKind operation, const Value& left, const Value& right) {
    const bool isSigned = left.isSigned && right.isSigned;
    const std::int64_t a = Value{left.bits, isSigned}.number();
    const std::int64_t b = Value{right.bits, isSigned}.number();
    switch (operation) {
    case OROR: return left.bits + right.bits != 0;
    case ANDAND: return left.bits != 0 && right.bits != 0;
    case EQ: return left.bits == right.bits;
    case NE: return left.bits != right.bits;
    case LESS: return a < b;
    case GREATER: return a > b;
    case LE: return a <= b;
    default: return a >= b;
    }
}

[[nodiscard]] Value combined(TokenKind operation, const Value& left, const Value& right) {
    const bool isSigned = left.isSigned && right.isSigned;
    const std::uint64_t a = left.bits;
    const std::uint64_t b = right.bits;
    const std::uint64_t power = std::uint64_t{1} << (b % 32);
    switch (operation) {
    case BAR: return {a | b, isSigned};
    case CARET: return {a ^ b, isSigned};
    case AMPERSAND: return {a & b, isSigned};
    case LSHIFT: return {a * power % kTwoTo32, isSigned};
    case RSHIFT: return {a / power, isSigned};
    case PLUS: return {(a + b) % kTwoTo32, isSigned};
    case MINUS: return {(a + kTwoTo32 - b) % kTwoTo32, isSigned};
    case STAR: return {a * b % kTwoTo32, isSigned};
    case SLASH:
    case PERCENT: return {divided(operation, left, right), isSigned};
    default: return {isTrue(operation, left, right) ? 1U : 0U, isSigned};
    }
}

[[nodiscard]] std::uint64_t integer(std::string_view text, std::uint64_t base) {
    std::uint64_t bits = 0;
    for (const char byte : text) {
        const std::size_t digit = std::string_view("0123456789abcdefABCDEF").find(byte);
        const std::uint64_t number = digit < 16 ? digit : digit - 6;
        if (digit == std::string_view::npos || number >= base) {
            break;
        }
        bits = bits * base + number;
        if (bits >= kTwoTo32) {
            return kTwoTo32 - 1;
        }
    }
    return bits;
}

// The value of what is between the quotes of a literal.
class Characters {
public:
    explicit Characters(std::string_view text) : text_(text) {}

    [[nodiscard]] Value value(bool& tooMany) {
        Value value;
        for (int count = 1; at_ < text_.size(); ++count) {
            if (count > 4) {
                tooMany = true;
                break;
            }
            const Value one = character();
            value.bits = (value.bits * 256 % kTwoTo32 + one.bits) % kTwoTo32;
            value.isSigned = value.isSigned && one.isSigned;
        }
        return value;
    }

private:
    [[nodiscard]] Value character() {
        const char byte = text_[at_++];
        if (byte != '\\') {
            return ofBits(static_cast<unsigned char>(byte));
        }
        const char escape = text_[at_];
        if (escape >= '0' && escape <= '7') {
            return number("01234567", 8);
        }
        ++at_;
        if (escape == 'x') {
            return number("0123456789abcdefABCDEF", 16);
        }
        static constexpr std::string_view kEscapes = "\"'?\\abfnrtv";
        static constexpr std::string_view kCodes = "\"'?\\\a\b\f\n\r\t\v";
        const std::size_t index = kEscapes.find(escape);
        return ofBits(index == std::string_view::npos ? 0U
                                                      : static_cast<unsigned char>(kCodes[index]));
    }

    // As many digits as there are; the low 8 bits count, as a signed number.
    [[nodiscard]] Value number(std::string_view digits, std::uint64_t base) {
        std::uint64_t bits = 0;
        while (at_ < text_.size() && digits.find(text_[at_]) != std::string_view::npos) {
            bits = (bits * base + integer(text_.substr(at_, 1), 16)) % 256;
            ++at_;
        }
        return ofBits(bits < 128 ? bits : kTwoTo32 - 256 + bits);
    }

    std::string_view text_;
    std::size_t at_ = 0;
};

class Climber {
public:
    Climber(std::string_view text, const std::set<std::string, std::less<>>& macros)
        : tokens_(allTokens(text)), macros_(macros) {}

    [[nodiscard]] RuledCondition condition() {
        RuledCondition result;
        try {
            const Value value = conditional();
            result.value = value.bits;
            result.isSigned = value.isSigned;
        } catch (const Fault&) {
            result.isFault = true;
        }
        result.isCorrect = isCorrect_;
        result.messages = messages_;
        for (; at_ < tokens_.size(); ++at_) {
            result.left += tokens_[at_].text;
        }
        return result;
    }

private:
    [[nodiscard]] TokenKind peek() {
        while (at_ < tokens_.size() && isBlank(tokens_[at_].kind)) {
            ++at_;
        }
        return at_ < tokens_.size() ? tokens_[at_].kind : END_OF_INPUT;
    }

    RuledToken next() {
        (void)peek();
        return at_ < tokens_.size() ? tokens_[at_++] : RuledToken{};
    }

    Value wrong(std::string_view message) {
        messages_.append(message).append("\n");
        isCorrect_ = false;
        return {};
    }

    [[nodiscard]] Value conditional() {
        const Value condition = level(0);
        if (peek() != QUESTION) {
            return condition;
        }
        next();
        const Value middle = conditional();
        if (next().kind != COLON) {
            return wrong("\":\" expected in constant expression");
        }
        const Value third = conditional();
        return condition.bits != 0 ? middle : third;
    }

    [[nodiscard]] Value level(std::size_t number) {
        if (number == kLevels.size()) {
            return unary();
        }
        const std::vector<TokenKind>& operators = kLevels[number];
        Value left = level(number + 1);
        while (std::find(operators.begin(), operators.end(), peek()) != operators.end()) {
            const TokenKind operation = next().kind;
            left = combined(operation, left, level(number + 1));
        }
        return left;
    }

    [[nodiscard]] Value unary() {
        switch (peek()) {
        case BANG: {
            next();
            const Value operand = unary();
            return {operand.bits == 0 ? 1U : 0U, operand.isSigned};
        }
        case TILDE: {
            next();
            const Value operand = unary();
            return {kTwoTo32 - 1 - operand.bits, operand.isSigned};
        }
        case MINUS: {
            next();
            const Value operand = unary();
            return {(kTwoTo32 - operand.bits) % kTwoTo32, operand.isSigned};
        }
        case PLUS: next(); return unary();
        default: return primary();
        }
    }

    [[nodiscard]] Value primary() {
        const RuledToken token = next();
        const std::string_view text(token.text);
        switch (token.kind) {
        case KW_DEFINED: return isDefined();
        case INT_DEC: return ofBits(integer(text, 10));
        case INT_OCT: return ofBits(integer(text, 8));
        case INT_HEX: return ofBits(integer(text.substr(2), 16));
        case UINT_DEC: return {integer(text, 10), false};
        case UINT_OCT: return {integer(text, 8), false};
        case UINT_HEX: return {integer(text.substr(2), 16), false};
        case CHAR_LITERAL: return characters(text.substr(1, text.size() - 2));
        case LEFT_PARENTHESIS: return parenthesized();
        default: break;
        }
        if (token.kind >= KW_IF && token.kind <= IDENTIFIER) {
            rejectCall();
            return {};
        }
        return wrong("Lexical element expected");
    }

    [[nodiscard]] Value characters(std::string_view text) {
        bool tooMany = false;
        const Value value = Characters(text).value(tooMany);
        if (tooMany) {
            messages_.append("Too many characters in character literal\n");
        }
        return value;
    }

    [[nodiscard]] Value parenthesized() {
        const Value value = conditional();
        if (next().kind != RIGHT_PARENTHESIS) {
            return wrong("\")\" expected");
        }
        rejectCall();
        return value;
    }

    void rejectCall() {
        if (peek() == LEFT_PARENTHESIS) {
            wrong("A function call is not allowed in a constant expression");
        }
    }

    [[nodiscard]] Value isDefined() {
        const bool isParenthesized = peek() == LEFT_PARENTHESIS;
        if (isParenthesized) {
            next();
        }
        const RuledToken name = next();
        if (name.kind != IDENTIFIER) {
            return wrong("Identifier expected for 'defined' operator");
        }
        if (isParenthesized && next().kind != RIGHT_PARENTHESIS) {
            return wrong("\")\" expected for \"defined\" operator");
        }
        return {macros_.contains(name.text) ? 1U : 0U, true};
    }

    std::vector<RuledToken> tokens_;
    const std::set<std::string, std::less<>>& macros_;
    std::size_t at_ = 0;
    std::string messages_;
    bool isCorrect_ = true;
};

}  // namespace

RuledCondition conditionOf(std::string_view text,
                           const std::set<std::string, std::less<>>& macros) {
    return Climber(text, macros).condition();
}

}  // namespace umpre::fuzz
