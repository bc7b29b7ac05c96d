// SPDX-License-Identifier: MIT
#include "driver/preprocessor.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/recording_sink.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

struct Fixture {
    Fixture() { preprocessor.setOutput(output); }

    [[nodiscard]] RunResult run(std::string_view text) {
        preprocessor.openText("main", text);
        return preprocessor.run();
    }

    testing::RecordingSink output;
    testing::RecordingSink errors;
    Preprocessor preprocessor{linesTo(errors)};
};

struct Row {
    std::string_view text;
    std::string_view output;
};

// The first line marker is left out of the table.
void expectOutputs(const std::vector<Row>& table) {
    for (const Row& row : table) {
        Fixture f;
        EXPECT_EQ(f.run(row.text), RunResult::Clean) << row.text;
        EXPECT_EQ(f.output.bytes(), "#line 1 \"main\"\n" + std::string(row.output)) << row.text;
        EXPECT_EQ(f.errors.bytes(), "") << row.text;
    }
}

TEST(Preprocessor, CopiesText) {
    expectOutputs({{"a b\n", "a b\n"}, {"  a \"b\" 'c' 1.5\n", "  a \"b\" 'c' 1.5\n"}});
}

TEST(Preprocessor, CarriesOutDirectives) {
    expectOutputs({
        {"#define N 3\nN\n", "#line 2 \"main\"\n3\n"},
        {"#if 1\na\n#else\nb\n#endif\n", "\na\n\n\n\n"},
        {"#line 7 \"b\"\na\n", "#line 7 \"b\"\na\n"},
    });
}

TEST(Preprocessor, KeepsDefinitionsFromOutside) {
    Fixture f;
    f.preprocessor.defineMacro("N", "3");
    f.preprocessor.defineMacro("N", "4");
    EXPECT_EQ(f.run("N\n"), RunResult::Clean);
    EXPECT_EQ(f.output.bytes(), "#line 1 \"main\"\n3\n");
}

TEST(Preprocessor, OpensASource) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("main", "a\n");
    Fixture f;
    EXPECT_TRUE(f.preprocessor.openSource(name, ""));
    EXPECT_EQ(f.preprocessor.run(), RunResult::Clean);
    EXPECT_EQ(f.output.bytes(), "#line 1 \"" + name + "\"\na\n");
}

TEST(Preprocessor, ReportsASourceThatCannotBeOpened) {
    Fixture f;
    EXPECT_FALSE(f.preprocessor.openSource("/none/none", "name"));
    EXPECT_EQ(f.errors.bytes(), "FATAL ERROR: cannot open /none/none.\n");
}

TEST(Preprocessor, GoesOnAfterAnError) {
    Fixture f;
    EXPECT_EQ(f.run("#error x\na\n"), RunResult::Errors);
    EXPECT_EQ(f.errors.bytes(), "main:2: #error directive:  x.\n");
    EXPECT_TRUE(f.output.bytes().ends_with("a\n"));
}

TEST(Preprocessor, EndsCleanlyAfterAWarning) {
    Fixture f;
    EXPECT_EQ(f.run("#define A 1\n#define A 2\n"), RunResult::Clean);
    EXPECT_TRUE(
        f.errors.bytes().ends_with("Warning: Macro \"A\" has an incompatible"
                                   " redefinition.\n"));
}

TEST(Preprocessor, ReportsGroupsThatAreOpenAtTheEnd) {
    Fixture f;
    EXPECT_EQ(f.run("#if 1\n#if 1\n"), RunResult::Errors);
    EXPECT_TRUE(f.errors.bytes().ends_with(": Unterminated \"#if\" conditional.\n"));
    EXPECT_EQ(f.errors.calls(), 1U);
}

TEST(Preprocessor, EndsAtADivisionThatNoMachineCarriesOut) {
    Fixture f;
    EXPECT_EQ(f.run("a\n#if (-2147483647 - 1) / -1\n#endif\nb\n"), RunResult::ArithmeticFault);
    EXPECT_EQ(f.output.bytes(), "#line 1 \"main\"\na\n");
}

TEST(Preprocessor, EndsWhenTheOutputFails) {
    testing::RecordingSink failing(1);
    Fixture f;
    f.preprocessor.setOutput(failing);
    f.preprocessor.openText("main", "a\n");
    (void)f.preprocessor.run();
    EXPECT_TRUE(f.preprocessor.outputFailed());
    EXPECT_EQ(failing.bytes(), "");
}

}  // namespace
}  // namespace umpre
