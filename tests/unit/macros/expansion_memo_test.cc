// SPDX-License-Identifier: MIT
#include "macros/expansion_memo.h"

#include <string>
#include <string_view>

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

    [[nodiscard]] std::string textOf(std::string_view name) {
        return std::string(memo.textOf(*macros.find(name)).value_or(kNotTold));
    }

    MacroTable macros;
    ExpansionMemo memo{macros};
};

// A macro of this text, among others, comes out as that.
struct Row {
    std::string_view text;
    std::string_view expansion;
};

TEST(ExpansionMemo, PutsTextsInThePlacesOfNames) {
    constexpr Row kRows[] = {
        {"", ""},
        {"1 + 2", "1 + 2"},
        {"N", "3"},
        {"(N-N)", "(3-3)"},
        {"N2 + aN", "N2 + aN"},
        {"M", "3 3"},
        {"EMPTY N EMPTY", " 3 "},
        {"<LESS<", "<<<"},  // three tokens, which came from three texts
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
    };
    for (const Row& row : kRows) {
        Fixture f;
        f.define("N", "3");
        f.define("M", "N N");
        f.define("EMPTY", "");
        f.define("LESS", "<");
        f.define("defined", "N");
        f.define("TEXT", row.text);
        EXPECT_EQ(f.textOf("TEXT"), row.expansion) << row.text;
        EXPECT_EQ(f.textOf("TEXT"), row.expansion) << row.text << ", again";
    }
}

TEST(ExpansionMemo, AMacroIsNotReplacedInItsOwnText) {
    Fixture f;
    f.define("A", "A B C");
    f.define("B", "A B C");
    f.define("C", "c");
    EXPECT_EQ(f.textOf("A"), "A A B c c");
    EXPECT_EQ(f.textOf("B"), "A B c B c");
}

TEST(ExpansionMemo, LeavesWhatIsMoreThanText) {
    constexpr std::string_view kTexts[] = {
        "F",        "x F(1)", "__LINE__", "N __FILE__", "a // b",  "a /* b */",
        "\"open N", "' N",    "a\nb",     "a\rb",       "a \\\nb", std::string_view("a\0b", 3),
    };
    for (const std::string_view text : kTexts) {
        Fixture f;
        f.macros.define("F", {"x", "x", true});
        f.define("N", "3");
        f.define("TEXT", text);
        f.define("OUTER", "(TEXT)");
        EXPECT_EQ(f.textOf("TEXT"), kNotTold) << text;
        EXPECT_EQ(f.textOf("OUTER"), kNotTold) << text;
    }
}

TEST(ExpansionMemo, FollowsWhatNamesAreDefinedAs) {
    Fixture f;
    f.define("OUTER", "INNER OTHER");
    EXPECT_EQ(f.textOf("OUTER"), "INNER OTHER");
    f.define("INNER", "1");
    EXPECT_EQ(f.textOf("OUTER"), "1 OTHER");
    f.define("INNER", "2");
    EXPECT_EQ(f.textOf("OUTER"), "2 OTHER");
    f.macros.define("OTHER", {"x", "", true});
    EXPECT_EQ(f.textOf("OUTER"), kNotTold);
    f.macros.undefine("OTHER");
    f.macros.undefine("INNER");
    EXPECT_EQ(f.textOf("OUTER"), "INNER OTHER");
    f.define("OUTER", "3");
    EXPECT_EQ(f.textOf("OUTER"), "3");
}

TEST(ExpansionMemo, LeavesWhatIsLarge) {
    Fixture f;
    f.define("LONG", std::string(5000, '+'));
    EXPECT_EQ(f.textOf("LONG"), kNotTold);
    // Each two of the next, and nothing in the end.
    f.define("D0", "");
    for (int depth = 1; depth < 12; ++depth) {
        const std::string inner = "D" + std::to_string(depth - 1);
        f.define("D" + std::to_string(depth), inner + " " + inner);
    }
    EXPECT_EQ(f.textOf("D2"), "   ");
    EXPECT_EQ(f.textOf("D11"), kNotTold);
    // Each the next.
    f.define("C0", "end");
    for (int depth = 1; depth < 20; ++depth) {
        f.define("C" + std::to_string(depth), "C" + std::to_string(depth - 1));
    }
    EXPECT_EQ(f.textOf("C10"), "end");
    EXPECT_EQ(f.textOf("C19"), kNotTold);
}

}  // namespace
}  // namespace umpre
