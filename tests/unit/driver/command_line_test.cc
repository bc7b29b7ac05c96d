// SPDX-License-Identifier: MIT
#include "driver/command_line.h"

#include <string>
#include <string_view>
#include <unistd.h>
#include <vector>

#include <gtest/gtest.h>

#include "driver/version.h"
#include "support/descriptors.h"
#include "support/recording_sink.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

// What a command line gives, up to the end of the run if there is one.
struct Outcome {
    bool runs = false;
    std::string output;
    std::string errors;
};

[[nodiscard]] Outcome outcomeOf(const std::vector<std::string>& arguments,
                                std::string_view input = {}) {
    std::vector<const char*> words{"umpre"};
    for (const std::string& argument : arguments) {
        words.push_back(argument.c_str());
    }
    const testing::Pipe in(input);
    const testing::Pipe out;
    const testing::Replaced replacedInput(STDIN_FILENO, in.readEnd());
    const testing::Replaced replacedOutput(STDOUT_FILENO, out.writeEnd());
    testing::RecordingSink errors;
    OutputFile output;
    Preprocessor preprocessor(linesTo(errors));
    Outcome outcome;
    outcome.runs = parseCommandLine(preprocessor, {output, errors}, static_cast<int>(words.size()),
                                    words.data());
    if (outcome.runs) {
        EXPECT_EQ(preprocessor.run(), RunResult::Clean);
    }
    EXPECT_TRUE(output.write("|"));  // so that reading does not wait
    outcome.output = out.read();
    outcome.errors = errors.bytes();
    return outcome;
}

void expectRefusal(const std::vector<std::string>& arguments, std::string_view errors) {
    const Outcome outcome = outcomeOf(arguments);
    EXPECT_FALSE(outcome.runs) << errors;
    EXPECT_EQ(outcome.output, "|") << errors;
    EXPECT_EQ(outcome.errors, errors);
}

TEST(CommandLine, ReadsStandardInputWithoutArguments) {
    const Outcome outcome = outcomeOf({}, "a\n");
    EXPECT_TRUE(outcome.runs);
    EXPECT_EQ(outcome.output, "#line 1 \"stdin\"\na\n|");
    EXPECT_EQ(outcome.errors, "");
}

TEST(CommandLine, NamesTheSource) {
    EXPECT_EQ(outcomeOf({"-s", "name"}, "a\n").output, "#line 1 \"name\"\na\n|");
    const testing::TemporaryDirectory directory;
    const std::string file = directory.write("main", "a\n");
    EXPECT_EQ(outcomeOf({file}).output, "#line 1 \"" + file + "\"\na\n|");
    EXPECT_EQ(outcomeOf({file, "-s", "name"}).output, "#line 1 \"name\"\na\n|");
}

TEST(CommandLine, DefinesMacros) {
    EXPECT_EQ(outcomeOf({"-DA", "-DB=2=3", "-DC=", "-DA=4"}, "A B C.\n").output,
              "#line 1 \"stdin\"\n1 2=3 .\n|");
}

TEST(CommandLine, SearchesDirectories) {
    const testing::TemporaryDirectory directory;
    const std::string file = directory.write("first/one.h", "one\n");
    const Outcome outcome =
        outcomeOf({"-I" + directory.name(), "-I", directory.nameOf("first")}, "#include <one.h>\n");
    EXPECT_NE(outcome.output.find("#line 1 \"" + file + "\"\none\n"), std::string::npos)
        << outcome.output;
}

TEST(CommandLine, ShowsTheHelp) {
    for (const char* const option : {"-h", "--help"}) {
        const Outcome outcome = outcomeOf({option});
        EXPECT_FALSE(outcome.runs);
        EXPECT_EQ(outcome.output.substr(0, 38), "Usage: umpre [options] [source_file]\n\n");
        EXPECT_EQ(outcome.errors, "");
    }
}

TEST(CommandLine, ShowsTheVersion) {
    for (const char* const option : {"-v", "--version"}) {
        const Outcome outcome = outcomeOf({option, "a"});
        EXPECT_FALSE(outcome.runs);
        EXPECT_EQ(outcome.output, std::string("umpre version ") + UmGetVersionString() + "\n"
                                      + UmGetCopyrightString() + "\n|");
        EXPECT_EQ(outcome.errors, "umpre: argument(s) 'a ' is(are) ignored\n");
    }
}

TEST(CommandLine, RefusesWhatIsWrong) {
    expectRefusal({"-x", "--y"},
                  "umpre: unknown option '-x' ('-h' for help)\n"
                  "umpre: unknown option '--y' ('-h' for help)\n");
    expectRefusal({"-D"}, "umpre: missing macro for '-D' option number 1\n");
    expectRefusal({"-Ia", "-I"}, "umpre: missing path name for '-I' option number 2\n");
    expectRefusal({"-o"}, "umpre: missing output file name for '-o' option\n");
    expectRefusal({"-s"}, "umpre: no source name provided to '-s' option\n");
    expectRefusal({"a", "b"}, "umpre: cannot provide more than one source file\n");
    expectRefusal({"-o", "/"}, "umpre: cannot open output file '/'\n");
    expectRefusal({"/none/none"}, "FATAL ERROR: cannot open /none/none.\n");
}

TEST(CommandLine, TakesTheLastOfTheSameOptions) {
    const Outcome outcome = outcomeOf({"-s", "a", "-s", "b"}, "c\n");
    EXPECT_EQ(outcome.output, "#line 1 \"b\"\nc\n|");
    EXPECT_EQ(outcome.errors,
              "umpre: '-s' option appears more than once\n"
              "\tonly the last one will be considered\n");
}

TEST(CommandLine, WritesToAFile) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.nameOf("out");
    std::vector<const char*> words{"umpre", "-o", name.c_str()};
    const testing::Pipe in("a\n");
    const testing::Replaced replacedInput(STDIN_FILENO, in.readEnd());
    testing::RecordingSink errors;
    OutputFile output;
    Preprocessor preprocessor(linesTo(errors));
    ASSERT_TRUE(parseCommandLine(preprocessor, {output, errors}, 3, words.data()));
    EXPECT_EQ(preprocessor.run(), RunResult::Clean);
    EXPECT_TRUE(output.close());
    EXPECT_EQ(testing::contentsOf(name), "#line 1 \"stdin\"\na\n");
}

}  // namespace
}  // namespace umpre
