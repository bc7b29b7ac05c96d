// SPDX-License-Identifier: MIT
#include "directives/file_finder.h"

#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "support/source_fixture.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

using enum FileFinder::Result;
using enum IncludeForm;
using enum TokenKind;

// A sink that nobody can wait at, as if it wrote to the file of this identity.
class FileSink final : public ByteSink {
public:
    explicit FileSink(const FileIdentity& identity) : identity_(identity) {}

    [[nodiscard]] bool write(std::string_view /*bytes*/) override { return true; }

    [[nodiscard]] std::optional<FileIdentity> target() const override { return identity_; }

private:
    FileIdentity identity_;
};

// The folders "one" and "two" are searched; "two" holds a.h.
struct FinderFixture {
    explicit FinderFixture(const RunOptions& options = {.settlingTime = RunOptions::kAlwaysSettled})
        : f("main\n"), finder(f.sources, f.output, f.reporter, options) {
        directory.write("one/other.h", "");
        directory.write("two/a.h", "in two\n");
        finder.addDirectory(directory.nameOf("one"));
        finder.addDirectory(directory.nameOf("two"));
    }

    // Enters the file so often that it is worth remembering.
    void enterTwice(std::string_view name, IncludeForm form) {
        EXPECT_EQ(finder.enter(name, form), Entered);
        EXPECT_EQ(finder.enter(name, form), Entered);
    }

    // Returns the name of the file that an earlier search leads to, or what is missing.
    [[nodiscard]] std::string known(std::string_view name, IncludeForm form) {
        Search* const search = finder.find(name, form);
        if (search == nullptr) {
            return "no search";
        }
        const KnownFile* const file = finder.fileOf(*search);
        return file == nullptr ? "no file" : file->name;
    }

    // Something that may have made the program wait.
    void beginMoment() { f.reporter.reportError("a message"); }

    testing::TemporaryDirectory directory;
    testing::SourceFixture f;
    FileFinder finder;
};

TEST(FileFinder, KnowsAFileThatWasEnteredTwice) {
    FinderFixture i;
    EXPECT_EQ(i.finder.enter("a.h", Brackets), Entered);
    EXPECT_EQ(i.known("a.h", Brackets), "no search");
    EXPECT_EQ(i.finder.entered(), nullptr);
    EXPECT_EQ(i.finder.enter("a.h", Brackets), Entered);
    EXPECT_EQ(i.known("a.h", Brackets), i.directory.nameOf("two/a.h"));
    EXPECT_EQ(i.finder.entered()->name, i.directory.nameOf("two/a.h"));
}

TEST(FileFinder, KnowsEachFormOfANameByItself) {
    FinderFixture i;
    i.enterTwice("a.h", Quotes);
    EXPECT_EQ(i.known("a.h", Quotes), i.directory.nameOf("two/a.h"));
    EXPECT_EQ(i.known("a.h", Brackets), "no search");
}

TEST(FileFinder, KnowsOneFileUnderSeveralNames) {
    FinderFixture i;
    i.enterTwice("a.h", Brackets);
    const std::shared_ptr<KnownFile> file = i.finder.entered();
    EXPECT_EQ(i.finder.enter(i.directory.nameOf("two/a.h"), Quotes), Entered);
    EXPECT_EQ(i.finder.entered(), file);
}

TEST(FileFinder, KnowsNothingOfAFileThatIsNowhere) {
    FinderFixture i;
    EXPECT_EQ(i.finder.enter("none.h", Brackets), Nowhere);
    EXPECT_EQ(i.finder.enter("none.h", Brackets), Nowhere);
    EXPECT_EQ(i.known("none.h", Brackets), "no search");
}

TEST(FileFinder, KnowsNothingOnThePlainRoad) {
    FinderFixture i({.plainRoad = true, .settlingTime = RunOptions::kAlwaysSettled});
    i.enterTwice("a.h", Brackets);
    EXPECT_EQ(i.known("a.h", Brackets), "no search");
}

