// SPDX-License-Identifier: MIT
#include "run.h"

#include <algorithm>
#include <cstdlib>
#include <ctime>
#include <initializer_list>
#include <iostream>
#include <string>
#include <string_view>
#include <utility>

#include "check.h"
#include "driver/preprocessor.h"
#include "lex/byte_sink.h"
#include "memory_limit.h"
#include "support/descriptors.h"

namespace umpre::fuzz {
namespace {

constexpr std::size_t kMostOutput = std::size_t{16} * 1024;
constexpr std::size_t kMostMemory = std::size_t{1536} * 1024;
constexpr std::size_t kMostFiles = 40;
constexpr int kMostAttempts = 5;

// Keeps what is written, up to a limit.
class LimitedSink final : public ByteSink {
public:
    LimitedSink() { bytes_.reserve(kMostOutput); }

    [[nodiscard]] bool write(std::string_view bytes) override {
        isFull_ = isFull_ || bytes_.size() + bytes.size() > kMostOutput;
        if (!isFull_) {
            bytes_.append(bytes);
        }
        return !isFull_;
    }

    [[nodiscard]] const std::string& bytes() const noexcept { return bytes_; }

    [[nodiscard]] bool isFull() const noexcept { return isFull_; }

private:
    std::string bytes_;
    bool isFull_ = false;
};

// What a run gave.
struct Outcome {
    std::string output;
    std::string messages;
    std::string asked;  // for these files
    RunResult result = RunResult::Clean;
    bool isCut = false;  // it met a limit
};

enum class Source { Text, File };

struct Run {
    Run(const Files& files, const RunOptions& options)
        : preprocessor([this](const Diagnostic& diagnostic) { add(diagnostic); }, options) {
        preprocessor.setOutput(sink);
        preprocessor.addIncludeDirectory("d");
        preprocessor.setResolver([this, &files](std::string_view name) {
            outcome.asked.append(name).append("\n");
            return ++included <= kMostFiles ? files.find(name)
                                            : IncludeAnswer{IncludeAnswer::Kind::Absent, {}};
        });
    }

    // That there is no memory is a limit's doing.
    void add(const Diagnostic& diagnostic) {
        if (diagnostic.severity != Severity::Failure) {
            outcome.messages.append(messageOf(diagnostic));
        }
    }

    Outcome outcome;
    LimitedSink sink;
    std::size_t included = 0;
    Preprocessor preprocessor;
};

[[nodiscard]] Outcome outcomeOf(const Files& files, const RunOptions& options, Source source) {
    Run run(files, options);
    if (source == Source::Text) {
        run.preprocessor.openText("main", files.main);
    } else {
        const testing::MemoryFile file(files.main);
        const std::string name = "/proc/self/fd/" + std::to_string(file.descriptor());
        if (!run.preprocessor.openSource(name, "main")) {
            fail("the source cannot be opened");
        }
    }
    {
        const MemoryLimit memory(kMostMemory);
        run.outcome.result = run.preprocessor.run();
        run.outcome.isCut = run.sink.isFull() || memory.wasMet();
    }
    run.outcome.output = run.sink.bytes();
    return run.outcome;
}

[[nodiscard]] std::string differenceOf(const Outcome& found, const Outcome& expected) {
    const bool isCut = found.isCut || expected.isCut;
    const auto inText = [isCut](std::string_view what, std::string_view one,
                                std::string_view other) {
        const std::size_t size = isCut ? std::min(one.size(), other.size()) : std::string::npos;
        return fuzz::differenceOf(what, one.substr(0, size), other.substr(0, size));
    };
    std::string difference = inText("output", found.output, expected.output)
                             + inText("messages", found.messages, expected.messages)
                             + inText("files", found.asked, expected.asked);
    if (!isCut && found.result != expected.result) {
        difference += "result differs: is " + std::to_string(static_cast<int>(found.result))
                      + ", should be " + std::to_string(static_cast<int>(expected.result));
    }
    return difference;
}

void show(const Files& files) {
    for (const auto& [name, text] : std::initializer_list<std::pair<const char*, std::string_view>>{
             {"a", files.a}, {"b", files.b}, {"d/c", files.c}, {"main", files.main}}) {
        std::cout << name << ":\n    " << printable(text) << "\n";
    }
    std::cout.flush();
}

}  // namespace

void expectSameOnAllRoads(const Files& files, std::size_t windowSize) {
    if (std::getenv("UMPRE_FUZZ_SHOW") != nullptr) {
        show(files);
    }
    // In another second __TIME__ may be another one.
    for (int attempt = 1;; ++attempt) {
        const std::time_t start = std::time(nullptr);
        const Outcome plain = outcomeOf(files, {.plainRoad = true}, Source::Text);
        const Outcome fast = outcomeOf(files, {}, Source::Text);
        const Outcome windows =
            outcomeOf(files, {.windowSize = windowSize, .manyMacros = 0}, Source::File);
        const std::string difference = differenceOf(fast, plain) + differenceOf(windows, plain);
        if (difference.empty()) {
            return;
        }
        if (std::time(nullptr) == start || attempt == kMostAttempts) {
            fail(difference);
        }
    }
}

}  // namespace umpre::fuzz
