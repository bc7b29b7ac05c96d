// SPDX-License-Identifier: MIT
#include "lex/scanner_stack.h"

#include <memory>
#include <string>
#include <unistd.h>

#include <gtest/gtest.h>

#include "support/descriptors.h"
#include "support/lexeme.h"
#include "support/source_fixture.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

using testing::lexemeOf;
using testing::SourceFixture;
using enum TokenKind;

TEST(ScannerStack, ReadsTheMainFileToItsEnd) {
    SourceFixture f("a b\n");
    EXPECT_EQ(f.sources.peek(), IDENTIFIER);
    EXPECT_EQ(f.rest(), "a b\n");
    EXPECT_EQ(f.sources.peek(), END_OF_INPUT);
    EXPECT_EQ(f.sources.next().kind, END_OF_INPUT);
}

TEST(ScannerStack, TheMainFileStaysTheCurrentOneAtItsEnd) {
    SourceFixture f("a\n");
    (void)f.rest();
    EXPECT_EQ(f.sources.position().fileName, "main");
    EXPECT_EQ(f.sources.position().line, 2);
    EXPECT_EQ(f.fileEvents.events(), "+main");
}

TEST(ScannerStack, HasAFileOnceOneIsPushed) {
    testing::RecordingFileEvents events;
    OutputWriter output;
    testing::RecordingReporter reporter;
    ScannerStack sources(events, output, reporter, {});
    events.watch(sources);
    EXPECT_FALSE(sources.hasFile());
    sources.pushFileText("main", "");
    EXPECT_TRUE(sources.hasFile());
}

TEST(ScannerStack, GoesOnBelowASourceThatIsReadToItsEnd) {
    SourceFixture f("below\n");
    f.pushText("top ");
    f.pushText("most ");
    EXPECT_EQ(f.rest(), "most top below\n");
}

TEST(ScannerStack, GoesOnInTheMiddleOfASource) {
    SourceFixture f("a b c");
    EXPECT_EQ(f.sources.next().text, "a");
    f.pushText("x");
    EXPECT_EQ(f.rest(), "x b c");
}

TEST(ScannerStack, PeekingGoesOnBelowToo) {
    SourceFixture f("a");
    f.pushText("");
    f.pushText("");
    EXPECT_EQ(f.sources.peek(), IDENTIFIER);
    EXPECT_EQ(f.sources.next().text, "a");
}

TEST(ScannerStack, ATokenLookedAheadAtIsKeptBelowANewSource) {
    SourceFixture f("a b");
    EXPECT_EQ(f.sources.peek(), IDENTIFIER);
    f.pushText("x ");
    EXPECT_EQ(f.rest(), "x a b");
}

TEST(ScannerStack, ReadsAPartOfAText) {
    SourceFixture f("!");
    const TextSlice slice{f.lexer.lexed("abc a"), 2, 3};
    f.sources.pushSlice(slice, {});
    f.sources.pushSlice(slice, {});
    EXPECT_EQ(f.rest(), "aa!");
}

TEST(ScannerStack, TheSetIsThatOfTheSourceReadNow) {
    NoExpandSets sets;
    const Name name{"n"};
    const NoExpandSet set = sets.with({}, name);
    SourceFixture f("b");
    f.pushText("a", set);
    EXPECT_EQ(f.sources.next().text, "a");
    EXPECT_EQ(f.sources.noExpandSet(), set);
    EXPECT_EQ(f.sources.next().text, "b");
    EXPECT_EQ(f.sources.noExpandSet(), NoExpandSet());
}

TEST(ScannerStack, TheSetChangesWhenTheNextSourceIsPeekedInto) {
    NoExpandSets sets;
    const Name name{"n"};
    SourceFixture f("b");
    f.pushText("a", sets.with({}, name));
    (void)f.sources.next();
    (void)f.sources.peek();
    EXPECT_EQ(f.sources.noExpandSet(), NoExpandSet());
}

TEST(ScannerStack, AFileInsideAFileTellsItsBeginningAndEnd) {
    SourceFixture f("a\nb\n");
    (void)f.sources.next();
    f.sources.pushFileText("inner", "x\n");
    EXPECT_EQ(f.fileEvents.events(), "+main +inner");
    EXPECT_EQ(f.rest(), "x\n\nb\n");
    EXPECT_EQ(f.fileEvents.events(), "+main +inner -inner =main");
}