TEST(FileFinder, KnowsNothingWhileSomebodyWatchesOrServes) {
    FinderFixture watched;
    watched.finder.setObserver([](const Event& /*event*/) {});
    watched.enterTwice("a.h", Brackets);
    EXPECT_EQ(watched.known("a.h", Brackets), "no search");

    FinderFixture served;
    served.finder.setResolver([](std::string_view /*name*/) { return IncludeAnswer{}; });
    served.enterTwice("a.h", Brackets);
    EXPECT_EQ(served.known("a.h", Brackets), "no search");
}

TEST(FileFinder, KnowsNothingOfAFileThatWasChangedJustNow) {
    constexpr std::int64_t kDay = 86'400'000'000'000;
    FinderFixture i({.settlingTime = kDay});
    i.enterTwice("a.h", Brackets);
    EXPECT_EQ(i.known("a.h", Brackets), "no search");
}

TEST(FileFinder, KnowsNothingOfAnEmptyFile) {
    FinderFixture i;
    i.enterTwice("other.h", Brackets);
    EXPECT_EQ(i.known("other.h", Brackets), "no search");
}

TEST(FileFinder, KnowsNothingOfTheFileThatIsWritten) {
    FinderFixture i;
    EXPECT_EQ(i.finder.enter("a.h", Brackets), Entered);
    FileSink sink(i.f.sources.currentFile().identity());
    i.f.output.redirect(sink);
    i.enterTwice("a.h", Brackets);
    EXPECT_EQ(i.known("a.h", Brackets), "no search");
}

TEST(FileFinder, SeesInTheNextMomentThatAFileHasChanged) {
    FinderFixture i;
    i.enterTwice("a.h", Brackets);
    i.directory.write("two/a.h", "something else\n");
    EXPECT_EQ(i.known("a.h", Brackets), i.directory.nameOf("two/a.h"));
    i.beginMoment();
    EXPECT_EQ(i.known("a.h", Brackets), "no file");
    const std::shared_ptr<KnownFile> before = i.finder.entered();
    EXPECT_EQ(i.finder.enter("a.h", Brackets), Entered);
    EXPECT_EQ(i.known("a.h", Brackets), i.directory.nameOf("two/a.h"));
    EXPECT_NE(i.finder.entered(), before);
}

TEST(FileFinder, BeginsAMomentWhenAFileTurnsOutToHaveChanged) {
    FinderFixture i;
    i.enterTwice("a.h", Brackets);
    EXPECT_EQ(i.finder.enter(i.directory.nameOf("two/a.h"), Quotes), Entered);
    i.directory.write("two/a.h", "something else\n");
    EXPECT_EQ(i.known("a.h", Brackets), i.directory.nameOf("two/a.h"));
    EXPECT_EQ(i.finder.enter(i.directory.nameOf("two/a.h"), Quotes), Entered);
    EXPECT_EQ(i.known("a.h", Brackets), "no file");
}

TEST(FileFinder, SeesInTheNextMomentThatAFileIsGone) {
    FinderFixture i;
    i.enterTwice("a.h", Brackets);
    std::filesystem::remove(i.directory.nameOf("two/a.h"));
    i.beginMoment();
    EXPECT_EQ(i.known("a.h", Brackets), "no file");
    EXPECT_EQ(i.finder.enter("a.h", Brackets), Nowhere);
}

TEST(FileFinder, SeesInTheNextMomentThatAFileCameBefore) {
    FinderFixture i;
    i.enterTwice("a.h", Brackets);
    i.directory.write("one/a.h", "in one\n");
    i.beginMoment();
    EXPECT_EQ(i.known("a.h", Brackets), "no file");
    EXPECT_EQ(i.finder.enter("a.h", Brackets), Entered);
    EXPECT_EQ(i.f.sources.position().fileName, i.directory.nameOf("one/a.h"));
}

TEST(FileFinder, GoesOnKnowingWhatHasNotChanged) {
    FinderFixture i;
    i.enterTwice("a.h", Brackets);
    i.beginMoment();
    EXPECT_EQ(i.known("a.h", Brackets), i.directory.nameOf("two/a.h"));
}

TEST(FileFinder, BeginsAMomentWhenTheOutputMayHaveWaited) {
    FinderFixture i;
    i.enterTwice("a.h", Brackets);
    i.directory.write("two/a.h", "something else\n");
    i.f.output.write("text");
    i.f.output.flush();
    EXPECT_EQ(i.known("a.h", Brackets), "no file");
}

