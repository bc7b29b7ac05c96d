// SPDX-License-Identifier: MIT
#include "lex/input_buffer.h"

#include <array>
#include <cstddef>
#include <fcntl.h>
#include <fstream>
#include <string>
#include <string_view>
#include <unistd.h>
#include <vector>

#include <gtest/gtest.h>

#include "lex/scanner_failure.h"
#include "support/descriptors.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using testing::Pipe;
using testing::TemporaryDirectory;
using Need = InputBuffer::Need;

constexpr auto kWindowSizes = std::to_array<std::size_t>({1, 2, 3, 7, 16, 65'536});

constexpr auto kTexts = std::to_array<std::string_view>({
    "a",
    "\n",
    "a\n",
    "a\nb",
    "\n\n\n",
    "one\ntwo\nthree\n",
    "a\rb\r",
    "\r\n\r\n",
    "x\0y\n\0z\n"sv,
    "no line end at all",
    "a long line\nb\n\na much longer line\n",
});

// Returns what the windows hold, one text for each, having checked that two zero bytes follow.
[[nodiscard]] std::vector<std::string> windowsOf(InputBuffer& input) {
    std::vector<std::string> windows;
    char* position = input.begin();
    while (input.refill(position, Need::Line)) {
        EXPECT_EQ(position, input.begin());
        EXPECT_EQ(input.end()[0], '\0');
        EXPECT_EQ(input.end()[1], '\0');
        windows.emplace_back(position, input.lineLimit());
        position = input.lineLimit();
    }
    return windows;
}

[[nodiscard]] std::string joined(const std::vector<std::string>& windows) {
    std::string text;
    for (const std::string& window : windows) {
        text += window;
    }
    return text;
}

TEST(InputBuffer, GivesAllBytesOfAFile) {
    const TemporaryDirectory directory;
    for (const std::string_view text : kTexts) {
        const std::string name = directory.write("file", text);
        for (const std::size_t windowSize : kWindowSizes) {
            SCOPED_TRACE(::testing::Message()
                         << ::testing::PrintToString(text) << ", window " << windowSize);
            InputBuffer input(windowSize);
            ASSERT_TRUE(input.openFile(name));
            EXPECT_EQ(joined(windowsOf(input)), text);
        }
    }
}

TEST(InputBuffer, GivesAllBytesOfADescriptor) {
    for (const std::string_view text : kTexts) {
        for (const std::size_t windowSize : kWindowSizes) {
            SCOPED_TRACE(::testing::Message()
                         << ::testing::PrintToString(text) << ", window " << windowSize);
            const Pipe pipe(text);
            InputBuffer input(windowSize);
            input.openBorrowed(pipe.readEnd());
            EXPECT_EQ(joined(windowsOf(input)), text);
        }
    }
}

TEST(InputBuffer, GivesAllBytesOfAText) {
    for (const std::string_view text : kTexts) {
        SCOPED_TRACE(::testing::PrintToString(text));
        InputBuffer input(4);
        input.openText(text);
        EXPECT_EQ(joined(windowsOf(input)), text);
    }
}

TEST(InputBuffer, CopiesATextThatItIsGiven) {
    std::string text = "one\n";
    InputBuffer input(16);
    input.openText(text);
    text = "two\n";
    EXPECT_EQ(joined(windowsOf(input)), "one\n");
}

TEST(InputBuffer, EveryWindowButTheLastEndsWithALineFeed) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "a\nbb\nccc\ndddd\neeeee\nffffff");
    for (const std::size_t windowSize : kWindowSizes) {
        SCOPED_TRACE(windowSize);
        InputBuffer input(windowSize);
        ASSERT_TRUE(input.openFile(name));
        const std::vector<std::string> windows = windowsOf(input);
        ASSERT_FALSE(windows.empty());
        for (std::size_t index = 0; index + 1 < windows.size(); ++index) {
            EXPECT_EQ(windows[index].back(), '\n') << index;
        }
        EXPECT_EQ(windows.back().back(), 'f');
    }
}

TEST(InputBuffer, HoldsALineHoweverLongItIs) {
    const TemporaryDirectory directory;
    const std::string line = std::string(100'000, 'x') + "\n";
    const std::string name = directory.write("file", "a\n" + line + "b\n");
    InputBuffer input(4);
    ASSERT_TRUE(input.openFile(name));
    const std::vector<std::string> windows = windowsOf(input);
    bool isWhole = false;
    for (const std::string& window : windows) {
        isWhole = isWhole || window.find(line) != std::string::npos;
    }
    EXPECT_TRUE(isWhole);
    EXPECT_EQ(joined(windows), "a\n" + line + "b\n");
}

TEST(InputBuffer, KeepsWindowsSmallWhenLinesAreShort) {
    const TemporaryDirectory directory;
    std::string text;
    for (int line = 0; line < 10'000; ++line) {
        text += "line\n";
    }
    InputBuffer input(1024);
    ASSERT_TRUE(input.openFile(directory.write("file", text)));
    for (const std::string& window : windowsOf(input)) {
        EXPECT_LE(window.size(), 4096U);
    }
}

TEST(InputBuffer, HasNothingInAnEmptyInput) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("empty", "");
    const Pipe pipe("");
    for (const Need need : {Need::Line, Need::Bytes}) {
        InputBuffer input(8);
        ASSERT_TRUE(input.openFile(name));
        char* position = input.begin();
        EXPECT_FALSE(input.refill(position, need));
        EXPECT_EQ(input.begin(), input.end());
        input.openText("");
        position = input.begin();
        EXPECT_FALSE(input.refill(position, need));
        input.openBorrowed(pipe.readEnd());
        position = input.begin();
        EXPECT_FALSE(input.refill(position, need));
    }
}

