// SPDX-License-Identifier: MIT
#include "lines/marker.h"

#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

TEST(Marker, HasANumberAndAName) {
    const auto marker = parseMarker("#line 12 \"dir\\\\a.src\"\n");
    ASSERT_TRUE(marker);
    EXPECT_EQ(marker->number, "12");
    EXPECT_EQ(marker->doubledName, "dir\\\\a.src");
    EXPECT_EQ(fileNameOf(*marker), "dir\\a.src");
}

TEST(Marker, NeedsNoLineEnd) {
    EXPECT_TRUE(parseMarker("#line 1 \"a\""));
}

TEST(Marker, MayHaveANameWithQuotesOrNone) {
    EXPECT_EQ(fileNameOf(*parseMarker("#line 1 \"a\"b\"")), "a\"b");
    EXPECT_EQ(fileNameOf(*parseMarker("#line 1 \"\"")), "");
}

TEST(Marker, HasANumberAsAnIntegerIsWritten) {
    for (const std::string number : {"0", "7", "10", "-1", "-2147483648", "2147483647"}) {
        const std::string line = "#line " + number + " \"a\"\n";
        const auto marker = parseMarker(line);
        ASSERT_TRUE(marker) << number;
        EXPECT_EQ(marker->number, number);
    }
    for (const std::string number : {"", "-", "-0", "00", "01", "-01", "+1", "1x", "x", "1 1"}) {
        EXPECT_FALSE(parseMarker("#line " + number + " \"a\"\n")) << number;
    }
}

TEST(Marker, HasExactlyItsForm) {
    const std::vector<std::string> others{
        "",
        "\n",
        "#",
        "#line",
        "#line 1",
        "#line 1 ",
        "#line 1 \"",
        "#line 1 a",
        "# line 1 \"a\"",
        "#line 1 \"a",
        "#line 1 a\"",
        "#line 1  \"a\"",
        "#line 1 \"a\" ",
        " #line 1 \"a\"",
        "#line 1 \"a\\\"",
        "#line 1 \"a\\b\"",
        "#line 1 \"a\\\\\\b\"",
    };
    for (const std::string& line : others) {
        EXPECT_FALSE(parseMarker(line)) << line;
    }
}

}  // namespace
}  // namespace umpre
