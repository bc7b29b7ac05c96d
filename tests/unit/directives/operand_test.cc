// SPDX-License-Identifier: MIT
#include "directives/operand.h"

#include <gtest/gtest.h>

#include "support/macro_fixture.h"

namespace umpre {
namespace {

using testing::Lexemes;
using testing::MacroFixture;
using enum TokenKind;

TEST(Operand, GathersUpToTheEndOfTheLine) {
    MacroFixture f(" a  + \"b\\n\" 1.5 \nnext");
    EXPECT_EQ(gatherLine(f.sources), " a  + \"b\\n\" 1.5 ");
    EXPECT_EQ(f.rest(), "\nnext");
}

TEST(Operand, GathersUpToTheEndOfTheInput) {
    MacroFixture f("a b");
    EXPECT_EQ(gatherLine(f.sources), "a b");
    EXPECT_EQ(gatherLine(f.sources), "");
}

TEST(Operand, GathersACommentAsABlank) {
    MacroFixture f("a/* b */c // d\n");
    EXPECT_EQ(gatherLine(f.sources), "a c  ");
}

TEST(Operand, GathersContinuationsOrDropsThem) {
    MacroFixture kept("a\\\n b\nnext");
    EXPECT_EQ(gatherLine(kept.sources), "a\\\n b");
    MacroFixture dropped("a\\\n b\nnext");
    EXPECT_EQ(gatherUncontinuedLine(dropped.sources), "a b");
    EXPECT_EQ(dropped.rest(), "\nnext");
}

TEST(Operand, DoesNotExpandWhatIsGathered) {
    MacroFixture f("N\n");
    f.define("N", "3");
    EXPECT_EQ(gatherLine(f.sources), "N");
}

TEST(Operand, IsReadExpandedAndOnItsOwn) {
    MacroFixture f("next");
    f.define("N", "3");
    {
        const ExpandedOperand operand(f.sources, f.expander, f.lexer, "a N", LineKind::Operand);
        EXPECT_EQ(f.rest(), "a 3");
        EXPECT_EQ(f.sources.peek(), END_OF_INPUT);
    }
    EXPECT_EQ(f.rest(), "next");
}

TEST(Operand, IsDroppedWithWhatIsLeftOfIt) {
    MacroFixture f("next");
    {
        const ExpandedOperand operand(f.sources, f.expander, f.lexer, "a b", LineKind::Operand);
        EXPECT_EQ(f.sources.next().text, "a");
    }
    EXPECT_EQ(f.rest(), "next");
}

TEST(Operand, MayBeNothing) {
    MacroFixture f("next");
    f.define("EMPTY", "");
    {
        const ExpandedOperand operand(f.sources, f.expander, f.lexer, "EMPTY", LineKind::Operand);
        EXPECT_EQ(f.sources.next().kind, END_OF_INPUT);
    }
    EXPECT_EQ(f.rest(), "next");
}

TEST(Operand, LetsTokensOfDifferentMacrosMeet) {
    MacroFixture f("");
    f.define("L", "<");
    const ExpandedOperand operand(f.sources, f.expander, f.lexer, "L<", LineKind::Operand);
    EXPECT_EQ(testing::readLexemes(f.sources), (Lexemes{{LSHIFT, "<<"}}));
}

TEST(Operand, OfAConditionKeepsTheNamesOfDefined) {
    MacroFixture f("");
    f.define("N", "3");
    const ExpandedOperand operand(f.sources, f.expander, f.lexer, "defined N + defined(N) + N",
                                  LineKind::Condition);
    EXPECT_EQ(f.rest(), "defined N + defined(N) + 3");
}

}  // namespace
}  // namespace umpre
