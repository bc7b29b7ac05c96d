// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TOKEN_JOIN_H
#define UMPRE_LEX_TOKEN_JOIN_H

#include <array>
#include <string_view>

#include "lex/token.h"

namespace umpre {

/// Tells whether lexing the joined texts of two tokens that meet may give anything but these two.
/// `left` and `right` are tokens of the scanner, and neither is a quote by itself: that may be
/// closed by another one further on.
[[nodiscard]] bool mayJoin(const Token& left, const Token& right) noexcept;

/// The bytes that can go on with a token that began before them, or be gone on with.
inline constexpr std::array<unsigned char, 256> kJoiningBytes = [] {
    std::array<unsigned char, 256> groups{};
    for (const char byte :
         std::string_view("ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz_0123456789")) {
        groups[static_cast<unsigned char>(byte)] = 1;
    }
    for (const char byte : std::string_view("/*<>=&|#!\\\n\r")) {
        groups[static_cast<unsigned char>(byte)] = 2;
    }
    return groups;
}();

/// The same as `mayJoin`, told by the bytes that meet alone, and so more often true.
[[nodiscard]] inline bool mayMeet(char left, char right) noexcept {
    return (kJoiningBytes[static_cast<unsigned char>(left)]
            & kJoiningBytes[static_cast<unsigned char>(right)])
           != 0;
}

/// Tells whether a token is a quote that no other closed where it was read.
[[nodiscard]] inline bool isLoneQuote(const Token& token) noexcept {
    return token.kind == TokenKind::OTHER && (token.text == "\"" || token.text == "'");
}

}  // namespace umpre

#endif
