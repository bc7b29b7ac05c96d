// SPDX-License-Identifier: MIT
#include "lex/cpp_scanner.h"

#include <gtest/gtest.h>

#include "lex/cpp_file_scanner.h"
#include "lex/cpp_token_scanner.h"
#include "lex/text_lexer.h"
#include "support/recording_comment_sink.h"

namespace umpre {
namespace {

using enum TokenKind;

// One text as both kinds of source. A comment with a line end shows when it is scanned.
struct CppScannerTest : ::testing::Test {
    CppScannerTest() {
        file.openText("main", kText);
        list.read(TextSlice::whole(lexer.lexed(kText)), {});
    }

    static constexpr std::string_view kText = "a/*\n*/b\n";
    TextLexer lexer;
    testing::RecordingCommentSink fileComments;
    testing::RecordingCommentSink listComments;
    CppFileScanner file{fileComments};
    CppTokenScanner list{listComments};
};

void expectLookAhead(CppScanner& source) {
    EXPECT_EQ(source.peek(), IDENTIFIER);
    EXPECT_EQ(source.peek(), IDENTIFIER);
    EXPECT_EQ(source.next().text, "a");
    EXPECT_EQ(source.peek(), WHITESPACE);
    EXPECT_EQ(source.next().kind, WHITESPACE);
    const Token last = source.next();
    EXPECT_EQ(last.kind, IDENTIFIER);
    EXPECT_EQ(last.text, "b");
}

TEST_F(CppScannerTest, PeekingConsumesNothing) {
    expectLookAhead(file);
    expectLookAhead(list);
}

TEST_F(CppScannerTest, ATokenIsScannedWhenItIsFirstAskedFor) {
    for (CppScanner* const source :
         {static_cast<CppScanner*>(&file), static_cast<CppScanner*>(&list)}) {
        (void)source->next();
    }
    EXPECT_EQ(fileComments.effects(), "");
    EXPECT_EQ(listComments.effects(), "");
    (void)file.peek();
    (void)list.peek();
    EXPECT_EQ(fileComments.effects(), "\n");
    EXPECT_EQ(listComments.effects(), "\n");
    (void)file.next();
    (void)list.next();
    EXPECT_EQ(fileComments.effects(), "\n");
    EXPECT_EQ(listComments.effects(), "\n");
}

TEST_F(CppScannerTest, TheEndStaysTheEnd) {
    for (CppScanner* const source :
         {static_cast<CppScanner*>(&file), static_cast<CppScanner*>(&list)}) {
        while (source->next().kind != END_OF_INPUT) {
        }
        EXPECT_EQ(source->peek(), END_OF_INPUT);
        EXPECT_EQ(source->next().kind, END_OF_INPUT);
        EXPECT_EQ(source->next().kind, END_OF_INPUT);
        EXPECT_EQ(source->next().text, "");
    }
}

TEST_F(CppScannerTest, FilesAndListsKnowWhatTheyAre) {
    EXPECT_TRUE(file.isFile());
    EXPECT_FALSE(file.isTokenList());
    EXPECT_FALSE(list.isFile());
    EXPECT_TRUE(list.isTokenList());
}

}  // namespace
}  // namespace umpre
