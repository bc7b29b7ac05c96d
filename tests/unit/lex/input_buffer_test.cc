// SPDX-License-Identifier: MIT
#include "lex/input_buffer.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <fcntl.h>
#include <fstream>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unistd.h>
#include <vector>

#include <gtest/gtest.h>

#include "lex/scanner_failure.h"
#include "lex/spelling.h"
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

// Returns what the windows hold, one text for each, having checked what stands around it.
[[nodiscard]] std::vector<std::string> windowsOf(InputBuffer& input) {
    std::vector<std::string> windows;
    char* position = input.begin();
    while (input.refill(position, Need::Tokens)) {
        EXPECT_EQ(position, input.begin());
        EXPECT_EQ(input.end()[0], '\0');
        EXPECT_EQ(input.end()[1], '\0');
        std::array<char, 16> around{};
        std::memcpy(around.data(), input.begin() - 8, 8);
        std::memcpy(around.data() + 8, input.end(), 8);
        windows.emplace_back(position, input.limit());
        position = input.limit();
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

// Brings a text byte by byte; ends, fails, or claims too much.
class Bytewise final : public ByteSource {
public:
    Bytewise(std::string_view text, std::optional<std::size_t> end) : text_(text), end_(end) {}

    [[nodiscard]] std::optional<std::size_t> read(char* to, std::size_t size) override {
        const std::size_t count = text_.copy(to, size > 0 ? 1 : 0);
        text_.remove_prefix(count);
        return count > 0 ? count : end_;
    }

private:
    std::string_view text_;
    std::optional<std::size_t> end_;
};

TEST(InputBuffer, ReadsWhatSomebodyElseBrings) {
    for (const std::string_view text : kTexts) {
        for (const std::size_t size : kWindowSizes) {
            Bytewise bytes(text, 0);
            InputBuffer input({.windowSize = size});
            input.openSource(bytes);
            EXPECT_EQ(joined(windowsOf(input)), text);
            EXPECT_GT(input.takeWaits(), text.size());
            EXPECT_FALSE(input.isReadWhole());
        }
    }
}

TEST(InputBuffer, FailsAsWhoBringsTheBytesDoes) {
    for (const std::optional<std::size_t> end :
         {std::optional<std::size_t>{}, std::optional<std::size_t>{SIZE_MAX}}) {
        Bytewise bytes("a\nb", end);
        InputBuffer input({});
        input.openSource(bytes);
        EXPECT_THROW((void)windowsOf(input), ScannerFailure);
    }
}

TEST(InputBuffer, IsEmptyBeforeItIsOpened) {
    InputBuffer input({});
    EXPECT_EQ(windowsOf(input), std::vector<std::string>{});
    EXPECT_EQ(*input.end(), '\0');
}

TEST(InputBuffer, GivesAllBytesOfAFile) {
    const TemporaryDirectory directory;
    for (const std::string_view text : kTexts) {
        const std::string name = directory.write("file", text);
        for (const std::size_t windowSize : kWindowSizes) {
            SCOPED_TRACE(::testing::Message()
                         << ::testing::PrintToString(text) << ", window " << windowSize);
            InputBuffer input({.windowSize = windowSize});
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
            InputBuffer input({.windowSize = windowSize});
            input.openBorrowed(pipe.readEnd());
            EXPECT_EQ(joined(windowsOf(input)), text);
        }
    }
}

TEST(InputBuffer, GivesAllBytesOfAText) {
    for (const std::string_view text : kTexts) {
        SCOPED_TRACE(::testing::PrintToString(text));
        InputBuffer input({.windowSize = 4});
        input.openText(text);
        EXPECT_EQ(joined(windowsOf(input)), text);
    }
}

TEST(InputBuffer, CopiesATextThatItIsGiven) {
    std::string text = "one\n";
    InputBuffer input({.windowSize = 16});
    input.openText(text);
    text = "two\n";
    EXPECT_EQ(joined(windowsOf(input)), "one\n");
}

TEST(InputBuffer, EveryWindowButTheLastEndsWithALineFeedIfLinesAreShort) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "a\nbb\nccc\ndddd\neeeee\nffffff");
    for (const std::size_t windowSize : {std::size_t{16}, std::size_t{65'536}}) {
        SCOPED_TRACE(windowSize);
        InputBuffer input({.windowSize = windowSize});
        ASSERT_TRUE(input.openFile(name));
        const std::vector<std::string> windows = windowsOf(input);
        ASSERT_FALSE(windows.empty());
        for (std::size_t index = 0; index + 1 < windows.size(); ++index) {
            EXPECT_EQ(windows[index].back(), '\n') << index;
        }
        EXPECT_EQ(windows.back().back(), 'f');
    }
}

TEST(InputBuffer, AWindowEndsWithinALongLineBetweenTokens) {
    for (const std::string_view text : {
             "aaa bbb ccc ddd eee fff ggg hhh",
             "a,b,c,d,e,f,g,h,i,j,k,l,m,n,o,p",
             "aaaaa==bbbbb!=ccccc<<ddddd##eeeee&&fffff||",
             "aaa\rbbb\rccc\rddd\r\reee\r",
             "1.5e3+0x1F+2.5e3+0x2F+3.5e3",
         }) {
        for (const std::size_t windowSize : {std::size_t{4}, std::size_t{5}, std::size_t{6}}) {
            InputBuffer input({.windowSize = windowSize});
            const Pipe pipe(text);
            input.openBorrowed(pipe.readEnd());
            const std::vector<std::string> windows = windowsOf(input);
            EXPECT_EQ(joined(windows), text);
            EXPECT_GE(windows.size(), 2U) << text;
            for (std::size_t index = 0; index + 1 < windows.size(); ++index) {
                const char before = windows[index].back();
                const char behind = windows[index + 1].front();
                EXPECT_FALSE(isWordByte(before) && isWordByte(behind)) << text;
                EXPECT_EQ(std::string("=!<>#&|").find(before), std::string::npos) << text;
            }
        }
    }
}

TEST(InputBuffer, KeepsPairsOfBytesTogether) {
    for (const std::string_view pair : {"\r\n", "\\\n", "\\\r", "/*", "//", "##", "||", "&&",
                                        "==", "!=", "<=", ">=", "<<", ">>", "ab", "0x", "_1"}) {
        for (std::size_t before = 1; before < 8; ++before) {
            const std::string text = std::string(before, '.') + std::string(pair) + "...";
            InputBuffer input({.windowSize = 2});
            const Pipe pipe(text);
            input.openBorrowed(pipe.readEnd());
            std::size_t end = 0;
            for (const std::string& window : windowsOf(input)) {
                end += window.size();
                EXPECT_NE(end, before + 1) << ::testing::PrintToString(text);
            }
        }
    }
}

TEST(InputBuffer, HoldsATokenHoweverLongItIs) {
    const TemporaryDirectory directory;
    const std::string word(100'000, 'x');
    const std::string name = directory.write("file", "a\n" + word + "\nb\n");
    InputBuffer input({.windowSize = 4});
    ASSERT_TRUE(input.openFile(name));
    const std::vector<std::string> windows = windowsOf(input);
    bool isWhole = false;
    for (const std::string& window : windows) {
        isWhole = isWhole || window.find(word) != std::string::npos;
    }
    EXPECT_TRUE(isWhole);
    EXPECT_EQ(joined(windows), "a\n" + word + "\nb\n");
}

// One line of many words.
[[nodiscard]] std::string longLine() {
    std::string line;
    while (line.size() < 100'000) {
        line += "word ";
    }
    return line + "\n";
}

TEST(InputBuffer, HoldsALineHoweverLongItIsOnThePlainRoad) {
    const TemporaryDirectory directory;
    const std::string line = longLine();
    InputBuffer input({.plainRoad = true, .windowSize = 4});
    ASSERT_TRUE(input.openFile(directory.write("file", "a\n" + line + "b\n")));
    bool isWhole = false;
    for (const std::string& window : windowsOf(input)) {
        isWhole = isWhole || window.find(line) != std::string::npos;
    }
    EXPECT_TRUE(isWhole);
}

TEST(InputBuffer, KeepsWindowsSmallWhenALineIsLong) {
    const TemporaryDirectory directory;
    InputBuffer input({.windowSize = 1024});
    ASSERT_TRUE(input.openFile(directory.write("file", longLine())));
    for (const std::string& window : windowsOf(input)) {
        EXPECT_LE(window.size(), 4096U);
    }
}

TEST(InputBuffer, KeepsWindowsSmallWhenLinesAreShort) {
    const TemporaryDirectory directory;
    std::string text;
    for (int line = 0; line < 10'000; ++line) {
        text += "line\n";
    }
    InputBuffer input({.windowSize = 1024});
    ASSERT_TRUE(input.openFile(directory.write("file", text)));
    for (const std::string& window : windowsOf(input)) {
        EXPECT_LE(window.size(), 4096U);
    }
}

TEST(InputBuffer, TakesAnotherWindowSize) {
    const TemporaryDirectory directory;
    std::string text;
    for (int line = 0; line < 10'000; ++line) {
        text += "line\n";
    }
    const std::string name = directory.write("file", text);
    InputBuffer input({.windowSize = 65'536});
    for (const std::size_t size : {65'536U, 256U, 65'536U}) {
        input.setWindowSize(size);
        ASSERT_TRUE(input.openFile(name));
        const std::vector<std::string> windows = windowsOf(input);
        EXPECT_EQ(windows.size() == 1, size > text.size());
        EXPECT_LE(windows.front().size(), 4 * size);
        input.close();
    }
}

TEST(InputBuffer, HasNothingInAnEmptyInput) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("empty", "");
    const Pipe pipe("");
    for (const Need need : {Need::Tokens, Need::Bytes}) {
        InputBuffer input({.windowSize = 8});
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
    InputBuffer input({.windowSize = 8});
    input.openText("a\n");
    EXPECT_EQ(joined(windowsOf(input)), "a\n");
    char* position = input.end();
    EXPECT_FALSE(input.refill(position, Need::Tokens));
    EXPECT_FALSE(input.refill(position, Need::Bytes));
}

TEST(InputBuffer, WaitsForAWholeLine) {
    Pipe pipe;
    pipe.write("one\ntw");
    InputBuffer input({.windowSize = 1024});
    input.openBorrowed(pipe.readEnd());
    char* position = input.begin();
    ASSERT_TRUE(input.refill(position, Need::Tokens));
    EXPECT_EQ(std::string(position, input.limit()), "one\n");
    EXPECT_EQ(std::string(position, input.end()), "one\ntw");
    pipe.write("o\n");
    pipe.closeWriteEnd();
    position = input.limit();
    ASSERT_TRUE(input.refill(position, Need::Tokens));
    EXPECT_EQ(std::string(position, input.limit()), "two\n");
}

TEST(InputBuffer, TakesWhatThereIsIfBytesAreEnough) {
    const Pipe pipe;
    pipe.write("tw");
    InputBuffer input({.windowSize = 1024});
    input.openBorrowed(pipe.readEnd());
    char* position = input.begin();
    ASSERT_TRUE(input.refill(position, Need::Bytes));
    EXPECT_EQ(std::string(position, input.end()), "tw");
    EXPECT_EQ(input.limit(), input.begin());
}

TEST(InputBuffer, KeepsWhatStandsBehindThePosition) {
    const Pipe pipe;
    pipe.write("abcdef");
    InputBuffer input({.windowSize = 1024});
    input.openBorrowed(pipe.readEnd());
    char* position = input.begin();
    ASSERT_TRUE(input.refill(position, Need::Bytes));
    pipe.write("ghi");
    position += 4;
    ASSERT_TRUE(input.refill(position, Need::Bytes));
    EXPECT_EQ(std::string(position, input.end()), "efghi");
}

TEST(InputBuffer, BringsAsMuchAgainAsIsKept) {
    const Pipe pipe("abcdefghijkl");
    InputBuffer input({.windowSize = 4});
    input.openBorrowed(pipe.readEnd());
    char* position = input.begin();
    ASSERT_TRUE(input.refill(position, Need::Bytes));
    ASSERT_EQ(std::string(position, input.end()), "abcd");
    ASSERT_TRUE(input.refill(position, Need::Double));
    EXPECT_GE(std::string(position, input.end()), "abcdefgh");
}

TEST(InputBuffer, FindsAnotherLimitInWhatIsLeft) {
    const Pipe pipe;
    pipe.write("aa\nbb\ncc");
    InputBuffer input({.windowSize = 1024});
    input.openBorrowed(pipe.readEnd());
    char* position = input.begin();
    ASSERT_TRUE(input.refill(position, Need::Bytes));
    position += 1;
    ASSERT_TRUE(input.refill(position, Need::Tokens));
    EXPECT_EQ(std::string(position, input.limit()), "a\nbb\n");
}

TEST(InputBuffer, CannotOpenWhatIsNoFile) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "a\n");
    InputBuffer input({.windowSize = 8});
    EXPECT_FALSE(input.openFile(directory.nameOf("nothing")));
    EXPECT_FALSE(input.openFile(directory.name()));
    EXPECT_FALSE(input.openFile(name + "/below"));
    EXPECT_FALSE(input.openFile(""));
}

TEST(InputBuffer, ANameWithAZeroByteOpensNothing) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "a\n");
    InputBuffer input({.windowSize = 8});
    EXPECT_FALSE(input.openFile(name + std::string("\0x", 2)));
    EXPECT_FALSE(input.openFile(name + std::string(1, '\0')));
}

TEST(InputBuffer, AFileEndsWhereItEndedWhenItWasOpened) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "one\ntwo\n");
    for (const std::size_t windowSize : kWindowSizes) {
        directory.write("file", "one\ntwo\n");
        InputBuffer input({.windowSize = windowSize});
        ASSERT_TRUE(input.openFile(name));
        std::ofstream(name, std::ios::app) << "three\n";
        EXPECT_EQ(joined(windowsOf(input)), "one\ntwo\n") << windowSize;
    }
}

