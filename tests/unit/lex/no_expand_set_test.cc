// SPDX-License-Identifier: MIT
#include "lex/no_expand_set.h"

#include <cstddef>
#include <deque>
#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

struct NoExpandSetTest : ::testing::Test {
    NoExpandSets sets;
    const Name a{"a"};
    const Name b{"b"};
    const Name c{"c"};
};

TEST_F(NoExpandSetTest, TheEmptySetHoldsNothing) {
    EXPECT_FALSE(sets.contains({}, a));
}

TEST_F(NoExpandSetTest, ASetHoldsTheNamesAddedAndNoOthers) {
    const NoExpandSet set = sets.with(sets.with({}, a), b);
    EXPECT_TRUE(sets.contains(set, a));
    EXPECT_TRUE(sets.contains(set, b));
    EXPECT_FALSE(sets.contains(set, c));
}

TEST_F(NoExpandSetTest, AddingANameLeavesTheFirstSetAsItWas) {
    const NoExpandSet small = sets.with({}, a);
    const NoExpandSet large = sets.with(small, b);
    EXPECT_FALSE(sets.contains(small, b));
    EXPECT_TRUE(sets.contains(large, b));
}

TEST_F(NoExpandSetTest, AddingANameAgainGivesTheSameSet) {
    const NoExpandSet set = sets.with(sets.with({}, a), b);
    EXPECT_EQ(sets.with(set, a), set);
    EXPECT_EQ(sets.with(set, b), set);
}

TEST_F(NoExpandSetTest, SetsMadeInTheSameOrderAreEqual) {
    EXPECT_EQ(sets.with(sets.with({}, a), b), sets.with(sets.with({}, a), b));
    EXPECT_NE(sets.with({}, a), sets.with({}, b));
    EXPECT_NE(sets.with({}, a), NoExpandSet());
}

TEST_F(NoExpandSetTest, NamesOfOneSpellingAreTwoNames) {
    const Name other{"a"};
    EXPECT_FALSE(sets.contains(sets.with({}, a), other));
}

TEST_F(NoExpandSetTest, AUnionHoldsTheNamesOfBoth) {
    const NoExpandSet both = sets.united(sets.with({}, a), sets.with({}, b));
    EXPECT_TRUE(sets.contains(both, a));
    EXPECT_TRUE(sets.contains(both, b));
    EXPECT_FALSE(sets.contains(both, c));
}

TEST_F(NoExpandSetTest, AUnionWithTheEmptySetIsTheOther) {
    const NoExpandSet set = sets.with({}, a);
    EXPECT_EQ(sets.united(set, {}), set);
    EXPECT_EQ(sets.united({}, set), set);
    EXPECT_EQ(sets.united({}, {}), NoExpandSet());
}

TEST_F(NoExpandSetTest, AUnionWithItselfIsTheSetItself) {
    const NoExpandSet set = sets.with(sets.with({}, a), b);
    EXPECT_EQ(sets.united(set, set), set);
}

TEST_F(NoExpandSetTest, AUnionWithASetThatItWasMadeOfIsTheLargerOne) {
    const NoExpandSet small = sets.with({}, a);
    const NoExpandSet large = sets.with(sets.with(small, b), c);
    EXPECT_EQ(sets.united(small, large), large);
    EXPECT_EQ(sets.united(large, small), large);
}

TEST_F(NoExpandSetTest, AUnionMadeAgainIsTheSameSet) {
    const NoExpandSet one = sets.with({}, a);
    const NoExpandSet two = sets.with(sets.with({}, b), c);
    EXPECT_EQ(sets.united(one, two), sets.united(one, two));
}

// A set made by adding names one by one, and every set on the way to it.
struct NoExpandSetChain : NoExpandSetTest {
    NoExpandSetChain() {
        for (std::size_t number = 0; number < kCount; ++number) {
            names.push_back({std::to_string(number)});
            chain.push_back(sets.with(chain.back(), names.back()));
        }
    }

    static constexpr std::size_t kCount = 300;
    std::deque<Name> names;
    std::vector<NoExpandSet> chain{NoExpandSet()};  // chain[n] holds the first n names
};

TEST_F(NoExpandSetChain, EachSetHoldsTheNamesAddedSoFar) {
    for (std::size_t size = 0; size <= kCount; ++size) {
        for (std::size_t number = 0; number < kCount; number += 7) {
            EXPECT_EQ(sets.contains(chain[size], names[number]), number < size)
                << number << " in a set of " << size;
        }
    }
}

TEST_F(NoExpandSetChain, SetsMayBeAskedInAnyOrder) {
    for (std::size_t step = 0; step < 5000; ++step) {
        const std::size_t size = step * 101 % (kCount + 1);
        const std::size_t number = step * 37 % kCount;
        EXPECT_EQ(sets.contains(chain[size], names[number]), number < size)
            << number << " in a set of " << size;
    }
}

TEST_F(NoExpandSetChain, LargeSetsMayPartAndBeAskedInTurn) {
    const NoExpandSet left = sets.with(sets.with(chain[200], a), b);
    const NoExpandSet right = sets.with(sets.with(chain[150], b), c);
    for (int round = 0; round < 3; ++round) {
        EXPECT_TRUE(sets.contains(left, a));
        EXPECT_FALSE(sets.contains(right, a));
        EXPECT_FALSE(sets.contains(left, c));
        EXPECT_TRUE(sets.contains(right, c));
        EXPECT_TRUE(sets.contains(left, b));
        EXPECT_TRUE(sets.contains(right, b));
        EXPECT_TRUE(sets.contains(left, names[199]));
        EXPECT_FALSE(sets.contains(right, names[199]));
    }
}

TEST_F(NoExpandSetChain, AddingANameAgainGivesTheSameLargeSet) {
    EXPECT_EQ(sets.with(chain[kCount], names[0]), chain[kCount]);
    EXPECT_EQ(sets.with(chain[kCount], names[kCount - 1]), chain[kCount]);
}

TEST_F(NoExpandSetChain, ALargeUnionHoldsTheNamesOfBoth) {
    NoExpandSet even;
    NoExpandSet third;
    for (std::size_t number = 0; number < kCount; ++number) {
        even = number % 2 == 0 ? sets.with(even, names[number]) : even;
        third = number % 3 == 0 ? sets.with(third, names[number]) : third;
    }
    const NoExpandSet both = sets.united(even, third);
    for (std::size_t number = 0; number < kCount; ++number) {
        EXPECT_EQ(sets.contains(even, names[number]), number % 2 == 0) << number;
        EXPECT_EQ(sets.contains(third, names[number]), number % 3 == 0) << number;
        EXPECT_EQ(sets.contains(both, names[number]), number % 2 == 0 || number % 3 == 0) << number;
    }
}

}  // namespace
}  // namespace umpre
