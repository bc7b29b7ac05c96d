// SPDX-License-Identifier: MIT
#include "lex/text_scan.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

using enum TextMark;

// What a scan stopped at: the mark and its place.
struct Found {
    TextMark mark;
    std::size_t place;

    friend bool operator==(const Found&, const Found&) = default;
};

struct TextScanTest : ::testing::Test {
    TextScanTest() { names.add("MACRO"); }

    // Scans a text to its end, going on behind each mark.
    [[nodiscard]] std::vector<Found> scanned(std::string_view text, bool copies = true,
                                             bool marksLineFeeds = false) {
        memory = std::string(text) + "12345678";
        const std::string_view bytes = std::string_view(memory).substr(0, text.size());
        LiteralFinder literals;
        TextScan scan(bytes, true, literals, copies ? &names : nullptr);
        scan.markLineFeeds(marksLineFeeds);
        std::vector<Found> found;
        for (TextMark mark = scan.next(); mark != End; mark = scan.next()) {
            const char* const at = scan.at();
            found.push_back({mark, static_cast<std::size_t>(at - bytes.data())});
            scan.resume(mark == Name ? scan.nameEnd() : at + 1, *at == '\n');
        }
        lineFeeds = scan.takeLineFeeds();
        return found;
    }

    NameFilter names;
    std::string memory;
    std::size_t lineFeeds = 0;
};

TEST_F(TextScanTest, FindsWhatMatters) {
    EXPECT_EQ(scanned("a MACRO b"), (std::vector<Found>{{Name, 2}}));
    EXPECT_EQ(scanned("MACRO1 xMACRO 1MACRO"), (std::vector<Found>{{Name, 15}}));
    EXPECT_EQ(scanned("a / b // c"), (std::vector<Found>{{Comment, 6}}));
    EXPECT_EQ(scanned("a /* b"), (std::vector<Found>{{Comment, 2}}));
    EXPECT_EQ(scanned("a \\ b \\\n"), (std::vector<Found>{{Continuation, 6}}));
    EXPECT_EQ(scanned("a\rb\r\n"), (std::vector<Found>{{CarriageReturn, 1}, {CarriageReturn, 3}}));
    EXPECT_EQ(scanned("a # b\n # c\n## d"), (std::vector<Found>{{Hash, 7}}));
    EXPECT_EQ(scanned("a\n\nb \n \t\n"), (std::vector<Found>{{BlankLine, 8}}));
    EXPECT_EQ(scanned("'a' \"b\" \"c"), (std::vector<Found>{{Literal, 8}}));
}

TEST_F(TextScanTest, PassesLiterals) {
    EXPECT_EQ(scanned("\"MACRO // /* \\\" \r #\" 'MACRO'"), std::vector<Found>{});
    EXPECT_EQ(scanned("it's MACRO\n"), (std::vector<Found>{{Name, 5}}));
}

TEST_F(TextScanTest, MarksLineFeedsIfTheyMatter) {
    EXPECT_EQ(scanned("a\n\nb\n", true, true),
              (std::vector<Found>{{LineFeed, 1}, {LineFeed, 2}, {LineFeed, 4}}));
    EXPECT_EQ(lineFeeds, 0U);
}

TEST_F(TextScanTest, CountsLineFeeds) {
    EXPECT_EQ(scanned("a\n\nb\nMACRO\n"), (std::vector<Found>{{Name, 5}}));
    EXPECT_EQ(lineFeeds, 4U);
}

TEST_F(TextScanTest, FindsNeitherNamesNorBlankLinesIfNothingIsCopied) {
    EXPECT_EQ(scanned("MACRO\n \n#a", false), (std::vector<Found>{{Hash, 8}}));
    EXPECT_EQ(lineFeeds, 2U);
}

TEST_F(TextScanTest, KnowsWhereALineStarts) {
    const std::string_view text = "  a\n  /**/ b\n";
    LiteralFinder literals;
    TextScan scan(text, true, literals, nullptr);
    EXPECT_EQ(scan.lineStart(text.data() + 2), text.data());
    EXPECT_EQ(scan.lineStart(text.data() + 3), nullptr);
    EXPECT_EQ(scan.lineStart(text.data() + 6), text.data() + 4);
    EXPECT_EQ(scan.lineStart(text.data() + 11), nullptr);
    scan.resume(text.data() + 10, true);
    EXPECT_EQ(scan.lineStart(text.data() + 11), text.data() + 10);
    scan.resume(text.data() + 10, false);
    EXPECT_EQ(scan.lineStart(text.data() + 11), nullptr);
}

}  // namespace
}  // namespace umpre
