// SPDX-License-Identifier: MIT
#ifndef UMPRE_FUZZ_TOKEN_RULES_H
#define UMPRE_FUZZ_TOKEN_RULES_H

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "lex/token.h"

namespace umpre::fuzz {

/// A token as the rules tell it, read by itself.
struct RuledToken {
    TokenKind kind = TokenKind::END_OF_INPUT;
    std::string text;
    std::size_t size = 0;      ///< of what was matched
    std::size_t lineEnds = 0;  ///< in what was matched
    bool isComment = false;
    bool isUnterminated = false;  ///< a comment that nothing closes
};

/// Reads the token at the beginning of a text that is not empty. This is the scanner once more, as
/// plain as it can be: every rule is tried, the longest match wins, among equals the first rule.
[[nodiscard]] RuledToken firstToken(std::string_view text);

/// Reads all tokens of a text.
[[nodiscard]] std::vector<RuledToken> allTokens(std::string_view text);

}  // namespace umpre::fuzz

#endif
