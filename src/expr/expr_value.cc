// SPDX-License-Identifier: MIT
#include "expr/expr_value.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <limits>

namespace umpre {
namespace {

using enum TokenKind;

constexpr std::uint32_t kShiftMask = 31;  // counts are taken modulo 32

[[nodiscard]] std::uint32_t divide(ExprValue left, ExprValue right, bool wantRemainder) {
    if (right.value == 0) {
        throw ArithmeticFault{};
    }
    if (!left.isSigned || !right.isSigned) {
        return wantRemainder ? left.value % right.value : left.value / right.value;
    }
    const auto dividend = static_cast<std::int32_t>(left.value);
    const auto divisor = static_cast<std::int32_t>(right.value);
    if (dividend == std::numeric_limits<std::int32_t>::min() && divisor == -1) {
        throw ArithmeticFault{};
    }
    return static_cast<std::uint32_t>(wantRemainder ? dividend % divisor : dividend / divisor);
}

[[nodiscard]] bool isLess(ExprValue a, ExprValue b) noexcept {
    if (a.isSigned && b.isSigned) {
        return static_cast<std::int32_t>(a.value) < static_cast<std::int32_t>(b.value);
    }
    return a.value < b.value;
}

[[nodiscard]] bool isTrue(TokenKind operation, ExprValue left, ExprValue right) noexcept {
    switch (operation) {
    case OROR: return left.value != 0 || right.value != 0;
    case ANDAND: return left.value != 0 && right.value != 0;
    case EQ: return left.value == right.value;
    case NE: return left.value != right.value;
    case LESS: return isLess(left, right);
    case GREATER: return isLess(right, left);
    case LE: return !isLess(right, left);
    default: return !isLess(left, right);
    }
}

[[nodiscard]] std::uint32_t bitsOf(TokenKind operation, ExprValue left, ExprValue right) {
    const std::uint32_t a = left.value;
    const std::uint32_t b = right.value;
    switch (operation) {
    case BAR: return a | b;
    case CARET: return a ^ b;
    case AMPERSAND: return a & b;
    case LSHIFT: return a << (b & kShiftMask);
    case RSHIFT: return a >> (b & kShiftMask);  // zeros come in, whatever the sign
    case PLUS: return a + b;
    case MINUS: return a - b;
    case STAR: return a * b;
    case SLASH:
    case PERCENT: return divide(left, right, operation == PERCENT);
    default: return isTrue(operation, left, right) ? 1 : 0;
    }
}

[[nodiscard]] constexpr int precedence(TokenKind operation) noexcept {
    switch (operation) {
    case OROR: return 1;
    case ANDAND: return 2;
    case BAR: return 3;
    case CARET: return 4;
    case AMPERSAND: return 5;
    case EQ:
    case NE: return 6;
    case LESS:
    case GREATER:
    case LE:
    case GE: return 7;
    case LSHIFT:
    case RSHIFT: return 8;
    case PLUS:
    case MINUS: return 9;
    case STAR:
    case SLASH:
    case PERCENT: return kTightest;
    default: return 0;
    }
}

constexpr std::array<std::int8_t, 512> kPrecedences = [] {
    std::array<std::int8_t, 512> precedences{};
    for (std::size_t kind = 0; kind != precedences.size(); ++kind) {
        precedences[kind] = static_cast<std::int8_t>(precedence(static_cast<TokenKind>(kind)));
    }
    return precedences;
}();

}  // namespace

ExprValue applyUnary(TokenKind operation, ExprValue operand) noexcept {
    switch (operation) {
    case BANG: return {operand.value == 0 ? 1U : 0U, operand.isSigned};
    case TILDE: return {~operand.value, operand.isSigned};
    case MINUS: return {0U - operand.value, operand.isSigned};
    default: return operand;
    }
}

int precedenceOf(TokenKind operation) noexcept {
    return kPrecedences[static_cast<std::size_t>(operation)];
}

ExprValue applyBinary(TokenKind operation, ExprValue left, ExprValue right) {
    return {bitsOf(operation, left, right), left.isSigned && right.isSigned};
}

}  // namespace umpre
