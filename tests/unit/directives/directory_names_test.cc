// SPDX-License-Identifier: MIT
#include "directives/directory_names.h"

#include <cstdint>
#include <filesystem>
#include <string>

#include <gtest/gtest.h>

#include "lex/run_options.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

// A directory that holds a.h and was looked into in vain for so often that it was read.
struct NamesFixture {
    explicit NamesFixture(std::int64_t settlingTime = RunOptions::kAlwaysSettled)
        : names(settlingTime) {
        directory.write("in/a.h", "");
        missOften();
    }

    void missOften(std::size_t times = 5000) {
        for (std::size_t time = 0; time < times; ++time) {
            names.noteMiss(pathOf("missing.h"), moment, 0);
        }
    }

    [[nodiscard]] std::string pathOf(const std::string& name) const {
        return directory.nameOf("in/" + name);
    }

    [[nodiscard]] bool lacks(const std::string& name) { return names.lacks(pathOf(name), moment); }

    testing::TemporaryDirectory directory;
    std::size_t moment = 1;
    DirectoryNames names;
};

// Not every file system tells what a directory does not hold.
#define SKIP_IF_NOT_TOLD(fixture)                           \
    if (!(fixture).lacks("missing.h")) {                    \
        GTEST_SKIP() << "the file system is none of those"; \
    }

TEST(DirectoryNames, TellsWhatADirectoryLacks) {
    NamesFixture i;
    SKIP_IF_NOT_TOLD(i);
    EXPECT_FALSE(i.lacks("a.h"));
    int told = 0;
    for (int number = 0; number < 100; ++number) {
        told += i.lacks("b" + std::to_string(number) + ".h") ? 1 : 0;
    }
    EXPECT_GT(told, 50);
}

TEST(DirectoryNames, TellsNothingOfOtherDirectories) {
    NamesFixture i;
    EXPECT_FALSE(i.names.lacks(i.directory.nameOf("missing.h"), i.moment));
    EXPECT_FALSE(i.names.lacks("missing.h", i.moment));
    EXPECT_FALSE(i.names.lacks("/missing.h", i.moment));
    EXPECT_FALSE(i.names.lacks("", i.moment));
}

TEST(DirectoryNames, ReadsNoDirectoryForAFewMisses) {
    NamesFixture i;
    i.names = DirectoryNames(RunOptions::kAlwaysSettled);
    i.missOften(3);
    EXPECT_FALSE(i.lacks("missing.h"));
}

TEST(DirectoryNames, SeesANewNameInTheNextMoment) {
    NamesFixture i;
    SKIP_IF_NOT_TOLD(i);
    i.directory.write("in/missing.h", "");
    EXPECT_TRUE(i.lacks("missing.h"));
    ++i.moment;
    EXPECT_FALSE(i.lacks("missing.h"));
    EXPECT_FALSE(i.lacks("another.h"));
}

TEST(DirectoryNames, SeesInTheNextMomentThatADirectoryWasReplaced) {
    NamesFixture i;
    SKIP_IF_NOT_TOLD(i);
    std::filesystem::rename(i.directory.nameOf("in"), i.directory.nameOf("out"));
    ++i.moment;
    EXPECT_FALSE(i.lacks("missing.h"));
    i.directory.write("in/missing.h", "");
    EXPECT_FALSE(i.lacks("missing.h"));
}

TEST(DirectoryNames, GoesOnTellingWhatHasNotChanged) {
    NamesFixture i;
    SKIP_IF_NOT_TOLD(i);
    ++i.moment;
    EXPECT_TRUE(i.lacks("missing.h"));
}

TEST(DirectoryNames, TellsNothingOfADirectoryThatWasChangedJustNow) {
    constexpr std::int64_t kDay = 86'400'000'000'000;
    NamesFixture i(kDay);
    EXPECT_FALSE(i.lacks("missing.h"));
}

TEST(DirectoryNames, TellsNothingOfADirectoryThatIsNotThere) {
    NamesFixture i;
    for (int time = 0; time < 5000; ++time) {
        i.names.noteMiss(i.directory.nameOf("nowhere/a.h"), i.moment, 0);
    }
    EXPECT_FALSE(i.names.lacks(i.directory.nameOf("nowhere/a.h"), i.moment));
}

}  // namespace
}  // namespace umpre
