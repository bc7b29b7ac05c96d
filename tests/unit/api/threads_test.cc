// SPDX-License-Identifier: MIT
//
// Runs share nothing, so any number of them can go on at a time. The thread sanitizer looks at
// these tests, too (preset `threads`).
#include <cstddef>
#include <optional>
#include <sstream>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "support/event_list.h"
#include "support/temporary_directory.h"
#include "umpre/preprocessing.h"

namespace umpre {
namespace {

constexpr std::size_t kThreads = 4;
constexpr int kRuns = 5;

// All that a run of some kind gives. The kinds take their sources from elsewhere.
std::string resultOf(const std::string& folder, std::size_t kind) {
    std::string result;
    testing::EventList events;
    Preprocessing preprocessing;
    preprocessing.define("KIND", std::to_string(kind));
    preprocessing.addIncludeDirectory(folder + "/none");
    preprocessing.addIncludeDirectory(folder);
    preprocessing.setOutput([&result](std::string_view bytes) {
        result.append(bytes);
        return true;
    });
    preprocessing.setDiagnostics(
        [&result](const Diagnostic& diagnostic) { result.append(messageOf(diagnostic)); });
    const std::string text =
        "#include <guarded.h>\n#include <plain.h>\nTWICE(KIND) __LINE__ \"KIND\" /* \n */ 1.5e3\n"
        "#if KIND > 1 && TWICE(-KIND)\n#else\n#endif\n#undef KIND\n#define KIND\n#endif\n";
    std::string source;
    for (int part = 0; part < 100; ++part) {
        source.append(text);
    }
    std::istringstream stream(source);
    switch (kind) {
    case 0: preprocessing.setSourceText("main", source); break;
    case 1: preprocessing.setSourceFile(folder + "/main.src"); break;
    case 2: preprocessing.setSourceStream("main", stream); break;
    default:
        preprocessing.setSourceText("main", source);
        preprocessing.setObserver(events.observer(), EventScope::FilesAndMacros);
        preprocessing.setIncludeResolver([](std::string_view name) -> IncludeAnswer {
            const bool isGuarded = name.find("guarded") != std::string_view::npos;
            return {isGuarded ? IncludeAnswer::Kind::Text : IncludeAnswer::Kind::Disk, "text\n"};
        });
    }
    const Outcome outcome = preprocessing.run();
    return result + std::to_string(static_cast<int>(outcome)) + events.text();
}

TEST(Threads, RunAtTheSameTimeAndDoNotMeet) {
    const testing::TemporaryDirectory folder;
    folder.write("guarded.h", "#ifndef G\n#define G\n#define TWICE(x) x x\n#endif\n");
    folder.write("plain.h", "plain KIND\n#include <guarded.h>\n");
    folder.write("main.src", "#include <guarded.h>\n#include <plain.h>\n#include <plain.h>\n");
    const std::string path = folder.name();
    std::vector<std::string> expected;
    for (std::size_t kind = 0; kind < kThreads; ++kind) {
        expected.push_back(resultOf(path, kind));
    }
    std::vector<std::vector<std::string>> results(2 * kThreads);
    std::vector<std::thread> threads;
    for (std::size_t number = 0; number < results.size(); ++number) {
        threads.emplace_back([&results, &path, number] {
            for (int run = 0; run < kRuns; ++run) {
                results[number].push_back(resultOf(path, number % kThreads));
            }
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    for (std::size_t number = 0; number < results.size(); ++number) {
        EXPECT_EQ(results[number], std::vector<std::string>(kRuns, expected[number % kThreads]));
    }
}

// An object that was made in one thread can run in another.
TEST(Threads, CanHandOverAnObject) {
    std::string result;
    Preprocessing preprocessing;
    preprocessing.setSourceText("main", "text\n");
    preprocessing.setOutput([&result](std::string_view bytes) {
        result.append(bytes);
        return true;
    });
    std::optional<Outcome> outcome;
    std::thread([&] { outcome = preprocessing.run(); }).join();
    EXPECT_EQ(outcome, Outcome::Clean);
    EXPECT_EQ(result, "#line 1 \"main\"\ntext\n");
}

}  // namespace
}  // namespace umpre
