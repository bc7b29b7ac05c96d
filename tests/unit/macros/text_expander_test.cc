// SPDX-License-Identifier: MIT
#include "macros/text_expander.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "macros/predefined_macros.h"

namespace umpre {
namespace {

constexpr std::string_view kNotTold = "(not told)";

struct Fixture {
    Fixture() { definePredefinedMacros(macros); }

    void define(std::string_view name, std::string_view text) {
        macros.define(name, {text, {}, false});
    }

    void define(std::string_view name, std::string_view parameters, std::string_view text) {
        macros.define(name, {text, parameters, true});
    }

    // Expands what a text begins with: a name, or a name and its arguments. Puts "|" before the
    // rest.
    [[nodiscard]] std::string expanded(std::string_view text) {
        const std::string all = std::string(text) + std::string(32, ' ');
        const std::string name(text.substr(0, text.find('(')));
        const char* const end = all.data() + text.size();
        TextBuffer result;
        if (name == text) {
            return std::string(expander.expandObject(*macros.find(name), result) ? result.view()
                                                                                 : kNotTold);
        }
        const char* const behind =
            expander.expandCall(*macros.find(name), all.data() + name.size(), end, result);
        if (behind == nullptr) {
            return std::string(kNotTold);
        }
        return std::string(result.view()) + (behind == end ? "" : "|" + std::string(behind, end));
    }

