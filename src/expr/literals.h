// SPDX-License-Identifier: MIT
#ifndef UMPRE_EXPR_LITERALS_H
#define UMPRE_EXPR_LITERALS_H

#include <string_view>

#include "expr/expr_value.h"
#include "lex/reporter.h"
#include "lex/token.h"

namespace umpre {

/// Returns the value of an integer literal, which must be one of the six kinds of them. A number
/// too large for 32 bits becomes 4294967295.
[[nodiscard]] ExprValue integerValue(const Token& literal) noexcept;

/// Returns the value of a character literal, quotes included in its text: its characters side by
/// side, eight bits each. Reports an error for more than four and leaves the rest out.
[[nodiscard]] ExprValue characterValue(std::string_view literal, Reporter& reporter);

}  // namespace umpre

#endif
