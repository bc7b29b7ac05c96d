// SPDX-License-Identifier: MIT
#include "directives/inclusion.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "support/directive_fixture.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

using testing::DirectiveFixture;
using testing::TemporaryDirectory;

constexpr std::string_view kInvalidCharacters =
    "Invalid characters appear before a new-line in the preprocessor directive";

// What comes after the directive word. The folders "one" and "two" hold a.h; "two" alone holds b.h.
struct InclusionFixture {
    explicit InclusionFixture(std::string_view text) : f(text) {
        directory.write("one/a.h", "in one\n");
        directory.write("two/a.h", "in two\n");
        directory.write("two/b.h", "b\n");
    }

    void search(std::string_view folder) { files.addDirectory(directory.nameOf(folder)); }

    // Reads a line as bytes. Returns false if it was left to the scanner.
    [[nodiscard]] bool includeLine() {
        CppFileScanner& file = f.sources.currentFile();
        if (inclusion.includeLines(file)) {
            return true;
        }
        DirectiveLine line(file);
        return line.word() == TokenKind::KW_INCLUDE
               && inclusion.includeDirective(line) == DirectiveLine::Outcome::EndTaken;
    }

    // Reads the file that was entered.
    void readFile() {
        while (!f.sources.leaveEndedFile()) {
            (void)f.sources.next();
        }
    }

    TemporaryDirectory directory;
    DirectiveFixture f;
    Conditionals conditionals{f.sources, f.macros, f.expander, f.lexer, f.reporter};
    IncludedFiles files{f.sources,
                        f.output,
                        conditionals,
                        f.reporter,
                        {.settlingTime = RunOptions::kAlwaysSettled}};
    Inclusion inclusion{f.sources, f.expander, f.lexer, f.macros, files, f.reporter};
};

TEST(Inclusion, ReadsAFileFromTheFirstDirectoryThatHasIt) {
    InclusionFixture i(" <a.h>\nrest\n");
    i.search("one");
    i.search("two");
    i.inclusion.includeDirective();
    EXPECT_EQ(i.f.sources.position().fileName, i.directory.nameOf("one/a.h"));
    EXPECT_EQ(i.f.sources.position().line, 1);
    EXPECT_EQ(i.f.rest(), "in one\nrest\n");
    EXPECT_EQ(i.f.reporter.report(), "");
}

TEST(Inclusion, GoesOnToDirectoriesThatHaveIt) {
    InclusionFixture i(" \"b.h\"\nrest\n");
    i.search("nowhere");
    i.search("one");
    i.search("two");
    i.inclusion.includeDirective();
    EXPECT_EQ(i.f.rest(), "b\nrest\n");
}

TEST(Inclusion, TriesAQuotedNameAsItIsFirst) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("a.h", "as it is\n");
    InclusionFixture i(" \"" + name + "\"\nrest\n");
    i.search("one");
    i.inclusion.includeDirective();
    EXPECT_EQ(i.f.sources.position().fileName, name);
    EXPECT_EQ(i.f.rest(), "as it is\nrest\n");
}

TEST(Inclusion, NeverTriesANameInBracketsAsItIs) {
    const TemporaryDirectory directory;
    const std::string name = directory.write("a.h", "as it is\n");
    InclusionFixture i(" <" + name + ">\nrest\n");
    i.inclusion.includeDirective();
    EXPECT_EQ(i.f.rest(), "rest\n");
    EXPECT_EQ(i.f.reporter.report(), "Cannot open file: " + name);
}

TEST(Inclusion, PassesOverDirectoriesOfThatName) {
    InclusionFixture i(" <two>\nrest\n");
    i.directory.write("one/two/x", "");
    i.directory.write("three/two", "a file\n");
    i.search("one");
    i.search("three");
    i.inclusion.includeDirective();
    EXPECT_EQ(i.f.rest(), "a file\nrest\n");
}

TEST(Inclusion, JoinsDirectoryAndNameWithASlash) {
    InclusionFixture i(" <a.h>\n");
    i.search("one/");
    i.inclusion.includeDirective();
    EXPECT_EQ(i.f.sources.position().fileName, i.directory.nameOf("one//a.h"));
}

