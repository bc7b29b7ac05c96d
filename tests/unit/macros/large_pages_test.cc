// SPDX-License-Identifier: MIT
#include "macros/large_pages.h"

#include <algorithm>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <memory_resource>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

constexpr std::size_t kLargePage = std::size_t{2} << 20U;

TEST(LargePages, MemoryOfAnySizeCanBeWrittenAndGivenBack) {
    LargePages pages;
    for (const std::size_t size : {std::size_t{1}, std::size_t{4096}, kLargePage - 1, kLargePage,
                                   kLargePage + 1, 3 * kLargePage + 4097}) {
        void* const memory = pages.allocate(size, 8);
        auto* const bytes = static_cast<unsigned char*>(memory);
        std::fill_n(bytes, size, static_cast<unsigned char>(0xA5));
        EXPECT_EQ(std::count(bytes, bytes + size, 0xA5), static_cast<std::ptrdiff_t>(size));
        pages.deallocate(memory, size, 8);
    }
}

TEST(LargePages, WhatFillsALargePageBeginsWithOne) {
    LargePages pages;
    void* const memory = pages.allocate(kLargePage, 1);
    EXPECT_EQ(std::bit_cast<std::uintptr_t>(memory) % kLargePage, 0U);
    pages.deallocate(memory, kLargePage, 1);
}

TEST(LargePages, ContainersGrowInThem) {
    LargePages pages;
    std::pmr::vector<std::size_t> numbers(&pages);
    for (std::size_t number = 0; number < kLargePage; ++number) {
        numbers.push_back(number);
    }
    for (std::size_t number = 0; number < kLargePage; number += 1009) {
        ASSERT_EQ(numbers[number], number);
    }
}

TEST(LargePages, EachGivesBackItsOwn) {
    const LargePages one;
    const LargePages other;
    EXPECT_TRUE(one.is_equal(one));
    EXPECT_FALSE(one.is_equal(other));
}

}  // namespace
}  // namespace umpre
