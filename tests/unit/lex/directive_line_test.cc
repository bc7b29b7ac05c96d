// SPDX-License-Identifier: MIT
#include "lex/directive_line.h"

#include <optional>
#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "support/lexeme.h"
#include "support/recording_comment_sink.h"

namespace umpre {
namespace {

using enum TokenKind;

struct DirectiveLineTest : ::testing::Test {
    // Begins with a text as the file.
    [[nodiscard]] DirectiveLine lineOf(std::string_view text) {
        file.openText("main", text);
        return DirectiveLine(file);
    }

    // The text behind the word.
    [[nodiscard]] std::optional<std::string> textOf(std::string_view text) {
        DirectiveLine line = lineOf(text);
        line.skipBlanks();
        const std::optional<std::string_view> read = line.readText(memory);
        return read ? std::optional(std::string(*read)) : std::nullopt;
    }

    testing::RecordingCommentSink comments;
    CppFileScanner file{comments};
    std::string memory;
};

TEST_F(DirectiveLineTest, KnowsItsWord) {
    for (const std::string_view text :
         {"#define\n", " \t#\v\fdefine x\n", "#/* a */define\n", "/* a */ # define\n",
          "#\\\ndefine(\n", "#define\"\n", "#define/\n"}) {
        EXPECT_EQ(lineOf(text).word(), KW_DEFINE) << text;
    }
    EXPECT_EQ(lineOf("#definex\n").word(), IDENTIFIER);
    EXPECT_EQ(lineOf("#endif\n").word(), KW_ENDIF);
}

TEST_F(DirectiveLineTest, HasNoWordWhereThereIsNoDirective) {
    for (const std::string_view text :
         {"", "\n", "x\n", "#\n", "# 1\n", "##define\n", "#\"\"\n", "#defined\n", "//#define\n",
          "/* a\n*/ #define\n", "#/* a\n*/define\n", "\r#define\n", "#\rdefine\n",
          "#\\\r\ndefine\n", "\\\n#define\n", "#define", "#\\\n"}) {
        EXPECT_EQ(lineOf(text).word(), END_OF_INPUT) << text;
    }
}

TEST_F(DirectiveLineTest, LeavesTheFileAsItIsUnlessItsEndIsTaken) {
    {
        DirectiveLine line = lineOf("#define \\\n a\nb\n");
        EXPECT_TRUE(line.skipRest());
    }
    EXPECT_EQ(file.position().line, 1);
    EXPECT_EQ(testing::readText(file), "#define \\\n a\nb\n");
}

TEST_F(DirectiveLineTest, LeavesTheFileBehindTheEndThatItTakes) {
    DirectiveLine line = lineOf("#define \\\n a\nb\n");
    EXPECT_TRUE(line.skipRest());
    EXPECT_FALSE(line.isOneLine());
    line.takeEnd();
    EXPECT_EQ(file.position().line, 3);
    EXPECT_EQ(testing::readText(file), "b\n");
}

// Where lines end with carriage returns, a line feed may be the whole file away.
TEST_F(DirectiveLineTest, LooksForALineFeedAmongSoManyBytes) {
    EXPECT_EQ(lineOf("#if A > 1\nb\n").bytesToLineFeed(1024), " A > 1");
    EXPECT_EQ(lineOf("#if\n").bytesToLineFeed(1024), "");
    const std::string text = " A\r" + std::string(300, 'b') + "\r";
    EXPECT_EQ(lineOf("#if" + text + "\n").bytesToLineFeed(1024), text);
    EXPECT_EQ(lineOf("#if" + text + "\n").bytesToLineFeed(128), "");
}

TEST_F(DirectiveLineTest, ReadsTokens) {
    DirectiveLine line = lineOf("#define N(x) 0x1fL >= /* a */ 'c'\n");
    EXPECT_TRUE(line.isOneLine());
    std::string texts;
    for (line.skipBlanks(); !line.isAtEnd(); line.skipBlanks()) {
        texts.append("[").append(line.next().text).append("]");
    }
    EXPECT_EQ(texts, "[N][(][x][)][0x1fL][>=]['][c][']");
}

TEST_F(DirectiveLineTest, NormalisesText) {
    EXPECT_EQ(textOf("#define\n"), "");
    EXPECT_EQ(textOf("#define a b\n"), "a b");
    EXPECT_EQ(textOf("#define  a  b\t\tc \n"), "a b c");
    EXPECT_EQ(textOf("#define a\tb\n"), "a b");
    EXPECT_EQ(textOf("#define a/* b */c // d\n"), "a c");
    EXPECT_EQ(textOf("#define \"a  b\" 'c  d'  e\n"), "\"a  b\" 'c  d' e");
    EXPECT_EQ(textOf("#define \"a  b\n"), "\"a b");
    EXPECT_EQ(textOf("#define \"a\\\"  b\"  '\"  '\n"), "\"a\\\"  b\" '\"  '");
    EXPECT_EQ(textOf("#define a\\\nb \\\nc\\\n d\\\n\ne\n"), "ab c d");
    EXPECT_EQ(textOf("#define a \\b / c\n"), "a \\b / c");
}

TEST_F(DirectiveLineTest, DoesNotTellTextThatNeedsTheScanner) {
    EXPECT_EQ(textOf("#define a /* b\n*/\n"), std::nullopt);
    EXPECT_EQ(textOf("#define a /* b\r*/\n"), std::nullopt);
    EXPECT_EQ(textOf("#define a // b\r\n"), std::nullopt);
    EXPECT_EQ(textOf("#define a\r\n"), std::nullopt);
    EXPECT_EQ(textOf("#define a\\\r\nb\n"), std::nullopt);
    EXPECT_EQ(textOf("#define a\\\n"), std::nullopt);
    EXPECT_EQ(textOf("#define a\\\nb"), std::nullopt);
    EXPECT_EQ(textOf("#define \"a\r\"\n"), "\"a\r\"");
}

TEST_F(DirectiveLineTest, PassesOverTheRestByTheSameRules) {
    for (const std::string_view text : {"#if\n", "#if a /* b */ \"/*\" '//' // c \\\n",
                                        "#if a \\\n b\n", "#if \"\n", "#if /\n"}) {
        EXPECT_TRUE(lineOf(text).skipRest()) << text;
    }
    for (const std::string_view text :
         {"#if /*\n*/\n", "#if a\r\n", "#if // a\r\n", "#if a\\\r\n\n", "#if a \\\n"}) {
        EXPECT_FALSE(lineOf(text).skipRest()) << text;
    }
}

TEST_F(DirectiveLineTest, StopsAtBlanksThatNeedTheScanner) {
    for (const std::string_view text :
         {"#if /* a\n*/\n", "#if // a\r\n", "#if \\\r\n\n", "#if \r\n"}) {
        DirectiveLine line = lineOf(text);
        line.skipBlanks();
        EXPECT_FALSE(line.isAtEnd()) << text;
        EXPECT_EQ(line.next().kind, OTHER) << text;
    }
}

}  // namespace
}  // namespace umpre
