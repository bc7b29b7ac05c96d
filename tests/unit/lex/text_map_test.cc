// SPDX-License-Identifier: MIT
#include "lex/text_map.h"

#include <algorithm>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

// A text with a byte before it, as a map wants it.
struct MappedText {
    explicit MappedText(std::string_view text) : bytes(" " + std::string(text) + "  ") {}

    [[nodiscard]] const char* begin() const { return bytes.data() + 1; }

    [[nodiscard]] const char* end() const { return bytes.data() + bytes.size() - 2; }

    // Where a search from a place ends.
    [[nodiscard]] std::size_t special(std::size_t from) {
        return static_cast<std::size_t>(map.findSpecial(begin() + from, end()) - begin());
    }

    std::string bytes;
    TextMap map;
};

// A text, and where what is special in it is found.
struct Row {
    std::string_view text;
    std::size_t place;
};

const std::vector<Row> kSpecials = {
    {"", 0},
    {"a b", 3},
    {"a#", 1},
    {"\"a\" #", 4},
    {"\"#\" #", 4},
    {"\"a", 0},
    {"\"a\n\"", 0},
    {"\"\" \"#\n", 3},
    {"\"\\\"#\"'", 5},
    {"\"\\\\\"#\"", 4},
    {"\"a\\\n\"", 0},
    {"\"\r\"", 0},
    {"'\"'", 0},
    {"\"/*\" /*", 5},
    {"\\\"#\"", 0},
    {"\"a\"\"b\"#", 6},
    {"\"a\"\"b#\n", 3},
};

TEST(TextMap, FindsWhatIsSpecialOutsideOfStrings) {
    for (const Row& row : kSpecials) {
        MappedText text(row.text);
        EXPECT_EQ(text.special(0), row.place) << row.text;
    }
}

TEST(TextMap, FindsItBehindBlocksAndStretches) {
    for (const std::size_t before :
         std::vector<std::size_t>{1, 60, 61, 62, 63, 64, 65, 126, 8187, 8188, 8190, 8192, 20000}) {
        for (const Row& row : kSpecials) {
            SCOPED_TRACE(std::string(row.text) + " behind " + std::to_string(before));
            MappedText text(std::string(before, 'x') + std::string(row.text));
            EXPECT_EQ(text.special(0), before + row.place);
            EXPECT_EQ(text.special(before), before + row.place);
            EXPECT_EQ(text.special(0), before + row.place);
        }
    }
}

TEST(TextMap, FollowsLongStrings) {
    for (const std::size_t size : std::vector<std::size_t>{63, 64, 65, 128, 8192, 30000}) {
        const std::string characters(size, 'x');
        MappedText closed("a \"" + characters + "\"#");
        EXPECT_EQ(closed.special(0), size + 4);
        MappedText broken("a \"" + characters + "\n\"#");
        EXPECT_EQ(broken.special(0), 2U);
        MappedText open("a \"" + characters);
        EXPECT_EQ(open.special(0), 2U);
    }
}

TEST(TextMap, BeginsOutsideOfStringsWhereverItIsAsked) {
    MappedText text("\" a \" # \"");
    EXPECT_EQ(text.special(0), 6U);
    EXPECT_EQ(text.special(1), 9U);
    EXPECT_EQ(text.special(7), 8U);
    MappedText escaped("\\\"'\" #");
    EXPECT_EQ(escaped.special(0), 0U);
    EXPECT_EQ(escaped.special(1), 1U);
    EXPECT_EQ(escaped.special(4), 5U);
}

TEST(TextMap, EndsCharacterLiterals) {
    for (const auto& [text, size] : {Row{"'a' ", 3},
                                     {"'\\'' ", 4},
                                     {"'\\\\' ", 4},
                                     {"'ab' ", 4},
                                     {"'' '", 0},
                                     {"'a\n'", 0},
                                     {"'\\'", 0},
                                     {"'a\\\n'", 0},
                                     {"'", 0}}) {
        MappedText mapped(text);
        const char* const end = mapped.map.characterEnd(mapped.begin(), mapped.end());
        EXPECT_EQ(end, size == 0 ? nullptr : mapped.begin() + size) << text;
    }
}

TEST(TextMap, EndsComments) {
    for (const auto& [text, size] : {Row{"// a\nb", 4},
                                     {"// a\r\n", 4},
                                     {"//\n", 2},
                                     {"// a", 0},
                                     {"// a\r", 0},
                                     {"/**/a", 4},
                                     {"/*/ */", 6},
                                     {"/***/", 5},
                                     {"/* * / /*/ ", 10},
                                     {"/*", 0},
                                     {"/*/", 0},
                                     {"/* \r */", 0},
                                     {"/*\r*/", 0},
                                     {"/*a\\*/b*/", 6}}) {
        for (const std::size_t before : std::vector<std::size_t>{1, 60, 62, 63, 8190, 8191}) {
            MappedText mapped(std::string(before, 'x') + std::string(text));
            const char* const begin = mapped.begin() + before;
            EXPECT_LT(mapped.map.findSpecial(mapped.begin(), mapped.end()), begin + 1);
            const char* const end = mapped.map.commentAt(begin, mapped.end()).end;
            EXPECT_EQ(end, size == 0 ? nullptr : begin + size) << text << before;
        }
    }
}

TEST(TextMap, CountsLineFeedsForwardsAndBackwards) {
    std::string lines;
    for (int line = 0; line < 10000; ++line) {
        lines += std::string(static_cast<std::size_t>(line % 7), 'x') + '\n';
    }
    MappedText text(lines);
    const auto before = [&text](std::size_t place) {
        return text.map.lineFeedsBefore(text.begin() + place, text.end());
    };
    const auto counted = [&lines](std::size_t place) {
        return static_cast<std::size_t>(
            std::count(lines.begin(), lines.begin() + static_cast<std::ptrdiff_t>(place), '\n'));
    };
    for (const std::size_t place :
         std::vector<std::size_t>{0, 5, 64, 8191, 8192, 20000, 16384, 3, 39999}) {
        EXPECT_EQ(before(place), counted(place)) << place;
    }
    EXPECT_EQ(text.map.commentAt(text.begin(), text.end()).end, nullptr);
}

}  // namespace
}  // namespace umpre
