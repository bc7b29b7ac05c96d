// SPDX-License-Identifier: MIT
#include "lex/token.h"

#include <cstdint>

#include <gtest/gtest.h>

#include "support/lexeme.h"

namespace umpre {
namespace {

using enum TokenKind;

constexpr std::int32_t kFirstNamed = 257;
constexpr std::int32_t kLastNamed = 292;

template <typename Check>
void forEveryKind(Check check) {
    for (std::int32_t code = 0; code <= kLastNamed; ++code) {
        check(static_cast<TokenKind>(code));
    }
}

TEST(Token, NothingReadIsTheEndOfTheInput) {
    const Token token;
    EXPECT_EQ(token.kind, END_OF_INPUT);
    EXPECT_EQ(token.text, "");
}

TEST(Token, NamedKindsFollowEachOtherFrom257To292) {
    EXPECT_EQ(static_cast<std::int32_t>(NEWLINE), kFirstNamed);
    EXPECT_EQ(static_cast<std::int32_t>(PASTE), 260);
    EXPECT_EQ(static_cast<std::int32_t>(KW_IF), 261);
    EXPECT_EQ(static_cast<std::int32_t>(IDENTIFIER), 274);
    EXPECT_EQ(static_cast<std::int32_t>(KW_DEFINED), 285);
    EXPECT_EQ(static_cast<std::int32_t>(UINT_HEX), kLastNamed);
}

TEST(Token, NamesAreTheDirectiveWordsAndIdentifiersButNotDefined) {
    forEveryKind([](TokenKind kind) {
        EXPECT_EQ(isName(kind), kind >= KW_IF && kind <= IDENTIFIER)
            << ::testing::PrintToString(kind);
    });
    EXPECT_FALSE(isName(KW_DEFINED));
}

TEST(Token, BlanksAreBlankCharactersAndContinuations) {
    forEveryKind([](TokenKind kind) {
        EXPECT_EQ(isBlank(kind), kind == WHITESPACE || kind == CONTINUATION)
            << ::testing::PrintToString(kind);
    });
}

TEST(Token, BlanksAndLineEndsAreTheSameWithLineEnds) {
    forEveryKind([](TokenKind kind) {
        EXPECT_EQ(isBlankOrNewline(kind), isBlank(kind) || kind == NEWLINE)
            << ::testing::PrintToString(kind);
    });
}

TEST(Token, ALineEndsAtItsNewlineAndAtTheEndOfTheInput) {
    forEveryKind([](TokenKind kind) {
        EXPECT_EQ(endsLine(kind), kind == NEWLINE || kind == END_OF_INPUT)
            << ::testing::PrintToString(kind);
    });
}

}  // namespace
}  // namespace umpre
