// SPDX-License-Identifier: MIT
#include "driver/version.h"

#include <regex>
#include <string>

#include <gtest/gtest.h>

namespace umpre {
namespace {

TEST(Version, HasNumbersDateAndName) {
    const std::regex form(
        R"form(\d+\.\d+\.\d+ win32 \([A-Z][a-z]+ +\d+ \d+\) "Amber Crossroads")form");
    EXPECT_TRUE(std::regex_match(UmGetVersionString(), form)) << UmGetVersionString();
}

TEST(Version, StandsAfterTheName) {
    EXPECT_EQ(UmGetLibNameAndVersionString(), std::string("Umbrite ") + UmGetVersionString());
}

TEST(Version, StaysAtItsPlace) {
    EXPECT_EQ(UmGetVersionString(), UmGetVersionString());
    EXPECT_EQ(UmGetLibNameAndVersionString(), UmGetLibNameAndVersionString());
    EXPECT_NE(UmGetVersionString(), UmGetLibNameAndVersionString());
}

TEST(Version, ComesWithACopyrightLine) {
    EXPECT_STREQ(UmGetCopyrightString(), "Copyright (c) 2026 The umpre developers.");
}

}  // namespace
}  // namespace umpre
