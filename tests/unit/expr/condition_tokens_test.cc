// SPDX-License-Identifier: MIT
#include "expr/condition_tokens.h"

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "expr/evaluator.h"
#include "support/recording_comment_sink.h"

namespace umpre {
namespace {

using enum TokenKind;

// A line "#if" with some macros around.
struct ConditionTokensTest : ::testing::Test {
    ConditionTokensTest() {
        macros.defineMacro("__LINE__", "");
        for (const auto& [name, text] :
             std::vector<std::pair<std::string_view, std::string_view>>{{"N", "3"},
                                                                        {"NN", "N"},
                                                                        {"SUM", "(N + 4)"},
                                                                        {"EMPTY", ""},
                                                                        {"SELF", "SELF + 1"},
                                                                        {"A", "B"},
                                                                        {"B", "A"},
                                                                        {"LESS", "<"},
                                                                        {"MINUS", "-1"},
                                                                        {"SLASH", "/"},
                                                                        {"ARCH_X86", "1"},
                                                                        {"TAB", "1\t"},
                                                                        {"COMMENT", "1 /* a */"},
                                                                        {"STRING", "\"a\""},
                                                                        {"HAS", "defined"},
                                                                        {"HAS_N", "defined(N)"},
                                                                        {"HEX", "0x1"}}) {
            macros.defineMacro(name, text);
        }
        macros.define("F", {"x", "x", true});
        std::string text = "0";
        for (int depth = 0; depth < 20; ++depth) {
            const std::string name = "D" + std::to_string(depth);
            macros.defineMacro(name, text);
            text = name;
        }
    }

    // The tokens' texts with blanks between them, and "?" if the condition is not told.
    [[nodiscard]] std::string tokensOf(std::string_view condition) {
        file.openText("main", std::string("#if ").append(condition).append("\n"));
        DirectiveLine line(file);
        tokens.read(line);
        std::string texts;
        while (tokens.peek() != END_OF_INPUT) {
            texts.append(texts.empty() ? "" : " ").append(tokens.next().text);
        }
        return tokens.isTold() ? texts : "?";
    }

    // The condition's value, or "?".
    [[nodiscard]] std::string valueOf(std::string_view condition) {
        file.openText("main", std::string("#if ").append(condition).append("\n"));
        DirectiveLine line(file);
        tokens.read(line);
        Evaluator<ConditionTokens> evaluator(tokens, macros, tokens);
        bool ok = true;
        const ExprValue value = evaluator.evaluate(ok);
        const bool isWhole = tokens.peek() == END_OF_INPUT;
        return tokens.isTold() && isWhole && ok ? std::to_string(value.value) : "?";
    }