TEST(ScannerStack, AFileEndsWhenReadingGoesOnBelowIt) {
    SourceFixture f("a");
    f.sources.pushFileText("inner", "x\n");
    (void)f.sources.next();
    (void)f.sources.next();
    EXPECT_EQ(f.fileEvents.events(), "+main +inner");
    (void)f.sources.peek();
    EXPECT_EQ(f.fileEvents.events(), "+main +inner -inner =main");
}

TEST(ScannerStack, FilesThatEndTogetherEndOneAfterTheOther) {
    SourceFixture f("");
    f.sources.pushFileText("one", "");
    f.sources.pushFileText("two", "");
    EXPECT_EQ(f.sources.next().kind, END_OF_INPUT);
    EXPECT_EQ(f.fileEvents.events(), "+main +one +two -two =one -one =main");
}

TEST(ScannerStack, ListsTellNothing) {
    SourceFixture f("a");
    f.pushText("x");
    EXPECT_EQ(f.rest(), "xa");
    EXPECT_EQ(f.fileEvents.events(), "+main");
}

TEST(ScannerStack, ThePositionIsThatOfTheFileWhileAListIsRead) {
    SourceFixture f("a\n\nb\n");
    (void)f.sources.next();
    (void)f.sources.next();
    (void)f.sources.next();
    f.pushText("x\ny\n");
    (void)f.sources.next();
    (void)f.sources.next();
    EXPECT_EQ(f.sources.position().fileName, "main");
    EXPECT_EQ(f.sources.position().line, 3);
}

TEST(ScannerStack, ThePositionFollowsTheInnermostFile) {
    SourceFixture f("a\nb\n");
    (void)f.sources.next();
    (void)f.sources.next();
    f.sources.pushFileText("inner", "x");
    EXPECT_EQ(f.sources.position().fileName, "inner");
    EXPECT_EQ(f.sources.position().line, 1);
    EXPECT_EQ(f.rest(), "xb\n");
    EXPECT_EQ(f.sources.position().fileName, "main");
}

TEST(ScannerStack, TheCurrentFileCanBeRenamed) {
    SourceFixture f("a\n");
    f.sources.currentFile().setFileName("other");
    f.sources.currentFile().setLine(7);
    EXPECT_EQ(f.sources.position().fileName, "other");
    EXPECT_EQ(f.sources.position().line, 7);
}

TEST(ScannerStack, AFileIsReadNowIfNothingIsLeftOnTopOfIt) {
    SourceFixture f("a");
    EXPECT_EQ(f.sources.fileReadNow(), &f.sources.currentFile());
    f.pushText("x");
    EXPECT_EQ(f.sources.fileReadNow(), nullptr);
    (void)f.sources.next();
    EXPECT_EQ(f.sources.fileReadNow(), &f.sources.currentFile());
    EXPECT_EQ(f.sources.next().text, "a");
}

TEST(ScannerStack, OpensFilesByName) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("inner", "x\n");
    SourceFixture f("a\n");
    ASSERT_TRUE(f.sources.pushFile(name));
    EXPECT_EQ(f.sources.position().fileName, name);
    EXPECT_EQ(f.rest(), "x\na\n");
}

TEST(ScannerStack, AMessageNameReplacesTheFileName) {
    const testing::TemporaryDirectory directory;
    SourceFixture f("");
    ASSERT_TRUE(f.sources.pushFile(directory.write("inner", "x\n"), "called"));
    EXPECT_EQ(f.sources.position().fileName, "called");
    EXPECT_EQ(f.fileEvents.events(), "+main +called");
}

TEST(ScannerStack, AnEmptyFileNameIsStandardInput) {
    const testing::Pipe pipe("x\n");
    const testing::Replaced standardInput(STDIN_FILENO, pipe.readEnd());
    SourceFixture f("a\n");
    ASSERT_TRUE(f.sources.pushFile(""));
    EXPECT_EQ(f.sources.position().fileName, "stdin");
    EXPECT_EQ(f.rest(), "x\na\n");
}

