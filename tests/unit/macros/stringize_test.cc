// SPDX-License-Identifier: MIT
#include "macros/stringize.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

struct Row {
    std::string_view argument;
    std::string_view literal;
};

void expectLiterals(const std::vector<Row>& table) {
    for (const Row& row : table) {
        std::string result;
        stringize(row.argument, result);
        EXPECT_EQ(result, row.literal) << row.argument;
    }
}

TEST(Stringize, PutsQuotesAroundAnArgument) {
    expectLiterals({
        {"", R"("")"},
        {"abc", R"("abc")"},
        {"a + b", R"("a + b")"},
        {"1 , (2)", "\"1 , (2)\""},
    });
}

TEST(Stringize, AddsToTheResult) {
    std::string result = "L";
    stringize("a", result);
    stringize("b", result);
    EXPECT_EQ(result, R"(L"a""b")");
}

TEST(Stringize, EscapesEveryDoubleQuote) {
    expectLiterals({
        {R"("a")", R"("\"a\"")"},
        {R"(")", R"("\"")"},
        {R"(""")", R"("\"\"\"")"},
        {R"('"')", R"("'\"'")"},
    });
}

TEST(Stringize, DoublesBackslashesInLiteralsOnly) {
    expectLiterals({
        {R"(\)", R"("\")"},
        {R"(\n)", R"("\n")"},
        {R"(a "b\n" c)", R"("a \"b\\n\" c")"},
        {R"('\n')", R"("'\\n'")"},
        {R"("a" \n "b\n" \n)", R"("\"a\" \n \"b\\n\" \n")"},
    });
}

TEST(Stringize, AnEscapedQuoteDoesNotEndALiteral) {
    expectLiterals({
        {R"('\'')", R"("'\\''")"},
        {R"("\"" \n)", R"("\"\\\"\" \n")"},
        {R"("\"\n")", R"("\"\\\"\\n\"")"},
        {R"('\'' \n)", R"("'\\'' \n")"},
    });
}

TEST(Stringize, ASecondBackslashEscapesWhatFollowsToo) {
    expectLiterals({
        {R"("\\")", R"("\"\\\\\"")"},
        // The literal is taken for going on, so the backslash behind it is doubled.
        {R"("\\" \n)", R"("\"\\\\\" \\n")"},
        {R"('\\' \n)", R"("'\\\\' \\n")"},
        {R"("\\" "\n")", R"("\"\\\\\" \"\n\"")"},
    });
}

TEST(Stringize, AnyCharacterBetweenEndsAnEscape) {
    expectLiterals({
        {R"("\a" \n)", R"("\"\\a\" \n")"},
        {R"("\\a" \n)", R"("\"\\\\a\" \n")"},
    });
}

TEST(Stringize, QuotesOfEitherKindOpenAndCloseALiteral) {
    expectLiterals({
        {R"('a" \n)", R"("'a\" \n")"},
        {R"("it's" \n)", R"("\"it's\" \\n")"},
    });
}

}  // namespace
}  // namespace umpre
