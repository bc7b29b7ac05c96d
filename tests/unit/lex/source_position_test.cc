// SPDX-License-Identifier: MIT
#include "lex/source_position.h"

#include <cstdint>
#include <limits>

#include <gtest/gtest.h>

namespace umpre {
namespace {

TEST(SourcePosition, LinesAreAdded) {
    EXPECT_EQ(addLines(7, 0), 7);
    EXPECT_EQ(addLines(7, 3), 10);
    EXPECT_EQ(addLines(-7, 3), -4);
}

TEST(SourcePosition, LineCountersWrapAround) {
    constexpr std::int32_t kHighest = std::numeric_limits<std::int32_t>::max();
    constexpr std::int32_t kLowest = std::numeric_limits<std::int32_t>::min();
    EXPECT_EQ(addLines(kHighest, 1), kLowest);
    EXPECT_EQ(addLines(kHighest, 3), kLowest + 2);
    EXPECT_EQ(addLines(-1, 1), 0);
    EXPECT_EQ(addLines(5, std::size_t{1} << 32U), 5);
}

}  // namespace
}  // namespace umpre
