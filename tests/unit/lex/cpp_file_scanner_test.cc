// SPDX-License-Identifier: MIT
#include "lex/cpp_file_scanner.h"

#include <string_view>
#include <unistd.h>
#include <vector>

#include <gtest/gtest.h>

#include "support/descriptors.h"
#include "support/lexeme.h"
#include "support/recording_comment_sink.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

using testing::Lexemes;
using testing::readLexemes;
using testing::readText;
using enum TokenKind;

struct CppFileScannerTest : ::testing::Test {
    testing::RecordingCommentSink comments;
    CppFileScanner file{comments};
};

TEST_F(CppFileScannerTest, GivesTheTokensOfAText) {
    file.openText("main", "a \n");
    EXPECT_EQ(readLexemes(file), (Lexemes{{IDENTIFIER, "a"}, {WHITESPACE, " "}, {NEWLINE, "\n"}}));
}

TEST_F(CppFileScannerTest, ClosesALastLineWithoutALineEnd) {
    file.openText("main", "a\nb");
    EXPECT_EQ(readLexemes(file),
              (Lexemes{{IDENTIFIER, "a"}, {NEWLINE, "\n"}, {IDENTIFIER, "b"}, {NEWLINE, ""}}));
}

TEST_F(CppFileScannerTest, SuppliesTheLineEndForPeekingToo) {
    file.openText("main", "a");
    (void)file.next();
    EXPECT_EQ(file.peek(), NEWLINE);
    EXPECT_EQ(file.peek(), NEWLINE);
    EXPECT_EQ(file.next().kind, NEWLINE);
    EXPECT_EQ(file.peek(), END_OF_INPUT);
}

TEST_F(CppFileScannerTest, SuppliesALineEndAfterAnythingButALineEnd) {
    const std::vector<std::string_view> texts{"a",    " ",    "// a",  "/* a */",
                                              "/* a", "\\\n", "// a\r"};
    for (const std::string_view text : texts) {
        file.openText("main", text);
        const Lexemes tokens = readLexemes(file);
        ASSERT_FALSE(tokens.empty());
        EXPECT_EQ(tokens.back().kind, NEWLINE) << text;
        EXPECT_EQ(tokens.back().text, "") << text;
    }
}

TEST_F(CppFileScannerTest, SuppliesNoLineEndAfterOneOfAnyForm) {
    for (const std::string_view text : {"\n", "\r", "\r\n"}) {
        file.openText("main", text);
        EXPECT_EQ(readLexemes(file), (Lexemes{{NEWLINE, "\n"}}));
    }
}

TEST_F(CppFileScannerTest, AnEmptyTextEndsAtOnce) {
    file.openText("main", "");
    EXPECT_EQ(file.peek(), END_OF_INPUT);
    EXPECT_EQ(file.next().kind, END_OF_INPUT);
}

TEST_F(CppFileScannerTest, ALineEndThatIsSuppliedCountsNoLine) {
    file.openText("main", "a");
    (void)readText(file);
    EXPECT_EQ(file.position().line, 1);
}

TEST_F(CppFileScannerTest, ReadsAFileByItsName) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("file", "one two\n");
    ASSERT_TRUE(file.open(name));
    EXPECT_EQ(file.fileName(), name);
    EXPECT_EQ(readText(file), "one two\n");
}

TEST_F(CppFileScannerTest, CannotOpenWhatIsNotThere) {
    const testing::TemporaryDirectory directory;
    EXPECT_FALSE(file.open(directory.nameOf("nothing")));
    EXPECT_FALSE(file.open(directory.name()));
}

TEST_F(CppFileScannerTest, AnEmptyNameIsStandardInput) {
    const testing::Pipe pipe("from outside\n");
    const testing::Replaced standardInput(STDIN_FILENO, pipe.readEnd());
    ASSERT_TRUE(file.open(""));
    EXPECT_EQ(file.fileName(), "stdin");
    EXPECT_EQ(readText(file), "from outside\n");
}

TEST_F(CppFileScannerTest, StandardInputIsNotClosedWithTheFile) {
    const testing::Pipe pipe;
    pipe.write("a\n");
    const testing::Replaced standardInput(STDIN_FILENO, pipe.readEnd());
    ASSERT_TRUE(file.open(""));
    (void)file.next();
    file.close();
    pipe.write("b\n");
    EXPECT_EQ(pipe.read(), "b\n");
}

TEST_F(CppFileScannerTest, ThePositionIsTheNameAndTheLine) {
    file.openText("main", "a\nb\n");
    EXPECT_EQ(file.position().fileName, "main");
    EXPECT_EQ(file.position().line, 1);
    (void)file.next();
    EXPECT_EQ(file.peek(), NEWLINE);
    EXPECT_EQ(file.position().line, 2);
}

TEST_F(CppFileScannerTest, NameAndLineCanBeSet) {
    file.openText("main", "a\nb");
    file.setFileName("other");
    file.setLine(41);
    (void)file.next();
    (void)file.next();
    EXPECT_EQ(file.fileName(), "other");
    EXPECT_EQ(file.position().fileName, "other");
    EXPECT_EQ(file.position().line, 42);
}

TEST_F(CppFileScannerTest, EveryNameInItMayBeExpanded) {
    file.openText("main", "a");
    (void)file.next();
    EXPECT_EQ(file.noExpandSet(), NoExpandSet());
}

TEST_F(CppFileScannerTest, TellsTheLineEndsOfComments) {
    file.openText("main", "/*\n\n");
    (void)readText(file);
    EXPECT_EQ(comments.effects(), "\n\n[3]");
}

TEST_F(CppFileScannerTest, WholeLinesLieAheadUnlessATokenDoes) {
    file.openText("main", "a b\nc\n");
    EXPECT_EQ(file.wholeLines(), "a b\nc\n");
    EXPECT_EQ(file.peek(), IDENTIFIER);
    EXPECT_EQ(file.wholeLines(), "");
    (void)file.next();
    EXPECT_EQ(file.wholeLines(), " b\nc\n");
}

TEST_F(CppFileScannerTest, NoLinesLieAheadAtTheEnd) {
    file.openText("main", "");
    EXPECT_EQ(file.wholeLines(), "");
}

TEST_F(CppFileScannerTest, AdvancingCountsTheLinesItIsTold) {
    file.openText("main", "a\nb\nc\n");
    (void)file.wholeLines();
    file.advance(4, 2, true);
    EXPECT_EQ(file.position().line, 3);
    EXPECT_EQ(file.next().text, "c");
}

TEST_F(CppFileScannerTest, AdvancingKnowsWhetherTheLineIsClosed) {
    file.openText("main", "a\nb");
    (void)file.wholeLines();
    file.advance(3, 1, false);
    EXPECT_EQ(readLexemes(file), (Lexemes{{NEWLINE, ""}}));
    file.openText("main", "a\nb\n");
    (void)file.wholeLines();
    file.advance(4, 2, true);
    EXPECT_EQ(readLexemes(file), Lexemes{});
}

TEST_F(CppFileScannerTest, CanOpenAnotherTextInTheMiddleOfOne) {
    file.openText("one", "a b c");
    (void)file.next();
    (void)file.peek();
    file.setLine(10);
    file.close();
    file.openText("two", "d\n");
    EXPECT_EQ(file.fileName(), "two");
    EXPECT_EQ(file.position().line, 1);
    EXPECT_EQ(readLexemes(file), (Lexemes{{IDENTIFIER, "d"}, {NEWLINE, "\n"}}));
}

}  // namespace
}  // namespace umpre
