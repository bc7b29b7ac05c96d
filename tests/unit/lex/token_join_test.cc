// SPDX-License-Identifier: MIT
#include "lex/token_join.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "lex/text_lexer.h"
#include "support/lexeme.h"

namespace umpre {
namespace {

using testing::Lexemes;
using testing::lexemesOf;
using enum TokenKind;

// Tokens of every kind, with several beginnings and ends.
constexpr std::string_view kTokens[] = {
    "a", "_",  "x1", "e5", "f",  "u",  "L",   "x",     "xf",    "defined", "if", "0",
    "1", "07", "9",  "1l", "1u", "0x", "0x1", "0xfUL", "\"s\"", "'c'",     " ",  "\t",
    "/", "*",  "//", "/*", "<",  ">",  "<<",  ">>",    "<=",    ">=",      "=",  "==",
    "!", "!=", "&",  "&&", "|",  "||", "#",   "##",    "+",     "-",       "(",  ")",
    ",", ".",  "\\", "@",  "^",  "%",  "~",   "?",     ":"};

[[nodiscard]] Lexemes lexed(std::string_view text) {
    TextLexer lexer;
    return lexemesOf(*lexer.lexed(text));
}

// What is one token by itself.
[[nodiscard]] bool isOneToken(const Lexemes& lexemes, std::string_view text) {
    return lexemes.size() == 1 && lexemes.front().text == text;
}

TEST(TokenJoin, SaysSoWhereTwoTokensBecomeOthers) {
    for (const std::string_view left : kTokens) {
        for (const std::string_view right : kTokens) {
            const Lexemes lefts = lexed(left);
            const Lexemes rights = lexed(right);
            if (!isOneToken(lefts, left) || !isOneToken(rights, right)) {
                continue;
            }
            const std::string both = std::string(left) + std::string(right);
            const bool stay = lexed(both) == Lexemes{lefts.front(), rights.front()};
            const bool may = mayJoin({lefts.front().kind, left}, {rights.front().kind, right});
            EXPECT_TRUE(stay || may) << both;
        }
    }
}

TEST(TokenJoin, LetsCommonNeighboursStayApart) {
    EXPECT_FALSE(mayJoin({IDENTIFIER, "a"}, {LEFT_PARENTHESIS, "("}));
    EXPECT_FALSE(mayJoin({LEFT_PARENTHESIS, "("}, {IDENTIFIER, "a"}));
    EXPECT_FALSE(mayJoin({INT_OCT, "0"}, {IDENTIFIER, "f"}));
    EXPECT_FALSE(mayJoin({OTHER, "."}, {INT_DEC, "5"}));
    EXPECT_FALSE(mayJoin({STAR, "*"}, {SLASH, "/"}));
    EXPECT_FALSE(mayJoin({IDENTIFIER, "a"}, {WHITESPACE, " "}));
}

TEST(TokenJoin, FearsThatATokenWithoutTextIsLost) {
    EXPECT_TRUE(mayJoin({NEWLINE, ""}, {IDENTIFIER, "a"}));
    EXPECT_TRUE(mayJoin({IDENTIFIER, "a"}, {NEWLINE, ""}));
}

TEST(TokenJoin, KnowsLoneQuotes) {
    EXPECT_TRUE(isLoneQuote({OTHER, "\""}));
    EXPECT_TRUE(isLoneQuote({OTHER, "'"}));
    EXPECT_FALSE(isLoneQuote({OTHER, "@"}));
    EXPECT_FALSE(isLoneQuote({CHAR_LITERAL, "'a'"}));
}

}  // namespace
}  // namespace umpre
