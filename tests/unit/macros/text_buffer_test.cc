// SPDX-License-Identifier: MIT
#include "macros/text_buffer.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

namespace umpre {
namespace {

TEST(TextBuffer, GrowsByTextsOfAllSizes) {
    const std::string letters = "abcdefghijklmnopqrstuvwxyz";
    std::string source;
    while (source.size() < 300) {
        source += letters;
    }
    TextBuffer buffer;
    std::string expected;
    for (std::size_t size = 0; size < 200; ++size) {
        const std::string_view text = std::string_view(source).substr(size % 26, size);
        buffer.append(text);
        buffer.appendAlone(text);
        buffer.append('-');
        expected.append(text).append(text).append("-");
        ASSERT_EQ(buffer.view(), expected) << size;
    }
    EXPECT_EQ(buffer[1], 'b');
    EXPECT_EQ(buffer.view().data()[expected.size()], '\0');
}

TEST(TextBuffer, HoldsWhatIsLeftWhenSomeIsTakenAway) {
    TextBuffer buffer;
    buffer.appendAlone("abc");
    buffer.truncate(1);
    buffer.append('d');
    EXPECT_EQ(buffer.view(), "ad");
    buffer.clear();
    EXPECT_EQ(buffer.view(), "");
}

TEST(TextBuffer, JoinsSettledPartsThatMeet) {
    TextBuffer buffer;
    buffer.appendAlone("ab");
    buffer.settleFrom(1);
    buffer.settleFrom(2);  // nothing
    buffer.appendAlone("cd");
    buffer.settleFrom(2);
    buffer.appendAlone("ef");
    buffer.settleFrom(5);
    ASSERT_EQ(buffer.settled().size(), 2U);
    EXPECT_EQ(buffer.settled()[0].begin, 1U);
    EXPECT_EQ(buffer.settled()[0].end, 4U);
    EXPECT_EQ(buffer.settled()[1].begin, 5U);
    EXPECT_EQ(buffer.settled()[1].end, 6U);
}

TEST(TextBuffer, IsSettledIfAllOfItIs) {
    TextBuffer buffer;
    EXPECT_TRUE(buffer.isSettled());
    buffer.appendAlone("ab");
    EXPECT_FALSE(buffer.isSettled());
    buffer.settleFrom(0);
    EXPECT_TRUE(buffer.isSettled());
    buffer.append('c');
    EXPECT_FALSE(buffer.isSettled());
    buffer.clear();
    buffer.appendAlone("ab");
    buffer.settleFrom(1);
    EXPECT_FALSE(buffer.isSettled());
}

}  // namespace
}  // namespace umpre
