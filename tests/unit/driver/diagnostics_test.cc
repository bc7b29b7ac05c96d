// SPDX-License-Identifier: MIT
#include "driver/diagnostics.h"

#include <gtest/gtest.h>

#include "lex/output_writer.h"
#include "lex/scanner_stack.h"
#include "support/recording_sink.h"
#include "support/source_fixture.h"

namespace umpre {
namespace {

struct Fixture {
    Fixture() { events.watch(sources); }

    testing::RecordingSink sink;
    testing::RecordingFileEvents events;
    OutputWriter output;
    testing::RecordingReporter reporter;
    ScannerStack sources{events, output, reporter, {}};
    Diagnostics diagnostics{linesTo(sink), sources};
};

TEST(Diagnostics, BeginsWithoutReports) {
    const Fixture f;
    EXPECT_FALSE(f.diagnostics.errorFlag());
    EXPECT_EQ(f.diagnostics.reportCount(), 0U);
}

TEST(Diagnostics, WritesAnErrorWithItsPosition) {
    Fixture f;
    f.sources.pushFileText("main", "\n\n");
    EXPECT_EQ(f.sources.next().kind, TokenKind::NEWLINE);
    f.diagnostics.reportError("It is wrong");
    EXPECT_EQ(f.sink.bytes(), "main:2: It is wrong.\n");
    EXPECT_TRUE(f.diagnostics.errorFlag());
    EXPECT_EQ(f.diagnostics.reportCount(), 1U);
}

TEST(Diagnostics, WritesAWarningThatIsNoError) {
    Fixture f;
    f.sources.pushFileText("main", "");
    f.diagnostics.reportWarning("It is odd");
    EXPECT_EQ(f.sink.bytes(), "main:1: Warning: It is odd.\n");
    EXPECT_FALSE(f.diagnostics.errorFlag());
    EXPECT_EQ(f.diagnostics.reportCount(), 1U);
}

TEST(Diagnostics, WritesAFatalErrorWithAndWithoutAPosition) {
    Fixture f;
    f.diagnostics.reportFatal("cannot open a");
    f.sources.pushFileText("main", "");
    f.diagnostics.reportFatal("cannot open b");
    EXPECT_EQ(f.sink.bytes(),
              "FATAL ERROR: cannot open a.\n"
              "main:1: FATAL ERROR: cannot open b.\n");
    EXPECT_TRUE(f.diagnostics.errorFlag());
    EXPECT_EQ(f.diagnostics.reportCount(), 2U);
}

TEST(Diagnostics, NotesAnUnterminatedCommentWithoutAnError) {
    Fixture f;
    f.sources.pushFileText("main", "");
    f.diagnostics.noteUnterminatedComment(7);
    EXPECT_EQ(f.sink.bytes(), "7: unterminated comment.\n");
    EXPECT_FALSE(f.diagnostics.errorFlag());
    EXPECT_EQ(f.diagnostics.reportCount(), 1U);
}

TEST(Diagnostics, NotesAScannerFailureAsItIs) {
    Fixture f;
    f.sources.pushFileText("main", "");
    f.diagnostics.noteScannerFailure("input in flex scanner failed");
    EXPECT_EQ(f.sink.bytes(), "input in flex scanner failed\n");
    EXPECT_EQ(f.diagnostics.reportCount(), 0U);
}

TEST(Diagnostics, UsesTheFileThatIsReadNow) {
    Fixture f;
    f.sources.pushFileText("main", "");
    f.sources.pushFileText("other", "");
    f.sources.currentFile().setLine(-5);
    f.diagnostics.reportError("It is wrong");
    EXPECT_EQ(f.sink.bytes(), "other:-5: It is wrong.\n");
}

TEST(Diagnostics, WritesEachMessageAtOnce) {
    Fixture f;
    f.sources.pushFileText("main", "");
    f.diagnostics.reportError("a");
    f.diagnostics.reportWarning("b");
    EXPECT_EQ(f.sink.calls(), 2U);
}

TEST(Diagnostics, CountsWhatCouldNotBeWritten) {
    Fixture f;
    testing::RecordingSink failing(1);
    Diagnostics diagnostics(linesTo(failing), f.sources);
    diagnostics.reportError("a");
    EXPECT_TRUE(diagnostics.errorFlag());
    EXPECT_EQ(diagnostics.reportCount(), 1U);
}

}  // namespace
}  // namespace umpre
