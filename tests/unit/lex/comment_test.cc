// SPDX-License-Identifier: MIT
#include "lex/comment.h"

#include <cstddef>
#include <string>
#include <string_view>

#include <gtest/gtest.h>

namespace umpre {
namespace {

using Stop = CommentScan::Stop;

struct Row {
    std::string_view text;  // behind the opening
    Stop stop;
    std::size_t at;
    std::size_t lineFeeds;
};

TEST(Comment, IsReadUpToItsEnd) {
    for (const Row& row : {
             Row{"*/", Stop::Closed, 2, 0},
             Row{" a */ b", Stop::Closed, 5, 0},
             Row{"**/", Stop::Closed, 3, 0},
             Row{"* / */", Stop::Closed, 6, 0},
             Row{"/*/", Stop::Closed, 3, 0},
             Row{"\n*\n/\n*/\n", Stop::Closed, 7, 3},
             Row{"a\r\n*/", Stop::CarriageReturn, 1, 0},
             Row{"\n*\r/", Stop::CarriageReturn, 2, 1},
             Row{"", Stop::Cut, 0, 0},
             Row{"a\n", Stop::Cut, 2, 1},
             Row{"/", Stop::Cut, 1, 0},
             Row{"a*", Stop::Cut, 1, 0},
         }) {
        const char* const begin = row.text.data();
        const CommentScan scan = scanBlockComment(begin, begin + row.text.size());
        EXPECT_EQ(scan.stop, row.stop) << ::testing::PrintToString(row.text);
        EXPECT_EQ(scan.at, begin + row.at) << ::testing::PrintToString(row.text);
        EXPECT_EQ(scan.lineFeeds, row.lineFeeds) << ::testing::PrintToString(row.text);
    }
}

TEST(Comment, IsReadUpToItsEndHoweverLongItIs) {
    for (std::size_t size = 0; size < 200; ++size) {
        const std::string text = std::string(size, 'a') + "\n*/" + std::string(70, '/');
        const char* const begin = text.data();
        const char* const end = begin + text.size();
        const CommentScan scan = scanBlockComment(begin, end);
        EXPECT_EQ(scan.stop, Stop::Closed);
        EXPECT_EQ(scan.at, begin + size + 3);
        EXPECT_EQ(scan.lineFeeds, 1U);
        // Cut between the two last bytes, it goes on with the first of them.
        const CommentScan cut = scanBlockComment(begin, begin + size + 2);
        EXPECT_EQ(cut.stop, Stop::Cut);
        EXPECT_EQ(scanBlockComment(cut.at, end).at, begin + size + 3);
    }
}

TEST(Comment, ALineEndsAtAnyLineEnd) {
    for (const std::string lineEnd : {"\n", "\r", "\r\n"}) {
        for (std::size_t size = 0; size < 200; ++size) {
            const std::string text = std::string(size, 'a').append(lineEnd).append("b\n");
            EXPECT_EQ(findLineEnd(text.data(), text.data() + text.size()), text.data() + size);
            EXPECT_EQ(findLineEnd(text.data(), text.data() + size), text.data() + size);
        }
    }
}

}  // namespace
}  // namespace umpre
