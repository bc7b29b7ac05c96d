// SPDX-License-Identifier: MIT
#include "directives/definitions.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/directive_fixture.h"

namespace umpre {
namespace {

using testing::DirectiveFixture;

// What comes after the directive word.
struct DefinitionFixture : DirectiveFixture {
    using DirectiveFixture::DirectiveFixture;

    [[nodiscard]] bool isFunctionLike(std::string_view name) {
        return macros.find(name)->macro.functionLike();
    }

    [[nodiscard]] std::string_view parametersOf(std::string_view name) {
        return macros.find(name)->macro.parameters();
    }

    Definitions definitions{sources, macros, reporter};
};

struct Replacement {
    std::string_view line;
    std::string_view name;
    std::string_view text;
};

void expectReplacements(const std::vector<Replacement>& table) {
    for (const Replacement& row : table) {
        DefinitionFixture f(std::string(row.line) + "\nrest\n");
        f.definitions.defineDirective();
        EXPECT_EQ(f.definition(row.name), row.text) << row.line;
        EXPECT_FALSE(f.isFunctionLike(row.name)) << row.line;
        EXPECT_EQ(f.rest(), "rest\n") << row.line;
        EXPECT_EQ(f.reporter.report(), "") << row.line;
    }
}

struct Function {
    std::string_view line;
    std::string_view parameters;
    std::string_view text;
};

void expectFunctions(const std::vector<Function>& table) {
    for (const Function& row : table) {
        DefinitionFixture f(std::string(row.line) + "\nrest\n");
        f.definitions.defineDirective();
        EXPECT_EQ(f.definition("F"), row.text) << row.line;
        EXPECT_TRUE(f.isFunctionLike("F")) << row.line;
        EXPECT_EQ(f.parametersOf("F"), row.parameters) << row.line;
        EXPECT_EQ(f.rest(), "rest\n") << row.line;
        EXPECT_EQ(f.reporter.report(), "") << row.line;
    }
}

struct Rejected {
    std::string_view text;
    std::string_view message;
    std::string_view rest;
};

void expectRejected(const std::vector<Rejected>& table) {
    for (const Rejected& row : table) {
        DefinitionFixture f(row.text);
        f.definitions.defineDirective();
        EXPECT_EQ(f.definition("F"), "(not defined)") << row.text;
        EXPECT_EQ(f.rest(), row.rest) << row.text;
        EXPECT_EQ(f.reporter.report(), row.message) << row.text;
    }
}

TEST(Definitions, KeepTheReplacementWithOneSpaceForEachRunOfBlanks) {
    expectReplacements({
        {" A 1", "A", "1"},
        {" A", "A", ""},
        {" A  ", "A", ""},
        {" A  1   +   2  ", "A", "1 + 2"},
        {" A 1/* c */+2", "A", "1 +2"},
        {" A\t1\v\f+ // c", "A", "1 +"},
        {" A/**/1", "A", "1"},
        {" A 1 /* c */ /* d */ 2", "A", "1 2"},
        {" A \"a  b\"", "A", "\"a  b\""},
        {" A # ## #", "A", "# ## #"},
    });
}

TEST(Definitions, JoinWhatAContinuationParts) {
    expectReplacements({
        {" A a\\\nb", "A", "ab"},
        {" A a \\\nb", "A", "a b"},
        {" A a\\\n b", "A", "a b"},
        {" A \\\n a \\\n", "A", "a"},
        {" \\\n A \\\n\\\n1", "A", "1"},
    });
}

TEST(Definitions, TakeDirectiveWordsForNames) {
    expectReplacements({{" line 7", "line", "7"}, {" if 1", "if", "1"}});
}

TEST(Definitions, TakeABlankBeforeTheParenthesisForAnObjectLikeMacro) {
    expectReplacements({
        {" F (x) x", "F", "(x) x"},
        {" F/**/(x)", "F", "(x)"},
        {" F\\\n(x)", "F", "(x)"},
    });
}

TEST(Definitions, KeepTheParametersOfAFunctionLikeMacro) {
    expectFunctions({
        {" F(x) x", "x", "x"},
        {" F(x)x", "x", "x"},
        {" F() 1", "", "1"},
        {" F( )", "", ""},
        {" F( a , b,c )  a b", "a,b,c", "a b"},
        {" F(x, x) x", "x,x", "x"},
        {" F(if, line) if", "if,line", "if"},
        {" F(\\\na\\\n,/* c */b)", "a,b", ""},
    });
}

TEST(Definitions, RejectWhatIsNoName) {
    expectRejected({
        {" 3 x\n", "Invalid macro name", " x\n"},
        {" \"F\"\n", "Invalid macro name", "\n"},
        {" defined 1\n", "Invalid macro name", " 1\n"},
        {" (F)\n", "Invalid macro name", "F)\n"},
        {"\nF\n", "Invalid macro name", "F\n"},
        {"  \nF\n", "Invalid macro name", "F\n"},
        {" ", "Invalid macro name", ""},
    });
}

TEST(Definitions, RejectWhatIsNoParameterAndSkipTheLine) {
    constexpr std::string_view kIdentifier = "An identifier is expected";
    expectRejected({
        {" F(1) a\nrest", kIdentifier, "rest"},
        {" F(a,) a\nrest", kIdentifier, "rest"},
        {" F(,a) a\nrest", kIdentifier, "rest"},
        {" F(...) a\nrest", kIdentifier, "rest"},
        {" F(a, ...) a\nrest", kIdentifier, "rest"},
        {" F(defined) a\nrest", kIdentifier, "rest"},
        {" F((a)) a\nrest", kIdentifier, "rest"},
    });
}

TEST(Definitions, RejectWhatFollowsAParameterAndSkipTheLine) {
    constexpr std::string_view kSeparator = "An ')' or ',' was expected";
    expectRejected({
        {" F(a b) a\nrest", kSeparator, "rest"},
        {" F(a...) a\nrest", kSeparator, "rest"},
        {" F(a, b(c)) a\nrest", kSeparator, "rest"},
        {" F(a(b), c) a\nrest", kSeparator, "rest"},
    });
}

TEST(Definitions, SkipTheNextLineWhereTheLineEndStandsInTheList) {
    expectRejected({
        {" F(\nskipped\nrest", "An identifier is expected", "rest"},
        {" F(a\nskipped\nrest", "An ')' or ',' was expected", "rest"},
        {" F(a,\nskipped\nrest", "An identifier is expected", "rest"},
        {" F(", "An identifier is expected", ""},
    });
}

TEST(Definitions, SayNothingAboutTheSameTextAgain) {
    DefinitionFixture f(" G(a) a\n G a\n G(b)   a\n");
    f.definitions.defineDirective();
    f.definitions.defineDirective();
    f.definitions.defineDirective();
    EXPECT_TRUE(f.isFunctionLike("G"));
    EXPECT_EQ(f.parametersOf("G"), "a");
    EXPECT_EQ(f.reporter.report(), "");
}

TEST(Definitions, WarnOfAnotherTextAndTakeIt) {
    DefinitionFixture f(" A 1\n A   1\n A(x) 2\n");
    f.definitions.defineDirective();
    f.definitions.defineDirective();
    EXPECT_EQ(f.reporter.report(), "");
    f.definitions.defineDirective();
    EXPECT_EQ(f.reporter.report(), "Warning: Macro \"A\" has an incompatible redefinition");
    EXPECT_EQ(f.definition("A"), "2");
    EXPECT_TRUE(f.isFunctionLike("A"));
}

TEST(Definitions, UndefineAName) {
    DefinitionFixture f(" A \n if\nrest");
    f.define("A", "1");
    f.define("if", "1");
    f.definitions.undefDirective();
    f.definitions.undefDirective();
    EXPECT_EQ(f.definition("A"), "(not defined)");
    EXPECT_EQ(f.definition("if"), "(not defined)");
    EXPECT_EQ(f.rest(), "rest");
    EXPECT_EQ(f.reporter.report(), "");
}

TEST(Definitions, SayNothingAboutUndefiningWhatIsNotDefined) {
    DefinitionFixture f(" A\nrest");
    f.definitions.undefDirective();
    EXPECT_EQ(f.rest(), "rest");
    EXPECT_EQ(f.reporter.report(), "");
}

TEST(Definitions, UndefineReadsOneTokenBehindTheName) {
    DefinitionFixture f(" A B C\nrest");
    f.define("A", "1");
    f.define("B", "1");
    f.definitions.undefDirective();
    EXPECT_EQ(f.definition("A"), "(not defined)");
    EXPECT_EQ(f.definition("B"), "1");
    EXPECT_EQ(f.rest(), " C\nrest");
    EXPECT_EQ(f.reporter.report(), "");
}

TEST(Definitions, UndefineRejectsWhatIsNoName) {
    DefinitionFixture f(" 3 x\n");
    f.definitions.undefDirective();
    EXPECT_EQ(f.rest(), " x\n");
    EXPECT_EQ(f.reporter.report(), "Invalid macro name");
}

}  // namespace
}  // namespace umpre