TEST(InputBuffer, TheEndStaysTheEnd) {
    InputBuffer input(8);
    input.openText("a\n");
    EXPECT_EQ(joined(windowsOf(input)), "a\n");
    char* position = input.end();
    EXPECT_FALSE(input.refill(position, Need::Line));
    EXPECT_FALSE(input.refill(position, Need::Bytes));
}

TEST(InputBuffer, WaitsForAWholeLine) {
    Pipe pipe;
    pipe.write("one\ntw");
    InputBuffer input(1024);
    input.openBorrowed(pipe.readEnd());
    char* position = input.begin();
    ASSERT_TRUE(input.refill(position, Need::Line));
    EXPECT_EQ(std::string(position, input.lineLimit()), "one\n");
    EXPECT_EQ(std::string(position, input.end()), "one\ntw");
    pipe.write("o\n");
    pipe.closeWriteEnd();
    position = input.lineLimit();
    ASSERT_TRUE(input.refill(position, Need::Line));
    EXPECT_EQ(std::string(position, input.lineLimit()), "two\n");
}

TEST(InputBuffer, TakesWhatThereIsIfBytesAreEnough) {
    const Pipe pipe;
    pipe.write("tw");
    InputBuffer input(1024);
    input.openBorrowed(pipe.readEnd());
    char* position = input.begin();
    ASSERT_TRUE(input.refill(position, Need::Bytes));
    EXPECT_EQ(std::string(position, input.end()), "tw");
    EXPECT_EQ(input.lineLimit(), input.begin());
}

TEST(InputBuffer, KeepsWhatStandsBehindThePosition) {
    const Pipe pipe;
    pipe.write("abcdef");
    InputBuffer input(1024);
    input.openBorrowed(pipe.readEnd());
    char* position = input.begin();
    ASSERT_TRUE(input.refill(position, Need::Bytes));
    pipe.write("ghi");
    position += 4;
    ASSERT_TRUE(input.refill(position, Need::Bytes));
    EXPECT_EQ(std::string(position, input.end()), "efghi");
}

TEST(InputBuffer, CannotOpenWhatIsNoFile) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "a\n");
    InputBuffer input(8);
    EXPECT_FALSE(input.openFile(directory.nameOf("nothing")));
    EXPECT_FALSE(input.openFile(directory.name()));
    EXPECT_FALSE(input.openFile(name + "/below"));
    EXPECT_FALSE(input.openFile(""));
}

TEST(InputBuffer, ANameWithAZeroByteOpensNothing) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "a\n");
    InputBuffer input(8);
    EXPECT_FALSE(input.openFile(name + std::string("\0x", 2)));
    EXPECT_FALSE(input.openFile(name + std::string(1, '\0')));
}

TEST(InputBuffer, AFileEndsWhereItEndedWhenItWasOpened) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "one\ntwo\n");
    for (const std::size_t windowSize : kWindowSizes) {
        directory.write("file", "one\ntwo\n");
        InputBuffer input(windowSize);
        ASSERT_TRUE(input.openFile(name));
        std::ofstream(name, std::ios::app) << "three\n";
        EXPECT_EQ(joined(windowsOf(input)), "one\ntwo\n") << windowSize;
    }
}

TEST(InputBuffer, AFileThatBecomesShorterEndsThere) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "one\ntwo\n");
    InputBuffer input(64);
    ASSERT_TRUE(input.openFile(name));
    directory.write("file", "1\n");
    EXPECT_EQ(joined(windowsOf(input)), "1\n");
}

TEST(InputBuffer, ReadsFilesThatDoNotTellTheirSize) {
    const std::string name = "/proc/self/maps";
    InputBuffer input(16);
    if (!input.openFile(name)) {
        GTEST_SKIP() << "there is no " << name;
    }
    EXPECT_NE(joined(windowsOf(input)).find('\n'), std::string::npos);
}

TEST(InputBuffer, ThrowsIfReadingFails) {
    const TemporaryDirectory directory;
    const int descriptor = ::open(directory.name().c_str(), O_RDONLY | O_CLOEXEC);
    ASSERT_GE(descriptor, 0);
    InputBuffer input(8);
    input.openBorrowed(descriptor);
    char* position = input.begin();
    try {
        (void)input.refill(position, Need::Line);
        ADD_FAILURE() << "nothing was thrown";
    } catch (const ScannerFailure& failure) {
        EXPECT_STREQ(failure.message, "input in flex scanner failed");
    }
    ::close(descriptor);
}

TEST(InputBuffer, LeavesABorrowedDescriptorOpen) {
    const Pipe pipe;
    pipe.write("a\n");
    {
        InputBuffer input(8);
        input.openBorrowed(pipe.readEnd());
        char* position = input.begin();
        EXPECT_TRUE(input.refill(position, Need::Line));
        input.close();
    }
    pipe.write("b\n");
    EXPECT_EQ(pipe.read(), "b\n");
}

TEST(InputBuffer, CanBeUsedAgain) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", std::string(1000, 'x') + "\n");
    InputBuffer input(8);
    for (int round = 0; round < 3; ++round) {
        ASSERT_TRUE(input.openFile(name));
        EXPECT_EQ(joined(windowsOf(input)).size(), 1001U);
        input.openText("short");
        EXPECT_EQ(joined(windowsOf(input)), "short");
        input.close();
    }
}

}  // namespace
}  // namespace umpre
