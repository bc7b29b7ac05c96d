// SPDX-License-Identifier: MIT
#include "lex/text_outline.h"

#include <cstddef>
#include <string_view>
#include <tuple>
#include <vector>

#include <gtest/gtest.h>

#include "lex/text_lexer.h"

namespace umpre {
namespace {

[[nodiscard]] TextOutline outlineOf(std::string_view text) {
    TextLexer lexer;
    return lexer.lexed(text)->outline();
}

TEST(TextOutline, OfOrdinaryTextIsPlain) {
    for (const std::string_view text :
         {"", "a", "a + b", "f(1.0f, \"x\" 'y')", "a==b&&c", "it's"}) {
        EXPECT_TRUE(outlineOf(text).isPlain) << text;
    }
}

TEST(TextOutline, OfWhatLexingAgainMayChangeIsNot) {
    for (const std::string_view text : {"a  b", "a\tb", "a\nb", "' \n'", "a/*\n*/b"}) {
        EXPECT_FALSE(outlineOf(text).isPlain) << text;
    }
}

TEST(TextOutline, OfTextsThatWereLexedApartIsPlainIfTheyDoNotMeet) {
    TextLexer lexer;
    for (const auto& [first, second, isPlain] :
         {std::tuple{"a+", "b", true}, {"a", "b", false}, {"it's", " isn't", false}}) {
        LexedText text;
        lexer.append(text, first);
        lexer.append(text, second);
        EXPECT_EQ(text.outline().isPlain, isPlain) << first << second;
    }
}

TEST(TextOutline, KnowsWhereParenthesesAreClosed) {
    const TextOutline outline = outlineOf("f(a,(b))(c");
    EXPECT_EQ(outline.closing, (std::vector<std::size_t>{0, 7, 0, 0, 6, 0, 0, 0, 0, 0}));
}

TEST(TextOutline, LeavesOutAClosingParenthesisTooMany) {
    EXPECT_EQ(outlineOf("a)(b)").closing, (std::vector<std::size_t>{0, 0, 4, 0, 0}));
}

}  // namespace
}  // namespace umpre