    TextLexer lexer;
    MacroTable macros;
    BodyMaker bodies{lexer, macros};
    TextExpander expander{macros, bodies};
};

struct Row {
    std::string_view text;
    std::string_view expansion = kNotTold;
};

// The macro TEXT, which has each row's text, comes out as the row says.
TEST(TextExpander, PutsTextsInThePlacesOfNames) {
    const std::vector<Row> rows{
        {"", ""},
        {"1 + 2", "1 + 2"},
        {"N", "3"},
        {"(N-N)", "(3-3)"},
        {"N2 + aN", "N2 + aN"},
        {"M", "3 3"},
        {"EMPTY N EMPTY", " 3 "},
        {"<LESS<", "<<<"},  // three tokens, from three texts
        {"\"N\" 'N' N", "\"N\" 'N' 3"},
        {"\"\\\"N\" N", "\"\\\"N\" 3"},
        {"0xN 1N 12uN", "0xN 13 12u3"},  // the rules for numbers split so
        {"\\N", "\\3"},
        {"N/N", "3/3"},
        {"# N ## N", "# 3 ## 3"},
        {"defined N", "defined 3"},
        {"\xE9N",
         "\xE9"
         "3"},
        {"TEXT", "TEXT"},
        {"A TEXT", "A B c TEXT c TEXT TEXT"},
        {"F(N)", "[3]"},
        {"F (N) F( N )", "[3] [3]"},
        {"F + 1", kNotTold},  // the blank comes before the name
        {"F+1", "F+1"},
        {"F", kNotTold},
        {"F ", kNotTold},
        {"F(1", kNotTold},
        {"F() F(1)", kNotTold},
        {"LAST(1)", kNotTold},
        {"__LINE__"},
        {"x __FILE__"},
        {"a // b"},
        {"a /* b */"},
        {"\"open N"},
        {"' N"},
        {"a\nb"},
        {"a\rb"},
        {"a \\\nb"},
        {std::string_view("a\0b", 3)},
    };
    for (const Row& row : rows) {
        Fixture f;
        f.define("N", "3");
        f.define("M", "N N");
        f.define("A", "A B C TEXT");
        f.define("B", "B C TEXT");
        f.define("C", "c");
        f.define("EMPTY", "");
        f.define("LESS", "<");
        f.define("defined", "N");
        f.define("F", "x", "[x]");
        f.define("LAST", "x", "x LAST2");
        f.define("LAST2", "", "0");
        f.define("TEXT", row.text);
        EXPECT_EQ(f.expanded("TEXT"), row.expansion) << row.text;
    }
}

TEST(TextExpander, ExpandsCalls) {
    const std::vector<Row> rows{
        {"F(1)", "[1]"},
        {"F(1)2", "[1]|2"},
        {"F( a + N )", "[a + 3]"},
        {"F(F(F(N)))", "[[[3]]]"},
        {"F((a, b))", "[(a, b)]"},
        {"F(\",)\")", "[\",)\"]"},
        {"NONE()", "0"},
        {"NONE( )", "0"},
        {"TWO(a,b)", "a b"},
        {"TWO( a , b )", "a b"},
        {"TWO(,b)", " b"},
        {"F(a,)", "[a]"},
        {"ONE(,)", ""},
        {"TEXT(a + \"b\\n\" 'c')", "\"a + \\\"b\\\\n\\\" 'c'\""},
        {"TEXT(N)", "\"N\""},
        {"JOIN(a,b)", "ab"},
        {"JOIN(N,1)", "N1"},
        {"JOIN(,N)", "3"},
        {"JOIN(1,N)", "13"},  // two tokens
        {"JOIN(a N,N)", "a NN"},
        {"JOIN(\"N\",N)", "\"N\"3"},
        {"JOIN(F,)", kNotTold},  // a last argument is never empty
        {"CALL(F,1)", "[1]"},
        {"CALL(N,1)", "3(1)"},
        {"CALL(CALL,1)", "CALL(1)"},
        {"TABLE(ROW)", "<1> <2>"},
        {"INNER(N)", "[3] 3 34"},
        {"F(F)", "[F]"},
        {"F(INNER)", "[INNER]"},
        {"MEETING(<)", "<<"},
        {"F(SELF)"},
        {"ONE(SELF)"},
        {"F(N + SELF)"},
        {"TWICE(TWICE(EMPTY))", "   "},
    };
    for (const Row& row : rows) {
        Fixture f;
        f.define("N", "3");
        f.define("EMPTY", "");
        f.define("SELF", "SELF");
        f.define("F", "x", "[x]");
        f.define("ONE", "x", "x");
        f.define("NONE", "", "0");
        f.define("TWO", "a,b", "a b");
        f.define("TEXT", "x", "#x");
        f.define("JOIN", "a,b", "a ## b");
        f.define("CALL", "f,x", "f(x)");
        f.define("ROW", "x", "<x>");
        f.define("TABLE", "row", "row(1) row(2)");
        f.define("INNER", "x", "F(x) x JOIN(x, 4)");
        f.define("TWICE", "x", "x x");
        f.define("MEETING", "a", "<a");
        EXPECT_EQ(f.expanded(row.text), row.expansion) << row.text;
    }
}

TEST(TextExpander, LeavesCallsThatAreMoreThanText) {
    for (const std::string_view text : {
             "F(1",        "F(1\n)",          "F(1\\\n)",      "F(a /* b */)",
             "F(a // b)",  "F(\"a)",          "F(')",          "F()",
             "F(1, 2)",    "F(a  b)",         "F(a\tb)",       "F(__LINE__)",
             "F(F x)",     "F(ONE(SELF))",    "ONE(F)",        "MISPLACED(1)",
             "PASTE(1)",   "SLASHES(1)",      "COMMENT(/, *)", "QUOTE(1)",
             "MEET(+, 1)", "ONE(MEETING(<))",
         }) {
        Fixture f;
        f.define("SELF", "SELF");
        f.define("F", "x", "[x]");
        f.define("ONE", "x", "x");
        f.define("MISPLACED", "x", "x # y");
        f.define("PASTE", "x", "x ##");
        f.define("SLASHES", "x", "/ ## /");
        f.define("COMMENT", "a,b", "a ## b");
        f.define("QUOTE", "x", "x \" y");
        f.define("MEET", "a,b", "b##a a b__LINE__ __LINE__");
        f.define("MEETING", "a", "<a");
        EXPECT_EQ(f.expanded(text), kNotTold) << text;
    }
}

TEST(TextExpander, LeavesWhatIsLargeOrDeep) {
    Fixture f;
    // Each two of the next, and nothing in the end.
    f.define("D0", "");
    for (int depth = 1; depth < 20; ++depth) {
        const std::string inner = "D" + std::to_string(depth - 1);
        f.define("D" + std::to_string(depth), inner + " " + inner);
    }
    EXPECT_EQ(f.expanded("D2"), "   ");
    EXPECT_EQ(f.expanded("D19"), kNotTold);
    // Each the next.
    f.define("C0", "end");
    for (int depth = 1; depth < 200; ++depth) {
        f.define("C" + std::to_string(depth), "C" + std::to_string(depth - 1));
    }
    EXPECT_EQ(f.expanded("C20"), "end");
    EXPECT_EQ(f.expanded("C199"), kNotTold);
    // An argument used twice, again and again.
    f.define("T", "x", "x x");
    std::string text = "1";
    for (int depth = 0; depth < 28; ++depth) {
        text = "T(" + text + ")";
    }
    EXPECT_EQ(f.expanded(text), kNotTold);
    EXPECT_EQ(f.expanded("T(T(1))"), "1 1 1 1");
}

TEST(TextExpander, TakesNoMoreOfATextThanItIsGiven) {
    Fixture f;
    f.define("F", "x", "[x]");
    f.define("P", "x", "x");
    EXPECT_EQ(f.expanded("P(F (1))"), "[1]");
    EXPECT_EQ(f.expanded("P(F)"), kNotTold);  // behind the F of before was more in memory
}

TEST(TextExpander, TellsNothingWhereEachMacroIsToldOf) {
    Fixture f;
    f.define("N", "3");
    f.define("F", "x", "x");
    BodyMaker bodies(f.lexer, f.macros, true);
    TextExpander expander(f.macros, bodies);
    const std::string call = "(1)" + std::string(32, ' ');
    TextBuffer result;
    EXPECT_FALSE(expander.expandObject(*f.macros.find("N"), result));
    EXPECT_EQ(expander.expandCall(*f.macros.find("F"), call.data(), call.data() + 3, result),
              nullptr);
}

}  // namespace
}  // namespace umpre