TEST(Inclusion, ConsumesTheLineEndBeforeTheFile) {
    InclusionFixture i(" <a.h>\nrest\n");
    i.search("one");
    i.inclusion.includeDirective();
    (void)i.f.rest();
    EXPECT_EQ(i.f.fileEvents.events(), "+main +" + i.directory.nameOf("one/a.h") + " -"
                                           + i.directory.nameOf("one/a.h") + " =main");
    EXPECT_EQ(i.f.sources.position().line, 3);
}

TEST(Inclusion, TakesEveryTokenBetweenBrackets) {
    InclusionFixture i(" < a  \"b\"/c.h >\nrest\n");
    i.inclusion.includeDirective();
    EXPECT_EQ(i.f.reporter.report(), "Cannot open file:  a  \"b\"/c.h ");
}

TEST(Inclusion, DoesNotInterpretEscapes) {
    InclusionFixture i(" \"x\\\\y\\n\"\nrest\n");
    i.inclusion.includeDirective();
    EXPECT_EQ(i.f.reporter.report(), "Cannot open file: x\\\\y\\n");
}

TEST(Inclusion, TakesTheNameFromAMacro) {
    for (const std::string_view header : {"<b.h>", "\"b.h\"", "LESS b.h>", "<NAME>"}) {
        InclusionFixture i(" HEADER\nrest\n");
        i.search("two");
        i.f.define("HEADER", header);
        i.f.define("LESS", "<EMPTY");
        i.f.define("EMPTY", "");
        i.f.define("NAME", "b.h");
        i.inclusion.includeDirective();
        if (header == "LESS b.h>") {
            EXPECT_EQ(i.f.reporter.report(), "Cannot open file:  b.h");
        } else {
            EXPECT_EQ(i.f.rest(), "b\nrest\n") << header;
        }
    }
}

TEST(Inclusion, ReportsAFileThatIsNowhere) {
    for (const std::string_view operand : {" <none.h>", " \"none.h\""}) {
        InclusionFixture i(std::string(operand) + "\nrest\n");
        i.search("one");
        i.inclusion.includeDirective();
        EXPECT_EQ(i.f.reporter.report(), "Cannot open file: none.h");
        EXPECT_EQ(i.f.rest(), "rest\n");
    }
}

TEST(Inclusion, ReportsAMissingNameAndSkipsItAlone) {
    struct Row {
        std::string_view operand;
        std::string_view message;
    };

    constexpr std::string_view kFilename = "Filename expected after #include directive";
    constexpr std::string_view kMissing = "An expected file name is missing";
    for (const Row& row : {
             Row{"", kFilename},
             Row{" ", kFilename},
             Row{" a.h", kFilename},
             Row{" 'a.h'", kFilename},
             Row{" <a.h", kFilename},
             Row{" <", kFilename},
             Row{" \"a.h", kFilename},
             Row{" >a.h<", kFilename},
             Row{" \"\"", kMissing},
             Row{" <>", kMissing},
             Row{" <> x", kMissing},
         }) {
        InclusionFixture i(std::string(row.operand) + "\nrest\n");
        i.search("one");
        i.inclusion.includeDirective();
        EXPECT_EQ(i.f.reporter.report(), row.message) << row.operand;
        EXPECT_EQ(i.f.rest(), "\nrest\n") << row.operand;
    }
}

TEST(Inclusion, ReportsWhatFollowsTheNameAndReadsTheFile) {
    for (const std::string_view operand : {" <b.h> x", " \"b.h\" \"c.h\"", " <b.h> >"}) {
        InclusionFixture i(std::string(operand) + "\nrest\n");
        i.search("two");
        i.inclusion.includeDirective();
        EXPECT_EQ(i.f.reporter.report(), kInvalidCharacters) << operand;
        EXPECT_EQ(i.f.rest(), "b\nrest\n") << operand;
    }
}

