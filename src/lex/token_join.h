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

/// What a byte is where two texts meet: bytes of one group may go on with each other in a token,
/// and a token that begins with a byte of the last group must be looked at by itself.
struct JoinGroup {
    static constexpr unsigned kWord = 1;
    static constexpr unsigned kPunctuator = 2;
    static constexpr unsigned kBlank = 4;
    static constexpr unsigned kAlone = 8;
};

inline constexpr std::array<unsigned char, 256> kJoinGroups = [] {
    std::array<unsigned char, 256> groups{};
    const auto add = [&groups](std::string_view bytes, unsigned group) {
        for (const char byte : bytes) {
            groups[static_cast<unsigned char>(byte)] |= static_cast<unsigned char>(group);
        }
    };
    add("ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz_0123456789", JoinGroup::kWord);
    add("/*<>=&|#!\\\n\r", JoinGroup::kPunctuator);
    add(" \t\v\f\n\r", JoinGroup::kBlank);
    add("\t\v\f\n\r\\\"'", JoinGroup::kAlone);
    return groups;
}();

[[nodiscard]] inline unsigned joinGroupsOf(char byte) noexcept {
    return kJoinGroups[static_cast<unsigned char>(byte)];
}

/// The same as `mayJoin`, told by the bytes that meet alone, and so more often true.
[[nodiscard]] inline bool mayMeet(char left, char right) noexcept {
    constexpr unsigned kTokens = JoinGroup::kWord | JoinGroup::kPunctuator;
    return (joinGroupsOf(left) & joinGroupsOf(right) & kTokens) != 0;
}

/// Tells whether a token is a quote that no other closed where it was read.
[[nodiscard]] inline bool isLoneQuote(const Token& token) noexcept {
    return token.kind == TokenKind::OTHER && (token.text == "\"" || token.text == "'");
}

}  // namespace umpre

#endif
