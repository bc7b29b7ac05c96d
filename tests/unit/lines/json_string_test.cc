// SPDX-License-Identifier: MIT
#include "lines/json_string.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

namespace umpre {
namespace {

TEST(JsonString, QuotesAndEscapes) {
    EXPECT_EQ(jsonString(""), "\"\"");
    EXPECT_EQ(jsonString("a b/c"), "\"a b/c\"");
    EXPECT_EQ(jsonString("\"\\\n\x1f\x7f"), "\"\\\"\\\\\\u000a\\u001f\x7f\"");
    EXPECT_EQ(jsonString(std::string_view("\0", 1)), "\"\\u0000\"");
}

TEST(JsonString, LeavesUtf8AsItIs) {
    for (const std::string text : {"\u00e4", "\u07ff", "\u0800", "\ud7ff", "\ue000", "\uffff",
                                   "\U00010000", "\U0010ffff", "a\u00e4b"}) {
        EXPECT_EQ(jsonString(text), "\"" + text + "\"");
    }
}

struct Broken {
    std::string_view bytes;
    std::string_view expected;
};

TEST(JsonString, EscapesEachByteThatIsNoUtf8) {
    const Broken table[]{
        {"\x80", "\\udc80"},                                   // only a following byte
        {"\xe4", "\\udce4"},                                   // nothing follows
        {"\xe4z", "\\udce4z"},                                 // something else follows
        {"\xe2\x82", "\\udce2\\udc82"},                        // cut off
        {"\xc0\xaf", "\\udcc0\\udcaf"},                        // too long for its character
        {"\xe0\x9f\xbf", "\\udce0\\udc9f\\udcbf"},             // so is this
        {"\xed\xa0\x80", "\\udced\\udca0\\udc80"},             // half of a pair
        {"\xf4\x90\x80\x80", "\\udcf4\\udc90\\udc80\\udc80"},  // beyond the last character
        {"\xf5\xff", "\\udcf5\\udcff"},                        // no byte of UTF-8
    };
    for (const Broken& broken : table) {
        EXPECT_EQ(jsonString(broken.bytes), "\"" + std::string(broken.expected) + "\"");
    }
}

}  // namespace
}  // namespace umpre