TEST(FileFinder, BeginsNoMomentWhenTheOutputGoesToAFile) {
    FinderFixture i;
    FileSink sink({});
    i.f.output.redirect(sink);
    i.enterTwice("a.h", Brackets);
    i.directory.write("two/a.h", "something else\n");
    i.f.output.write("text");
    i.f.output.flush();
    EXPECT_EQ(i.known("a.h", Brackets), i.directory.nameOf("two/a.h"));
}

// Looks for files that "two" alone holds until "one" need not be looked into any more.
struct MissingFixture : FinderFixture {
    explicit MissingFixture(
        const RunOptions& runOptions = {.settlingTime = RunOptions::kAlwaysSettled})
        : FinderFixture(runOptions) {
        directory.write("two/b.h", "in two\n");
        for (int time = 0; time < 1000; ++time) {
            EXPECT_EQ(finder.enter("a.h", Brackets), Entered);
            EXPECT_TRUE(f.sources.leaveEndedFile() || f.sources.next().kind != NEWLINE);
            while (f.sources.position().fileName != "main") {
                (void)f.sources.next();
                (void)f.sources.leaveEndedFile();
            }
        }
    }

    [[nodiscard]] std::string entered(std::string_view name) {
        return finder.enter(name, Brackets) == Entered ? std::string(f.sources.position().fileName)
                                                       : "none";
    }
};

TEST(FileFinder, OmitsAttemptsThatAreKnownToFail) {
    MissingFixture i;
    i.directory.write("one/b.h", "in one\n");
    const std::string found = i.entered("b.h");
    EXPECT_TRUE(found == i.directory.nameOf("two/b.h") || found == i.directory.nameOf("one/b.h"));
    i.beginMoment();
    EXPECT_EQ(i.entered("b.h"), i.directory.nameOf("one/b.h"));
}

TEST(FileFinder, MakesEachAttemptBeforeItSaysThatThereIsNoFile) {
    MissingFixture i;
    EXPECT_EQ(i.entered("c.h"), "none");
    i.directory.write("one/c.h", "in one\n");
    EXPECT_EQ(i.entered("c.h"), i.directory.nameOf("one/c.h"));
}

TEST(FileFinder, BeginsAMomentWhenItMeetsAFileThatIsYoungerThanTheMoment) {
    constexpr std::int64_t kSecond = 1'000'000'000;
    FinderFixture i({.settlingTime = kSecond});
    const std::size_t before = i.finder.moment();
    EXPECT_EQ(i.finder.enter("a.h", Brackets), Entered);
    EXPECT_NE(i.finder.moment(), before);
}

TEST(FileFinder, LeadsToAFileThatIsAtHandWithoutOpeningIt) {
    FinderFixture i;
    const std::string path = i.directory.nameOf("two/a.h");
    i.enterTwice("a.h", Brackets);
    EXPECT_TRUE(i.f.sources.leaveEndedFile() || i.f.sources.next().kind != NEWLINE);
    while (i.f.sources.position().fileName != "main") {
        (void)i.f.sources.next();
        (void)i.f.sources.leaveEndedFile();
    }
    i.finder.find("a.h", Brackets)->file->bytes = std::make_shared<FileBytes>("in two\n");
    EXPECT_EQ(i.finder.enter(path, Quotes), Known);
    EXPECT_EQ(i.f.sources.position().fileName, "main");
    EXPECT_EQ(i.known(path, Quotes), path);
    i.directory.write("two/a.h", "something else\n");
    EXPECT_EQ(i.finder.enter(path, Quotes), Entered);
}

TEST(FileFinder, OpensAFileThatIsAtHandWhereNoneWasOpenBefore) {
    FinderFixture i;
    i.enterTwice("a.h", Brackets);
    i.finder.find("a.h", Brackets)->file->bytes = std::make_shared<FileBytes>("in two\n");
    EXPECT_EQ(i.finder.enter(i.directory.nameOf("two/a.h"), Quotes), Entered);
}

}  // namespace
}  // namespace umpre
