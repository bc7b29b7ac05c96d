// SPDX-License-Identifier: MIT
#include "directives/included_files.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "support/directive_fixture.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

// The folder "one" is searched; it holds a.h.
struct FilesFixture {
    FilesFixture() : f("main\n") {
        directory.write("one/a.h", "in one\n");
        files.addDirectory(directory.nameOf("one"));
    }

    void open(std::string_view name) {
        files.lookAtClock();
        files.open(name, IncludeForm::Brackets, files.find(name, IncludeForm::Brackets));
    }

    // Reads the file that was entered, to its end.
    void readFile() {
        while (f.sources.next().kind != TokenKind::NEWLINE) {
        }
        files.fileEnds();
        EXPECT_TRUE(f.sources.leaveEndedFile());
    }

    testing::TemporaryDirectory directory;
    testing::DirectiveFixture f;
    Conditionals conditionals{f.sources, f.macros, f.expander, f.lexer, f.reporter};
    IncludedFiles files{f.sources,
                        f.output,
                        conditionals,
                        f.reporter,
                        {.settlingTime = RunOptions::kAlwaysSettled}};
};

// a.h was read so often that it is known to come out empty.
struct EmptyFileFixture : FilesFixture {
    EmptyFileFixture() : name(directory.write("one/a.h", "#ifndef G\n#endif\n")) {
        f.define("G", "");
        includeAsTheMainLoopDoes();
        includeAsTheMainLoopDoes();
        EXPECT_EQ(f.written(), "\n\n\n\n");
        f.sink.clear();
    }

    void includeAsTheMainLoopDoes() {
        open("a.h");
        conditionals.enterFileGroups();
        files.noteAction();
        EXPECT_TRUE(conditionals.carryOut(f.readWord()));
        f.sources.skipToEndOfLine();
        EXPECT_TRUE(conditionals.carryOut(f.readWord()));
        f.sources.skipToEndOfLine();
        f.output.endLines(2);
        conditionals.closeFileGroups();
        files.fileEnds();
        (void)f.sources.peek();
    }

    std::string name;
    std::string passed = "#line 1 \"" + name + "\"\n\n\n#line 1 \"main\"\n";
};

TEST(IncludedFiles, OpensAFile) {
    FilesFixture i;
    i.open("a.h");
    EXPECT_EQ(i.f.rest(), "in one\nmain\n");
    EXPECT_EQ(i.f.reporter.report(), "");
}

TEST(IncludedFiles, ReportsAFileThatIsNowhere) {
    FilesFixture i;
    i.open("none.h");
    EXPECT_EQ(i.f.reporter.report(), "Cannot open file: none.h");
    EXPECT_EQ(i.f.rest(), "main\n");
}

TEST(IncludedFiles, ANameWithAZeroByteOpensNothing) {
    FilesFixture i;
    const std::string name("a.h\0", 4);
    i.open(name);
    EXPECT_EQ(i.f.reporter.report(), "Cannot open file: " + name);
}

TEST(IncludedFiles, PassesOverAFileThatComesOutEmpty) {
    EmptyFileFixture i;
    const std::string events = i.f.fileEvents.events();
    i.open("a.h");
    EXPECT_EQ(i.f.fileEvents.events(), events);
    EXPECT_EQ(i.f.written(), i.passed);
    i.f.macros.undefine("G");
    i.open("a.h");
    EXPECT_EQ(i.f.fileEvents.events(), events + " +" + i.name);
}

TEST(IncludedFiles, KeepsAPassageOverAFile) {
    EmptyFileFixture i;
    Search& search = *i.files.find("a.h", IncludeForm::Brackets);
    Passage passage;
    EXPECT_TRUE(i.files.passOver(search, passage));
    EXPECT_EQ(passage.guard, i.f.macros.find("G"));
    EXPECT_EQ(passage.text.text(), "#line 1 \"" + i.name + "\"\n\n\n");
    EXPECT_TRUE(i.files.passOver(search, passage));
    EXPECT_EQ(i.f.written(), i.passed + i.passed);
    i.f.macros.undefine("G");
    EXPECT_FALSE(i.files.passOver(search, passage));
}

TEST(IncludedFiles, LooksAtAPassageAnewInTheNextMoment) {
    EmptyFileFixture i;
    Search& search = *i.files.find("a.h", IncludeForm::Brackets);
    Passage passage;
    EXPECT_TRUE(i.files.passOver(search, passage));
    i.directory.write("one/a.h", "something else\n");
    EXPECT_TRUE(i.files.passOver(search, passage));
    i.f.reporter.reportError("a message");
    EXPECT_FALSE(i.files.passOver(search, passage));
}

TEST(IncludedFiles, PassesOverAFileWhoseMarkerIsLong) {
    EmptyFileFixture i;
    Search& search = *i.files.find("a.h", IncludeForm::Brackets);
    const std::string name(70, 'm');
    i.f.sources.currentFile().setFileName(name);
    Passage passage;
    for (int times = 0; times < 3; ++times) {
        EXPECT_TRUE(i.files.passOver(search, passage));
        EXPECT_EQ(i.f.written(), "#line 1 \"" + i.name + "\"\n\n\n#line 1 \"" + name + "\"\n");
        i.f.sink.clear();
    }
}

TEST(IncludedFiles, ReadsAFileFromWhatItKept) {
    FilesFixture i;
    for (int times = 0; times < 2; ++times) {
        i.open("a.h");
        i.readFile();
    }
    Search& search = *i.files.find("a.h", IncludeForm::Brackets);
    ASSERT_NE(search.file->bytes, nullptr);
    i.directory.write("one/a.h", "something else\n");
    i.open("a.h");
    EXPECT_EQ(i.f.sources.peek(), TokenKind::IDENTIFIER);
    EXPECT_TRUE(i.f.sources.currentFile().lacksDescriptor());
    i.readFile();
    i.f.reporter.reportError("a message");
    i.open("a.h");
    EXPECT_FALSE(i.f.sources.currentFile().lacksDescriptor());
    EXPECT_EQ(i.f.rest(), "something else\nmain\n");
}

TEST(IncludedFiles, OpensAFileThatItKeptWhereNoneWasOpenBefore) {
    FilesFixture i;
    for (int times = 0; times < 2; ++times) {
        i.open("a.h");
        i.readFile();
    }
    i.open("a.h");
    EXPECT_TRUE(i.f.sources.currentFile().lacksDescriptor());
    i.open("a.h");
    EXPECT_FALSE(i.f.sources.currentFile().lacksDescriptor());
}

TEST(IncludedFiles, KeepsNothingOfAFileThatComesOutEmpty) {
    EmptyFileFixture i;
    EXPECT_EQ(i.files.find("a.h", IncludeForm::Brackets)->file->bytes, nullptr);
}

TEST(IncludedFiles, PassesOverAFileByAnotherOfItsNames) {
    EmptyFileFixture i;
    i.files.open(i.name, IncludeForm::Quotes, nullptr);
    EXPECT_EQ(i.f.written(), i.passed);
}

TEST(IncludedFiles, ReadsAKeptFileByAnotherOfItsNames) {
    FilesFixture i;
    for (int times = 0; times < 2; ++times) {
        i.open("a.h");
        i.readFile();
    }
    const std::string name = i.directory.nameOf("one/a.h");
    i.files.open(name, IncludeForm::Quotes, nullptr);
    EXPECT_TRUE(i.f.sources.currentFile().lacksDescriptor());
    EXPECT_EQ(i.f.sources.position().fileName, name);
    EXPECT_EQ(i.f.rest(), "in one\nmain\n");
}

}  // namespace
}  // namespace umpre
