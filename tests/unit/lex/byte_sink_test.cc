// SPDX-License-Identifier: MIT
#include "lex/byte_sink.h"

#include <fcntl.h>
#include <string>
#include <unistd.h>

#include <gtest/gtest.h>

#include "support/descriptors.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using testing::Pipe;

TEST(DescriptorSink, WritesAllBytes) {
    const Pipe pipe;
    DescriptorSink sink(pipe.writeEnd());
    EXPECT_TRUE(sink.write("one\0two\xFF"sv));
    EXPECT_TRUE(sink.write("three"));
    EXPECT_EQ(pipe.read(), "one\0two\xFFthree"sv);
}

TEST(DescriptorSink, WritesNothingForAnEmptyText) {
    DescriptorSink sink(-1);
    EXPECT_TRUE(sink.write(""));
}

TEST(DescriptorSink, LeavesTheDescriptorOpen) {
    const Pipe pipe;
    EXPECT_TRUE(DescriptorSink(pipe.writeEnd()).write("a"));
    EXPECT_TRUE(DescriptorSink(pipe.writeEnd()).write("b"));
    EXPECT_EQ(pipe.read(), "ab");
}

TEST(DescriptorSink, FailsWhereNothingCanBeWritten) {
    const Pipe pipe;
    EXPECT_FALSE(DescriptorSink(-1).write("a"));
    EXPECT_FALSE(DescriptorSink(pipe.readEnd()).write("a"));
}

TEST(DescriptorSink, FailsWhenOnlySomeBytesFindRoom) {
    const Pipe pipe;
    ASSERT_EQ(::fcntl(pipe.writeEnd(), F_SETFL, O_NONBLOCK), 0);
    const std::string large(std::size_t{4} * 1024 * 1024, 'x');
    EXPECT_FALSE(DescriptorSink(pipe.writeEnd()).write(large));
}

}  // namespace
}  // namespace umpre
