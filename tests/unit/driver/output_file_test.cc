// SPDX-License-Identifier: MIT
#include "driver/output_file.h"

#include <string>
#include <unistd.h>

#include <gtest/gtest.h>

#include "support/descriptors.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

TEST(OutputFile, WritesToStandardOutputAtFirst) {
    const testing::Pipe pipe;
    const testing::Replaced replaced(STDOUT_FILENO, pipe.writeEnd());
    OutputFile file;
    EXPECT_TRUE(file.write("text"));
    EXPECT_TRUE(file.close());
    EXPECT_EQ(pipe.read(), "text");
    EXPECT_EQ(file.failureMessage(), "umpre: cannot write to standard output\n");
}

TEST(OutputFile, WritesToTheFileItOpened) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("out", "what was there before");
    OutputFile file;
    EXPECT_TRUE(file.open(name));
    EXPECT_EQ(testing::contentsOf(name), "");
    EXPECT_TRUE(file.write("one "));
    EXPECT_TRUE(file.write("two"));
    EXPECT_TRUE(file.close());
    EXPECT_EQ(testing::contentsOf(name), "one two");
    EXPECT_EQ(file.failureMessage(), "umpre: cannot write output file '" + name + "'\n");
}

TEST(OutputFile, CreatesAFile) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.nameOf("new");
    {
        OutputFile file;
        EXPECT_TRUE(file.open(name));
        EXPECT_TRUE(file.write("text"));
    }
    EXPECT_EQ(testing::contentsOf(name), "text");
}

TEST(OutputFile, DoesNotOpenWhatCannotBeWritten) {
    const testing::TemporaryDirectory directory;
    const testing::Pipe pipe;
    const testing::Replaced replaced(STDOUT_FILENO, pipe.writeEnd());
    OutputFile file;
    EXPECT_FALSE(file.open(directory.name()));
    EXPECT_FALSE(file.open(directory.nameOf("none/out")));
    EXPECT_TRUE(file.write("text"));
    EXPECT_EQ(pipe.read(), "text");
}

TEST(OutputFile, RemembersThatAWriteFailed) {
    OutputFile file;
    ASSERT_TRUE(file.open("/dev/full"));
    EXPECT_FALSE(file.write("text"));
    EXPECT_FALSE(file.write(""));
    EXPECT_FALSE(file.close());
}

TEST(OutputFile, ClosesOnce) {
    const testing::TemporaryDirectory directory;
    OutputFile file;
    ASSERT_TRUE(file.open(directory.nameOf("out")));
    EXPECT_TRUE(file.close());
    EXPECT_TRUE(file.close());
    EXPECT_FALSE(file.write("text"));
}

}  // namespace
}  // namespace umpre
