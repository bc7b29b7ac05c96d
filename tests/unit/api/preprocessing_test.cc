// SPDX-License-Identifier: MIT
#include "umpre/preprocessing.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <fstream>
#include <initializer_list>
#include <istream>
#include <memory>
#include <new>
#include <optional>
#include <sstream>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "support/event_list.h"
#include "support/temporary_directory.h"
#include "umpre/version.h"

namespace umpre {
namespace {

// A diagnostic that outlives its call.
struct Message {
    Severity severity;
    std::string file;
    std::int32_t line;
    std::string text;

    bool operator==(const Message& other) const = default;
};

void PrintTo(const Message& message, std::ostream* stream) {
    *stream << static_cast<int>(message.severity) << " " << message.file << ":" << message.line
            << ": " << message.text;
}

struct Fixture {
    Fixture() { connect(); }

    void connect() {
        preprocessing.setOutput([this](std::string_view bytes) {
            output.append(bytes);
            return true;
        });
        preprocessing.setDiagnostics([this](const Diagnostic& diagnostic) {
            messages.push_back({diagnostic.severity, std::string(diagnostic.file), diagnostic.line,
                                std::string(diagnostic.text)});
        });
    }

    [[nodiscard]] Outcome run(std::string_view text) {
        preprocessing.setSourceText("main", text);
        return preprocessing.run();
    }