TEST(ScannerStack, AFileThatCannotBeOpenedChangesNothing) {
    const testing::TemporaryDirectory directory;
    SourceFixture f("a\n");
    EXPECT_FALSE(f.sources.pushFile(directory.nameOf("nothing")));
    EXPECT_FALSE(f.sources.pushFile(directory.name(), "called"));
    EXPECT_EQ(f.sources.position().fileName, "main");
    EXPECT_EQ(f.fileEvents.events(), "+main");
    EXPECT_EQ(f.rest(), "a\n");
    EXPECT_TRUE(f.reporter.reports().empty());
}

TEST(ScannerStack, TheSameFileCanBeOpenAtManyDepths) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("inner", "x y\n");
    SourceFixture f("");
    constexpr int kDepth = 100;
    std::string expected;
    for (int depth = 0; depth < kDepth; ++depth) {
        ASSERT_TRUE(f.sources.pushFile(name));
        EXPECT_EQ(f.sources.next().text, "x");
        expected += " y\n";
    }
    EXPECT_EQ(f.rest(), expected);
}

TEST(ScannerStack, SkipsBlanksAndReturnsThem) {
    SourceFixture f(" \t\\\n/* c */a\n");
    EXPECT_EQ(f.sources.skipBlanks(), " \t\\\n ");
    EXPECT_EQ(f.sources.next().text, "a");
    EXPECT_EQ(f.sources.skipBlanks(), "");
    EXPECT_EQ(f.sources.peek(), NEWLINE);
}

TEST(ScannerStack, SkipsBlanksThroughTheEndsOfSources) {
    SourceFixture f(" a");
    f.pushText(" ");
    f.pushText(" \t");
    EXPECT_EQ(f.sources.skipBlanks(), " \t  ");
    EXPECT_EQ(f.sources.next().text, "a");
}

TEST(ScannerStack, SkipsLineEndsToo) {
    SourceFixture f(" \n\r\n\ta");
    EXPECT_EQ(f.sources.skipBlanksAndNewlines(), " \n\n\t");
    EXPECT_EQ(f.sources.next().text, "a");
}

TEST(ScannerStack, SkipsNothingWhereNoBlanksStand) {
    SourceFixture f("a");
    EXPECT_EQ(f.sources.skipBlanksAndNewlines(), "");
    EXPECT_FALSE(f.sources.passBlanksAndNewlines());
}

TEST(ScannerStack, TellsThatBlanksOrLineEndsWerePassed) {
    SourceFixture f(" \n a");
    EXPECT_TRUE(f.sources.passBlanksAndNewlines());
    EXPECT_EQ(f.sources.next().text, "a");
}

TEST(ScannerStack, ALineEndWithoutTextIsPassedAsWell) {
    SourceFixture f("a");
    (void)f.sources.next();
    EXPECT_TRUE(f.sources.passBlanksAndNewlines());
    EXPECT_EQ(f.sources.next().kind, END_OF_INPUT);
}

TEST(ScannerStack, SkipsToTheEndOfTheLineIncluded) {
    SourceFixture f("a b \\\n c\nd\n");
    f.sources.skipToEndOfLine();
    EXPECT_EQ(f.sources.next().text, "d");
}

TEST(ScannerStack, SkippingToTheEndOfTheLineConsumesAtLeastOneToken) {
    SourceFixture f("\na\nb\n");
    f.sources.skipToEndOfLine();
    EXPECT_EQ(f.sources.next().text, "a");
    (void)f.sources.next();
    f.sources.skipToEndOfLine();
    EXPECT_EQ(f.sources.next().kind, END_OF_INPUT);
}

TEST(ScannerStack, AnIsolatedSourceEndsByItself) {
    SourceFixture f("a b");
    (void)f.sources.next();
    f.isolateText("x y");
    EXPECT_EQ(f.rest(), "x y");
    EXPECT_EQ(f.sources.peek(), END_OF_INPUT);
    EXPECT_EQ(f.sources.next().kind, END_OF_INPUT);
    f.sources.endIsolation();
    EXPECT_EQ(f.rest(), " b");
}

