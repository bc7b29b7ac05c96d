// SPDX-License-Identifier: MIT
#include "expr/evaluator.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/small_stack.h"
#include "support/source_fixture.h"

namespace umpre {
namespace {

using testing::SourceFixture;

constexpr bool kSigned = true;
constexpr bool kUnsigned = false;

constexpr std::string_view kElement = "Lexical element expected";
constexpr std::string_view kCall = "A function call is not allowed in a constant expression";
constexpr std::string_view kIdentifier = "Identifier expected for 'defined' operator";
constexpr std::string_view kDefinedParenthesis = "\")\" expected for \"defined\" operator";
constexpr std::string_view kParenthesis = "\")\" expected";
constexpr std::string_view kColon = "\":\" expected in constant expression";

// A condition that is read alone, as it is after its macros were expanded. X is defined.
struct Condition : SourceFixture {
    explicit Condition(std::string_view text) : SourceFixture("\n") {
        macros.defineMacro("X", "");
        macros.defineMacro("line", "");
        isolateText(text);
        value = evaluator.evaluate(ok);
        left = rest();
        sources.endIsolation();
    }

    MacroTable macros;
    Evaluator<ScannerStack> evaluator{sources, macros, reporter};
    bool ok = true;
    ExprValue value;
    std::string left;  // of the text
};

struct Value {
    std::string_view text;
    std::uint32_t value;
    bool isSigned;
};

void expectValues(const std::vector<Value>& table) {
    for (const Value& row : table) {
        const Condition condition(row.text);
        EXPECT_EQ(condition.value.value, row.value) << row.text;
        EXPECT_EQ(condition.value.isSigned, row.isSigned) << row.text;
        EXPECT_TRUE(condition.ok) << row.text;
        EXPECT_EQ(condition.reporter.report(), "") << row.text;
        EXPECT_EQ(condition.left, "") << row.text;
    }
}

// A condition with a syntax error, what is said about it and what is left of it.
struct Error {
    std::string_view text;
    std::string message;
    std::string_view left;
    std::uint32_t value = 0;
};

void expectErrors(const std::vector<Error>& table) {
    for (const Error& row : table) {
        const Condition condition(row.text);
        EXPECT_FALSE(condition.ok) << row.text;
        EXPECT_EQ(condition.reporter.report(), row.message) << row.text;
        EXPECT_EQ(condition.left, row.left) << row.text;
        EXPECT_EQ(condition.value.value, row.value) << row.text;
    }
}

[[nodiscard]] std::string both(std::string_view first, std::string_view second) {
    return std::string(first) + "\n" + std::string(second);
}

TEST(Evaluator, ReadsLiterals) {
    expectValues({
        {"1", 1, kSigned},
        {"0x1F", 31, kSigned},
        {"017", 15, kSigned},
        {"7u", 7, kUnsigned},
        {"2147483648", 2147483648U, kUnsigned},
        {"4294967296", 4294967295U, kUnsigned},
        {"'a'", 97, kSigned},
        {"'\\377'", 4294967295U, kUnsigned},
    });
}

TEST(Evaluator, TakesANameForZero) {
    expectValues({
        {"FOO", 0, kSigned},
        {"X", 0, kSigned},
        {"if", 0, kSigned},
        {"include + 1", 1, kSigned},
        {"FOO == 0", 1, kSigned},
    });
}

TEST(Evaluator, SkipsBlanksEverywhere) {
    expectValues({
        {"  1\t+ /* c */ 2 ", 3, kSigned},
        {"( \\\n 1 )", 1, kSigned},
        {"! ~ 0", 0, kSigned},
        {"1 ? 2 : 3 // c", 2, kSigned},
    });
}

TEST(Evaluator, AnswersDefined) {
    expectValues({
        {"defined X", 1, kSigned},
        {"defined Y", 0, kSigned},
        {"defined(X)", 1, kSigned},
        {"defined ( Y )", 0, kSigned},
        {"defined ( X )+1", 2, kSigned},
        {"!defined X", 0, kSigned},
        {"defined X && defined Y", 0, kSigned},
        {"defined X || defined Y", 1, kSigned},
    });
}

TEST(Evaluator, AppliesUnaryOperatorsFromTheRight) {
    expectValues({
        {"-1", 4294967295U, kSigned},
        {"+1", 1, kSigned},
        {"!1", 0, kSigned},
        {"~0", 4294967295U, kSigned},
        {"- -1", 1, kSigned},
        {"!!5", 1, kSigned},
        {"-~0", 1, kSigned},
        {"~-1", 0, kSigned},
        {"!-1", 0, kSigned},
        {"-1u", 4294967295U, kUnsigned},
        {"-(1 + 2)", 4294967293U, kSigned},
    });
}

TEST(Evaluator, BindsUnaryOperatorsTighterThanBinaryOnes) {
    expectValues({
        {"!0 + 1", 2, kSigned},
        {"-1 * 2", 4294967294U, kSigned},
        {"2 * -1", 4294967294U, kSigned},
        {"~1 & 3", 2, kSigned},
        {"1 - -1", 2, kSigned},
    });
}

TEST(Evaluator, BindsBinaryOperatorsByTheirLevel) {
    // Each row tells two neighbouring levels apart; the other way round gives another value.
    expectValues({
        {"1 || 0 && 0", 1, kSigned},
        {"0 && 0 || 1", 1, kSigned},
        {"2 && 0 | 1", 1, kSigned},
        {"0 | 1 && 0", 0, kSigned},
        {"1 | 3 ^ 2", 1, kSigned},
        {"1 ^ 3 & 2", 3, kSigned},
        {"3 & 2 == 2", 1, kSigned},
        {"2 == 2 & 2", 0, kSigned},
        {"1 == 2 < 3", 1, kSigned},
        {"0 < 1 == 0", 0, kSigned},
        {"1 < 1 << 1", 1, kSigned},
        {"3 >> 1 < 2", 1, kSigned},
        {"1 << 1 + 1", 4, kSigned},
        {"8 - 1 >> 1", 3, kSigned},
        {"1 + 2 * 3", 7, kSigned},
        {"2 * 3 + 1", 7, kSigned},
        {"10 - 7 % 4", 7, kSigned},
    });
}

TEST(Evaluator, GroupsBinaryOperatorsOfOneLevelFromTheLeft) {
    expectValues({
        {"10 - 4 - 3", 3, kSigned},
        {"10 - 4 + 3", 9, kSigned},
        {"100 / 10 / 5", 2, kSigned},
        {"100 / 10 * 5", 50, kSigned},
        {"7 % 4 * 2", 6, kSigned},
        {"1 << 2 << 3", 32, kSigned},
        {"64 >> 3 << 1", 16, kSigned},
        {"3 > 2 > 1", 0, kSigned},
        {"1 < 2 <= 0", 0, kSigned},
        {"2 == 2 != 2", 1, kSigned},
        {"2 != 2 == 0", 1, kSigned},
    });
}

TEST(Evaluator, GroupsConditionalsFromTheRight) {
    expectValues({
        {"1 ? 2 : 3 ? 4 : 5", 2, kSigned},
        {"0 ? 1 : 0 ? 2 : 3", 3, kSigned},
        {"1 ? 0 ? 4 : 5 : 6", 5, kSigned},
        {"1 ? 1 ? 7 : 8 : 9", 7, kSigned},
        {"0 ? 1 ? 7 : 8 : 9", 9, kSigned},
        {"(1 ? 0 : 1) ? 2 : 3", 3, kSigned},
    });
}

TEST(Evaluator, BindsConditionalsLoosest) {
    expectValues({
        {"1 || 0 ? 2 : 3", 2, kSigned},
        {"0 ? 2 : 3 + 1", 4, kSigned},
        {"1 ? 2 : 3 + 1", 2, kSigned},
        {"1 ? 2 + 5 : 3", 7, kSigned},
        {"1 + 0 ? 2 : 3", 2, kSigned},
        {"2 * (0 ? 1 : 3)", 6, kSigned},
    });
}

TEST(Evaluator, GivesAConditionalTheFlagOfItsBranch) {
    expectValues({
        {"1 ? 2 : 3u", 2, kSigned},
        {"0 ? 2 : 3u", 3, kUnsigned},
        {"1u ? -1 : 0u", 4294967295U, kSigned},
        {"(1 ? -1 : 0u) < 0", 1, kSigned},
    });
}

TEST(Evaluator, KeepsToThirtyTwoBits) {
    expectValues({
        {"-1 > 0u", 1, kUnsigned},
        {"-1 > 0", 0, kSigned},
        {"-1 < 0u", 0, kUnsigned},
        {"0xFFFFFFFF == -1", 1, kUnsigned},
        {"2147483647 + 1 < 0", 1, kSigned},
        {"-16 >> 2", 1073741820, kSigned},
        {"1 << 33", 2, kSigned},
        {"'\\xFF' == -1", 1, kUnsigned},
        {"'\\xFF' > 0", 1, kUnsigned},
        {"-7 / 2", 4294967293U, kSigned},
        {"-7 % 2", 4294967295U, kSigned},
    });
}

TEST(Evaluator, EvaluatesParentheses) {
    expectValues({
        {"(1)", 1, kSigned},
        {"((1 + 2) * (3 + 4))", 21, kSigned},
        {"2 * (1 + 2)", 6, kSigned},
        {"-(-(1))", 1, kSigned},
        {"(1 ? (2) : (3))", 2, kSigned},
        {"(0u)", 0, kUnsigned},
    });
}

TEST(Evaluator, StopsAtWhatCannotGoOn) {
    struct Stop {
        std::string_view text;
        std::uint32_t value;
        std::string_view left;
    };

    for (const Stop& row : {
             Stop{"1 2", 1, "2"},
             Stop{"1, 2", 1, ", 2"},
             Stop{"1 = 1", 1, "= 1"},
             Stop{"1)", 1, ")"},
             Stop{"1 : 2", 1, ": 2"},
             Stop{"3 \"a\"", 3, "\"a\""},
             Stop{"1 + 2 defined X", 3, "defined X"},
             Stop{"1 (2)", 1, "(2)"},
             Stop{"'a'(2)", 97, "(2)"},
             Stop{"defined(X)(2)", 1, "(2)"},
             Stop{"1.5", 1, ".5"},
         }) {
        const Condition condition(row.text);
        EXPECT_TRUE(condition.ok) << row.text;
        EXPECT_EQ(condition.value.value, row.value) << row.text;
        EXPECT_EQ(condition.left, row.left) << row.text;
        EXPECT_EQ(condition.reporter.report(), "") << row.text;
    }
}

TEST(Evaluator, ReportsAMissingOperand) {
    expectErrors({
        {"", std::string(kElement), ""},
        {"  ", std::string(kElement), ""},
        {"1 +", std::string(kElement), "", 1},
        {"!", std::string(kElement), "", 1},
        {"* 2", std::string(kElement), "2"},
        {"1 + * 2", std::string(kElement), "2", 1},
        {"\"a\"", std::string(kElement), ""},
        {"@", std::string(kElement), ""},
        {"\n", std::string(kElement), ""},
        {"()", both(kElement, kParenthesis), ""},
        {"1 ? : 3", both(kElement, kColon), ""},
        {"1 ? 2 :", std::string(kElement), "", 2},
    });
}

TEST(Evaluator, ReportsAMissingParenthesis) {
    expectErrors({
        {"(1", std::string(kParenthesis), ""},
        {"(1 2)", std::string(kParenthesis), ")"},
        {"(1, 2)", std::string(kParenthesis), "2)"},
        {"((1)", std::string(kParenthesis), ""},
        {"1 + (2", std::string(kParenthesis), "", 1},
        {"(1 2) + 3", std::string(kParenthesis), ") + 3"},
    });
}

TEST(Evaluator, ReportsAMissingColon) {
    expectErrors({
        {"1 ? 2", std::string(kColon), ""},
        {"1 ? 2 3", std::string(kColon), ""},
        {"1 ? 2 3 4", std::string(kColon), " 4"},
        {"1 ? 2 , 3", std::string(kColon), " 3"},
        {"1 ? 1 ? 2 : 3", std::string(kColon), ""},
    });
}

TEST(Evaluator, ReportsWhatIsNoOperandOfDefined) {
    expectErrors({
        {"defined", std::string(kIdentifier), ""},
        {"defined 3", std::string(kIdentifier), ""},
        {"defined line", std::string(kIdentifier), ""},
        {"defined defined", std::string(kIdentifier), ""},
        {"defined(", std::string(kIdentifier), ""},
        {"defined()", std::string(kIdentifier), ""},
        {"defined(3)", std::string(kIdentifier), ")"},
        {"defined((X))", std::string(kIdentifier), "X))"},
    });
}

TEST(Evaluator, ReportsAnOpenOperandOfDefined) {
    expectErrors({
        {"defined(X", std::string(kDefinedParenthesis), ""},
        {"defined(X Y)", std::string(kDefinedParenthesis), ")"},
        {"defined(X + 1", std::string(kDefinedParenthesis), "1"},
    });
}

TEST(Evaluator, ReportsACall) {
    expectErrors({
        {"FOO(1)", std::string(kCall), "(1)"},
        {"FOO (1)", std::string(kCall), "(1)"},
        {"if(1)", std::string(kCall), "(1)"},
        {"(1)(2)", std::string(kCall), "(2)", 1},
        {"(5) (2)", std::string(kCall), "(2)", 5},
        {"1 + FOO(1)", std::string(kCall), "(1)", 1},
        {"((5)(2))", both(kCall, kParenthesis), "2))"},
    });
}

TEST(Evaluator, GoesOnAfterAnError) {
    expectErrors({
        {"defined 3 + 1", std::string(kIdentifier), "", 1},
        {"defined 3 || defined 4", both(kIdentifier, kIdentifier), ""},
        {"(1 2 + 5", std::string(kParenthesis), "", 5},
        {"@ + 4", std::string(kElement), "", 4},
        {"(@) + 4", std::string(kElement), "", 4},
    });
}

TEST(Evaluator, TooManyCharactersAreNoSyntaxError) {
    const Condition condition("'abcde' == 'abcd'");
    EXPECT_TRUE(condition.ok);
    EXPECT_EQ(condition.value.value, 1U);
    EXPECT_EQ(condition.reporter.report(), "Too many characters in character literal");
}

TEST(Evaluator, LeavesNotOkAsItIs) {
    SourceFixture f("1\n");
    MacroTable macros;
    Evaluator evaluator(f.sources, macros, f.reporter);
    bool ok = false;
    EXPECT_EQ(evaluator.evaluate(ok).value, 1U);
    EXPECT_FALSE(ok);
}

TEST(Evaluator, LeavesTheLineEndToBeRead) {
    SourceFixture f("1 + 2\nrest");
    MacroTable macros;
    Evaluator evaluator(f.sources, macros, f.reporter);
    bool ok = true;
    EXPECT_EQ(evaluator.evaluate(ok).value, 3U);
    EXPECT_EQ(f.rest(), "\nrest");
}

TEST(Evaluator, EvaluatesBothSidesWhateverTheyDecide) {
    expectErrors({
        {"1 || defined 3", std::string(kIdentifier), "", 1},
        {"0 && defined 3", std::string(kIdentifier), ""},
        {"1 ? 2 : defined 3", std::string(kIdentifier), "", 2},
        {"0 ? defined 3 : 4", std::string(kIdentifier), "", 4},
    });
}

TEST(Evaluator, ThrowsForADivisionThatCannotBeCarriedOut) {
    for (const std::string_view text :
         {"1 / 0", "1 % 0", "0 && (1 / 0)", "1 ? 1 : 1 / 0", "1 || 1 % FOO",
          "(-2147483647 - 1) / -1", "(-2147483647 - 1) % -1", "1 / 0u"}) {
        EXPECT_THROW(const Condition condition(text), ArithmeticFault) << text;
    }
}

TEST(Evaluator, DividesBeforeItReadsOn) {
    SourceFixture f("1 / 0 defined 3\n");
    MacroTable macros;
    Evaluator evaluator(f.sources, macros, f.reporter);
    bool ok = true;
    EXPECT_THROW((void)evaluator.evaluate(ok), ArithmeticFault);
    EXPECT_EQ(f.reporter.report(), "");
}

TEST(Evaluator, CanBeUsedAgainAfterAFault) {
    SourceFixture f("1 + (2 * (3 / 0\n1 + 1\n");
    MacroTable macros;
    Evaluator evaluator(f.sources, macros, f.reporter);
    bool ok = true;
    EXPECT_THROW((void)evaluator.evaluate(ok), ArithmeticFault);
    f.sources.skipToEndOfLine();
    EXPECT_EQ(evaluator.evaluate(ok).value, 2U);
    EXPECT_TRUE(ok);
}

TEST(Evaluator, DeepNestingDoesNotRecurse) {
    constexpr std::size_t kDepth = 20'000;
    const std::string open(kDepth, '(');
    const std::string close(kDepth, ')');
    const std::string complements(2 * kDepth, '~');
    std::string conditionals;
    for (std::size_t depth = 0; depth < kDepth; ++depth) {
        conditionals += "1?";
    }
    conditionals += "7";
    for (std::size_t depth = 0; depth < kDepth; ++depth) {
        conditionals += ":0";
    }
    testing::onSmallStack([&] {
        EXPECT_EQ(Condition(open + "7" + close).value.value, 7U);
        EXPECT_EQ(Condition(complements + "7").value.value, 7U);
        EXPECT_EQ(Condition(conditionals).value.value, 7U);
    });
}

}  // namespace
}  // namespace umpre
