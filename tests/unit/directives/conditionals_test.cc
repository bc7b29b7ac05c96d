// SPDX-License-Identifier: MIT
#include "directives/conditionals.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/directive_fixture.h"

namespace umpre {
namespace {

using testing::DirectiveFixture;
using enum TokenKind;

constexpr std::string_view kInvalidCharacters =
    "Invalid characters appear before a new-line in the preprocessor directive";

// Carries out all directives of a text. Text is kept if it is active, a character for each token.
struct ConditionalFixture : DirectiveFixture {
    explicit ConditionalFixture(std::string_view text) : DirectiveFixture(text) {
        define("X", "1");
        define("ZERO", "0");
        define({"F", {"x"}, "x"});
        conditionals.enterFileGroups();
    }

    // Carries out the directive that comes next.
    void carryOutOne() { EXPECT_TRUE(conditionals.carryOut(readWord())); }

    // Carries out every directive; returns the active text between them.
    [[nodiscard]] std::string run() {
        std::string active;
        for (TokenKind kind = sources.peek(); kind != END_OF_INPUT; kind = sources.peek()) {
            if (kind == HASH) {
                carryOutOne();
                continue;
            }
            const Token token = sources.next();
            active.append(conditionals.skipping() ? "" : token.text);
        }
        conditionals.closeFileGroups();
        return active;
    }