TEST(ScannerStack, SourcesPushedDuringAnIsolationBelongToIt) {
    SourceFixture f("a");
    f.isolateText("x");
    f.pushText("y ");
    EXPECT_EQ(f.rest(), "y x");
    f.sources.endIsolation();
    EXPECT_EQ(f.rest(), "a");
}

TEST(ScannerStack, IsolationsNest) {
    SourceFixture f("a");
    f.isolateText("x ");
    f.isolateText("y ");
    EXPECT_EQ(f.rest(), "y ");
    f.sources.endIsolation();
    EXPECT_EQ(f.rest(), "x ");
    f.sources.endIsolation();
    EXPECT_EQ(f.rest(), "a");
}

TEST(ScannerStack, WhatIsLeftOfAnIsolatedSourceIsDropped) {
    SourceFixture f("a");
    f.isolateText("x y z");
    (void)f.sources.next();
    f.sources.endIsolation();
    EXPECT_EQ(f.rest(), "a");
}

TEST(ScannerStack, AnExhaustedIsolatedSourceStaysWhenAnotherIsPushed) {
    SourceFixture f("a");
    f.isolateText("x");
    (void)f.sources.next();
    f.pushText("y");
    EXPECT_EQ(f.rest(), "y");
    f.sources.endIsolation();
    EXPECT_EQ(f.rest(), "a");
}

TEST(ScannerStack, ManyListsMayFollowEachOther) {
    SourceFixture f("a");
    constexpr int kCount = 100'000;
    for (int count = 0; count < kCount; ++count) {
        f.pushText("x");
        EXPECT_EQ(f.sources.next().text, "x");
    }
    EXPECT_EQ(f.rest(), "a");
}

TEST(ScannerStack, ManyListsMayWaitForEachOther) {
    SourceFixture f("a");
    constexpr std::size_t kCount = 10'000;
    for (std::size_t count = 0; count < kCount; ++count) {
        f.pushText("x");
    }
    EXPECT_EQ(f.rest(), std::string(kCount, 'x') + "a");
}

TEST(ScannerStack, CommentsInFilesAndListsActOnOutputAndReports) {
    SourceFixture f("/*\n\n*/a/*\n");
    EXPECT_EQ(f.sources.commentEffects(), 0U);
    f.pushText("/*\n*/");
    EXPECT_EQ(f.rest(), "  a ");
    EXPECT_EQ(f.written(), "\n\n\n\n");
    EXPECT_EQ(f.reporter.report(), "4: unterminated comment");
    EXPECT_GT(f.sources.commentEffects(), 0U);
}

TEST(ScannerStack, CommentsOnOneLineHaveNoEffects) {
    SourceFixture f("/* a */ // b\n");
    (void)f.rest();
    EXPECT_EQ(f.sources.commentEffects(), 0U);
}

TEST(ScannerStack, CarriesOutTheEffectsOfATextThatItDoesNotRead) {
    SourceFixture f("");
    LexedText text;
    text.append(IDENTIFIER, "a");
    text.addCommentEffect(2, true, 3);
    text.append(WHITESPACE, " ");
    f.sources.carryOutEffects(text, 0);
    EXPECT_EQ(f.sources.commentEffects(), 0U);
    f.sources.carryOutEffects(text, 1);
    EXPECT_EQ(f.sources.commentEffects(), 2U);
    EXPECT_EQ(f.written(), "\n\n");
    EXPECT_EQ(f.reporter.report(), "3: unterminated comment");
}

TEST(ScannerStack, LeavesAFileThatIsReadToItsEnd) {
    const testing::TemporaryDirectory directory;
    testing::SourceFixture f("rest\n");
    const std::string name = directory.write("a.h", "x\n");
    ASSERT_TRUE(f.sources.pushFile(name));
    EXPECT_FALSE(f.sources.leaveEndedFile());
    (void)f.sources.next();
    EXPECT_FALSE(f.sources.leaveEndedFile());
    (void)f.sources.next();
    EXPECT_TRUE(f.sources.leaveEndedFile());
    EXPECT_EQ(f.fileEvents.events(), "+main +" + name + " -" + name + " =main");
    EXPECT_EQ(f.rest(), "rest\n");
    EXPECT_FALSE(f.sources.leaveEndedFile());
}

