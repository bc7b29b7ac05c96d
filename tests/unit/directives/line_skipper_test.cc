// SPDX-License-Identifier: MIT
#include "directives/line_skipper.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/file_fixture.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using Stop = LineSkipper::Stop;
using enum TokenKind;

// A file of which all is skipped.
struct Skipping : testing::FileFixture {
    Skipping(std::string_view text, std::size_t windowSize) : FileFixture(text, windowSize) {
        groups.open();
        groups.decide(false);
    }

    ConditionalStack groups;
    LineSkipper skipper{output, groups};
};

// What is written for a text, and the text of the token that is left next.
struct Row {
    std::string_view text;
    std::string_view written;
    std::string_view next;
};

void expectSkips(const std::vector<Row>& table, Stop stop, Stop from = Stop::LineStart) {
    for (const Row& row : table) {
        SCOPED_TRACE(::testing::PrintToString(row.text));
        Skipping skipping(row.text, 1024);
        ASSERT_TRUE(skipping.isOpen);
        EXPECT_EQ(skipping.skipper.skip(skipping.file, from), stop);
        EXPECT_EQ(skipping.written(), row.written);
        EXPECT_EQ(skipping.file.next().text, row.next);
    }
}

TEST(LineSkipper, WritesALineFeedForEachLine) {
    expectSkips(
        {
            {"", "", ""},
            {"a\n\n  \nMACRO \"b\" 1\n", "\n\n\n\n", ""},
            {"a # b\n##c\n", "\n\n", ""},
            {"x\0y\n\xE9\n"sv, "\n\n", ""},
            {"a\r\nb\rc\n\r", "\n\n\n\n", ""},
        },
        Stop::LineStart);
}

TEST(LineSkipper, WritesALineFeedForEachLineOfAComment) {
    expectSkips({{"a /* b\n\n */ c\n// d\ne\n", "\n\n\n\n\n", ""}}, Stop::LineStart);
}

TEST(LineSkipper, StopsAtADirective) {
    expectSkips(
        {
            {"#else\n", "", "#"},
            {"a\n#else\n", "\n", "#"},
            {"a\n  #else\n", "\n", "#"},
            {"a\n/**/#else\n", "\n", "#"},
            {"a\n /* \n */ /* */ #else\n", "\n\n", "#"},
            {"a\n\\\n#else\n", "\n", "#"},
            {"a\n \\\r\n /**/ #else\n", "\n", "#"},
            {"a\n\r\n#else\n", "\n\n", "#"},
            {"a\r#else\n", "\n", "#"},
            {"a\n#elif 1\n", "\n", "#"},
            {"a\n#endif\n", "\n", "#"},
            {"a\n#\nb\n", "\n", "#"},
            {"a\n# 1\nb\n", "\n", "#"},
            {"a\n#if /*\n*/ 1\n", "\n", "#"},
        },
        Stop::LineStart);
}

TEST(LineSkipper, PassesOverWhatChangesNothing) {
    expectSkips(
        {
            {"#define a \"/*\"\n # x # y\n#line\n", "\n\n\n", ""},
            {"#if 1\n#else\na\n#endif\n", "\n\n\n", ""},
            {"#ifdef a // b\n#endif\n#else\n", "", "#"},
            {"#ifdef a\n#endif // b\n#else\n", "\n", "#"},
            {"#if 1\n#ifndef a\n#endif x\n#elif 1\n#else\n#endif\n#endif\n", "\n\n\n", "#"},
            {"#if 1\n#endif#endif\n", "", "#"},
            {"#if 1\r\n#endif\r\n#else\n", "\n", "#"},
        },
        Stop::LineStart);
}

