// SPDX-License-Identifier: MIT
#include "lex/cpp_token_scanner.h"

#include <string_view>
#include <utility>

#include <gtest/gtest.h>

#include "lex/text_lexer.h"
#include "support/lexeme.h"
#include "support/recording_comment_sink.h"

namespace umpre {
namespace {

using testing::Lexemes;
using testing::readLexemes;
using testing::readText;
using enum TokenKind;

struct CppTokenScannerTest : ::testing::Test {
    // Adds a piece.
    void add(std::string_view text, NoExpandSet noExpand) {
        lexer.append(pieces.open(), text);
        pieces.close(noExpand);
    }

    [[nodiscard]] TextSlice slice(std::string_view text) {
        return TextSlice::whole(lexer.lexed(text));
    }

    TextLexer lexer;
    NoExpandSets sets;
    const Name a{"a"};
    const Name b{"b"};
    const NoExpandSet setA = sets.with({}, a);
    const NoExpandSet setB = sets.with({}, b);
    Pieces pieces;
    testing::RecordingCommentSink comments;
    CppTokenScanner list{comments};
};

TEST_F(CppTokenScannerTest, GivesTheTokensOfAllPieces) {
    add("x ", setA);
    add("+", setB);
    add(" y", setA);
    list.read(std::move(pieces));
    EXPECT_EQ(readLexemes(list), (Lexemes{{IDENTIFIER, "x"},
                                          {WHITESPACE, " "},
                                          {PLUS, "+"},
                                          {WHITESPACE, " "},
                                          {IDENTIFIER, "y"}}));
}

TEST_F(CppTokenScannerTest, NoTokenReachesFromOnePieceIntoTheNext) {
    add("x", setA);
    add("y", setB);
    add("#", setB);
    add("#", setB);
    list.read(std::move(pieces));
    EXPECT_EQ(readLexemes(list),
              (Lexemes{{IDENTIFIER, "x"}, {IDENTIFIER, "y"}, {HASH, "#"}, {HASH, "#"}}));
}

TEST_F(CppTokenScannerTest, SuppliesNoLineEnd) {
    add("x", setA);
    list.read(std::move(pieces));
    (void)list.next();
    EXPECT_EQ(list.peek(), END_OF_INPUT);
}

TEST_F(CppTokenScannerTest, TheSetIsThatOfTheTokenLastRead) {
    add("x y", setA);
    add("z", setB);
    list.read(std::move(pieces));
    for (int count = 0; count < 3; ++count) {
        (void)list.next();
        EXPECT_EQ(list.noExpandSet(), setA);
    }
    EXPECT_EQ(list.peek(), IDENTIFIER);
    EXPECT_EQ(list.noExpandSet(), setB);
    (void)list.next();
    EXPECT_EQ(list.noExpandSet(), setB);
}

TEST_F(CppTokenScannerTest, AfterTheEndTheSetIsThatOfTheLastPiece) {
    add("x", setA);
    add("y", setB);
    list.read(std::move(pieces));
    (void)readText(list);
    EXPECT_EQ(list.next().kind, END_OF_INPUT);
    EXPECT_EQ(list.noExpandSet(), setB);
}

TEST_F(CppTokenScannerTest, EmptyPiecesAreTheEnd) {
    list.read(std::move(pieces));
    EXPECT_EQ(list.next().kind, END_OF_INPUT);
    EXPECT_EQ(list.noExpandSet(), NoExpandSet());
    add("", setA);
    list.read(std::move(pieces));
    EXPECT_EQ(list.next().kind, END_OF_INPUT);
}

TEST_F(CppTokenScannerTest, TakesThePiecesOver) {
    add("x", setA);
    list.read(std::move(pieces));
    pieces.restart();
    add("other", setB);
    EXPECT_EQ(readText(list), "x");
}

TEST_F(CppTokenScannerTest, ASliceIsOnePiece) {
    list.read(slice("x y"), setA);
    EXPECT_EQ(readLexemes(list),
              (Lexemes{{IDENTIFIER, "x"}, {WHITESPACE, " "}, {IDENTIFIER, "y"}}));
    EXPECT_EQ(list.noExpandSet(), setA);
}

TEST_F(CppTokenScannerTest, ATextLivesAsLongAsItIsRead) {
    TextSlice text = slice("x y");
    list.read(text, setA);
    text = {};
    EXPECT_EQ(readText(list), "x y");
}

TEST_F(CppTokenScannerTest, IsUsedUpWhenAllTokensAreTaken) {
    add("x y", setA);
    list.read(std::move(pieces));
    EXPECT_FALSE(list.isExhausted());
    (void)list.next();
    (void)list.next();
    EXPECT_FALSE(list.isExhausted());
    (void)list.peek();
    EXPECT_FALSE(list.isExhausted());
    (void)list.next();
    EXPECT_TRUE(list.isExhausted());
    (void)list.peek();
    EXPECT_TRUE(list.isExhausted());
    (void)list.next();
    EXPECT_TRUE(list.isExhausted());
}

TEST_F(CppTokenScannerTest, WithoutTokensIsUsedUpFromTheBeginning) {
    list.read(slice(""), setA);
    EXPECT_TRUE(list.isExhausted());
}

TEST_F(CppTokenScannerTest, CanReadAnotherListInTheMiddleOfOne) {
    add("x y", setA);
    list.read(std::move(pieces));
    (void)list.next();
    (void)list.peek();
    list.read(slice("z"), setB);
    EXPECT_EQ(readText(list), "z");
    EXPECT_EQ(list.noExpandSet(), setB);
    pieces.restart();
    add("w", setA);
    list.read(std::move(pieces));
    EXPECT_EQ(readText(list), "w");
    EXPECT_EQ(list.noExpandSet(), setA);
}

TEST_F(CppTokenScannerTest, CommentsActEachTimeTheirTextIsRead) {
    const TextSlice text = slice("x/*\n*/y");
    list.read(text, setA);
    (void)readText(list);
    EXPECT_EQ(comments.effects(), "\n");
    list.read(text, setA);
    (void)readText(list);
    EXPECT_EQ(comments.effects(), "\n\n");
}

TEST_F(CppTokenScannerTest, ACommentActsWhenItsBlankIsRead) {
    add("x/*\n", setA);
    list.read(std::move(pieces));
    (void)list.next();
    EXPECT_EQ(comments.effects(), "");
    (void)list.peek();
    EXPECT_EQ(comments.effects(), "\n[2]");
    (void)list.next();
    EXPECT_EQ(comments.effects(), "\n[2]");
}

}  // namespace
}  // namespace umpre
