// SPDX-License-Identifier: MIT
#include "driver/option_parser.h"

#include <optional>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/recording_sink.h"

namespace umpre {
namespace {

using Words = std::vector<const char*>;
using Values = std::vector<std::string_view>;

constexpr OptionParser::Format kFormat{"<", ">\n"};

const std::vector<OptionSpec>& table() {
    static const std::vector<OptionSpec> kTable{
        {"I ", 1, "no directory number "},
        {"D_", 1, "no macro number "},
        {"o", 1, "no output"},
        {"pair", 2, "no pair"},
        {"flag", 0, {}},
        {"end", OptionSpec::kTerminal, {}},
    };
    return kTable;
}

// The words of a command line without the program's name.
struct Fixture {
    explicit Fixture(const Words& arguments, bool optionsMayFollowArguments = true)
        : words(withProgram(arguments)), mayFollow(optionsMayFollowArguments) {}

    [[nodiscard]] static Words withProgram(Words words) {
        words.insert(words.begin(), "program");
        return words;
    }

    Words words;
    bool mayFollow;
    testing::RecordingSink errors;
    OptionParser parser{
        static_cast<int>(words.size()), words.data(), table(), "p: ", mayFollow, errors};
};

TEST(OptionParser, TakesNothing) {
    const Fixture f({});
    EXPECT_EQ(f.parser.freeCount(), 0U);
    EXPECT_FALSE(f.parser.has("o"));
    EXPECT_FALSE(f.parser.hasPrefix("D_"));
    EXPECT_FALSE(f.parser.reportUnknown(kFormat));
    EXPECT_FALSE(f.parser.reportMisplaced(kFormat));
    f.parser.reportDuplicates(kFormat);
    f.parser.reportIgnored(kFormat);
    EXPECT_EQ(f.errors.bytes(), "");
}

TEST(OptionParser, TakesNotEvenAProgramName) {
    testing::RecordingSink errors;
    const char* const none = nullptr;
    const OptionParser parser(0, &none, table(), "", true, errors);
    EXPECT_EQ(parser.freeCount(), 0U);
}

TEST(OptionParser, CountsFreeArguments) {
    const Fixture f({"a", "-flag", "", "b"});
    EXPECT_EQ(f.parser.freeCount(), 3U);
    EXPECT_EQ(f.parser.free(0), std::nullopt);
    EXPECT_EQ(f.parser.free(1), "a");
    EXPECT_EQ(f.parser.free(2), "");
    EXPECT_EQ(f.parser.free(3), "b");
    EXPECT_EQ(f.parser.free(4), std::nullopt);
}

TEST(OptionParser, TakesTheArgumentsOfOrdinaryOptions) {
    const Fixture f({"-o", "a", "-flag", "b", "-pair", "c", "d", "e"});
    EXPECT_TRUE(f.parser.has("flag"));
    EXPECT_TRUE(f.parser.has("pair"));
    EXPECT_EQ(f.parser.get("o"), "a");
    EXPECT_EQ(f.parser.get("pair"), "c");
    EXPECT_EQ(f.parser.freeCount(), 2U);
    EXPECT_EQ(f.parser.free(2), "e");
}

TEST(OptionParser, TakesAnArgumentThatLooksLikeAnUnknownOption) {
    const Fixture f({"-o", "-x", "-o2"});
    EXPECT_EQ(f.parser.get("o"), "-x");
    EXPECT_TRUE(f.parser.reportUnknown(kFormat));
    EXPECT_EQ(f.errors.bytes(), "p: <-o2>\n");
}

TEST(OptionParser, TellsOfAMissingArgument) {
    for (const Words& words : {Words{"-o"}, Words{"-o", "-flag"}, Words{"-o", "-Da"}}) {
        const Fixture f(words);
        EXPECT_TRUE(f.parser.has("o"));
        EXPECT_EQ(f.parser.get("o"), std::nullopt);
        EXPECT_EQ(f.errors.bytes(), "p: no output\n");
    }
}

TEST(OptionParser, CollectsThePrefixOptions) {
    const Fixture f({"-Da", "-Ix", "-Db=1", "-D-c", "-I", "y"});
    EXPECT_TRUE(f.parser.hasPrefix("D_"));
    EXPECT_EQ(f.parser.values("D_"), (Values{"a", "b=1", "-c"}));
    EXPECT_EQ(f.parser.values("I "), (Values{"x", "y"}));
    EXPECT_EQ(f.parser.freeCount(), 0U);
    EXPECT_EQ(f.errors.bytes(), "");
}

TEST(OptionParser, TakesTheNextWordOnlyIfThePrefixAllowsIt) {
    const Fixture f({"-D", "a"});
    EXPECT_TRUE(f.parser.hasPrefix("D_"));
    EXPECT_EQ(f.parser.values("D_"), Values{});
    EXPECT_EQ(f.errors.bytes(), "p: no macro number 1\n");
    EXPECT_EQ(f.parser.free(1), "a");
}

TEST(OptionParser, TakesForADirectoryOnlyWhatLooksLikeOneOption) {
    EXPECT_EQ(Fixture({"-I", "-Ix"}).parser.values("I "), Values{"-Ix"});
    const Fixture f({"-Ix", "-I", "-Dx"});
    EXPECT_EQ(f.parser.values("I "), Values{});
    EXPECT_EQ(f.errors.bytes(), "p: no directory number 2\n");
    EXPECT_EQ(f.parser.values("D_"), Values{"x"});
}

TEST(OptionParser, TellsTheUnknownOptions) {
    const Fixture f({"-x", "a", "-", "--flag", "-flagged"});
    EXPECT_TRUE(f.parser.reportUnknown(kFormat));
    EXPECT_EQ(f.errors.bytes(), "p: <-x>\np: <->\np: <--flag>\np: <-flagged>\n");
    EXPECT_EQ(f.parser.freeCount(), 1U);
}

TEST(OptionParser, LetsTheLastOfTheSameOptionsCount) {
    const Fixture f({"-o", "a", "-o", "b", "-flag", "-o", "c"});
    EXPECT_EQ(f.parser.get("o"), "c");
    f.parser.reportDuplicates(kFormat);
    EXPECT_EQ(f.errors.bytes(), "p: <o>\np: <o>\n");
}

TEST(OptionParser, EndsAtATerminalOption) {
    const Fixture f({"a", "-o", "b", "-end", "-x", "-Dc"});
    EXPECT_TRUE(f.parser.has("end"));
    EXPECT_FALSE(f.parser.hasPrefix("D_"));
    EXPECT_FALSE(f.parser.reportUnknown(kFormat));
    f.parser.reportIgnored(kFormat);
    EXPECT_EQ(f.errors.bytes(), "p: <a -o b -x -Dc >\n");
}

TEST(OptionParser, IgnoresNothingIfATerminalOptionStandsAlone) {
    const Fixture f({"-end"});
    f.parser.reportIgnored(kFormat);
    EXPECT_EQ(f.errors.bytes(), "");
}

TEST(OptionParser, TellsMisplacedArguments) {
    const Fixture f({"-flag", "a", "b", "-o", "c"}, false);
    EXPECT_TRUE(f.parser.reportMisplaced(kFormat));
    EXPECT_EQ(f.errors.bytes(), "p: <a>\np: <b>\n");

    const Fixture inOrder({"-o", "c", "a", "b"}, false);
    EXPECT_FALSE(inOrder.parser.reportMisplaced(kFormat));
    EXPECT_EQ(inOrder.parser.freeCount(), 2U);
}

TEST(OptionParser, ComparesWordsWithARow) {
    const OptionSpec ordinary{"o", 1, {}};
    EXPECT_FALSE(ordinary.isPrefix());
    EXPECT_TRUE(ordinary.matches("o"));
    EXPECT_FALSE(ordinary.matches("ox"));
    EXPECT_FALSE(ordinary.matches(""));
    for (const std::string_view name : {"D_", "D "}) {
        const OptionSpec prefix{name, 1, {}};
        EXPECT_TRUE(prefix.isPrefix());
        EXPECT_TRUE(prefix.matches("D"));
        EXPECT_TRUE(prefix.matches("Dx"));
        EXPECT_FALSE(prefix.matches("d"));
        EXPECT_FALSE(prefix.matches(""));
    }
}

}  // namespace
}  // namespace umpre
