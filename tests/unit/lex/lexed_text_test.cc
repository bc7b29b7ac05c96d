// SPDX-License-Identifier: MIT
#include "lex/lexed_text.h"

#include <gtest/gtest.h>

#include "support/lexeme.h"
#include "support/recording_comment_sink.h"

namespace umpre {
namespace {

using testing::Lexemes;
using testing::lexemesOf;
using testing::RecordingCommentSink;
using enum TokenKind;

[[nodiscard]] LexedText threeTokens() {
    LexedText text;
    text.append(IDENTIFIER, "one");
    text.append(WHITESPACE, " ");
    text.append(INT_DEC, "2");
    return text;
}

// Returns what reading the token at `index` does.
[[nodiscard]] std::string effectsAt(const LexedText& text, std::size_t index) {
    RecordingCommentSink comments;
    text.carryOutEffects(index, comments);
    return comments.effects();
}

TEST(LexedText, IsEmptyAtFirst) {
    const LexedText text;
    EXPECT_EQ(text.size(), 0U);
    EXPECT_EQ(text.joined(), "");
    EXPECT_FALSE(text.hasEffects());
}

TEST(LexedText, KeepsKindsAndTexts) {
    const LexedText text = threeTokens();
    EXPECT_EQ(lexemesOf(text), (Lexemes{{IDENTIFIER, "one"}, {WHITESPACE, " "}, {INT_DEC, "2"}}));
    EXPECT_EQ(text.joined(), "one 2");
}

TEST(LexedText, TokensSideBySideStayTwo) {
    LexedText text;
    text.append(PLUS, "+");
    text.append(PLUS, "+");
    text.append(IDENTIFIER, "a");
    text.append(IDENTIFIER, "b");
    EXPECT_EQ(lexemesOf(text),
              (Lexemes{{PLUS, "+"}, {PLUS, "+"}, {IDENTIFIER, "a"}, {IDENTIFIER, "b"}}));
}

TEST(LexedText, HoldsTokensWithoutText) {
    LexedText text;
    text.append(NEWLINE, "");
    text.append(IDENTIFIER, "a");
    text.append(NEWLINE, "");
    EXPECT_EQ(lexemesOf(text), (Lexemes{{NEWLINE, ""}, {IDENTIFIER, "a"}, {NEWLINE, ""}}));
}

TEST(LexedText, TakesSomeTokensOfAnother) {
    const LexedText other = threeTokens();
    LexedText text;
    text.append(COMMA, ",");
    text.append(other, 1, 3);
    text.append(other, 0, 1);
    text.append(other, 2, 2);
    EXPECT_EQ(lexemesOf(text),
              (Lexemes{{COMMA, ","}, {WHITESPACE, " "}, {INT_DEC, "2"}, {IDENTIFIER, "one"}}));
    EXPECT_EQ(text.joined(), ", 2one");
}

TEST(LexedText, ForgetsAllWhenCleared) {
    LexedText text;
    text.addCommentEffect(1, false, 0);
    text.append(WHITESPACE, " ");
    text.clear();
    EXPECT_EQ(text.size(), 0U);
    EXPECT_EQ(text.joined(), "");
    EXPECT_FALSE(text.hasEffects());
}

TEST(LexedText, AnEffectBelongsToTheTokenAddedNext) {
    LexedText text;
    text.append(IDENTIFIER, "a");
    text.addCommentEffect(2, false, 0);
    text.append(WHITESPACE, " ");
    text.append(IDENTIFIER, "b");
    EXPECT_TRUE(text.hasEffects());
    EXPECT_EQ(effectsAt(text, 0), "");
    EXPECT_EQ(effectsAt(text, 1), "\n\n");
    EXPECT_EQ(effectsAt(text, 2), "");
}

TEST(LexedText, ATokenMayHaveSeveralEffects) {
    LexedText text;
    text.addCommentEffect(1, false, 0);
    text.addCommentEffect(0, true, 7);
    text.append(WHITESPACE, " ");
    EXPECT_EQ(effectsAt(text, 0), "\n[7]");
}

TEST(LexedText, EffectsHappenEachTime) {
    LexedText text;
    text.addCommentEffect(1, false, 0);
    text.append(WHITESPACE, " ");
    EXPECT_EQ(effectsAt(text, 0), "\n");
    EXPECT_EQ(effectsAt(text, 0), "\n");
}

}  // namespace
}  // namespace umpre
