// SPDX-License-Identifier: MIT
#include "lines/rewriting.h"

#include <gtest/gtest.h>

#include "support/recording_sink.h"

namespace umpre {
namespace {

TEST(GnuText, EscapesEveryQuoteOfTheName) {
    testing::RecordingSink sink;
    OutputWriter output;
    output.redirect(sink);
    GnuText text(output);
    text.marker({"1", "\"a\"\\\\\""});
    text.text("x\n");
    output.flush();
    EXPECT_EQ(sink.bytes(), "# 1 \"\\\"a\\\"\\\\\\\"\"\nx\n");
}

TEST(StrippedText, IsTheTextAlone) {
    testing::RecordingSink sink;
    OutputWriter output;
    output.redirect(sink);
    StrippedText text(output);
    text.marker({"1", "a"});
    text.text("x\n");
    output.flush();
    EXPECT_EQ(sink.bytes(), "x\n");
}

}  // namespace
}  // namespace umpre
