// SPDX-License-Identifier: MIT
#include "macros/argument_slices.h"

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "support/argument_lists.h"
#include "support/source_fixture.h"

namespace umpre {
namespace {

using testing::SourceFixture;
using testing::Texts;
using testing::textsOf;

struct Row {
    std::string_view text;
    std::size_t parameterCount;
    Texts arguments;
    std::string_view rest;
};

TEST(ArgumentSlices, AreTakenFromAList) {
    const std::vector<Row> table{
        {"() x", 0, {}, " x"},
        {"(a)", 1, {"a"}, ""},
        {"( a )b", 1, {"a"}, "b"},
        {"(a, b + c)", 2, {"a", "b + c"}, ""},
        {"(,a)", 2, {"", "a"}, ""},
        {"(a,)", 1, {"a"}, ""},
        {"((a, b), c(d))", 2, {"(a, b)", "c(d)"}, ""},
        {"(a) (b)", 1, {"a"}, " (b)"},
    };
    for (const Row& row : table) {
        SCOPED_TRACE(row.text);
        SourceFixture f("");
        f.pushText(row.text);
        ArgumentList arguments;
        ASSERT_TRUE(takeArgumentSlices(*f.sources.listReadNow(), row.parameterCount, arguments));
        EXPECT_EQ(textsOf(arguments), row.arguments);
        EXPECT_EQ(f.rest(), row.rest);
    }
}

TEST(ArgumentSlices, AreLeftToBeReadAsTokens) {
    const std::vector<Row> table{
        {"(a", 1, {}, "(a"},          // goes on below
        {"(", 0, {}, "("},            // the same
        {"(a,", 2, {}, "(a,"},        // the same
        {"(a, b)", 1, {}, "(a, b)"},  // too many
        {"(a)", 2, {}, "(a)"},        // too few
        {"()", 1, {}, "()"},          // too few
        {"(a  b)", 1, {}, "(a  b)"},  // two blanks become one
        {"(a\tb)", 1, {}, "(a\tb)"},  // a tab becomes a space
        {"(a\nb)", 1, {}, "(a\nb)"},  // a line end becomes a space
        {"(\na)", 1, {}, "(\na)"},    // a line end is dropped
    };
    for (const Row& row : table) {
        SCOPED_TRACE(row.text);
        SourceFixture f("");
        f.pushText(row.text);
        ArgumentList arguments;
        EXPECT_FALSE(takeArgumentSlices(*f.sources.listReadNow(), row.parameterCount, arguments));
        EXPECT_EQ(f.rest(), row.rest);
    }
}

TEST(ArgumentSlices, SayWhichMustBeLexedAgain) {
    NoExpandSets sets;
    SourceFixture f("");
    Pieces pieces;
    f.lexer.append(pieces.open(), "(a");
    f.lexer.append(pieces.open(), "b, c)");
    pieces.close({});
    f.sources.pushPieces(std::move(pieces));
    ArgumentList arguments;
    ASSERT_TRUE(takeArgumentSlices(*f.sources.listReadNow(), 2, arguments));
    EXPECT_TRUE(arguments[0].mustBeLexed);
    EXPECT_FALSE(arguments[1].mustBeLexed);
}

TEST(ArgumentSlices, OfATextThatWasLexedAsOneNeedNotBeLexedAgain) {
    SourceFixture f("");
    f.pushText("(it's, 1x, &&&)");
    ArgumentList arguments;
    ASSERT_TRUE(takeArgumentSlices(*f.sources.listReadNow(), 3, arguments));
    EXPECT_FALSE(arguments[0].mustBeLexed);
    EXPECT_FALSE(arguments[1].mustBeLexed);
    EXPECT_FALSE(arguments[2].mustBeLexed);
}

TEST(ArgumentSlices, HaveTheSetOfTheTokenThatEndsThem) {
    NoExpandSets sets;
    const Name name{"n"};
    const NoExpandSet set = sets.with({}, name);
    SourceFixture f("");
    Pieces pieces;
    f.lexer.append(pieces.open(), "(a");
    pieces.close({});
    f.lexer.append(pieces.open(), ", b");
    pieces.close(set);
    f.lexer.append(pieces.open(), ")");
    pieces.close({});
    f.sources.pushPieces(std::move(pieces));
    ArgumentList arguments;
    ASSERT_TRUE(takeArgumentSlices(*f.sources.listReadNow(), 2, arguments));
    EXPECT_EQ(arguments[0].noExpand, set);
    EXPECT_EQ(arguments[1].noExpand, NoExpandSet());
}

TEST(ArgumentSlices, OfALongListAreFoundByItsOutline) {
    std::string inner;
    for (int depth = 0; depth < 1000; ++depth) {
        inner += "(a, ";
    }
    inner += std::string(1000, ')');
    SourceFixture f("");
    f.pushText("(x, f" + inner + ", y) z");
    ArgumentList arguments;
    ASSERT_TRUE(takeArgumentSlices(*f.sources.listReadNow(), 3, arguments));
    EXPECT_EQ(textsOf(arguments), (Texts{"x", "f" + inner, "y"}));
    EXPECT_EQ(f.rest(), " z");
}

}  // namespace
}  // namespace umpre
