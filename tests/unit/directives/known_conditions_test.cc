// SPDX-License-Identifier: MIT
#include "directives/known_conditions.h"

#include <cstdint>
#include <optional>
#include <string>

#include <gtest/gtest.h>

namespace umpre {
namespace {

// Meets a condition twice and keeps what comes out of it.
void keepTwice(KnownConditions& conditions, const std::string& text, bool value,
               std::uint64_t version) {
    (void)conditions.meet(text, version);
    conditions.keep(conditions.meet(text, version), value, version);
}

TEST(KnownConditions, KeepWhatComesOutTheSecondTime) {
    KnownConditions conditions;
    const KnownConditions::Place first = conditions.meet(" A > 1", 1);
    EXPECT_FALSE(first.comesAgain);
    EXPECT_EQ(first.value, std::nullopt);
    const KnownConditions::Place second = conditions.meet(" A > 1", 1);
    EXPECT_TRUE(second.comesAgain);
    EXPECT_EQ(second.value, std::nullopt);
    conditions.keep(second, true, 1);
    EXPECT_EQ(conditions.meet(" A > 1", 1).value, true);
    EXPECT_EQ(conditions.meet(" A > 2", 1).value, std::nullopt);
    EXPECT_EQ(conditions.meet(" A > 1 ", 1).value, std::nullopt);
}

TEST(KnownConditions, ForgetWithAnotherVersion) {
    KnownConditions conditions;
    keepTwice(conditions, " A", true, 1);
    const KnownConditions::Place stale = conditions.meet(" A", 2);
    EXPECT_EQ(stale.value, std::nullopt);
    EXPECT_FALSE(stale.comesAgain);
    const KnownConditions::Place again = conditions.meet(" A", 2);
    EXPECT_TRUE(again.comesAgain);
    conditions.keep(again, false, 2);
    EXPECT_EQ(conditions.meet(" A", 2).value, false);
}

TEST(KnownConditions, AreBounded) {
    KnownConditions conditions;
    for (int number = 0; number < 20'000; ++number) {
        const std::string text = std::to_string(number) + std::string(100, ' ');
        keepTwice(conditions, text, number % 3 == 0, 1);
        EXPECT_NE(conditions.meet(text, 1).value, number % 3 != 0);
    }
    const std::string longText(5000, 'A');
    keepTwice(conditions, longText, true, 1);
    EXPECT_EQ(conditions.meet(longText, 1).value, std::nullopt);
}

}  // namespace
}  // namespace umpre
