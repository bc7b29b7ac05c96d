// SPDX-License-Identifier: MIT
#include "lex/growing_array.h"

#include <numeric>
#include <utility>

#include <gtest/gtest.h>

namespace umpre {
namespace {

TEST(GrowingArray, KeepsWhatWasWrittenWhileItGrows) {
    GrowingArray<int> array;
    for (int value = 0; value < 1000; ++value) {
        *array.extend(1) = value;
    }
    ASSERT_EQ(array.size(), 1000U);
    for (std::size_t index = 0; index < 1000; ++index) {
        EXPECT_EQ(array[index], static_cast<int>(index));
    }
}

TEST(GrowingArray, GrowsBySeveralElementsAtATime) {
    GrowingArray<char> array;
    char* const added = array.extend(100);
    added[99] = 'z';
    EXPECT_EQ(array.size(), 100U);
    EXPECT_EQ(array[99], 'z');
}

TEST(GrowingArray, KeepsWhatWasWrittenWhileItIsLarge) {
    GrowingArray<int> array;
    constexpr int kGroup = 10000;
    constexpr int kGroups = 100;
    for (int group = 0; group < kGroups; ++group) {
        int* const added = array.extend(kGroup);
        std::iota(added, added + kGroup, group * kGroup);
    }
    for (int value = 0; value < kGroups * kGroup; ++value) {
        ASSERT_EQ(array[static_cast<std::size_t>(value)], value);
    }
}

TEST(GrowingArray, StaysWhereItIsWhileThereIsRoom) {
    GrowingArray<char> array;
    *array.extend(1) = 'a';
    const char* const place = array.data();
    const std::size_t room = array.room();
    ASSERT_GT(room, 0U);
    (void)array.extend(room);
    EXPECT_EQ(array.data(), place);
    EXPECT_EQ(array.room(), 0U);
    EXPECT_EQ(array.size(), room + 1);
}

TEST(GrowingArray, IsEmptyAfterBeingCleared) {
    GrowingArray<char> array;
    *array.extend(1) = 'a';
    array.clear();
    EXPECT_EQ(array.size(), 0U);
    *array.extend(1) = 'b';
    EXPECT_EQ(array[0], 'b');
}

TEST(GrowingArray, CanBeHandedOver) {
    GrowingArray<int> array;
    *array.extend(1) = 7;
    const GrowingArray<int> other = std::move(array);
    ASSERT_EQ(other.size(), 1U);
    EXPECT_EQ(other[0], 7);
}

}  // namespace
}  // namespace umpre