    Conditionals conditionals{sources, macros, expander, lexer, reporter};
};

struct Row {
    std::string_view text;
    std::string_view active;
    std::string_view report;
};

void expectRuns(const std::vector<Row>& table) {
    for (const Row& row : table) {
        ConditionalFixture f(row.text);
        EXPECT_EQ(f.run(), row.active) << row.text;
        EXPECT_EQ(f.reporter.report(), row.report) << row.text;
    }
}

TEST(Conditionals, CarryOutSixWordsAndNoOthers) {
    for (int code = 0; code <= static_cast<int>(UINT_HEX); ++code) {
        const auto kind = static_cast<TokenKind>(code);
        ConditionalFixture f(" X\n");
        EXPECT_EQ(f.conditionals.carryOut(kind), kind >= KW_IF && kind <= KW_ENDIF)
            << ::testing::PrintToString(kind);
    }
}

TEST(Conditionals, DecideByACondition) {
    expectRuns({
        {"#if 1\na#endif\nb", "\na\nb", ""},
        {"#if 0\na#endif\nb", "\nb", ""},
        {"#if X && F(X) == 1\na#endif", "\na", ""},
        {"#if ZERO\na#endif", "", ""},
        {"#if UNKNOWN\na#endif", "", ""},
        {"#if defined X\na#endif", "\na", ""},
        {"#if !defined(X)\na#endif", "", ""},
        {"#if -1u\na#endif", "\na", ""},
    });
}

TEST(Conditionals, DecideByADefinition) {
    expectRuns({
        {"#ifdef X\na#endif", "\na", ""},
        {"#ifdef Y\na#endif", "", ""},
        {"#ifndef X\na#endif", "", ""},
        {"#ifndef Y\na#endif", "\na", ""},
        {"#ifdef \\\n X /* c */\na#endif", "\na", ""},
        {"#ifndef if\na#endif", "\na", ""},
    });
}

TEST(Conditionals, TakeOneBranch) {
    expectRuns({
        {"#if 1\na#elif 1\nb#else\nc#endif\nd", "\na\nd", ""},
        {"#if 0\na#elif 1\nb#elif 1\nc#else\nd#endif", "\nb", ""},
        {"#if 0\na#elif 0\nb#else\nc#endif", "\nc", ""},
        {"#ifdef X\na#else\nb#endif", "\na", ""},
        {"#ifndef X\na#else\nb#endif", "\nb", ""},
        {"#ifdef Y\na#elif X\nb#endif", "\nb", ""},
    });
}

TEST(Conditionals, NestInActiveAndInSkippedText) {
    expectRuns({
        {"#if 0\n#if 1\na#else\nb#endif\nc#endif\nd", "\nd", ""},
        {"#if 1\n#if 0\na#else\nb#endif\nc#endif\nd", "\n\nb\nc\nd", ""},
        {"#if 1\na#else\n#ifdef X\nb#elif 1\nc#endif\n#endif", "\na", ""},
    });
}

TEST(Conditionals, DoNotLookAtConditionsThatDecideNothing) {
    expectRuns({
        {"#if 0\n#if (\n#elif (\n#ifdef\n\n#ifndef 3\n#endif\n#endif\n#endif\n#endif\na", "\na",
         ""},
        {"#if 1\n#elif (\n#elif 1/0\n#endif\na", "\n\na", ""},
    });
}

TEST(Conditionals, TakeABadConditionForAFalseOne) {
    expectRuns({
        {"#if\na#else\nb#endif", "\nb", "Lexical element expected"},
        {"#if 1 +\na#else\nb#endif", "\nb", "Lexical element expected"},
        {"#if 0\n#elif (1\na#elif 1\nb#endif", "\nb", "\")\" expected"},
        {"#if @ 1 2\na#else\nb#endif", "\nb", "Lexical element expected"},
    });
}

TEST(Conditionals, ReportWhatFollowsACondition) {
    expectRuns({
        {"#if 1 2\na#endif", "\na", kInvalidCharacters},
        {"#if 0 2\na#else\nb#endif", "\nb", kInvalidCharacters},
        {"#if 0\n#elif 1 = 2\na#endif", "\na", kInvalidCharacters},
        {"#if 1 /* c */ // d\na#endif", "\na", ""},
    });
}

TEST(Conditionals, ReportWhatFollowsAName) {
    expectRuns({
        {"#ifdef X junk\na#endif", "junk\na", kInvalidCharacters},
        {"#ifdef Y junk\na#else\nb#endif", "\nb", kInvalidCharacters},
        {"#ifndef Y junk\na#endif", "junk\na", kInvalidCharacters},
    });
}

TEST(Conditionals, TakeAMissingNameForAFalseCondition) {
    expectRuns({
        {"#ifdef 3 x\na#else\nb#endif", "\nb", "An identifier is expected after \"#ifdef\""},
        {"#ifndef \"X\"\na#elif 1\nb#endif", "\nb", "An identifier is expected after \"#ifndef\""},
        {"#ifdef defined\na#else\nb#endif", "\nb", "An identifier is expected after \"#ifdef\""},
    });
}

TEST(Conditionals, SkipTheNextLineWhereTheLineEndStandsForTheName) {
    expectRuns({
        {"#ifdef\n#else\na#else\nb#endif", "\nb", "An identifier is expected after \"#ifdef\""},
        {"#ifndef  \nx\n#else\nb#endif", "\nb", "An identifier is expected after \"#ifndef\""},
    });
}

TEST(Conditionals, ReportAnElifThatBelongsNowhere) {
    expectRuns({
        {"#elif 1\na", "a", "No \"#if\" directive associated to \"elif\""},
        {"#if 1\n#else\n#elif 1\na#endif\nb", "\n\nb",
         "Cannot use an \"#elif\" directive after an \"#else\""},
        {"#if 0\n#else\n#elif (\na#endif\nb", "\na\nb",
         "Cannot use an \"#elif\" directive after an \"#else\""},
    });
}

TEST(Conditionals, ReportAnElseThatBelongsNowhere) {
    expectRuns({
        {"#else\na", "\na", "No \"#if\" directive associated to \"#else\""},
        {"#if 1\na#else\nb#else\nc#endif\nd", "\na\nd",
         "Cannot use another \"#else\" directive after an \"#else\""},
        {"#if 0\na#else\nb#else\nc#endif\nd", "\nb\nc\nd",
         "Cannot use another \"#else\" directive after an \"#else\""},
    });
}

TEST(Conditionals, ReportAnEndifThatBelongsNowhere) {
    expectRuns({
        {"#endif\na", "\na", "No \"#if\" directive associated to \"#endif\""},
        {"#if 0\n#endif\n#endif x\na", "\n x\na", "No \"#if\" directive associated to \"#endif\""},
    });
}

TEST(Conditionals, LeaveTheRestOfElseAndEndifAsText) {
    expectRuns({
        {"#if 0\n#else a\n#endif b\n", " a\n b\n", ""},
        {"#if 1\n#else a\n#endif b\n", "\n b\n", ""},
    });
}

TEST(Conditionals, ReportOpenGroupsOnceAtTheEndOfAFile) {
    expectRuns({
        {"#if 1\n#if 0\n", "\n", "Unterminated \"#if\" conditional"},
        {"#ifdef X", "", "Unterminated \"#if\" conditional"},
        {"#if 1\n#endif\n", "\n\n", ""},
    });
}

TEST(Conditionals, AreActiveAgainAfterTheGroupsOfAFileAreClosed) {
    ConditionalFixture f("#if 0\n#if 1\n");
    f.carryOutOne();
    f.sources.skipToEndOfLine();
    f.carryOutOne();
    EXPECT_TRUE(f.conditionals.skipping());
    f.conditionals.closeFileGroups();
    EXPECT_FALSE(f.conditionals.skipping());
    EXPECT_EQ(f.reporter.report(), "Unterminated \"#if\" conditional");
}

TEST(Conditionals, AFileCannotCloseTheGroupsOfItsIncluder) {
    ConditionalFixture f("#if 1\n#endif\n#endif\n");
    f.carryOutOne();
    f.conditionals.enterFileGroups();
    f.sources.skipToEndOfLine();
    f.carryOutOne();
    EXPECT_EQ(f.reporter.report(), "No \"#if\" directive associated to \"#endif\"");
    f.conditionals.closeFileGroups();
    f.sources.skipToEndOfLine();
    f.carryOutOne();
    f.conditionals.closeFileGroups();
    EXPECT_EQ(f.reporter.reports().size(), 1U);
}

TEST(Conditionals, LetADivisionFaultThrough) {
    ConditionalFixture f("#if 1 / 0\n");
    EXPECT_THROW(f.carryOutOne(), ArithmeticFault);
}

}  // namespace
}  // namespace umpre
