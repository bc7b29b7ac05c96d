// SPDX-License-Identifier: MIT
#ifndef UMPRE_EXPR_EXPR_VALUE_H
#define UMPRE_EXPR_EXPR_VALUE_H

#include <cstdint>

#include "lex/token.h"

namespace umpre {

/// Thrown for a division that the machine cannot carry out; ends the process as the machine would.
struct ArithmeticFault {};

/// The value of a condition or of a part of it: 32 bits, and whether they are a signed number.
struct ExprValue {
    std::uint32_t value = 0;
    bool isSigned = true;

    /// Makes a value from bits alone: signed if the top bit is clear.
    [[nodiscard]] static constexpr ExprValue fromPattern(std::uint32_t pattern) noexcept {
        return {pattern, pattern < 0x80000000U};
    }

    friend bool operator==(const ExprValue&, const ExprValue&) = default;
};

/// Applies `!`, `~`, `+` or `-`. The operand's flag stays.
[[nodiscard]] ExprValue applyUnary(TokenKind operation, ExprValue operand) noexcept;

/// Returns how tightly a binary operator binds, from 1 for `||` to `kTightest`; 0 for other kinds.
[[nodiscard]] int precedenceOf(TokenKind operation) noexcept;
constexpr int kTightest = 10;

/// Applies a binary operator. The result is signed only if both operands are. Throws
/// ArithmeticFault for a division by zero and for the lowest signed number divided by -1.
[[nodiscard]] ExprValue applyBinary(TokenKind operation, ExprValue left, ExprValue right);

}  // namespace umpre

#endif
