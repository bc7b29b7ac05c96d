// SPDX-License-Identifier: MIT
#include "lex/pieces.h"

#include <gtest/gtest.h>

#include "support/lexeme.h"

namespace umpre {
namespace {

using testing::Lexemes;
using testing::lexemesOf;
using enum TokenKind;

struct PiecesTest : ::testing::Test {
    NoExpandSets sets;
    const Name a{"a"};
    const Name b{"b"};
    const NoExpandSet setA = sets.with({}, a);
    const NoExpandSet setB = sets.with({}, b);
    Pieces pieces;
};

TEST_F(PiecesTest, AreEmptyAtFirst) {
    EXPECT_EQ(pieces.tokens().size(), 0U);
    EXPECT_TRUE(pieces.runs().empty());
}

TEST_F(PiecesTest, KeepEachTokenWithItsSet) {
    pieces.append({IDENTIFIER, "x"}, setA);
    pieces.append({PLUS, "+"}, setB);
    pieces.append({IDENTIFIER, "y"}, setA);
    EXPECT_EQ(lexemesOf(pieces.tokens()),
              (Lexemes{{IDENTIFIER, "x"}, {PLUS, "+"}, {IDENTIFIER, "y"}}));
    ASSERT_EQ(pieces.runs().size(), 3U);
    EXPECT_EQ(pieces.runs()[0].end, 1U);
    EXPECT_EQ(pieces.runs()[0].noExpand, setA);
    EXPECT_EQ(pieces.runs()[1].end, 2U);
    EXPECT_EQ(pieces.runs()[1].noExpand, setB);
    EXPECT_EQ(pieces.runs()[2].end, 3U);
    EXPECT_EQ(pieces.runs()[2].noExpand, setA);
}

TEST_F(PiecesTest, WithEqualSetsSideBySideAreOneRun) {
    pieces.append({IDENTIFIER, "x"}, setA);
    pieces.append({PLUS, "+"}, setA);
    ASSERT_EQ(pieces.runs().size(), 1U);
    EXPECT_EQ(pieces.runs()[0].end, 2U);
    EXPECT_EQ(pieces.runs()[0].noExpand, setA);
}

TEST_F(PiecesTest, TakeTokensOfAText) {
    LexedText text;
    text.append(IDENTIFIER, "x");
    text.append(COMMA, ",");
    text.append(IDENTIFIER, "y");
    pieces.append(text, 1, 3, setB);
    EXPECT_EQ(lexemesOf(pieces.tokens()), (Lexemes{{COMMA, ","}, {IDENTIFIER, "y"}}));
    ASSERT_EQ(pieces.runs().size(), 1U);
    EXPECT_EQ(pieces.runs()[0].end, 2U);
    EXPECT_EQ(pieces.runs()[0].noExpand, setB);
}

TEST_F(PiecesTest, GiveTokensAddedFromOutsideTheSetTheyAreClosedWith) {
    pieces.append({IDENTIFIER, "x"}, setA);
    pieces.open().append(PLUS, "+");
    pieces.open().append(INT_DEC, "1");
    pieces.close(setB);
    ASSERT_EQ(pieces.runs().size(), 2U);
    EXPECT_EQ(pieces.runs()[0].end, 1U);
    EXPECT_EQ(pieces.runs()[1].end, 3U);
    EXPECT_EQ(pieces.runs()[1].noExpand, setB);
}

TEST_F(PiecesTest, AreEmptyAfterARestart) {
    pieces.append({IDENTIFIER, "x"}, setA);
    pieces.restart();
    EXPECT_EQ(pieces.tokens().size(), 0U);
    EXPECT_TRUE(pieces.runs().empty());
}

}  // namespace
}  // namespace umpre
