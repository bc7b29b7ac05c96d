// SPDX-License-Identifier: MIT
#include "lex/snippet.h"

#include <string>

#include <gtest/gtest.h>

namespace umpre {
namespace {

TEST(Snippet, HoldsUpTo64Bytes) {
    for (std::size_t size = 1; size <= 64; ++size) {
        const std::string text(size, 'a');
        const Snippet snippet(text);
        EXPECT_EQ(snippet.text(), text);
        EXPECT_EQ(snippet.size(), size);
        EXPECT_FALSE(snippet.isEmpty());
    }
}

TEST(Snippet, IsCopiedAsAWhole) {
    for (std::size_t size = 0; size <= 64; ++size) {
        std::string text;
        for (std::size_t at = 0; at < size; ++at) {
            text.push_back(static_cast<char>('0' + at));
        }
        std::string copy(66, 'x');
        Snippet(text).copyTo(copy.data() + 1);
        EXPECT_EQ(copy, "x" + text + std::string(64 - size, '\0') + "x");
    }
}

TEST(Snippet, KnowsWhereItStands) {
    const std::string text(64, 'a');
    for (std::size_t size = 1; size <= 64; ++size) {
        const Snippet snippet(text.substr(0, size));
        EXPECT_TRUE(snippet.standsAt(text.data()));
        for (std::size_t place = 0; place < 64; ++place) {
            std::string other = text;
            other[place] = 'b';
            EXPECT_EQ(snippet.standsAt(other.data()), place >= size);
        }
    }
}

TEST(Snippet, IsEmptyWithoutATextThatFits) {
    EXPECT_TRUE(Snippet().isEmpty());
    EXPECT_TRUE(Snippet("").isEmpty());
    EXPECT_TRUE(Snippet(std::string(65, 'a')).isEmpty());
    EXPECT_EQ(Snippet(std::string(65, 'a')).text(), "");
}

}  // namespace
}  // namespace umpre
