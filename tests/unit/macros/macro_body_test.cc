// SPDX-License-Identifier: MIT
#include "macros/macro_body.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "macros/macro_table.h"
#include "support/lexeme.h"
#include "support/recording_comment_sink.h"

namespace umpre {
namespace {

using testing::lexemesOf;
using enum TokenKind;

[[nodiscard]] std::string describe(const MacroBody& body, const BodyOperand& operand) {
    const std::string number = std::to_string(operand.index);
    switch (operand.kind) {
    case BodyOperand::Kind::Token: return "'" + std::string(body.tokens->text(operand.index)) + "'";
    case BodyOperand::Kind::RawArgument: return "raw " + number;
    case BodyOperand::Kind::Stringized: return "#" + number;
    }
    return {};
}

[[nodiscard]] std::string describe(const MacroBody& body, const BodyStep& step) {
    std::string text;
    switch (step.kind) {
    case BodyStep::Kind::Tokens:
        for (std::size_t index = step.first; index < step.last; ++index) {
            text += body.tokens->text(index);
        }
        return "'" + text + "'";
    case BodyStep::Kind::Effects: {
        testing::RecordingCommentSink comments;
        body.source->carryOutEffects(step.first, comments);
        return comments.effects();
    }
    case BodyStep::Kind::Argument: return "argument " + std::to_string(step.first);
    case BodyStep::Kind::Joined:
        for (std::size_t index = step.first; index < step.last; ++index) {
            text += (text.empty() ? "" : " + ") + describe(body, body.operands[index]);
        }
        return "join(" + text + ")";
    case BodyStep::Kind::Misplaced: return "misplaced";
    case BodyStep::Kind::PasteFirst: return "paste first";
    case BodyStep::Kind::PasteLast: return "paste last";
    }
    return {};
}

// Enters a definition and returns it.
[[nodiscard]] const Macro& defined(MacroTable& macros, const MacroText& definition) {
    macros.define("M", definition);
    return macros.find("M")->macro;
}

// Returns the steps of a function-like macro's body in words; those that do nothing are left out.
[[nodiscard]] std::string stepsOf(std::string_view text) {
    TextLexer lexer;
    MacroTable macros;
    const Macro& macro = defined(macros, {text, "x,y", true});
    const MacroBody& body = BodyMaker(lexer, macros).bodyOf(macro);
    std::string steps;
    for (const BodyStep& step : body.steps) {
        const std::string description = describe(body, step);
        steps += (steps.empty() || description.empty() ? "" : ", ") + description;
    }
    return steps;
}

struct Row {
    std::string_view text;
    std::string_view steps;
};

// The parameters are x and y.
void expectSteps(const std::vector<Row>& table) {
    for (const Row& row : table) {
        EXPECT_EQ(stepsOf(row.text), row.steps) << row.text;
    }
}

TEST(MacroBody, OfAnObjectLikeMacroIsItsTokens) {
    TextLexer lexer;
    MacroTable macros;
    const Macro& macro = defined(macros, {"a ## #x", "", false});
    EXPECT_EQ(lexemesOf(*BodyMaker(lexer, macros).tokensOf(macro)),
              (testing::Lexemes{{IDENTIFIER, "a"},
                                {WHITESPACE, " "},
                                {PASTE, "##"},
                                {WHITESPACE, " "},
                                {HASH, "#"},
                                {IDENTIFIER, "x"}}));
}

TEST(MacroBody, OnlyWhatIsJoinedIsKeptAsOperands) {
    TextLexer lexer;
    MacroTable macros;
    const Macro& macro = defined(macros, {"a x + y x ## 1 b #y (x) c ## d e", "x,y", true});
    EXPECT_EQ(BodyMaker(lexer, macros).bodyOf(macro).operands.size(), 5U);
}

TEST(MacroBody, OfAnObjectLikeMacroIsKeptFromTheSecondUseOn) {
    TextLexer lexer;
    MacroTable macros;
    BodyMaker maker(lexer, macros);
    const Macro& macro = defined(macros, {"x", "", false});
    (void)maker.tokensOf(macro);
    EXPECT_EQ(macro.use(), nullptr);
    const SharedText second = maker.tokensOf(macro);
    const SharedText third = maker.tokensOf(macro);
    EXPECT_EQ(&*second, &*third);
}

TEST(MacroBody, KnowsTheEntriesOfItsNames) {
    TextLexer lexer;
    MacroTable macros;
    BodyMaker maker(lexer, macros);
    const Macro& macro = defined(macros, {"M + other", "", false});
    (void)maker.tokensOf(macro);
    const SharedText tokens = maker.tokensOf(macro);
    EXPECT_EQ(tokens->name(0), macros.find("M"));
    EXPECT_EQ(tokens->name(2), nullptr);
    EXPECT_EQ(tokens->name(4), macros.findEntry("other"));
    EXPECT_FALSE(tokens->name(4)->isDefined);
}

TEST(MacroBody, OfAFunctionLikeMacroIsMadeOnce) {
    TextLexer lexer;
    MacroTable macros;
    BodyMaker maker(lexer, macros);
    const Macro& macro = defined(macros, {"x", "x", true});
    EXPECT_EQ(macro.use(), nullptr);
    const MacroBody& body = maker.bodyOf(macro);
    EXPECT_EQ(&maker.bodyOf(macro), &body);
    EXPECT_EQ(macro.use()->body.get(), &body);
}

TEST(MacroBody, IsMadeOnceForDefinitionsThatTakeTurns) {
    TextLexer lexer;
    MacroTable macros;
    BodyMaker maker(lexer, macros);
    const auto bodyOf = [&](const MacroText& definition) {
        return &maker.bodyOf(defined(macros, definition));
    };
    (void)bodyOf({"first", "", true});
    const MacroBody* const one = bodyOf({"x + y", "x,y", true});
    const MacroBody* const other = bodyOf({"x - y", "x,y", true});
    EXPECT_EQ(bodyOf({"x + y", "x,y", true}), one);
    EXPECT_EQ(bodyOf({"x - y", "x,y", true}), other);
    EXPECT_NE(bodyOf({"x + y", "x,z", true}), one);
}

TEST(MacroBody, WithoutParametersIsOneRunOfTokens) {
    expectSteps({
        {"", ""},
        {"a", "'a'"},
        {"a + b(c)", "'a + b(c)'"},
        {"\"x\" 'y'", "'\"x\" 'y''"},
        {"defined xx x1", "'defined xx x1'"},
    });
}

TEST(MacroBody, HasAnExpandedArgumentForEachParameter) {
    expectSteps({
        {"x", "argument 0"},
        {"y", "argument 1"},
        {"x y", "argument 0, ' ', argument 1"},
        {"x+x", "argument 0, '+', argument 0"},
        {"[x] z", "'[', argument 0, '] z'"},
        {"(x, y)", "'(', argument 0, ', ', argument 1, ')'"},
    });
}

TEST(MacroBody, StringizesTheParameterAfterAHash) {
    expectSteps({
        {"#x", "join(#0)"},
        {"# x", "join(#0)"},
        {"#y #x", "join(#1), ' ', join(#0)"},
        {"a #x b", "'a ', join(#0), ' b'"},
        {"#x#y", "join(#0), join(#1)"},
    });
}

TEST(MacroBody, RejectsAHashWithoutAParameter) {
    expectSteps({
        {"#", "misplaced"},
        {"a # b", "'a ', misplaced"},
        {"a #", "'a ', misplaced"},
        {"x # 1 y", "argument 0, ' ', misplaced"},
        {"#\"x\"", "misplaced"},
        {"# # x", "misplaced"},
        {"x#", "argument 0, misplaced"},
        {"#defined", "misplaced"},
    });
}

TEST(MacroBody, JoinsWhatStandsBesideAPaste) {
    expectSteps({
        {"x##y", "join(raw 0 + raw 1)"},
        {"x ## y", "join(raw 0 + raw 1)"},
        {"a##b", "join('a' + 'b')"},
        {"x ## 1", "join(raw 0 + '1')"},
        {"+ ## x", "join('+' + raw 0)"},
        {"a ## x ## y ## b", "join('a' + raw 0 + raw 1 + 'b')"},
        {"[x ## y] x", "'[', join(raw 0 + raw 1), '] ', argument 0"},
        {"x x ## y y", "argument 0, ' ', join(raw 0 + raw 1), ' ', argument 1"},
    });
}

TEST(MacroBody, JoinsStringLiterals) {
    expectSteps({
        {"#x ## y", "join(#0 + raw 1)"},
        {"x ## #y", "join(raw 0 + #1)"},
        {"#x ## #y", "join(#0 + #1)"},
        {"L ## #x", "join('L' + #0)"},
    });
}

TEST(MacroBody, TakesSeveralPastesInARowForOne) {
    expectSteps({
        {"x ## ## y", "join(raw 0 + raw 1)"},
        {"x ## ## ## y", "join(raw 0 + raw 1)"},
        {"x #### y", "join(raw 0 + raw 1)"},
    });
}

TEST(MacroBody, RejectsAPasteAtTheBeginning) {
    expectSteps({
        {"##", "paste first"},
        {"## x", "paste first"},
        {"##x y", "paste first"},
    });
}

TEST(MacroBody, RejectsAPasteAtTheEndAndDropsItsOperand) {
    expectSteps({
        {"x ##", "paste last"},
        {"a x ##", "'a ', paste last"},
        {"a b ##", "'a ', paste last"},
        {"x y ## ##", "argument 0, ' ', paste last"},
    });
}

TEST(MacroBody, DropsTheOperandBeforeAPasteWithAMisplacedHash) {
    expectSteps({
        {"x ## #", "misplaced"},
        {"a x ## # b", "'a ', misplaced"},
    });
}

TEST(MacroBody, MakesARunOfBlanksOneSpace) {
    expectSteps({
        {"a  \t b", "'a b'"},
        {"a/* c */b", "'a b'"},
        {"a\\\nb", "'a b'"},
        {"a\nb", "'a b'"},
        {"a // c", "'a'"},
        {"  a ", "'a'"},
        {"x  ##  y", "join(raw 0 + raw 1)"},
    });
}

TEST(MacroBody, HoldsDirectiveWordsAsNames) {
    TextLexer lexer;
    MacroTable macros;
    const Macro& macro = defined(macros, {"line if", "line", true});
    const MacroBody& body = BodyMaker(lexer, macros).bodyOf(macro);
    ASSERT_EQ(body.steps.size(), 2U);
    EXPECT_EQ(describe(body, body.steps[0]), "argument 0");
    EXPECT_EQ(describe(body, body.steps[1]), "' if'");
}

TEST(MacroBody, OfTwoParametersWithOneNameTakesTheLast) {
    TextLexer lexer;
    MacroTable macros;
    const Macro& macro = defined(macros, {"x # x x ## x", "x,x", true});
    const MacroBody& body = BodyMaker(lexer, macros).bodyOf(macro);
    ASSERT_EQ(body.steps.size(), 5U);
    EXPECT_EQ(describe(body, body.steps[0]), "argument 1");
    EXPECT_EQ(describe(body, body.steps[2]), "join(#1)");
    EXPECT_EQ(describe(body, body.steps[4]), "join(raw 1 + raw 1)");
}

TEST(MacroBody, CarriesOutTheEffectsOfACommentWhereItIsRead) {
    expectSteps({
        {"/*\n*/", "\n"},
        {"x y/*\n*/", "argument 0, ' ', \n, argument 1"},
        {"x/*\n\n*/y", "\n\n, argument 0, ' ', argument 1"},
        {"# /*\n*/ x", "\n, join(#0)"},
        {"x ## /*\n*/ y", "\n, join(raw 0 + raw 1)"},
        {"x y z /*\n", "argument 0, ' ', argument 1, ' ', \n[2], 'z'"},
    });
}

TEST(MacroBody, KeepsTheSourceOnlyIfReadingItHasEffects) {
    TextLexer lexer;
    MacroTable macros;
    const Macro& plain = defined(macros, {"a /* b */ x", "x", true});
    EXPECT_FALSE(BodyMaker(lexer, macros).bodyOf(plain).source);
    const Macro& withEffects = defined(macros, {"a /*\n*/ x", "x", true});
    EXPECT_TRUE(BodyMaker(lexer, macros).bodyOf(withEffects).source->hasEffects());
}

}  // namespace
}  // namespace umpre
