// SPDX-License-Identifier: MIT
#include "directives/line_control.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/directive_fixture.h"

namespace umpre {
namespace {

using testing::DirectiveFixture;

constexpr std::string_view kInvalidFormat = "Invalid format for \"#line\" directive";
constexpr std::string_view kInvalidCharacters =
    "Invalid characters appear before a new-line in the preprocessor directive";

// What comes after the directive word.
struct LineControlFixture : DirectiveFixture {
    using DirectiveFixture::DirectiveFixture;

    LineControl lineControl{sources, expander, lexer, output, reporter};
};

// What `#line` makes of its operand: the line and the name of what follows, and what is written and
// reported.
struct Row {
    std::string_view operand;
    std::int32_t line;
    std::string_view name;
    std::string_view marker;
    std::string_view report;
};

void expectLines(const std::vector<Row>& table) {
    for (const Row& row : table) {
        LineControlFixture f(std::string(row.operand) + "\nrest\n");
        f.define("L", "42");
        f.define("NAMED", "9 \"named\"");
        f.lineControl.lineDirective();
        EXPECT_EQ(f.sources.position().line, row.line) << row.operand;
        EXPECT_EQ(f.sources.position().fileName, row.name) << row.operand;
        EXPECT_EQ(f.written(), row.marker) << row.operand;
        EXPECT_EQ(f.reporter.report(), row.report) << row.operand;
        EXPECT_EQ(f.rest(), "rest\n") << row.operand;
    }
}

TEST(LineControl, LineGivesTheNextLineItsNumber) {
    expectLines({
        {" 100", 100, "main", "#line 100 \"main\"\n", ""},
        {"7", 7, "main", "#line 7 \"main\"\n", ""},
        {" 100 /* c */ // d", 100, "main", "#line 100 \"main\"\n", ""},
        {" 1\\\n00", 100, "main", "#line 100 \"main\"\n", ""},
    });
}

TEST(LineControl, LineGivesTheFileAName) {
    expectLines({
        {" 7 \"x.src\"", 7, "x.src", "#line 7 \"x.src\"\n", ""},
        {" 7\"x.src\"", 7, "x.src", "#line 7 \"x.src\"\n", ""},
        {" 7 \"\"", 7, "", "#line 7 \"\"\n", ""},
        {" 7 \"a\\\\b\\n\"", 7, "a\\\\b\\n", "#line 7 \"a\\\\\\\\b\\\\n\"\n", ""},
    });
}

TEST(LineControl, LineExpandsItsOperand) {
    expectLines({
        {" L", 42, "main", "#line 42 \"main\"\n", ""},
        {" NAMED", 9, "named", "#line 9 \"named\"\n", ""},
        {" L \"x\"", 42, "x", "#line 42 \"x\"\n", ""},
    });
}

TEST(LineControl, LineRejectsAllButPlainDecimalNumbers) {
    expectLines({
        {" 0", 2, "main", "", "Invalid line number"},
        {" 010", 2, "main", "", kInvalidFormat},
        {" 00", 2, "main", "", kInvalidFormat},
        {" 0x10", 2, "main", "", kInvalidFormat},
        {" 10u", 2, "main", "", kInvalidFormat},
        {" 10L", 2, "main", "", kInvalidFormat},
        {" 10l \"x\"", 2, "main", "", kInvalidFormat},
        {" \"x\"", 2, "main", "", kInvalidFormat},
        {" x", 2, "main", "", kInvalidFormat},
        {" -1", 2, "main", "", kInvalidFormat},
        {"", 2, "main", "", kInvalidFormat},
        {" 0 \"x\"", 2, "main", "", "Invalid line number"},
    });
}

TEST(LineControl, LineReportsWhatStandsForTheNameAndKeepsTheNumber) {
    expectLines({
        {" 7 x", 7, "main", "#line 7 \"main\"\n", kInvalidFormat},
        {" 7 x \"y\"", 7, "main", "#line 7 \"main\"\n", kInvalidFormat},
        {" 7 'x'", 7, "main", "#line 7 \"main\"\n", kInvalidFormat},
        {" 1.5", 1, "main", "#line 1 \"main\"\n", kInvalidFormat},
    });
}

TEST(LineControl, LineReportsWhatFollowsTheName) {
    expectLines({{" 5 \"a\" b", 5, "a", "#line 5 \"a\"\n", kInvalidCharacters}});
}

TEST(LineControl, LineTakesTheLowBitsOfALargeNumber) {
    expectLines({
        {" 2147483647", 2147483647, "main", "#line 2147483647 \"main\"\n", ""},
        {" 2147483648", -2147483647 - 1, "main", "#line -2147483648 \"main\"\n", ""},
        {" 4294967297", 1, "main", "#line 1 \"main\"\n", ""},
        {" 9223372036854775806", -2, "main", "#line -2 \"main\"\n", ""},
        {" 9223372036854775807", -1, "main", "#line -1 \"main\"\n", ""},
        {" 9223372036854775808", -1, "main", "#line -1 \"main\"\n", ""},
        {" 99999999999999999999999", -1, "main", "#line -1 \"main\"\n", ""},
    });
}

TEST(LineControl, LineEndsWithTheInput) {
    LineControlFixture f(" 7");
    f.lineControl.lineDirective();
    EXPECT_EQ(f.written(), "#line 7 \"main\"\n");
    EXPECT_EQ(f.rest(), "");
}

TEST(LineControl, LineCountsOnFromItsNumber) {
    LineControlFixture f(" 100\na\nb");
    f.lineControl.lineDirective();
    (void)f.sources.next();
    (void)f.sources.next();
    EXPECT_EQ(f.sources.position().line, 101);
}

TEST(LineControl, PragmaWritesItsLineAsItStands) {
    struct Pragma {
        std::string_view text;
        std::string_view written;
    };

    for (const Pragma& row : {
             Pragma{" once\nrest", "#pragma  once\n"},
             Pragma{"\nrest", "#pragma \n"},
             Pragma{" a  \"b\"\tN(1) \nrest", "#pragma  a  \"b\"\tN(1) \n"},
             Pragma{" a /* c */ b // d\nrest", "#pragma  a   b  \n"},
             Pragma{" a\\\nb \\\n c\nrest", "#pragma  ab  c\n"},
         }) {
        LineControlFixture f(row.text);
        f.define("N", "3");
        f.lineControl.pragmaDirective();
        EXPECT_EQ(f.written(), row.written) << row.text;
        EXPECT_EQ(f.rest(), "\nrest") << row.text;
        EXPECT_EQ(f.reporter.report(), "") << row.text;
    }
}

TEST(LineControl, PragmaCountsTheLineItWrites) {
    LineControlFixture f(" once\n");
    f.output.writeLineMarker(f.sources.position());
    f.lineControl.pragmaDirective();
    EXPECT_TRUE(f.output.isAt({"main", 2}));
}

TEST(LineControl, ErrorReportsItsLineAsItStands) {
    struct ErrorRow {
        std::string_view text;
        std::string_view report;
    };

    for (const ErrorRow& row : {
             ErrorRow{" stop here\nrest", "#error directive:  stop here"},
             ErrorRow{"\nrest", "#error directive: "},
             ErrorRow{" N  \"b\"\t \nrest", "#error directive:  N  \"b\"\t "},
             ErrorRow{" a\\\nb /* c */\nrest", "#error directive:  ab  "},
         }) {
        LineControlFixture f(row.text);
        f.define("N", "3");
        f.lineControl.errorDirective();
        EXPECT_EQ(f.reporter.report(), row.report) << row.text;
        EXPECT_EQ(f.written(), "") << row.text;
        EXPECT_EQ(f.rest(), "\nrest") << row.text;
    }
}

}  // namespace
}  // namespace umpre
