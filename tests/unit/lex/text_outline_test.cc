// SPDX-License-Identifier: MIT
#include "lex/text_outline.h"

#include <string_view>

#include <gtest/gtest.h>

#include "lex/text_lexer.h"

namespace umpre {
namespace {

[[nodiscard]] TextOutline outlineOf(std::string_view text) {
    TextLexer lexer;
    return lexer.lexed(text)->outline();
}

TEST(TextOutline, OfOrdinaryTextIsPlain) {
    for (const std::string_view text : {"", "a", "a + b", "f(1.0f, \"x\" 'y')", "a==b&&c"}) {
        EXPECT_TRUE(outlineOf(text).isPlain) << text;
    }
}

TEST(TextOutline, OfWhatLexingAgainMayChangeIsNot) {
    for (const std::string_view text : {"a  b", "a\tb", "a\nb", "\"", "it's", "a/*\n*/b"}) {
        EXPECT_FALSE(outlineOf(text).isPlain) << text;
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
