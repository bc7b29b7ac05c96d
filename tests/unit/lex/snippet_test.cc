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
        EXPECT_EQ(snippet.block().any('a'), bitsBelow(size));
        EXPECT_EQ(snippet.block().any('\0'), ~bitsBelow(size));
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
