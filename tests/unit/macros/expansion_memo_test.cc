// SPDX-License-Identifier: MIT
#include "macros/expansion_memo.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "macros/text_expander.h"

namespace umpre {
namespace {

constexpr std::string_view kNotTold = "(not told)";

struct Fixture {
    void define(std::string_view name, std::string_view text) {
        macros.define(name, {text, {}, false});
    }

    [[nodiscard]] std::string textOf(std::string_view name) {
        return std::string(memo.textOf(*macros.find(name)).value_or(kNotTold));
    }

    TextLexer lexer;
    MacroTable macros;
    BodyMaker bodies{lexer, macros};
    TextExpander expander{macros, bodies};
    ExpansionMemo memo{macros, expander};
};

TEST(ExpansionMemo, TellsTheSameAgain) {
    Fixture f;
    f.define("OUTER", "(INNER)");
    f.define("INNER", "1");
    f.define("EMPTY", "");
    for (int time = 0; time < 3; ++time) {
        EXPECT_EQ(f.textOf("OUTER"), "(1)");
        EXPECT_EQ(f.textOf("EMPTY"), "");
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
    EXPECT_EQ(f.textOf("OUTER"), kNotTold);
    f.macros.undefine("OTHER");
    f.macros.undefine("INNER");
    EXPECT_EQ(f.textOf("OUTER"), "INNER OTHER");
    f.define("OUTER", "3");
    EXPECT_EQ(f.textOf("OUTER"), "3");
}

TEST(ExpansionMemo, FollowsWhatTheNamesOfACallAreDefinedAs) {
    Fixture f;
    f.macros.define("F", {"x BODY", "x", true});
    f.define("CALL", "F(ARGUMENT)");
    EXPECT_EQ(f.textOf("CALL"), "ARGUMENT BODY");
    f.define("ARGUMENT", "1");
    EXPECT_EQ(f.textOf("CALL"), "1 BODY");
    f.define("BODY", "2");
    EXPECT_EQ(f.textOf("CALL"), "1 2");
    f.macros.define("F", {"<x>", "x", true});
    EXPECT_EQ(f.textOf("CALL"), "<1>");
}

}  // namespace
}  // namespace umpre