    MacroTable macros;
    testing::RecordingCommentSink comments;
    CppFileScanner file{comments};
    ConditionTokens tokens{macros};
};

TEST_F(ConditionTokensTest, LeaveBlanksOut) {
    EXPECT_EQ(tokensOf(""), "");
    EXPECT_EQ(tokensOf(" 1+x >=0x1fu\t/* a */&&/**/!\\\n y // b"), "1 + x >= 0x1fu && ! y");
}

TEST_F(ConditionTokensTest, PutAMacrosTextInThePlaceOfItsName) {
    EXPECT_EQ(tokensOf("N"), "3");
    EXPECT_EQ(tokensOf("(NN)*SUM"), "( 3 ) * ( 3 + 4 )");
    EXPECT_EQ(tokensOf("EMPTY"), "");
    EXPECT_EQ(tokensOf("1 EMPTY + EMPTY 2"), "1 + 2");
    EXPECT_EQ(tokensOf("-MINUS ARCH_X86"), "- - 1 1");
    EXPECT_EQ(tokensOf("M NNN"), "M NNN");
}

TEST_F(ConditionTokensTest, DoNotExpandANameInItsOwnText) {
    EXPECT_EQ(tokensOf("SELF SELF"), "SELF + 1 SELF + 1");
    EXPECT_EQ(tokensOf("A + B"), "A + B");
}

TEST_F(ConditionTokensTest, KeepTheOperandOfDefined) {
    EXPECT_EQ(tokensOf("defined N + N"), "defined N + 3");
    EXPECT_EQ(tokensOf("defined ( N ) N"), "defined ( N ) 3");
    EXPECT_EQ(tokensOf("defined(F)"), "defined ( F )");
    EXPECT_EQ(tokensOf("defined defined N"), "defined defined 3");
    EXPECT_EQ(tokensOf("defined ((N"), "defined ( ( 3");
    EXPECT_EQ(tokensOf("HAS N N"), "defined N 3");
    EXPECT_EQ(tokensOf("HAS(N)"), "defined ( N )");
    EXPECT_EQ(tokensOf("HAS_N N"), "defined ( N ) 3");
    EXPECT_EQ(tokensOf("defined __LINE__"), "defined __LINE__");
}

TEST_F(ConditionTokensTest, DoNotTellTokensThatMayBecomeOne) {
    for (const std::string_view condition :
         {"1N", "1EMPTY N 2N", "<LESS", "LESS<", "<EMPTY<", "!EMPTY=", "&EMPTY&", "SLASH/ 1",
          "SLASH*", "/SLASH", "1HEX", ">EMPTY EMPTY>EMPTY="}) {
        EXPECT_EQ(tokensOf(condition), "?") << condition;
    }
    EXPECT_EQ(tokensOf("LESS LESS"), "< <");
    EXPECT_EQ(tokensOf("(EMPTY)"), "( )");
    EXPECT_EQ(tokensOf("1<EMPTY 2"), "1 < 2");
}

TEST_F(ConditionTokensTest, DoNotTellWhatTheyDoNotKnow) {
    for (const std::string_view condition :
         {"F", "F(1)", "__LINE__", "'a'", "\"a\"", "STRING", "COMMENT", "TAB", "1 /* a\n*/",
          "1 // a\r", "1\r", "1 \\\r", "= 1", "1 @", "\xE9", "1.0", "D18"}) {
        EXPECT_EQ(tokensOf(condition), "?") << condition;
    }
    EXPECT_EQ(tokensOf("D15"), "0");
}

TEST_F(ConditionTokensTest, ExpandNothingWhereEachMacroIsToldOf) {
    file.openText("main", "#if N\n");
    DirectiveLine line(file);
    ConditionTokens observed(macros, true);
    observed.read(line);
    EXPECT_EQ(observed.next().kind, END_OF_INPUT);
    EXPECT_FALSE(observed.isTold());
}

TEST_F(ConditionTokensTest, AreEvaluated) {
    EXPECT_EQ(valueOf("N > 2 && !defined(M) || SUM == 8"), "1");
    EXPECT_EQ(valueOf("(SUM << 2) ? -MINUS : 5"), "1");
    EXPECT_EQ(valueOf("0x10u + 010 - 2L"), "22");
    EXPECT_EQ(valueOf("defined HAS + defined M"), "1");
    EXPECT_EQ(valueOf("if + M"), "0");
}

TEST_F(ConditionTokensTest, AreNotToldWhereThereIsAnError) {
    for (const std::string_view condition :
         {"", "1 +", "(1", "1)", "1 1", "1 ? 2", "M(1)", "(1)(2)", "defined", "defined 1",
          "defined(N", "defined if", "defined(N N", ",", "1, 2", "#", "1 defined N", "EMPTY"}) {
        EXPECT_EQ(valueOf(condition), "?") << condition;
    }
}

TEST_F(ConditionTokensTest, BeginAnewWithEachLine) {
    EXPECT_EQ(tokensOf("defined ("), "defined (");
    EXPECT_EQ(tokensOf("N"), "3");
    EXPECT_EQ(tokensOf("'"), "?");
    EXPECT_EQ(tokensOf("N"), "3");
}

}  // namespace
}  // namespace umpre