TEST(LineSkipper, LeavesWhatIsWrongInADeadGroup) {
    for (const std::string_view wrong : {"#else\n", "#elif 1\n"}) {
        Skipping skipping("#if 1\n#else\n" + std::string(wrong) + "#endif\n", 1024);
        EXPECT_EQ(skipping.skipper.skip(skipping.file, Stop::LineStart), Stop::LineStart);
        EXPECT_EQ(skipping.file.position().line, 3);
        EXPECT_EQ(skipping.groups.conditionalDepth(), 2U);
        EXPECT_EQ(skipping.groups.groupState(), GroupState::AfterElse);
    }
}

TEST(LineSkipper, KeepsTheGroupsThatAreOpen) {
    Skipping skipping("#if 1\n#ifdef a\n#endif\n#if 2\n#else\nb\n", 1024);
    EXPECT_EQ(skipping.skipper.skip(skipping.file, Stop::LineStart), Stop::LineStart);
    EXPECT_TRUE(skipping.file.isAtEnd());
    EXPECT_EQ(skipping.groups.conditionalDepth(), 3U);
    EXPECT_EQ(skipping.groups.groupState(), GroupState::AfterElse);
    EXPECT_TRUE(skipping.groups.skipping());
}

TEST(LineSkipper, KnowsWhatIsNoDirective) {
    expectSkips(
        {
            {"a \\\n#b\n", "\n", ""},
            {"\"a\" #b\n'a' #b\n", "\n\n", ""},
            {"a /*\n*/ #b\n", "\n\n", ""},
            {"/*\n#b\n*/\n", "\n\n\n", ""},
            {"// a\\\n", "\n", ""},
            {"\"/*\" a\n'//*' b\n", "\n\n", ""},
        },
        Stop::LineStart);
}

TEST(LineSkipper, GoesOnWithinALine) {
    expectSkips({{"#else\n#else\n", "\n", "#"}, {"\n#else\n", "\n", "#"}}, Stop::LineStart,
                Stop::InLine);
}

TEST(LineSkipper, LeavesALastLineThatHasNoLineEndToBeClosed) {
    expectSkips({{"a\nb", "\n", ""}}, Stop::InLine);
    for (const std::string_view text : {"a", "a\n \\\n", "\n /* a */", "// a\r", "a\n "}) {
        Skipping skipping(text, 1024);
        while (skipping.skipper.skip(skipping.file, Stop::LineStart) == Stop::InLine
               && skipping.file.next().kind != NEWLINE) {
        }
        Skipping scanned(text, 1024);
        Token last = scanned.file.next();
        for (Token token = last; token.kind != END_OF_INPUT; token = scanned.file.next()) {
            last = token;
        }
        EXPECT_EQ(last.kind, NEWLINE) << ::testing::PrintToString(text);
    }
}

TEST(LineSkipper, LeavesWhatTheWindowDoesNotHoldToTheScanner) {
    Skipping skipping("a\n/* b c d e f g */ #else\n", 8);
    EXPECT_EQ(skipping.skipper.skip(skipping.file, Stop::LineStart), Stop::LineStart);
    EXPECT_EQ(skipping.file.next().text, " ");
    const std::string literal = "\"" + std::string(100, 'c') + "\"";
    Skipping other("a\nb " + literal + " d\n", 8);
    EXPECT_EQ(other.skipper.skip(other.file, Stop::LineStart), Stop::InLine);
    EXPECT_EQ(other.file.next().text, literal);
}

TEST(LineSkipper, KeepsTheOutputInStep) {
    Skipping skipping("a\nb\n\n#else\n", 1024);
    EXPECT_EQ(skipping.skipper.skip(skipping.file, Stop::LineStart), Stop::LineStart);
    EXPECT_TRUE(skipping.isInStep());
    Skipping comment("/*\n*/\n#else\n", 1024);
    EXPECT_EQ(comment.skipper.skip(comment.file, Stop::LineStart), Stop::LineStart);
    EXPECT_EQ(comment.file.position().line, 3);
    EXPECT_FALSE(comment.isInStep());
}

}  // namespace
}  // namespace umpre
