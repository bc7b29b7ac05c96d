// SPDX-License-Identifier: MIT
#include "macros/argument_texts.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

// Returns the arguments found, each in brackets, with "!" where one may have macros and "?" where
// it may have quotes, and the rest of the text.
[[nodiscard]] std::string argumentsOf(std::string_view text, std::size_t count) {
    NameFilter names;
    names.add("N");
    CallOutline outline;
    std::vector<ArgumentText> arguments(count);
    // What is behind the end is not to be taken for the end of an argument.
    const std::string padded = std::string(text) + ")" + std::string(32, ' ');
    const char* const end = padded.data() + text.size();
    const char* const behind = takeArgumentTexts(padded.data(), end, names, outline, arguments);
    if (behind == nullptr) {
        return "(not told)";
    }
    std::string result;
    for (const ArgumentText& argument : arguments) {
        result.append("[").append(argument.raw).append("]");
        result.append(argument.mayHaveMacros ? "!" : "").append(argument.mayHaveQuotes ? "?" : "");
    }
    return result.append(behind, end);
}

TEST(ArgumentTexts, AreFound) {
    struct Row {
        std::string_view text;
        std::size_t count;
        std::string_view arguments;
    };

    const std::vector<Row> rows{
        {"()", 0, ""},
        {"( \t) rest", 0, " rest"},
        {"(a)", 1, "[a]"},
        {"(a,)", 1, "[a]"},
        {"(,)", 1, "[]"},
        {"( a + 1 , b )c", 2, "[a + 1][b]c"},
        {"(a\t,\t b  )", 2, "[a][b]"},
        {"((a, b), (c))", 2, "[(a, b)][(c)]"},
        {"([a,b])", 2, "[[a][b]]"},
        {"(\"a,b)\", '(')", 2, "[\"a,b)\"]?['(']?"},
        {"(N, a N1, x + N)", 3, "[N]![a N1][x + N]!"},
        {"(1N, 0x1N)", 2, "[1N]![0x1N]!"},
        {"(1 08 123, 1uN)", 2, "[1 08 123][1uN]!"},
        {"(1 0xN 2, a1N)", 2, "[1 0xN 2][a1N]"},
        {"(a / b, \\)", 2, "[a / b][\\]?"},
        {"(a, b,)x,", 2, "[a][b]x,"},
    };
    for (const Row& row : rows) {
        EXPECT_EQ(argumentsOf(row.text, row.count), row.arguments) << row.text;
    }
}

TEST(ArgumentTexts, AreLeftIfBytesDoNotTell) {
    for (const std::string_view text :
         {"(",         "(a, b ",    "(a",       "(a,",        "(a, b",       "(a, (b)",
          "()",        "(a)",       "(a,)",     "(,)",        "(a, b, c)",   "(a  b, c)",
          "(a\tb, c)", "(a\nb, c)", "(\na, c)", "(a, b\n)",   "(a /**/, b)", "(a, b//)",
          "(a, \")",   "(a, ')",    "(a, '')",  "(a, b\\\n)", "(a, \r)"}) {
        EXPECT_EQ(argumentsOf(text, 2), "(not told)") << text;
    }
}

// Wherever it stands, so much of a text as is looked at together may end in it.
TEST(ArgumentTexts, AreFoundBehindAnyNumberOfBytes) {
    for (std::size_t count = 1; count < 140; ++count) {
        const std::string before(count, 'a');
        EXPECT_EQ(argumentsOf("(" + before + " \"N)\" N0 08N 0x1N , \t12 )", 2),
                  "[" + before + " \"N)\" N0 08N 0x1N]!?[12]");
        EXPECT_EQ(argumentsOf("(" + before + "  N)", 1), "(not told)");
    }
}

}  // namespace
}  // namespace umpre