TEST(InputBuffer, AFileThatBecomesShorterEndsThere) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "one\ntwo\n");
    InputBuffer input({.windowSize = 64});
    ASSERT_TRUE(input.openFile(name));
    directory.write("file", "1\n");
    EXPECT_EQ(joined(windowsOf(input)), "1\n");
}

TEST(InputBuffer, ReadsFilesThatDoNotTellTheirSize) {
    const std::string name = "/proc/self/maps";
    InputBuffer input({.windowSize = 16});
    if (!input.openFile(name)) {
        GTEST_SKIP() << "there is no " << name;
    }
    EXPECT_NE(joined(windowsOf(input)).find('\n'), std::string::npos);
}

TEST(InputBuffer, ThrowsIfReadingFails) {
    const TemporaryDirectory directory;
    const int descriptor = ::open(directory.name().c_str(), O_RDONLY | O_CLOEXEC);
    ASSERT_GE(descriptor, 0);
    InputBuffer input({.windowSize = 8});
    input.openBorrowed(descriptor);
    char* position = input.begin();
    try {
        (void)input.refill(position, Need::Tokens);
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
        InputBuffer input({.windowSize = 8});
        input.openBorrowed(pipe.readEnd());
        char* position = input.begin();
        EXPECT_TRUE(input.refill(position, Need::Tokens));
        input.close();
    }
    pipe.write("b\n");
    EXPECT_EQ(pipe.read(), "b\n");
}

