// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TOKEN_JOIN_H
#define UMPRE_LEX_TOKEN_JOIN_H

#include "lex/token.h"

namespace umpre {

/// Tells whether lexing the joined texts of two tokens that meet may give anything but these two.
/// `left` and `right` are tokens of the scanner, and neither is a quote by itself: that may be
/// closed by another one further on.
[[nodiscard]] bool mayJoin(const Token& left, const Token& right) noexcept;

/// Tells whether a token is a quote that no other closed where it was read.
[[nodiscard]] inline bool isLoneQuote(const Token& token) noexcept {
    return token.kind == TokenKind::OTHER && (token.text == "\"" || token.text == "'");
}

}  // namespace umpre

#endif
