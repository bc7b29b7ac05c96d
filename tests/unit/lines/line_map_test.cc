// SPDX-License-Identifier: MIT
#include "lines/line_map.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "support/recording_sink.h"

namespace umpre {
namespace {

std::string mapOf(LineMap::Count count, std::string_view text) {
    testing::RecordingSink sink;
    OutputWriter output;
    output.redirect(sink);
    LineMap map(output, count);
    MarkerFinder finder(map);
    for (const char byte : text) {
        finder.feed({&byte, 1});
    }
    finder.finish();
    map.finish();
    output.flush();
    return sink.bytes();
}

TEST(LineMap, CountsLinesThatComeInPieces) {
    EXPECT_EQ(mapOf(LineMap::Count::All, "before\n#line 7 \"a\"\nx\ny\n#line 1 \"b\"\nz"),
              "{\"segments\": [\n"
              "{\"output\": 3, \"file\": \"a\", \"line\": 7},\n"
              "{\"output\": 6, \"file\": \"b\", \"line\": 1}\n"
              "], \"lines\": 6}\n");
}

TEST(LineMap, CanLeaveTheMarkersUncounted) {
    EXPECT_EQ(mapOf(LineMap::Count::WithoutMarkers, "#line 7 \"a\"\nx\ny\n#line 1 \"b\"\nz\n"),
              "{\"segments\": [\n"
              "{\"output\": 1, \"file\": \"a\", \"line\": 7},\n"
              "{\"output\": 3, \"file\": \"b\", \"line\": 1}\n"
              "], \"lines\": 3}\n");
}

TEST(LineMap, HasNoSegmentForAMarkerWithoutText) {
    EXPECT_EQ(mapOf(LineMap::Count::All, "#line 7 \"a\"\n"), "{\"segments\": [], \"lines\": 1}\n");
}

}  // namespace
}  // namespace umpre
