// SPDX-License-Identifier: MIT
#include "lex/name_filter.h"

#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;

[[nodiscard]] std::vector<std::string> manyNames(const std::string& stem) {
    constexpr int kCount = 2000;
    std::vector<std::string> names;
    names.reserve(kCount);
    for (int number = 0; number < kCount; ++number) {
        names.push_back(stem + std::to_string(number));
    }
    return names;
}

TEST(NameFilter, HoldsNothingAtFirst) {
    const NameFilter filter;
    for (const std::string& name : manyNames("name_")) {
        EXPECT_FALSE(filter.mayHold(name)) << name;
    }
}

TEST(NameFilter, LetsEveryNamePassThatWasAdded) {
    NameFilter filter;
    for (const std::string& name : manyNames("")) {
        filter.add(name);
    }
    for (const std::string& name : manyNames("a_name_of_some_length_")) {
        filter.add(name);
    }
    for (const std::string& name : manyNames("")) {
        EXPECT_TRUE(filter.mayHold(name)) << name;
    }
    for (const std::string& name : manyNames("a_name_of_some_length_")) {
        EXPECT_TRUE(filter.mayHold(name)) << name;
    }
}

TEST(NameFilter, StopsNearlyAllOtherNames) {
    NameFilter filter;
    for (const std::string& name : manyNames("added_")) {
        filter.add(name);
    }
    int passed = 0;
    for (const std::string& name : manyNames("other_")) {
        passed += filter.mayHold(name) ? 1 : 0;
    }
    EXPECT_LT(passed, 200);
}

TEST(NameFilter, StopsNearlyAllOtherNamesHoweverManyItHolds) {
    NameFilter filter;
    constexpr int kCount = 100'000;
    for (int number = 0; number < kCount; ++number) {
        filter.add("REGISTER_" + std::to_string(number) + "_A");
    }
    int passed = 0;
    for (int number = 0; number < kCount; ++number) {
        EXPECT_TRUE(filter.mayHold("REGISTER_" + std::to_string(number) + "_A"));
        passed += filter.mayHold("REGISTER_" + std::to_string(number) + "_B") ? 1 : 0;
    }
    EXPECT_LT(passed, kCount / 8);
}

TEST(NameFilter, ForgetsItsNamesAndGrowsAgain) {
    NameFilter filter;
    constexpr int kCount = 100'000;
    for (int number = 0; number < kCount; ++number) {
        filter.add("A" + std::to_string(number));
    }
    filter.clear();
    EXPECT_EQ(filter.size(), 0U);
    for (int number = 0; number < kCount; ++number) {
        EXPECT_FALSE(filter.mayHold("A" + std::to_string(number)));
    }
    for (int number = 0; number < kCount; ++number) {
        filter.add("B" + std::to_string(number));
    }
    for (int number = 0; number < kCount; ++number) {
        EXPECT_TRUE(filter.mayHold("B" + std::to_string(number)));
    }
}

TEST(NameFilter, LooksAtTheBytesOfTheNameAlone) {
    NameFilter filter;
    for (const std::string name :
         {"a", "seven_b", "eight_by", "nine_byte", "a_name_of_20_bytes__"}) {
        filter.add(name);
        for (const std::string around : {"xxxxxxxx", "yyyyyyyy"}) {
            const std::string text = around + name + around;
            EXPECT_TRUE(filter.mayHoldAmongBytes(std::string_view(text).substr(8, name.size())))
                << name;
        }
    }
}

TEST(NameFilter, TellsTheEmptyNameFromAZeroByte) {
    EXPECT_NE(hashOfName(""), hashOfName("\0"sv));
    EXPECT_NE(hashOfName("\0"sv), hashOfName("\0\0"sv));
}

TEST(NameFilter, HashesByTheBytesAlone) {
    const std::string text = "xx_some_name_xx";
    EXPECT_EQ(hashOfName(std::string_view(text).substr(3, 9)), hashOfName("some_name"));
}

TEST(NameFilter, EveryByteOfANameMatters) {
    for (std::size_t size = 0; size <= 40; ++size) {
        const std::string name(size, 'a');
        EXPECT_TRUE(isSameName(name, std::string(size, 'a'))) << size;
        EXPECT_FALSE(isSameName(name, std::string(size + 1, 'a'))) << size;
        for (std::size_t place = 0; place < size; ++place) {
            std::string other = name;
            other[place] = 'b';
            EXPECT_FALSE(isSameName(name, other)) << size << ' ' << place;
            EXPECT_NE(hashOfName(name), hashOfName(other)) << size << ' ' << place;
        }
    }
}

}  // namespace
}  // namespace umpre
