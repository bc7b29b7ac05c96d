// SPDX-License-Identifier: MIT
#include "macros/macro_expander.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "macros/predefined_macros.h"
#include "support/macro_fixture.h"
#include "support/small_stack.h"

namespace umpre {
namespace {

using enum TokenKind;

using testing::MacroFixture;

constexpr std::string_view kNotEnough = "There are not enough arguments in a macro invocation";
constexpr std::string_view kTooMany = "A macro invocation has too many arguments";
constexpr std::string_view kUnterminated = "The macro invocation is improperly terminated";
constexpr std::string_view kMisplacedHash = "Macro variable expected after '#' operator";
constexpr std::string_view kPasteFirst =
    "'##' operator cannot be at the beginning of the replacement list";
constexpr std::string_view kPasteLast =
    "'##' operator cannot be at the end of the replacement list";

// The macros that the tests share.
void defineCommon(MacroFixture& f) {
    f.define("N", "3");
    f.define("EMPTY", "");
    f.define("SELF", "SELF");
    f.define("A", "B");
    f.define("B", "A");
    f.define("XX", "XX 1");
    f.define({
        {"F", {"x"}, "x"},
        {"G", {}, "1"},
        {"H", {"a", "b"}, "a b"},
        {"J", {"a", "b"}, "a##b"},
        {"S", {"x"}, "#x"},
        {"T", {"x"}, "x x"},
        {"B2", {"x"}, "[x]"},
        {"R", {"x"}, "x R(x)"},
        {"SKIP", {"x"}, "-"},
    });
}

struct Row {
    std::string_view text;
    std::string_view expansion;
};

void expectExpansions(const std::vector<Row>& table) {
    for (const Row& row : table) {
        MacroFixture f(row.text);
        defineCommon(f);
        EXPECT_EQ(f.expanded(), row.expansion) << row.text;
        EXPECT_EQ(f.reporter.report(), "") << row.text;
    }
}

struct FailingRow {
    std::string_view text;
    std::string_view expansion;
    std::string_view message;
};

void expectFailures(const std::vector<FailingRow>& table) {
    for (const FailingRow& row : table) {
        MacroFixture f(row.text);
        defineCommon(f);
        EXPECT_EQ(f.expanded(), row.expansion) << row.text;
        EXPECT_EQ(f.reporter.report(), row.message) << row.text;
    }
}

TEST(MacroExpander, LeavesOtherNamesAsTheyAre) {
    expectExpansions({{"a n if NN", "a n if NN"}, {"\"N\" 'N'", "\"N\" 'N'"}});
}

TEST(MacroExpander, ReplacesAnObjectLikeMacro) {
    expectExpansions({
        {"N", "3"},
        {"a N+N;", "a 3+3;"},
        {"EMPTY", ""},
        {"[EMPTY EMPTY]", "[ ]"},
    });
}

TEST(MacroExpander, ReplacesDirectiveWordsThatAreMacros) {
    MacroFixture f("if line error");
    f.define("line", "7");
    f.define("error", "if");
    f.define("if", "line");
    EXPECT_EQ(f.expanded(), "7 7 7");
}

TEST(MacroExpander, StopsAtNamesThatAreBeingReplaced) {
    expectExpansions({
        {"SELF", "SELF"},
        {"A B", "A B"},
        {"XX", "XX 1"},
        {"R(1)", "1 R(1)"},
    });
}

TEST(MacroExpander, ReplacesANameAgainBehindItsReplacement) {
    expectExpansions({{"SELF SELF", "SELF SELF"}, {"A A", "A A"}, {"T(N)", "3 3"}});
}

TEST(MacroExpander, LeavesAFunctionLikeMacroThatIsNotCalled) {
    expectExpansions({
        {"F", "F"},
        {"F;", "F;"},
        {"F N", " F3"},
        {"F + 1", " F+ 1"},
        {"F\n\n+", "\n\nF+"},
        {"F /* c */ )", "   F)"},
        {"F F(1)", " F1"},
    });
}

TEST(MacroExpander, FindsTheArgumentsBehindBlanksAndLineEnds) {
    expectExpansions({
        {"F ( 1 )", "1"},
        {"F\n(1)", "1"},
        {"F /* c */ // d\n\t(1)", "1"},
        {"G( )G()", "11"},
    });
}

TEST(MacroExpander, FindsTheArgumentsBehindTheReplacementThatNamesTheMacro) {
    MacroFixture f("CALL(1) (CALL) CALL");
    f.define("CALL", "F");
    f.define({"F", {"x"}, "<x>"});
    EXPECT_EQ(f.expanded(), "<1> (F) F");
}

TEST(MacroExpander, TakesArgumentsAsTheyAreCollected) {
    expectExpansions({
        {"F(,)", ""},
        {"F(a,)", "a"},
        {"H(,x)", " x"},
        {"F((a,b))", "(a,b)"},
        {"B2(  a   +\n b  )", "[a + b]"},
    });
}

TEST(MacroExpander, LeavesTheNameOfAnInvocationWithTheWrongArguments) {
    expectFailures({
        {"F() z", "F z", kNotEnough},
        {"H(1) z", "H z", kNotEnough},
        {"H(x,)", "H", kNotEnough},
        {"F(a,b) z", "F z", kTooMany},
        {"F(a,b,c) z", "Fc) z", kTooMany},
        {"G(x)", "G", kTooMany},
        {"F(a", "F", kUnterminated},
        {"F", "F", ""},
    });
}

TEST(MacroExpander, ExpandsAnArgumentBeforeItIsInserted) {
    expectExpansions({
        {"F(N)", "3"},
        {"F(F(N))", "3"},
        {"H(N, F(N))", "3 3"},
        {"T(XX)", "XX 1 XX 1"},
        {"F(XX)", "XX 1"},
        {"B2(B2(B2(1)))", "[[[1]]]"},
    });
}

TEST(MacroExpander, ExpandsAnArgumentAloneWithoutWhatFollows) {
    expectExpansions({{"F(F)(1)", "F(1)"}, {"F(F )(1)", "F(1)"}, {"F(G)()", "1"}});
}

TEST(MacroExpander, DoesNotExpandWhatIsStringizedOrPasted) {
    expectExpansions({
        {"S(N)", "\"N\""},
        {"S( a  \"b\" )", R"("a \"b\"")"},
        {"J(N,2)", "N2"},
        {"J(x,y)", "xy"},
        {"J(1, 2)", "12"},
        {"J(,N)", "3"},
        {"J(E,MPTY)", ""},
    });
}

TEST(MacroExpander, LexesAJoinedTextAnew) {
    MacroFixture f("J(+,+) J(a,1)J(1,a) J(\"a,b\")");
    f.define({"J", {"a", "b"}, "a##b"});
    f.define("a", "NO");
    f.define("a1", "YES");
    EXPECT_EQ(f.expanded(), "++ YES1NO J");
    EXPECT_EQ(f.reporter.report(), kNotEnough);
}

TEST(MacroExpander, ReportsABodyThatCannotBeBuiltAndKeepsItsBeginning) {
    struct BodyRow {
        std::string text;
        std::string_view expansion;
        std::string_view message;
    };

    for (const BodyRow& row : {
             BodyRow{"a # b", "a ", kMisplacedHash},
             BodyRow{"x #", "1 ", kMisplacedHash},
             BodyRow{"## x", "", kPasteFirst},
             BodyRow{"a x ##", "a ", kPasteLast},
             BodyRow{"a x ## #", "a ", kMisplacedHash},
         }) {
        MacroFixture f("M(1);");
        f.define({"M", {"x"}, row.text});
        EXPECT_EQ(f.expanded(), std::string(row.expansion) + ";") << row.text;
        EXPECT_EQ(f.reporter.report(), row.message) << row.text;
    }
}

TEST(MacroExpander, ReportsABodyAtEachUse) {
    MacroFixture f("M() M()");
    f.define({"M", {}, "#"});
    EXPECT_EQ(f.expanded(), " ");
    EXPECT_EQ(f.reporter.reports().size(), 2U);
}

TEST(MacroExpander, AllowsHashesInAnObjectLikeMacro) {
    MacroFixture f("M");
    f.define("M", "## # a #");
    EXPECT_EQ(f.expanded(), "## # a #");
    EXPECT_EQ(f.reporter.report(), "");
}

TEST(MacroExpander, ReportsAnArgumentAtEachUse) {
    struct UseRow {
        std::string text;
        std::size_t reports;
    };

    for (const UseRow& row : {
             UseRow{"-", 0},
             UseRow{"#x", 0},
             UseRow{"z ## x", 0},
             UseRow{"x", 1},
             UseRow{"x x x", 3},
             UseRow{"#x x z ## x x", 2},
         }) {
        MacroFixture f("M(F())");
        f.define({"F", {"y"}, "y"});
        f.define({"M", {"x"}, row.text});
        (void)f.expanded();
        EXPECT_EQ(f.reporter.reports().size(), row.reports) << row.text;
    }
}

TEST(MacroExpander, WritesTheLineEndsOfACommentInABodyAtEachUse) {
    MacroFixture f("T(P) T(O)");
    f.define("O", "a/*\n*/b");
    f.define({"T", {"x"}, "x x"});
    EXPECT_EQ(f.expanded(), "P P a b a b");
    EXPECT_EQ(f.written(), "\n\n");
}

TEST(MacroExpander, ExpandsAnArgumentOnceIfThatHadNoOtherEffect) {
    // Each D inserts its argument twice: without the first result, this would take 2^60 steps.
    constexpr int kDepth = 60;
    std::string text = "N";
    for (int depth = 0; depth < kDepth; ++depth) {
        text = "D(" + text + ")";
    }
    MacroFixture f(text);
    f.define({{"D", {"x"}, "SKIP(x x)"}, {"SKIP", {"x"}, "-"}});
    EXPECT_EQ(f.expanded(), "-");
    EXPECT_EQ(f.reporter.report(), "");
}

TEST(MacroExpander, NestedCallsInArgumentsDoNotRecurse) {
    constexpr std::size_t kDepth = 1500;
    std::string text;
    for (std::size_t depth = 0; depth < kDepth; ++depth) {
        text += "F(";
    }
    text += "x" + std::string(kDepth, ')');
    testing::onSmallStack([&] {
        MacroFixture f(text);
        f.define({"F", {"x"}, "x"});
        EXPECT_EQ(f.expanded(), "x");
        EXPECT_EQ(f.reporter.report(), "");
    });
}

TEST(MacroExpander, ChainsOfMacrosDoNotRecurse) {
    constexpr int kLength = 1500;
    testing::onSmallStack([] {
        MacroFixture f("M0 G0(1)");
        for (int number = 0; number < kLength; ++number) {
            const std::string next = std::to_string(number + 1);
            f.define("M" + std::to_string(number), "M" + next);
            f.define({"G" + std::to_string(number), {"x"}, "G" + next + "(x)"});
        }
        EXPECT_EQ(f.expanded(), "M1500 G1500(1)");
    });
}

TEST(MacroExpander, ArgumentsThatNameMacrosWithArgumentsDoNotRecurse) {
    constexpr int kLength = 300;
    testing::onSmallStack([] {
        MacroFixture f("F(A0)");
        f.define({"F", {"x"}, "[x]"});
        for (int number = 0; number < kLength; ++number) {
            f.define("A" + std::to_string(number), "F(A" + std::to_string(number + 1) + ")");
        }
        EXPECT_EQ(f.expanded(),
                  std::string(kLength + 1, '[') + "A300" + std::string(kLength + 1, ']'));
    });
}

TEST(MacroExpander, AnInvocationInAnArgumentKeepsTheOuterArguments) {
    MacroFixture f("P(P(a, b), P(c, d))");
    f.define({"P", {"x", "y"}, "<x|y>"});
    EXPECT_EQ(f.expanded(), "<<a|b>|<c|d>>");
}

TEST(MacroExpander, AnInvocationInheritsTheSetOfItsName) {
    for (const Row& row : {
             Row{"f(2)(9);", "2*f(9);"},
             Row{"Q;", "2*f(9);"},
             Row{"F(f)(1);", "1*g;"},
             Row{"F(f(2)(9));", "2*f(9);"},
         }) {
        MacroFixture f(row.text);
        defineCommon(f);
        f.define({{"f", {"a"}, "a*g"}, {"g", {"a"}, "f(a)"}});
        f.define("Q", "f(2)(9)");
        EXPECT_EQ(f.expanded(), row.expansion) << row.text;
    }
}

TEST(MacroExpander, GivesTheCurrentLineAndFile) {
    MacroFixture f("__LINE__\n__FILE__ __LINE__");
    definePredefinedMacros(f.macros);
    EXPECT_EQ(f.expanded(), "1\n\"main\" 2");
}

TEST(MacroExpander, TakesTheNewDefinitionOfANameAfterAChange) {
    MacroFixture f("N N N");
    f.define("N", "1");
    EXPECT_EQ(f.expander.expandName(f.sources.next()), "1");
    f.define("N", "2");
    EXPECT_EQ(f.expanded(), " 2 2");
    f.macros.undefine("N");
    EXPECT_EQ(f.expander.expandName({IDENTIFIER, "N"}), "N");
}

TEST(MacroExpander, ReadsABodyOnThoughItsDefinitionChanges) {
    MacroFixture f("N N");
    f.define({{"F", {"x"}, "x"}});
    f.define("N", "F(1) // 2");  // a comment is read each time
    EXPECT_EQ(f.expander.expandName(f.sources.next()), "");
    f.define("N", "3");
    EXPECT_EQ(f.expanded(), "1   3");
}

// The tests below expand directive lines.
struct LineRow {
    std::string_view line;
    LineKind kind;
    std::string_view expansion;
};

void expectLines(const std::vector<LineRow>& table) {
    for (const LineRow& row : table) {
        MacroFixture f("(9) rest\n");
        defineCommon(f);
        f.define("defd", "N");
        EXPECT_EQ(f.expander.expandLine(row.line, row.kind), row.expansion) << row.line;
        EXPECT_EQ(f.rest(), "(9) rest\n") << row.line;
        EXPECT_EQ(f.reporter.report(), "") << row.line;
    }
}

TEST(MacroExpander, ExpandsALine) {
    expectLines({
        {"", LineKind::Operand, ""},
        {" N + F(N) ", LineKind::Operand, " 3 + 3 "},
        {"<a/N.h>", LineKind::Operand, "<a/3.h>"},
        {"\"N\" A SELF", LineKind::Operand, "\"N\" A SELF"},
        {"S( N ) J(N, N)", LineKind::Condition, "\"N\" NN"},
        {"F + 1", LineKind::Condition, " F+ 1"},
    });
}

TEST(MacroExpander, ALineEndsByItself) {
    expectLines({{"F", LineKind::Operand, "F"}, {"1 F ", LineKind::Condition, "1  F"}});
}

TEST(MacroExpander, ReportsAnInvocationThatItsLineDoesNotClose) {
    MacroFixture f("2) rest");
    f.define({"F", {"x"}, "x"});
    EXPECT_EQ(f.expander.expandLine("a F(1", LineKind::Operand), "a F");
    EXPECT_EQ(f.reporter.report(), kUnterminated);
    EXPECT_EQ(f.rest(), "2) rest");
}

TEST(MacroExpander, KeepsTheOperandOfDefinedInAConditionAlone) {
    expectLines({
        {"defined N", LineKind::Condition, "defined N"},
        {"defined(N)", LineKind::Condition, "defined(N)"},
        {"defined ( N ) N", LineKind::Condition, "defined ( N ) 3"},
        {"defined N N", LineKind::Condition, "defined N 3"},
        {"defined(N N)", LineKind::Condition, "defined(N 3)"},
        {"defined", LineKind::Condition, "defined"},
        {"defined(", LineKind::Condition, "defined("},
        {"defined \\\n N", LineKind::Condition, "defined \\\n N"},
        {"defined N", LineKind::Operand, "defined 3"},
        {"defined(N)", LineKind::Operand, "defined(3)"},
    });
}

TEST(MacroExpander, KeepsTheOperandOfDefinedAtEveryDepth) {
    expectLines({
        {"F(defined N) N", LineKind::Condition, "defined N 3"},
        {"F(F(defined(N)))", LineKind::Condition, "defined(N)"},
        {"T(defined N)", LineKind::Condition, "defined N defined N"},
        {"F(defined N)", LineKind::Operand, "defined 3"},
    });
    MacroFixture f("");
    f.define("N", "3");
    f.define("HAS", "defined N && N");
    EXPECT_EQ(f.expander.expandLine("HAS", LineKind::Condition), "defined N && 3");
}

TEST(MacroExpander, ExpandsLinesAndTextInTurn) {
    MacroFixture f("N F(N)");
    defineCommon(f);
    EXPECT_EQ(f.expander.expandLine("T(N)", LineKind::Condition), "3 3");
    EXPECT_EQ(f.expanded(), "3 3");
    EXPECT_EQ(f.expander.expandLine("T(N)", LineKind::Operand), "3 3");
}

}  // namespace
}  // namespace umpre