    Preprocessing preprocessing;
    std::string output;
    std::vector<Message> messages;
};

TEST(Preprocessing, ReadsAText) {
    Fixture f;
    EXPECT_EQ(f.run("text\n"), Outcome::Clean);
    EXPECT_EQ(f.output, "#line 1 \"main\"\ntext\n");
    EXPECT_TRUE(f.messages.empty());
}

TEST(Preprocessing, ReadsAFile) {
    const testing::TemporaryDirectory folder;
    const std::string name = folder.write("a.src", "text\n");
    Fixture f;
    f.preprocessing.setSourceFile(name);
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(f.output, "#line 1 \"" + name + "\"\ntext\n");
}

TEST(Preprocessing, KeepsItsOwnCopyOfAText) {
    Fixture f;
    std::string text = "text\n";
    f.preprocessing.setSourceText("main", text);
    text.assign("other");
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(f.output, "#line 1 \"main\"\ntext\n");
}

// Brings a text in pieces of this size.
SourceReader readerOf(std::string text, std::size_t most) {
    return [text = std::move(text), most, at = std::size_t{0}](char* to, std::size_t size) mutable {
        const std::size_t count = text.copy(to, std::min(most, size), at);
        at += count;
        return std::optional(count);
    };
}

TEST(Preprocessing, ReadsWhatAReaderBrings) {
    std::string text = "#define N 3\n/* a\n */ N \"N\" N";
    for (int line = 0; line < 10'000; ++line) {
        text.append("\nint N = N ## N;");
    }
    Fixture expected;
    EXPECT_EQ(expected.run(text), Outcome::Clean);
    for (const std::size_t most : {1U, 3U, 1000U, 1'000'000U}) {
        Fixture f;
        f.preprocessing.setSourceReader("main", readerOf(text, most));
        EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
        EXPECT_EQ(f.output, expected.output) << most;
    }
}

TEST(Preprocessing, AsksAReaderForNoMoreThanIsNeeded) {
    constexpr std::size_t kLines = 1'000'000;
    constexpr std::size_t kFew = std::size_t{512} * 1024;
    constexpr std::string_view kLine = "a line of the source text, which is long\n";
    std::size_t read = 0;
    std::size_t written = 0;
    std::size_t most = 0;
    Preprocessing preprocessing;
    preprocessing.setOutput([&](std::string_view bytes) {
        written += bytes.size();
        return true;
    });
    preprocessing.setSourceReader("main", [&](char* to, std::size_t size) {
        const std::size_t lines = std::min(size / kLine.size(), kLines - read / kLine.size());
        for (std::size_t line = 0; line < lines; ++line) {
            kLine.copy(to + line * kLine.size(), kLine.size());
        }
        most = std::max(most, read - std::min(read, written));
        read += lines * kLine.size();
        return std::optional(lines * kLine.size());
    });
    EXPECT_EQ(preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(read, kLines * kLine.size());
    EXPECT_LT(most, kFew);
}

TEST(Preprocessing, TellsThatAReaderFails) {
    for (const std::optional<std::size_t> answer :
         {std::optional<std::size_t>{}, std::optional<std::size_t>{SIZE_MAX}}) {
        Fixture f;
        bool isFirst = true;
        f.preprocessing.setSourceReader("main", [&](char* to, std::size_t /*size*/) {
            return std::exchange(isFirst, false)
                       ? std::optional(std::string_view("a\nb").copy(to, 3))
                       : answer;
        });
        EXPECT_EQ(f.preprocessing.run(), Outcome::InputFailed);
        EXPECT_EQ(f.output, "#line 1 \"main\"\na\n");
        EXPECT_EQ(
            f.messages,
            (std::vector<Message>{{Severity::Failure, "main", 2, "input in flex scanner failed"}}));
    }
}

TEST(Preprocessing, AsksAReaderAnewInEachRun) {
    Fixture f;
    int calls = 0;
    f.preprocessing.setSourceReader(
        "main", [&](char* to, std::size_t /*size*/) -> std::optional<std::size_t> {
            return ++calls % 2 == 0 ? 0 : std::string_view("text\n").copy(to, 5);
        });
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(calls, 2);
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(calls, 4);
    EXPECT_EQ(f.output, "#line 1 \"main\"\ntext\n#line 1 \"main\"\ntext\n");
}

TEST(Preprocessing, LetsGoOfAReaderWhenAnotherSourceIsSet) {
    Fixture f;
    auto held = std::make_shared<int>(0);
    f.preprocessing.setSourceReader("main", [held](char* /*to*/, std::size_t /*size*/) {
        return std::optional<std::size_t>(0);
    });
    EXPECT_EQ(held.use_count(), 2);
    EXPECT_EQ(f.run("text\n"), Outcome::Clean);
    EXPECT_EQ(held.use_count(), 1);
    f.preprocessing.setSourceReader("empty", nullptr);
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(f.output, "#line 1 \"main\"\ntext\n#line 1 \"empty\"\n");
}

TEST(Preprocessing, ReadsAStreamFromWhereItStands) {
    std::istringstream stream("first\nsecond\n");
    stream.exceptions(std::ios::failbit | std::ios::badbit);
    std::string line;
    std::getline(stream, line);
    Fixture f;
    f.preprocessing.setMessageName("name");
    f.preprocessing.setSourceStream("main", stream);
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    stream.clear();
    stream.seekg(0);
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(f.output,
              "#line 1 \"name\"\nsecond\n#line 1 \"name\"\n#line 1 \"name\"\nfirst\nsecond\n");
}

TEST(Preprocessing, TellsThatAStreamFails) {
    struct Broken final : std::streambuf {
        int_type underflow() override { throw std::runtime_error("broken"); }
    } broken;

    std::istream unreadable(&broken);
    std::ifstream unopened("/nowhere/a.src");
    for (std::istream* const stream :
         std::initializer_list<std::istream*>{&unreadable, &unopened}) {
        Fixture f;
        f.preprocessing.setSourceStream("main", *stream);
        EXPECT_EQ(f.preprocessing.run(), Outcome::InputFailed);
        EXPECT_EQ(f.messages.size(), 1U);
    }
}

TEST(Preprocessing, HasAnEmptySourceAtFirst) {
    const Fixture f;
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(f.output, "#line 1 \"\"\n");
}

TEST(Preprocessing, NamesTheSourceInMarkersAndMessages) {
    const testing::TemporaryDirectory folder;
    Fixture f;
    f.preprocessing.setMessageName("name");
    EXPECT_EQ(f.run("#endif\n"), Outcome::Errors);
    f.preprocessing.setSourceFile(folder.write("a.src", "text\n"));
    EXPECT_EQ(f.preprocessing.run(), Outcome::Clean);
    EXPECT_EQ(f.output, "#line 1 \"name\"\n\n#line 1 \"name\"\ntext\n");
    EXPECT_EQ(f.messages.at(0).file, "name");
}

TEST(Preprocessing, DefinesMacrosOfWhichTheFirstHolds) {
    Fixture f;
    f.preprocessing.define("A");
    f.preprocessing.define("B", "b");
    f.preprocessing.define("B", "c");
    EXPECT_EQ(f.run("A B\n"), Outcome::Clean);
    EXPECT_EQ(f.output, "#line 1 \"main\"\n1 b\n");
}

TEST(Preprocessing, SearchesDirectoriesInTheirOrder) {
    const testing::TemporaryDirectory folder;
    folder.write("one/a.inc", "from one\n");
    folder.write("two/a.inc", "from two\n");
    Fixture f;
    f.preprocessing.addIncludeDirectory(folder.nameOf("two"));
    f.preprocessing.addIncludeDirectory(folder.nameOf("one"));
    EXPECT_EQ(f.run("#include <a.inc>\n"), Outcome::Clean);
    EXPECT_NE(f.output.find("from two"), std::string::npos);
}

TEST(Preprocessing, TellsProblemsApart) {
    Fixture f;
    EXPECT_EQ(f.run("#define A 1\n#define A 2\n#endif\ntext\n/*"), Outcome::Errors);
    EXPECT_EQ(f.messages,
              (std::vector<Message>{
                  {Severity::Warning, "main", 3, "Macro \"A\" has an incompatible redefinition"},
                  {Severity::Error, "main", 3, "No \"#if\" directive associated to \"#endif\""},
                  {Severity::Note, "main", 5, "unterminated comment"}}));
}

TEST(Preprocessing, TellsThatTheSourceCannotBeOpened) {
    Fixture f;
    f.preprocessing.setSourceFile("/nowhere/a.src");
    EXPECT_EQ(f.preprocessing.run(), Outcome::SourceNotOpened);
    EXPECT_EQ(f.messages,
              (std::vector<Message>{{Severity::Fatal, "", 0, "cannot open /nowhere/a.src"}}));
    EXPECT_EQ(f.output, "");
}

TEST(Preprocessing, TellsThatTheInputCannotBeReadOn) {
    Fixture f;
    f.preprocessing.setSourceFile("/proc/self/mem");
    EXPECT_EQ(f.preprocessing.run(), Outcome::InputFailed);
    EXPECT_EQ(f.messages, (std::vector<Message>{{Severity::Failure, "/proc/self/mem", 1,
                                                 "input in flex scanner failed"}}));
}

TEST(Preprocessing, TellsThatAConditionDividesByZero) {
    Fixture f;
    EXPECT_EQ(f.run("text\n#if 1 / 0\n"), Outcome::DivisionFault);
    EXPECT_EQ(f.output, "#line 1 \"main\"\ntext\n");
}

TEST(Preprocessing, TellsThatTheOutputFailed) {
    Fixture f;
    f.preprocessing.setOutput([](std::string_view /*bytes*/) { return false; });
    EXPECT_EQ(f.run("#endif\n"), Outcome::OutputFailed);
}

TEST(Preprocessing, TellsThatThereIsNoMemory) {
    Fixture f;
    f.preprocessing.setOutput([](std::string_view /*bytes*/) -> bool { throw std::bad_alloc(); });
    EXPECT_EQ(f.run("text\n"), Outcome::InputFailed);
    EXPECT_EQ(f.messages.back().severity, Severity::Failure);
    EXPECT_EQ(f.messages.back().text, "out of dynamic memory in yy_create_buffer()");
}

TEST(Preprocessing, AsksForIncludedFiles) {
    const testing::TemporaryDirectory folder;
    const std::string onDisk = folder.write("disk.inc", "from the disk\n");
    Fixture f;
    f.preprocessing.addIncludeDirectory("one");
    f.preprocessing.addIncludeDirectory("two");
    std::vector<std::string> asked;
    f.preprocessing.setIncludeResolver([&](std::string_view name) -> IncludeAnswer {
        asked.emplace_back(name);
        if (name == "two/a.inc") {
            return {IncludeAnswer::Kind::Text, "from memory\n"};
        }
        return {name == onDisk ? IncludeAnswer::Kind::Disk : IncludeAnswer::Kind::Absent, {}};
    });
    EXPECT_EQ(f.run("#include \"a.inc\"\n#include \"" + onDisk + "\"\n"), Outcome::Clean);
    EXPECT_EQ(f.output,
              "#line 1 \"main\"\n#line 1 \"two/a.inc\"\nfrom memory\n#line 2 \"main\"\n"
              "#line 1 \""
                  + onDisk + "\"\nfrom the disk\n#line 3 \"main\"\n");
    EXPECT_EQ(asked, (std::vector<std::string>{"a.inc", "one/a.inc", "two/a.inc", onDisk}));
}

TEST(Preprocessing, TellsWhichFilesAreEnteredMissedAndLeft) {
    Fixture f;
    f.preprocessing.addIncludeDirectory("one");
    f.preprocessing.setIncludeResolver([](std::string_view name) -> IncludeAnswer {
        return {name == "one/a" ? IncludeAnswer::Kind::Text : IncludeAnswer::Kind::Absent, "A\n"};
    });
    testing::EventList events;
    f.preprocessing.define("A");
    f.preprocessing.setObserver(events.observer());
    EXPECT_EQ(f.run("#include \"a\"\n"), Outcome::Clean);
    EXPECT_EQ(events.text(),
              "enter main; miss a main:1; enter one/a main:1; leave one/a main:2; leave main; ");
}

TEST(Preprocessing, TellsWhatBecomesOfMacrosIfAskedTo) {
    Fixture f;
    testing::EventList events;
    f.preprocessing.define("A");
    f.preprocessing.setObserver(events.observer(), EventScope::FilesAndMacros);
    EXPECT_EQ(f.run("A\n#undef A\n#define B\n"), Outcome::Clean);
    EXPECT_EQ(events.text(),
              "define __FILE__; define __LINE__; define __DATE__; define __TIME__; define A; "
              "enter main; expand A main:1; undefine A main:2; define B main:3; leave main; ");
}

TEST(Preprocessing, NeedsNoSinks) {
    Preprocessing preprocessing;
    preprocessing.setSourceText("main", "#endif\n");
    EXPECT_EQ(preprocessing.run(), Outcome::Errors);
}

TEST(Preprocessing, RunsAgainFromTheBeginning) {
    Fixture f;
    EXPECT_EQ(f.run("#define A 1\n#if 1\n"), Outcome::Errors);
    EXPECT_EQ(f.run("A\n"), Outcome::Clean);
    EXPECT_EQ(f.output, "#line 1 \"main\"\n\n#line 1 \"main\"\nA\n");
}

TEST(Preprocessing, CanBeMoved) {
    Preprocessing first;
    first.define("A", "b");
    first.setSourceText("main", "A\n");
    Preprocessing second(std::move(first));
    first = std::move(second);
    std::string output;
    first.setOutput([&output](std::string_view bytes) {
        output.append(bytes);
        return true;
    });
    EXPECT_EQ(first.run(), Outcome::Clean);
    EXPECT_EQ(output, "#line 1 \"main\"\nb\n");
}

TEST(Preprocessing, HasTheVersionOfItsHeaders) {
    EXPECT_STREQ(Preprocessing::version(), UMPRE_VERSION);
}

struct Line {
    Diagnostic diagnostic;
    std::string_view expected;
};

TEST(MessageOf, IsTheLineThatTheProgramPrints) {
    const std::vector<Line> table{
        {{Severity::Error, "a", 2, "x"}, "a:2: x.\n"},
        {{Severity::Error, "", 0, "x"}, ":0: x.\n"},
        {{Severity::Warning, "a", -1, "x"}, "a:-1: Warning: x.\n"},
        {{Severity::Fatal, "", 0, "x"}, "FATAL ERROR: x.\n"},
        {{Severity::Fatal, "a", 3, "x"}, "a:3: FATAL ERROR: x.\n"},
        {{Severity::Note, "a", 4, "x"}, "4: x.\n"},
        {{Severity::Failure, "a", 5, "x"}, "x\n"},
    };
    for (const Line& line : table) {
        EXPECT_EQ(messageOf(line.diagnostic), line.expected);
    }
}

}  // namespace
}  // namespace umpre