TEST(Inclusion, AllowsACommentBehindTheName) {
    InclusionFixture i(" <b.h> /* c */ // d\nrest\n");
    i.search("two");
    i.inclusion.includeDirective();
    EXPECT_EQ(i.f.reporter.report(), "");
    EXPECT_EQ(i.f.rest(), "b\nrest\n");
}

TEST(Inclusion, ReadsWholeLinesAsBytes) {
    InclusionFixture i("#include <a.h>\n# include\"b.h\" \n\t#\tinclude<b.h>\nrest\n");
    i.search("one");
    i.search("two");
    EXPECT_TRUE(i.includeLine());
    EXPECT_EQ(i.f.sources.position().fileName, i.directory.nameOf("one/a.h"));
    EXPECT_EQ(i.f.rest(), "in one\n# include\"b.h\" \n\t#\tinclude<b.h>\nrest\n");
}

TEST(Inclusion, ReadsCommentsAndContinuationsAsBytes) {
    for (const std::string_view line : {
             "#include <a.h> // c\n",
             "# /* c */ include /* c */ <a.h> /* c */\n",
             "#\\\ninclude \\\n <a.h> \\\n\n",
         }) {
        InclusionFixture i(std::string(line) + "rest\n");
        i.search("one");
        EXPECT_TRUE(i.includeLine()) << line;
        EXPECT_EQ(i.f.rest(), "in one\nrest\n") << line;
    }
}

TEST(Inclusion, ReportsAtTheSameLineHoweverItReads) {
    for (const bool asBytes : {false, true}) {
        InclusionFixture i("#include <none.h>\nrest\n");
        if (asBytes) {
            EXPECT_TRUE(i.includeLine());
        } else {
            (void)i.f.readWord();
            i.inclusion.includeDirective();
        }
        EXPECT_EQ(i.f.reporter.report(), "Cannot open file: none.h");
        EXPECT_EQ(i.f.sources.position().line, 2);
        EXPECT_EQ(i.f.rest(), "rest\n");
    }
}

TEST(Inclusion, LeavesLinesToTheScannerThatItMayReadDifferently) {
    for (const std::string_view line : {
             "",
             "\n",
             "rest",
             "#include",
             "#include\n",
             "#include \n",
             "#include \"a.h\"",
             "#include <a.h>",
             "#include <a.h> \\\n",
             "#include \"a.h\"\r\n",
             "#include <a.h>\r",
             "#include \"a.h\" x\n",
             "#include <a.h> /* x\n*/\n",
             "#include <a.h\n",
             "#include \"a.h\n\"\n",
             "#include \"\"\n",
             "#include <>\n",
             "#include \"a\\b.h\"\n",
             "#include <a b.h>\n",
             "#include <a//b.h>\n",
             "#include <a/*b.h>\n",
             "#include <=a.h>\n",
             "#include <'a.h>\n",
             "#include <MACRO>\n",
             "#include <1MACRO>\n",
             "#include MACRO\n",
             "#included <a.h>\n",
             "#Include <a.h>\n",
             "include <a.h>\n",
             "##include <a.h>\n",
         }) {
        InclusionFixture i(line);
        i.search("one");
        i.f.define("MACRO", "a.h");
        EXPECT_FALSE(i.includeLine()) << line;
        EXPECT_EQ(i.f.reporter.report(), "") << line;
        EXPECT_EQ(i.f.sources.position().fileName, "main") << line;
    }
}

TEST(Inclusion, LooksAgainAtALineWhoseNameBecameAMacro) {
    InclusionFixture i("#include <a.h>\n#include <a.h>\n#include <a.h>\n#include <a.h>\n");
    i.search("one");
    i.search("two");
    i.directory.write("one/a.h", "#ifndef GUARD\n#endif\n");
    i.f.define("GUARD", "");
    for (int times = 0; times < 3; ++times) {
        EXPECT_TRUE(i.includeLine());
        i.readFile();
    }
    i.f.define("a", "b");
    EXPECT_FALSE(i.includeLine());
}

}  // namespace
}  // namespace umpre
