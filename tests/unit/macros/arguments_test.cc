// SPDX-License-Identifier: MIT
#include "macros/arguments.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/argument_lists.h"
#include "support/source_fixture.h"

namespace umpre {
namespace {

using testing::SourceFixture;
using testing::Texts;
using testing::textsOf;

constexpr std::string_view kNotEnough = "There are not enough arguments in a macro invocation";
constexpr std::string_view kTooMany = "A macro invocation has too many arguments";
constexpr std::string_view kUnterminated = "The macro invocation is improperly terminated";

struct ArgumentsFixture : SourceFixture {
    using SourceFixture::SourceFixture;

    MacroTable macros;
    ArgumentCollector collector{sources, macros, reporter, lexer.texts()};
};

struct Accepted {
    std::string_view text;
    std::size_t parameterCount;
    Texts arguments;
    std::string_view rest;
};

void expectAccepted(const std::vector<Accepted>& table) {
    for (const Accepted& row : table) {
        SCOPED_TRACE(row.text);
        ArgumentsFixture f(row.text);
        ArgumentList arguments;
        EXPECT_TRUE(f.collector.collect(row.parameterCount, arguments));
        EXPECT_EQ(textsOf(arguments), row.arguments);
        EXPECT_EQ(f.rest(), row.rest);
        EXPECT_EQ(f.reporter.report(), "");
    }
}

struct Rejected {
    std::string_view text;
    std::size_t parameterCount;
    std::string_view message;
    std::string_view rest;
};

void expectRejected(const std::vector<Rejected>& table) {
    for (const Rejected& row : table) {
        SCOPED_TRACE(row.text);
        ArgumentsFixture f(row.text);
        ArgumentList arguments;
        EXPECT_FALSE(f.collector.collect(row.parameterCount, arguments));
        EXPECT_EQ(f.reporter.report(), row.message);
        EXPECT_EQ(f.rest(), row.rest);
    }
}

TEST(Arguments, AreSeparatedByCommas) {
    expectAccepted({
        {"(a) z", 1, {"a"}, " z"},
        {"(a,b)", 2, {"a", "b"}, ""},
        {"(a, b ,c )", 3, {"a", "b", "c"}, ""},
        {"(a b)", 1, {"a b"}, ""},
        {"(a)(b)", 1, {"a"}, "(b)"},
    });
}

TEST(Arguments, MayBeNone) {
    expectAccepted({
        {"()", 0, {}, ""},
        {"( )x", 0, {}, "x"},
        {"(\n/* c */)", 0, {}, ""},
    });
}

TEST(Arguments, MayBeEmptyButForTheLast) {
    expectAccepted({
        {"(,x)", 2, {"", "x"}, ""},
        {"( , x)", 2, {"", "x"}, ""},
        {"(,)", 1, {""}, ""},
        {"(,,x)", 3, {"", "", "x"}, ""},
    });
    expectRejected({
        {"()", 1, kNotEnough, ""},
        {"( ) x", 1, kNotEnough, " x"},
        {"(,)", 2, kNotEnough, ""},
        {"(x,)", 2, kNotEnough, ""},
    });
}

TEST(Arguments, MayBeFollowedByOneComma) {
    expectAccepted({{"(a,)", 1, {"a"}, ""}, {"(a, )", 1, {"a"}, ""}});
}

TEST(Arguments, InParenthesesBelongTogether) {
    expectAccepted({
        {"((a,b))", 1, {"(a,b)"}, ""},
        {"(f(a, b), g)", 2, {"f(a, b)", "g"}, ""},
        {"(())", 1, {"()"}, ""},
        {"((),())", 2, {"()", "()"}, ""},
        {"(((a))b)", 1, {"((a))b"}, ""},
    });
}

TEST(Arguments, InBracketsAndBracesDoNotBelongTogether) {
    expectAccepted({
        {"([a,b])", 2, {"[a", "b]"}, ""},
        {"({a,b})", 2, {"{a", "b}"}, ""},
    });
}

TEST(Arguments, HaveOneSpaceForEachRunOfBlanks) {
    expectAccepted({
        {"(  a   +\n b  )", 1, {"a + b"}, ""},
        {"(a\t\v\fb)", 1, {"a b"}, ""},
        {"(a/* c */b)", 1, {"a b"}, ""},
        {"(a // c\n b)", 1, {"a b"}, ""},
        {"(a\\\nb)", 1, {"a b"}, ""},
        {"(a+b)", 1, {"a+b"}, ""},
        {"(( a ))", 1, {"( a )"}, ""},
        {"(\na\r\n,\rb\n)", 2, {"a", "b"}, ""},
    });
}

TEST(Arguments, KeepLiteralsAsTheyAre) {
    expectAccepted({
        {"(\"a, b)\")", 1, {"\"a, b)\""}, ""},
        {"(',', '(' ')')", 2, {"','", "'(' ')'"}, ""},
        {"(\"a  b\")", 1, {"\"a  b\""}, ""},
    });
}

TEST(Arguments, HoldDirectiveWordsAndHashesAsText) {
    expectAccepted({{"(\n#define if\n)", 1, {"#define if"}, ""}});
}

TEST(Arguments, MayBeTooFew) {
    expectRejected({
        {"(a) z", 2, kNotEnough, " z"},
        {"(a,b)", 3, kNotEnough, ""},
    });
}

TEST(Arguments, ThatAreTooManyEndWhereThatShows) {
    expectRejected({
        {"(x) z", 0, kTooMany, " z"},
        {"(a,b) z", 1, kTooMany, " z"},
        {"(a,b,c) z", 1, kTooMany, "c) z"},
        {"(a, b, c)", 1, kTooMany, " c)"},
        {"(,) z", 0, kTooMany, ") z"},
        {"(,,) z", 1, kTooMany, ") z"},
        {"(,)z", 0, kTooMany, ")z"},
    });
}

TEST(Arguments, MustBeClosedBeforeTheInputEnds) {
    expectRejected({
        {"(", 0, kUnterminated, ""},
        {"(", 1, kUnterminated, ""},
        {"(a", 1, kUnterminated, ""},
        {"(a,", 2, kUnterminated, ""},
        {"(a, b\n\n", 2, kUnterminated, ""},
        {"((a)", 1, kUnterminated, ""},
    });
}

TEST(Arguments, MayReachThroughSeveralSources) {
    ArgumentsFixture f(", c) z");
    f.pushText("b");
    f.pushText("(a ");
    ArgumentList arguments;
    EXPECT_TRUE(f.collector.collect(2, arguments));
    EXPECT_EQ(textsOf(arguments), (Texts{"a b", "c"}));
    EXPECT_EQ(f.rest(), " z");
}

TEST(Arguments, EndWithAnIsolatedSource) {
    ArgumentsFixture f(") z");
    f.isolateText("(a");
    ArgumentList arguments;
    EXPECT_FALSE(f.collector.collect(1, arguments));
    EXPECT_EQ(f.reporter.report(), kUnterminated);
    f.sources.endIsolation();
    EXPECT_EQ(f.rest(), ") z");
}

TEST(Arguments, HaveTheSetOfTheTokenThatEndsThem) {
    NoExpandSets sets;
    const Name name{"n"};
    const NoExpandSet set = sets.with({}, name);
    ArgumentsFixture f(", c)");
    f.pushText(", b", set);
    f.pushText("(a");
    ArgumentList arguments;
    ASSERT_TRUE(f.collector.collect(3, arguments));
    EXPECT_EQ(arguments[0].noExpand, set);
    EXPECT_EQ(arguments[1].noExpand, NoExpandSet());
    EXPECT_EQ(arguments[2].noExpand, NoExpandSet());
}

TEST(Arguments, OfAnEarlierInvocationAreForgotten) {
    ArgumentsFixture f("(a, b)(c)()");
    ArgumentList arguments;
    ASSERT_TRUE(f.collector.collect(2, arguments));
    arguments[0].state = Argument::Expansion::Known;
    arguments[0].expansion.append({TokenKind::IDENTIFIER, "old"}, {});
    ASSERT_TRUE(f.collector.collect(1, arguments));
    EXPECT_EQ(textsOf(arguments), Texts{"c"});
    EXPECT_EQ(arguments[0].state, Argument::Expansion::Unknown);
    ASSERT_TRUE(f.collector.collect(0, arguments));
    EXPECT_EQ(arguments.size(), 0U);
}

TEST(Arguments, ThatAreAddedAreEmpty) {
    TextLexer lexer;
    const SharedText text = lexer.lexed("a b");
    ArgumentList arguments;
    arguments.add(text).raw.last = 1;
    arguments.add(text);
    EXPECT_EQ(textsOf(arguments), (Texts{"a", ""}));
    arguments.clear();
    EXPECT_EQ(arguments.size(), 0U);
    arguments.add(text);
    EXPECT_EQ(textsOf(arguments), Texts{""});
}

}  // namespace
}  // namespace umpre
