// SPDX-License-Identifier: MIT
#include "lex/literal.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;

struct Row {
    std::string_view text;
    std::size_t size;  // of the literal, or up to where it showed that there is none
};

using Result = LiteralScan::Result;

void expectScans(const std::vector<Row>& table, Result result) {
    for (const Row& row : table) {
        const LiteralScan scan = scanLiteral(row.text.data(), row.text.data() + row.text.size());
        EXPECT_EQ(scan.result, result) << ::testing::PrintToString(row.text);
        EXPECT_EQ(scan.end, row.text.data() + row.size) << ::testing::PrintToString(row.text);
    }
}

TEST(Literal, EndsBehindItsClosingQuote) {
    expectScans(
        {
            {R"("")", 2},
            {R"("a" "b")", 3},
            {R"("\"" ")", 4},
            {R"("\\" ")", 4},
            {R"("it's")", 6},
            {"\"a\0b\""sv, 5},
            {"\"\r\"", 3},
            {"'a'", 3},
            {"'ab' 'c'", 4},
            {R"('\'')", 4},
            {R"('"')", 3},
        },
        Result::Closed);
}

TEST(Literal, IsOpenAtTheLineEnd) {
    expectScans(
        {
            {"\"a\n\"", 2},
            {"'a\n'", 2},
        },
        Result::Open);
}

TEST(Literal, IsOpenAtAContinuation) {
    expectScans({{"\"a\\\nb\"", 2}, {"'a\\\r\nb'", 2}}, Result::Open);
}

TEST(Literal, OfACharacterHoldsAtLeastOne) {
    expectScans({{"''", 1}, {"\x27''", 1}}, Result::Open);
}

TEST(Literal, IsCutWhereNothingTells) {
    expectScans(
        {
            {"\"", 1},
            {"\"ab", 3},
            {"\"a'", 3},
            {R"("\")", 3},
            {"\"a\\", 2},
            {"'", 1},
        },
        Result::Cut);
}

TEST(Literal, EndsWhereItEndsHoweverLongItIs) {
    for (std::size_t size = 0; size < 200; ++size) {
        const std::string memory = "\"" + std::string(size, 'a') + R"(\\")" + std::string(70, ' ');
        const char* const text = memory.data();
        EXPECT_EQ(scanLiteral(text, text + memory.size()).end, text + size + 4);
        EXPECT_EQ(scanLiteral(text, text + size + 4).result, Result::Closed);
        EXPECT_EQ(scanLiteral(text, text + size + 3).result, Result::Cut);
    }
}

// The result of finding the literal whose quote stands at this place of a text.
[[nodiscard]] Result found(LiteralFinder& literals, std::string_view text, std::size_t quote,
                           bool isLast = false) {
    return literals.find(text.data() + quote, text.data() + text.size(), isLast).result;
}

TEST(LiteralFinder, FindsLiteralsInAnyOrder) {
    const std::string_view text = R"("a" 'b' "c 'd' "e)";
    LiteralFinder literals;
    for (const std::size_t quote : {15U, 8U, 15U, 0U, 4U, 10U, 8U}) {
        const Result expected = quote == 15 ? Result::Open : Result::Closed;
        EXPECT_EQ(found(literals, text, quote, true), expected) << quote;
    }
}

TEST(LiteralFinder, KnowsThatTheQuotesBehindAnOpenOneAreOpen) {
    const std::string_view text = R"("a\"b\"c)"
                                  "\n\"\"";
    LiteralFinder literals;
    for (const std::size_t quote : {0U, 3U, 6U}) {
        EXPECT_EQ(found(literals, text, quote), Result::Open) << quote;
    }
    EXPECT_EQ(found(literals, text, 9), Result::Closed);
}

TEST(LiteralFinder, ForgetsWhatItKnewOfBytesThatMoved) {
    std::string text = R"("a\"b)";
    LiteralFinder literals;
    EXPECT_EQ(found(literals, text, 0, true), Result::Open);
    text.back() = '"';
    literals.forget();
    EXPECT_EQ(found(literals, text, 3, true), Result::Closed);
}

TEST(LiteralFinder, CutsNoLiteralAtTheEnd) {
    LiteralFinder literals;
    EXPECT_EQ(found(literals, "\"a", 0), Result::Cut);
    EXPECT_EQ(found(literals, "\"a", 0, true), Result::Open);
}

}  // namespace
}  // namespace umpre