TEST(ScannerStack, LeavesAFileOnlyBehindItsLastLineEnd) {
    const testing::TemporaryDirectory directory;
    testing::SourceFixture f("rest\n");
    ASSERT_TRUE(f.sources.pushFile(directory.write("a.h", "x")));
    (void)f.sources.next();
    EXPECT_FALSE(f.sources.leaveEndedFile());
    EXPECT_EQ(f.sources.next().kind, TokenKind::NEWLINE);
    EXPECT_TRUE(f.sources.leaveEndedFile());
}

TEST(ScannerStack, CanOpenAsManyFilesAsWereOpen) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("a.h", "");
    testing::SourceFixture f("rest\n");
    EXPECT_FALSE(f.sources.canOpenOneMore());
    ASSERT_TRUE(f.sources.pushFile(name));
    EXPECT_FALSE(f.sources.canOpenOneMore());
    ASSERT_TRUE(f.sources.pushFile(name));
    EXPECT_TRUE(f.sources.leaveEndedFile());
    EXPECT_TRUE(f.sources.canOpenOneMore());
    ASSERT_TRUE(f.sources.pushFile(name));
    EXPECT_FALSE(f.sources.canOpenOneMore());
}

TEST(ScannerStack, ReadsAFileThatWasKept) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("a.h", "a");
    testing::SourceFixture f("rest\n");
    ASSERT_TRUE(f.sources.pushFile(name));
    (void)f.sources.next();
    EXPECT_EQ(f.sources.next().kind, TokenKind::NEWLINE);
    EXPECT_TRUE(f.sources.leaveEndedFile());
    f.sources.pushKeptFile("kept", std::make_shared<FileBytes>("kept\n"), {});
    EXPECT_EQ(f.sources.position().fileName, "kept");
    EXPECT_EQ(f.rest(), "kept\nrest\n");
    EXPECT_EQ(f.fileEvents.events(), "+main +" + name + " -" + name + " =main +kept -kept =main");
}

TEST(ScannerStack, ReadsAKeptFileInsideItself) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("a.h", "");
    testing::SourceFixture f("rest\n");
    ASSERT_TRUE(f.sources.pushFile(name));
    ASSERT_TRUE(f.sources.pushFile(name));
    EXPECT_TRUE(f.sources.leaveEndedFile());
    EXPECT_TRUE(f.sources.leaveEndedFile());
    const auto bytes = std::make_shared<FileBytes>("one two\nthree // c\n");
    f.sources.pushKeptFile("kept", bytes, {});
    EXPECT_EQ(f.sources.next().text, "one");
    f.sources.pushKeptFile("kept", bytes, {});
    EXPECT_EQ(f.rest(), "one two\nthree  \n two\nthree  \nrest\n");
}

TEST(ScannerStack, KeptFilesTakeDescriptorsBeforeMoreFilesAreOpenThanEver) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("a.h", "");
    testing::SourceFixture f("rest\n");
    const auto nextDescriptor = [] {
        const int descriptor = ::dup(STDERR_FILENO);
        ::close(descriptor);
        return descriptor;
    };
    const int before = nextDescriptor();
    ASSERT_TRUE(f.sources.pushFile(name));
    ASSERT_TRUE(f.sources.pushFile(name));
    EXPECT_TRUE(f.sources.leaveEndedFile());
    EXPECT_TRUE(f.sources.leaveEndedFile());
    EXPECT_EQ(nextDescriptor(), before);
    const auto bytes = std::make_shared<FileBytes>("kept\n");
    f.sources.pushKeptFile("kept", bytes, {});
    f.sources.pushKeptFile("kept", bytes, {});
    EXPECT_EQ(nextDescriptor(), before);
    EXPECT_FALSE(f.sources.canOpenOneMore());
    ASSERT_TRUE(f.sources.pushFile(name));
    EXPECT_EQ(nextDescriptor(), before + 3);
    EXPECT_EQ(f.rest(), "kept\nkept\nrest\n");
    EXPECT_EQ(nextDescriptor(), before);
}

}  // namespace
}  // namespace umpre
