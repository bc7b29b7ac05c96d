// SPDX-License-Identifier: MIT
#include "lex/text_lexer.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "support/lexeme.h"
#include "support/recording_comment_sink.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using testing::Lexemes;
using testing::lexemesOf;
using enum TokenKind;

TEST(TextLexer, GivesTheTokensOfAText) {
    TextLexer lexer;
    LexedText text;
    lexer.append(text, "f(x) ## \"y\"");
    EXPECT_EQ(lexemesOf(text), (Lexemes{{IDENTIFIER, "f"},
                                        {LEFT_PARENTHESIS, "("},
                                        {IDENTIFIER, "x"},
                                        {RIGHT_PARENTHESIS, ")"},
                                        {WHITESPACE, " "},
                                        {PASTE, "##"},
                                        {WHITESPACE, " "},
                                        {STRING_LITERAL, "\"y\""}}));
}

TEST(TextLexer, AddsToWhatIsThere) {
    TextLexer lexer;
    LexedText text;
    lexer.append(text, "+");
    lexer.append(text, "+");
    lexer.append(text, "");
    EXPECT_EQ(lexemesOf(text), (Lexemes{{PLUS, "+"}, {PLUS, "+"}}));
}

TEST(TextLexer, TakesZeroBytes) {
    TextLexer lexer;
    LexedText text;
    lexer.append(text, "a\0b"sv);
    EXPECT_EQ(lexemesOf(text),
              (Lexemes{{IDENTIFIER, "a"}, {OTHER, std::string(1, '\0')}, {IDENTIFIER, "b"}}));
}

TEST(TextLexer, SuppliesNoLineEnd) {
    TextLexer lexer;
    LexedText text;
    lexer.append(text, "a");
    EXPECT_EQ(text.size(), 1U);
}

TEST(TextLexer, RecordsWhatCommentsDoAtTheirBlank) {
    TextLexer lexer;
    LexedText text;
    lexer.append(text, "a/*\n\n*/b/*\n");
    EXPECT_EQ(text.joined(), "a b ");
    ASSERT_EQ(text.size(), 4U);
    testing::RecordingCommentSink comments;
    text.carryOutEffects(0, comments);
    text.carryOutEffects(2, comments);
    EXPECT_EQ(comments.effects(), "");
    text.carryOutEffects(1, comments);
    EXPECT_EQ(comments.effects(), "\n\n");
    text.carryOutEffects(3, comments);
    EXPECT_EQ(comments.effects(), "\n\n\n[4]");
}

TEST(TextLexer, CountsLinesInEachTextAnew) {
    TextLexer lexer;
    LexedText text;
    lexer.append(text, "\n\n\n");
    text.clear();
    lexer.append(text, "\n/*");
    testing::RecordingCommentSink comments;
    text.carryOutEffects(1, comments);
    EXPECT_EQ(comments.effects(), "[2]");
}

TEST(TextLexer, AnOpenCommentDoesNotReachTheNextText) {
    TextLexer lexer;
    LexedText text;
    lexer.append(text, "/* a");
    lexer.append(text, "b");
    EXPECT_EQ(lexemesOf(text), (Lexemes{{WHITESPACE, " "}, {IDENTIFIER, "b"}}));
}

}  // namespace
}  // namespace umpre
