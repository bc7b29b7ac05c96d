// SPDX-License-Identifier: MIT
#include "lines/marker_finder.h"

#include <algorithm>
#include <string>
#include <string_view>

#include <gtest/gtest.h>

namespace umpre {
namespace {

// Writes down what it is told, a marker as <number name>.
class Record final : public MarkedText {
public:
    void text(std::string_view bytes) override {
        EXPECT_FALSE(bytes.empty());
        told_.append(bytes);
    }

    void marker(const Marker& marker) override {
        told_.append("<").append(marker.number).append(" ").append(fileNameOf(marker)).append(">");
    }

    [[nodiscard]] const std::string& told() const { return told_; }

private:
    std::string told_;
};

// What is found in a text that comes in blocks of this size.
std::string found(std::string_view text, std::size_t blockSize) {
    Record record;
    MarkerFinder finder(record);
    while (!text.empty()) {
        const std::size_t size = std::min(blockSize, text.size());
        finder.feed(text.substr(0, size));
        text.remove_prefix(size);
    }
    finder.finish();
    return record.told();
}

TEST(MarkerFinder, FindsTheSameInBlocksOfEverySize) {
    const std::string_view text =
        "#line 1 \"a\"\n#line 2 \"b\"\ntext # text\n#line 3 \"c\" x\n #line 4 \"d\"\n"
        "one \\\n#line 5 \"e\"\n\\\n#line 6 \"f\"\n\n#\n##\n#line 7 \"g\"\n\\\n#line 8 \"h\"\n"
        "#line 9 \"i\"\n#pragma\n#l\n#line 10 \"j\"";
    const std::string_view expected =
        "<1 a><2 b>text # text\n#line 3 \"c\" x\n #line 4 \"d\"\n"
        "one \\\n#line 5 \"e\"\n\\\n#line 6 \"f\"\n\n#\n##\n<7 g>\\\n#line 8 \"h\"\n"
        "<9 i>#pragma\n#l\n<10 j>";
    for (std::size_t size = 1; size <= text.size(); ++size) {
        EXPECT_EQ(found(text, size), expected) << size;
    }
}

TEST(MarkerFinder, FindsNothingInNothing) {
    EXPECT_EQ(found("", 1), "");
}

TEST(MarkerFinder, HandsALineOnBeforeItsEnd) {
    Record record;
    MarkerFinder finder(record);
    finder.feed("text without");
    EXPECT_EQ(record.told(), "text without");
    finder.feed(" end\n#pra");
    EXPECT_EQ(record.told(), "text without end\n#pra");
    finder.feed("gma\n#lin");
    EXPECT_EQ(record.told(), "text without end\n#pragma\n");
    finder.finish();
    EXPECT_EQ(record.told(), "text without end\n#pragma\n#lin");
}

}  // namespace
}  // namespace umpre
