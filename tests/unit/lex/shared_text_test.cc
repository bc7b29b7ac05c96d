// SPDX-License-Identifier: MIT
#include "lex/shared_text.h"

#include <utility>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

TEST(SharedText, IsNoTextAtFirst) {
    EXPECT_FALSE(SharedText());
    EXPECT_TRUE(SharedText::alone());
}

TEST(SharedText, LivesAsLongAsSomebodyHoldsIt) {
    TextPool pool;
    SharedText first = pool.take();
    first.edit().append(TokenKind::IDENTIFIER, "a");
    const SharedText second = first;
    first = {};
    EXPECT_EQ(second->joined(), "a");
}

TEST(SharedText, HandedOverIsHeldOnce) {
    TextPool pool;
    SharedText first = pool.take();
    const LexedText* const text = &*first;
    SharedText second = std::move(first);
    second = {};
    EXPECT_EQ(&*pool.take(), text);
}

TEST(SharedText, IsEmptyWhenItIsTakenAgain) {
    TextPool pool;
    SharedText text = pool.take();
    text.edit().append(TokenKind::IDENTIFIER, "a");
    text = {};
    EXPECT_EQ(pool.take()->size(), 0U);
}

TEST(SharedText, OnlySomeAreKeptForUseAgain) {
    TextPool pool;
    std::vector<SharedText> many;
    for (int count = 0; count < 1000; ++count) {
        many.push_back(pool.take());
    }
    many.clear();
    EXPECT_EQ(pool.take()->size(), 0U);
}

TEST(SharedText, APartOfOneHasItsTokens) {
    SharedText text = SharedText::alone();
    text.edit().append(TokenKind::IDENTIFIER, "ab");
    text.edit().append(TokenKind::COMMA, ",");
    text.edit().append(TokenKind::INT_DEC, "12");
    EXPECT_EQ(TextSlice::whole(text).joined(), "ab,12");
    EXPECT_EQ((TextSlice{text, 1, 3}.joined()), ",12");
    EXPECT_EQ((TextSlice{text, 1, 1}.joined()), "");
}

}  // namespace
}  // namespace umpre
