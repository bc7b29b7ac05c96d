// SPDX-License-Identifier: MIT
#include "lex/text_scan.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
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
    [[nodiscard]] std::vector<Found> scanned(std::string_view text, bool marksLineFeeds = false) {
        memory = " " + std::string(text) + std::string(64, '8');
        const std::string_view bytes = std::string_view(memory).substr(1, text.size());
        LiteralFinder literals;
        TextMap map;
        TextScan scan(bytes, true, map, literals, names);
        scan.markLineFeeds(marksLineFeeds);
        std::vector<Found> found;
        for (TextMark mark = scan.next(); mark != End; mark = scan.next()) {
            const char* const at = scan.at();
            found.push_back({mark, static_cast<std::size_t>(at - bytes.data())});
            scan.resume(mark == Name ? scan.nameEnd() : at + 1, *at == '\n');
        }
        return found;
    }

    NameFilter names;
    std::string memory;
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
    EXPECT_EQ(scanned("a\n\nb\n", true),
              (std::vector<Found>{{LineFeed, 1}, {LineFeed, 2}, {LineFeed, 4}}));
    EXPECT_EQ(scanned("a\n\nb\nMACRO\n"), (std::vector<Found>{{Name, 5}}));
}

TEST_F(TextScanTest, GoesOnWithTheNameOfTheLineBefore) {
    // The name that stands behind the line feed, and whether a scan for MACRO goes on with it.
    const auto goesOn = [this](std::string_view text, bool marksLineFeeds = false) {
        memory = std::string(text) + std::string(64, '8');
        NameFilter none;
        LiteralFinder literals;
        TextMap map;
        TextScan scan(std::string_view(memory).substr(0, text.size()), false, map, literals, none);
        scan.markLineFeeds(marksLineFeeds);
        const bool passed = scan.passToSame("MACRO");
        EXPECT_EQ(scan.at() - memory.data(), passed ? 1 : 0) << text;
        EXPECT_TRUE(!passed || scan.nameEnd() == memory.data() + 6) << text;
        return passed;
    };
    EXPECT_TRUE(goesOn("\nMACRO("));
    EXPECT_TRUE(goesOn("\nMACRO\n"));
    EXPECT_FALSE(goesOn("\nMACRO(", true));
    EXPECT_FALSE(goesOn("\nMACRO"));  // it may go on behind these bytes
    EXPECT_FALSE(goesOn("\nMACRO1("));
    EXPECT_FALSE(goesOn("\nMACRA("));
    EXPECT_FALSE(goesOn("\nMAC("));
    EXPECT_FALSE(goesOn("\n"));
    EXPECT_FALSE(goesOn("\n\nMACRO("));
    EXPECT_FALSE(goesOn("MACRO("));
}

TEST_F(TextScanTest, FindsNamesBehindNumbers) {
    names.add("e5");
    names.add("g");
    names.add("L");
    names.add("xg");
    for (const auto& [text, place] :
         std::vector<std::pair<std::string_view, std::size_t>>{{"1e5", 1},
                                                               {"12e5", 2},
                                                               {"1.2e5", 3},
                                                               {"0x1g", 3},
                                                               {"0X1FuLg", 6},
                                                               {"0xg", 1},
                                                               {"00xg", 2},
                                                               {"10lug", 4},
                                                               {"1LL", 2},
                                                               {"1lL", 2},
                                                               {"1uLL", 3},
                                                               {"7u5g", 3},
                                                               {"7u5Lg", 4},
                                                               {"089ulg", 5},
                                                               {"0x1u0x2lg", 8},
                                                               {"1u1u1u1g", 7},
                                                               {"0u\x80g", 3},
                                                               {"0xfLUg", 5}}) {
        EXPECT_EQ(scanned(text), (std::vector<Found>{{Name, place}})) << text;
        const std::string behind = "\"x\" 12 " + std::string(text) + " 0xffu";
        EXPECT_EQ(scanned(behind), (std::vector<Found>{{Name, 7 + place}})) << behind;
    }
    for (const std::string_view text :
         {"1e6", "12", "089", "0x1e5", "1L", "1UL", "0x1fLu", "1lu", "1e5e5", "1uL", "0xe5",
          "\"1e5\"", "'0x1g'", "12u 34l 0x5"}) {
        EXPECT_EQ(scanned(text), std::vector<Found>{}) << text;
    }
}

TEST_F(TextScanTest, GoesOnBehindWhatIsNoLiteral) {
    EXPECT_EQ(scanned("\"MACRO\nMACRO"), (std::vector<Found>{{Name, 1}, {Name, 7}}));
    EXPECT_EQ(scanned("\"a\" \"MACRO\n\"MACRO\""), (std::vector<Found>{{Name, 5}}));
    EXPECT_EQ(scanned("'\"' MACRO '\"'"), (std::vector<Found>{{Name, 4}}));
    EXPECT_EQ(scanned("'\"' \"MACRO\""), std::vector<Found>{});
    EXPECT_EQ(scanned("\\\"MACRO\" MACRO"), (std::vector<Found>{{Name, 9}}));
    EXPECT_EQ(scanned("'' MACRO\n'"), (std::vector<Found>{{Name, 3}, {Literal, 9}}));
    EXPECT_EQ(scanned("\"\r MACRO \" MACRO"), (std::vector<Found>{{Name, 11}}));
    EXPECT_EQ(scanned("\"a\\\nMACRO \""),
              (std::vector<Found>{{Continuation, 2}, {Name, 4}, {Literal, 10}}));
}

// What is found does not depend on where the 64 bytes and the stretches of the map begin.
TEST_F(TextScanTest, FindsTheSameBehindAnyBytes) {
    const std::vector<std::string> texts = {"MACRO",
                                            "\"MACRO\" MACRO",
                                            "\"\\\"MACRO\" MACRO",
                                            "\"MACRO",
                                            "\"MACRO\n\"",
                                            "'\"' MACRO",
                                            "1MACRO",
                                            "0x1fulMACRO",
                                            "aMACRO MACROa MACRO",
                                            "// c",
                                            "/* c",
                                            "a / b /c",
                                            "\\\n",
                                            "\\x\"MACRO\"",
                                            "\\\"MACRO\" MACRO",
                                            "# a",
                                            "\n#",
                                            "\n \n",
                                            "\n \r\n#",
                                            "'\\''MACRO",
                                            "''MACRO",
                                            "\"" + std::string(70, 'm') + "\"MACRO",
                                            "\"" + std::string(200, 'm') + "\nMACRO",
                                            std::string(70, 'm') + " MACRO",
                                            std::string(130, '1') + "MACRO"};
    for (const std::string& text : texts) {
        const std::vector<Found> expected = scanned("; " + text);
        for (std::size_t before = 1; before < 8300;
             before += before < 140 || before > 8100 ? 1 : 97) {
            std::vector<Found> found = scanned(std::string(before, ';') + "; " + text);
            for (Found& each : found) {
                each.place -= before;
            }
            ASSERT_EQ(found, expected) << text << " behind " << before;
        }
    }
}

TEST_F(TextScanTest, KnowsWhereALineStarts) {
    const std::string_view text = "  a\n  /**/ b\n";
    LiteralFinder literals;
    TextMap map;
    TextScan scan(text, true, map, literals, names);
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
