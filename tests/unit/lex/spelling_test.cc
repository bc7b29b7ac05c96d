// SPDX-License-Identifier: MIT
#include "lex/spelling.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "lex/text_lexer.h"

namespace umpre {
namespace {

// The first token of a text, as the generated scanner has it.
[[nodiscard]] Token firstToken(LexedText& text, std::string_view of) {
    TextLexer lexer({.plainRoad = true});
    lexer.append(text, of);
    return {text.kind(0), text.text(0)};
}

TEST(Spelling, KnowsTheKindsOfNames) {
    for (const std::string_view name : {"if",    "ifdef",   "ifndef",   "else",     "elif",
                                        "endif", "include", "define",   "undef",    "line",
                                        "error", "pragma",  "ident",    "defined",  "i",
                                        "iff",   "If",      "IF",       "fi",       "_if",
                                        "if1",   "definee", "includes", "defined_", "an_identifier",
                                        "_"}) {
        LexedText text;
        EXPECT_EQ(kindOfName(name), firstToken(text, name).kind) << name;
    }
    EXPECT_EQ(kindOfName(""), TokenKind::IDENTIFIER);
}

TEST(Spelling, EndsANameWhereTheRuleDoes) {
    for (const std::string text : {"a", "_a1Z_9 b", "azAZ09_[", "a\x80", "z{", "Z`", "a/", "a:"}) {
        LexedText lexed;
        const std::string_view name = firstToken(lexed, text).text;
        EXPECT_EQ(nameEnd(text.data()), text.data() + name.size()) << text;
        const std::string padded = text + std::string(16, ' ');
        EXPECT_EQ(nameEndAhead(padded.data()), padded.data() + name.size()) << text;
    }
}

TEST(Spelling, EndsNamesOfAnySize) {
    for (std::size_t size = 0; size < 70; ++size) {
        const std::string text = std::string(size, 'n') + std::string(16, ' ');
        EXPECT_EQ(nameEndAhead(text.data()), text.data() + size);
    }
}

TEST(Spelling, SplitsNumbersAsTheRulesDo) {
    for (const std::string text :
         {"0",      "1",    "10L",   "10l",        "10U",   "10u",   "10UL",   "10LU",
          "10uL",   "10lu", "10LL",  "10UU",       "10ULL", "10LUL", "07",     "08",
          "007u",   "07L",  "0u",    "0lu",        "0x1",   "0X1fL", "0xABCu", "0xfLu",
          "0x",     "0xg",  "0xL",   "0x1g",       "1e5",   "1.5",   "1_000",  "0b1",
          "123abc", "9x",   "0x1U+", "4294967296", "1 2",   "0\x80", "0xa\xE9"}) {
        LexedText lexed;
        const Token expected = firstToken(lexed, text);
        const Token number = numberAt(text.data());
        EXPECT_EQ(number.kind, expected.kind) << text;
        EXPECT_EQ(number.text, expected.text) << text;
    }
}

TEST(Spelling, TellsNamesNumbersAndPunctuators) {
    for (const std::string text :
         {"if(", "x1+", "07uL)", "#",  "##", "###", "(",  ")",   ",", "?",  ":",  "|",   "||",
          "|||", "^",   "&",     "&&", "==", "!",   "!=", "!==", "<", "<=", "<<", "<<=", ">",
          ">=",  ">>",  "+",     "++", "-",  "->",  "*",  "*/",  "/", "/=", "%",  "~"}) {
        LexedText lexed;
        const Token expected = firstToken(lexed, text);
        const Token token = tokenAt(text.data());
        EXPECT_EQ(token.kind, expected.kind) << text;
        EXPECT_EQ(token.text, expected.text) << text;
    }
}

TEST(Spelling, TakesOneByteOfWhatItDoesNotTell) {
    for (const std::string text : {"\"a\"", "'a'", "//", "/* a */", "=", " ", "\\\n", "\n", "\r",
                                   "", "\xE9", ".", "@", "$a"}) {
        const Token token = tokenAt(text.c_str());
        EXPECT_EQ(token.kind, TokenKind::OTHER) << text;
        EXPECT_EQ(token.text, std::string_view(text.c_str(), 1)) << text;
    }
}

}  // namespace
}  // namespace umpre
