// SPDX-License-Identifier: MIT
#include "directives/guard_watch.h"

#include <memory>
#include <string_view>

#include <gtest/gtest.h>

#include "support/directive_fixture.h"

namespace umpre {
namespace {

// Watches over a file whose conditional directives are carried out as the main loop would. G is
// defined, U is not.
struct WatchFixture : testing::DirectiveFixture {
    explicit WatchFixture(std::string_view text) : DirectiveFixture(text) {
        define("G", "");
        conditionals.enterFileGroups();
        output.writeLineMarker({"a.h", 1});
        watch.fileEntered(file);
    }

    void directive() {
        if (!conditionals.skipping()) {
            watch.noteAction();
        }
        EXPECT_TRUE(conditionals.carryOut(readWord()));
        sources.skipToEndOfLine();
        output.endLine();
    }

    void end(bool asExpected = true) {
        conditionals.closeFileGroups();
        watch.fileEnds(asExpected);
    }

    Conditionals conditionals{sources, macros, expander, lexer, reporter};
    std::shared_ptr<KnownFile> file =
        std::make_shared<KnownFile>(KnownFile{"a.h", {}, nullptr, {}});
    GuardWatch watch{conditionals, output, reporter};
};

TEST(GuardWatch, FindsAGuardAroundTheFile) {
    WatchFixture f("#ifndef G\n#endif\n");
    f.output.endLines(2);
    f.directive();
    f.output.endLines(5);
    f.directive();
    f.end();
    EXPECT_TRUE(f.file->isGuarded());
    EXPECT_EQ(f.file->guardedText, "#line 1 \"a.h\"\n\n\n\n\n\n\n\n\n\n");
    f.macros.undefine("G");
    EXPECT_FALSE(f.file->isGuarded());
    f.define("G", "1");
    EXPECT_TRUE(f.file->isGuarded());
}

TEST(GuardWatch, TakesNoOtherConditionForAGuard) {
    for (const std::string_view text : {
             "#ifndef U\n#endif\n",
             "#ifdef U\n#endif\n",
             "#if !defined G\n#endif\n",
             "#if 0\n#endif\n",
         }) {
        WatchFixture f(text);
        f.directive();
        f.directive();
        f.end();
        EXPECT_FALSE(f.file->isGuarded()) << text;
    }
}

TEST(GuardWatch, TakesNoGuardThatHasAnotherBranch) {
    for (const std::string_view text : {
             "#ifndef G\n#else\n#endif\n",
             "#ifndef G\n#elif U\n#endif\n",
             "#ifndef G\n#endif\n#ifndef G\n",
         }) {
        WatchFixture f(text);
        f.directive();
        f.directive();
        f.directive();
        f.end();
        EXPECT_FALSE(f.file->isGuarded()) << text;
    }
}

TEST(GuardWatch, TakesNoGuardThatIsLeftOpen) {
    WatchFixture f("#ifndef G\n");
    f.directive();
    f.end();
    EXPECT_FALSE(f.file->isGuarded());
}

TEST(GuardWatch, TakesNoGuardOfAFileThatDidMore) {
    WatchFixture written("#ifndef G\n#endif\n");
    written.output.write("text");
    written.directive();
    written.directive();
    written.end();
    EXPECT_FALSE(written.file->isGuarded());

    WatchFixture reported("#ifndef G\n#endif\n");
    reported.directive();
    reported.reporter.reportWarning("a message");
    reported.directive();
    reported.end();
    EXPECT_FALSE(reported.file->isGuarded());

    WatchFixture acted("#ifndef G\n#endif\n");
    acted.directive();
    acted.directive();
    acted.watch.noteAction();
    acted.end();
    EXPECT_FALSE(acted.file->isGuarded());
}

TEST(GuardWatch, TakesNoGuardOfAFileThatWasNotAsExpected) {
    WatchFixture f("#ifndef G\n#endif\n");
    f.directive();
    f.directive();
    f.end(false);
    EXPECT_FALSE(f.file->isGuarded());
}

TEST(GuardWatch, TakesNoGuardOfWhatHasLeftTheBlock) {
    WatchFixture f("#ifndef G\n#endif\n");
    f.directive();
    f.output.flush();
    f.directive();
    f.end();
    EXPECT_FALSE(f.file->isGuarded());
}

TEST(GuardWatch, WatchesFilesWithinFiles) {
    WatchFixture f("#ifndef G\n#endif\n");
    const auto inner = std::make_shared<KnownFile>(KnownFile{"b.h", {}, nullptr, {}});
    f.watch.noteAction();
    f.conditionals.enterFileGroups();
    f.output.writeLineMarker({"b.h", 1});
    f.watch.fileEntered(inner);
    f.directive();
    f.directive();
    f.end();
    f.end();
    EXPECT_TRUE(inner->isGuarded());
    EXPECT_FALSE(f.file->isGuarded());
}

}  // namespace
}  // namespace umpre
