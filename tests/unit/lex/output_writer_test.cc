// SPDX-License-Identifier: MIT
#include "lex/output_writer.h"

#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>

#include <gtest/gtest.h>

#include "support/recording_sink.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using testing::RecordingSink;

constexpr std::size_t kMuch = 300'000;  // more than any block

struct OutputWriterTest : ::testing::Test {
    OutputWriterTest() { output.redirect(sink); }

    [[nodiscard]] const std::string& written() {
        output.flush();
        return sink.bytes();
    }

    RecordingSink sink;
    OutputWriter output;
};

TEST_F(OutputWriterTest, WritesTextAsItIs) {
    output.write("a\\b\0\r\n\xFF"sv);
    output.write("");
    output.write("c");
    EXPECT_EQ(written(),
              "a\\b\0\r\n\xFF"
              "c"sv);
}

TEST_F(OutputWriterTest, WritesNothingForATextThatHasNoMemory) {
    output.write({});
    EXPECT_EQ(written(), "");
}

TEST_F(OutputWriterTest, HandsNothingOverBeforeItMust) {
    output.write("a");
    EXPECT_EQ(sink.calls(), 0U);
    output.flush();
    EXPECT_EQ(sink.calls(), 1U);
    output.flush();
    EXPECT_EQ(sink.calls(), 1U);
}

TEST_F(OutputWriterTest, KeepsTheOrderOfShortAndLongTexts) {
    std::string expected;
    for (std::size_t size = 1; size < kMuch; size *= 3) {
        const std::string text(size, static_cast<char>('a' + size % 26));
        output.write(text);
        output.write("|");
        expected += text + "|";
    }
    EXPECT_EQ(written(), expected);
}

TEST_F(OutputWriterTest, CollectsManyShortTexts) {
    std::string expected;
    for (int count = 0; count < 60'000; ++count) {
        output.write("seven..");
        expected += "seven..";
    }
    EXPECT_EQ(written(), expected);
    EXPECT_LT(sink.calls(), 1000U);
}