TEST(InputBuffer, HasTheWholeTextOfAFileThatFitsIntoAWindow) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", "one\ntwo\n");
    for (const std::size_t windowSize : kWindowSizes) {
        InputBuffer input({.windowSize = windowSize});
        ASSERT_TRUE(input.openFile(name));
        EXPECT_EQ(input.wholeText(), "");
        EXPECT_EQ(joined(windowsOf(input)), "one\ntwo\n");
        EXPECT_EQ(input.wholeText(), windowSize < 8 ? "" : "one\ntwo\n") << windowSize;
        input.close();
        EXPECT_EQ(input.wholeText(), "");
    }
}

TEST(InputBuffer, HasNoWholeTextOfWhatIsNoFile) {
    InputBuffer input({.windowSize = 64});
    EXPECT_EQ(input.wholeText(), "");
    input.openText("text\n");
    EXPECT_EQ(joined(windowsOf(input)), "text\n");
    EXPECT_EQ(input.wholeText(), "");
    const Pipe pipe("piped\n");
    input.openBorrowed(pipe.readEnd());
    EXPECT_EQ(joined(windowsOf(input)), "piped\n");
    EXPECT_EQ(input.wholeText(), "");
}

TEST(InputBuffer, GivesKeptBytesToAnyNumberOfReaders) {
    const auto bytes = std::make_shared<FileBytes>("one\ntwo\n");
    FileIdentity identity;
    identity.size = 8;
    InputBuffer outer({.windowSize = 64});
    InputBuffer inner({.windowSize = 64});
    outer.openKept(bytes, identity);
    char* position = outer.begin();
    ASSERT_TRUE(outer.refill(position, Need::Tokens));
    for (int times = 0; times < 2; ++times) {
        inner.openKept(bytes, identity);
        EXPECT_EQ(inner.identity(), identity);
        EXPECT_TRUE(inner.isReadWhole());
        EXPECT_EQ(joined(windowsOf(inner)), "one\ntwo\n");
        EXPECT_EQ(inner.wholeText(), "");
    }
    EXPECT_EQ(std::string_view(position, outer.limit()), "one\ntwo\n");
    inner.openText("text");
    EXPECT_EQ(joined(windowsOf(inner)), "text");
}

TEST(InputBuffer, TakesADescriptorForKeptBytesWhenTold) {
    const auto nextDescriptor = [] {
        const int descriptor = ::dup(STDERR_FILENO);
        ::close(descriptor);
        return descriptor;
    };
    const int before = nextDescriptor();
    InputBuffer input({.windowSize = 64});
    EXPECT_FALSE(input.lacksDescriptor());
    input.openKept(std::make_shared<FileBytes>("text\n"), {});
    EXPECT_TRUE(input.lacksDescriptor());
    EXPECT_EQ(nextDescriptor(), before);
    input.holdDescriptor();
    EXPECT_FALSE(input.lacksDescriptor());
    EXPECT_GT(nextDescriptor(), before);
    input.close();
    EXPECT_EQ(nextDescriptor(), before);
}

TEST(InputBuffer, CanBeUsedAgain) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("file", std::string(1000, 'x') + "\n");
    InputBuffer input({.windowSize = 8});
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
