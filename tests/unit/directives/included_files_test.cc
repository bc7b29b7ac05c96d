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

    testing::TemporaryDirectory directory;
    testing::DirectiveFixture f;
    Conditionals conditionals{f.sources, f.macros, f.expander, f.lexer, f.reporter};
    IncludedFiles files{f.sources,
                        f.output,
                        conditionals,
                        f.reporter,
                        {.settlingTime = RunOptions::kAlwaysSettled}};
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
    FilesFixture i;
    const std::string name = i.directory.write("one/a.h", "#ifndef G\n#endif\n");
    i.f.define("G", "");
    const auto includeAsTheMainLoopDoes = [&i] {
        i.open("a.h");
        i.conditionals.enterFileGroups();
        i.files.noteAction();
        EXPECT_TRUE(i.conditionals.carryOut(i.f.readWord()));
        i.f.sources.skipToEndOfLine();
        EXPECT_TRUE(i.conditionals.carryOut(i.f.readWord()));
        i.f.sources.skipToEndOfLine();
        i.f.output.endLines(2);
        i.conditionals.closeFileGroups();
        i.files.fileEnds();
        (void)i.f.sources.peek();
    };
    includeAsTheMainLoopDoes();
    includeAsTheMainLoopDoes();
    const std::string events = i.f.fileEvents.events();
    (void)i.f.written();
    i.open("a.h");
    EXPECT_EQ(i.f.fileEvents.events(), events);
    EXPECT_EQ(i.f.written(), "\n\n\n\n#line 1 \"" + name + "\"\n\n\n#line 1 \"main\"\n");
    i.f.macros.undefine("G");
    i.open("a.h");
    EXPECT_EQ(i.f.fileEvents.events(), events + " +" + name);
}

}  // namespace
}  // namespace umpre