TEST_F(OutputWriterTest, WritesTextsAroundTheSizeOfABlock) {
    for (const std::size_t size : {65'535U, 65'536U, 65'537U}) {
        RecordingSink other;
        OutputWriter writer;
        writer.redirect(other);
        const std::string text(size, 'x');
        writer.write(text);
        writer.write("y");
        writer.write(text);
        writer.flush();
        EXPECT_EQ(other.bytes(), text + "y" + text) << size;
    }
}

TEST_F(OutputWriterTest, WritesManyLineFeeds) {
    output.write("a");
    output.writeLineFeeds(kMuch);
    output.write("b");
    output.writeLineFeeds(0);
    EXPECT_EQ(written(), "a" + std::string(kMuch, '\n') + "b");
}

TEST_F(OutputWriterTest, WritesAFewLineFeedsWhereverABlockEnds) {
    for (std::size_t before = 65'500; before <= 65'540; ++before) {
        for (const std::size_t count : {1U, 31U, 32U, 33U}) {
            RecordingSink other;
            OutputWriter writer;
            writer.redirect(other);
            const std::string text(before, 'x');
            writer.write(text);
            writer.writeLineFeeds(count);
            writer.write("b");
            writer.flush();
            ASSERT_EQ(other.bytes(), text + std::string(count, '\n') + "b") << before << count;
        }
    }
}

TEST_F(OutputWriterTest, CountsTheLinesThatItEnds) {
    output.writeLineMarker({"f", 5});
    output.endLine();
    EXPECT_TRUE(output.isAt({"f", 6}));
    output.endLines(3);
    EXPECT_TRUE(output.isAt({"f", 9}));
    EXPECT_EQ(written(), "#line 5 \"f\"\n\n\n\n\n");
}

TEST_F(OutputWriterTest, CountsLinesOfTextWhenTold) {
    output.writeLineMarker({"f", 5});
    output.write("a\nb\n");
    EXPECT_TRUE(output.isAt({"f", 5}));
    output.countLines(2);
    EXPECT_TRUE(output.isAt({"f", 7}));
}

TEST_F(OutputWriterTest, DoesNotCountTheLineEndsOfComments) {
    output.writeLineMarker({"f", 5});
    output.writeLineFeeds(2);
    EXPECT_TRUE(output.isAt({"f", 5}));
}

TEST_F(OutputWriterTest, TheLineCounterWrapsAround) {
    output.writeLineMarker({"f", std::numeric_limits<std::int32_t>::max()});
    output.endLine();
    EXPECT_TRUE(output.isAt({"f", std::numeric_limits<std::int32_t>::min()}));
}

TEST_F(OutputWriterTest, AMarkerHoldsTheLineAndTheName) {
    output.writeLineMarker({"dir/file.src", 12});
    EXPECT_EQ(written(), "#line 12 \"dir/file.src\"\n");
    EXPECT_TRUE(output.isAt({"any", 12}));
}

TEST_F(OutputWriterTest, AMarkerDoublesEveryBackslash) {
    struct Row {
        std::string_view name;
        std::string_view marker;
    };

    for (const Row& row : {
             Row{R"(c:\dir\f.h)", "#line 1 \"c:\\\\dir\\\\f.h\"\n"},
             Row{R"(\)", "#line 1 \"\\\\\"\n"},
             Row{R"(\\)", "#line 1 \"\\\\\\\\\"\n"},
             Row{R"(a\)", "#line 1 \"a\\\\\"\n"},
             Row{R"(a"b)", "#line 1 \"a\"b\"\n"},
             Row{"", "#line 1 \"\"\n"},
         }) {
        RecordingSink other;
        OutputWriter writer;
        writer.redirect(other);
        writer.writeLineMarker({row.name, 1});
        writer.flush();
        EXPECT_EQ(other.bytes(), row.marker) << row.name;
    }
}

TEST_F(OutputWriterTest, AMarkerShowsLinesOfAnySign) {
    output.writeLineMarker({"f", 0});
    output.writeLineMarker({"f", std::numeric_limits<std::int32_t>::max()});
    output.writeLineMarker({"f", std::numeric_limits<std::int32_t>::min()});
    EXPECT_EQ(written(), "#line 0 \"f\"\n#line 2147483647 \"f\"\n#line -2147483648 \"f\"\n");
}

TEST_F(OutputWriterTest, AMarkerTakesALongName) {
    const std::string name(kMuch, 'n');
    output.writeLineMarker({name, 1});
    EXPECT_EQ(written(), "#line 1 \"" + name + "\"\n");
}

TEST_F(OutputWriterTest, WritesSnippetsWhereverABlockEnds) {
    for (std::size_t before = 65'400; before < 65'600; ++before) {
        RecordingSink other;
        OutputWriter writer;
        writer.redirect(other);
        const std::string text(before, 'x');
        writer.write(text);
        writer.writeSnippet(Snippet("a snippet"));
        writer.writeLineMarker(12, Snippet(OutputWriter::markerEndOf("f")));
        writer.write("y");
        writer.flush();
        EXPECT_EQ(other.bytes(), text + "a snippet#line 12 \"f\"\ny");
    }
}

TEST_F(OutputWriterTest, AMarkerIsTheSameInOnePieceAndInTwo) {
    for (const std::string_view name : {"f", "dir/file.src", R"(c:\dir\f.h)", ""}) {
        for (const std::int32_t line : {1, 0, 123456, -1}) {
            RecordingSink other;
            OutputWriter writer;
            writer.redirect(other);
            writer.writeLineMarker(line, Snippet(OutputWriter::markerEndOf(name)));
            EXPECT_TRUE(writer.isAt({name, line}));
            writer.flush();
            EXPECT_EQ(other.bytes(), OutputWriter::markerOf({name, line}));
        }
    }
}

TEST_F(OutputWriterTest, SyncingWritesAMarkerOnlyIfTheLinesDiffer) {
    output.writeLineMarker({"f", 1});
    output.syncTo({"f", 1});
    output.syncTo({"g", 1});
    EXPECT_EQ(written(), "#line 1 \"f\"\n");
    output.syncTo({"f", 3});
    output.syncTo({"f", 3});
    EXPECT_EQ(written(), "#line 1 \"f\"\n#line 3 \"f\"\n");
}

TEST_F(OutputWriterTest, HasNotFailedWhileTheSinkTakesAll) {
    output.write(std::string(kMuch, 'x'));
    output.flush();
    EXPECT_FALSE(output.failed());
}

TEST_F(OutputWriterTest, GoesToTheSinkThatWasSetLast) {
    RecordingSink other;
    output.redirect(other);
    output.write("a");
    output.flush();
    EXPECT_EQ(sink.bytes(), "");
    EXPECT_EQ(other.bytes(), "a");
}

TEST(OutputWriterFailure, IsKnownWhenTheTextIsHandedOver) {
    RecordingSink sink(1);
    OutputWriter output;
    output.redirect(sink);
    output.write("a");
    EXPECT_FALSE(output.failed());
    output.flush();
    EXPECT_TRUE(output.failed());
}

TEST(OutputWriterFailure, IsKnownWithoutAFlushAfterMuchText) {
    RecordingSink sink(1);
    OutputWriter output;
    output.redirect(sink);
    output.writeLineFeeds(kMuch);
    EXPECT_TRUE(output.failed());
}

TEST(OutputWriterFailure, EndsAllWriting) {
    RecordingSink sink(2);
    OutputWriter output;
    output.redirect(sink);
    for (int count = 0; count < 5; ++count) {
        output.write("a");
        output.flush();
    }
    output.write(std::string(kMuch, 'x'));
    output.writeLineFeeds(kMuch);
    output.writeLineMarker({"f", 1});
    output.flush();
    EXPECT_TRUE(output.failed());
    EXPECT_EQ(sink.calls(), 2U);
    EXPECT_EQ(sink.bytes(), "a");
}

TEST(OutputWriterFailure, IsWhatTextWithoutASinkComesTo) {
    OutputWriter output;
    output.flush();
    EXPECT_FALSE(output.failed());
    output.write("a");
    output.flush();
    EXPECT_TRUE(output.failed());
}

}  // namespace
}  // namespace umpre
