// SPDX-License-Identifier: MIT
#include "lex/literal.h"

#include <cstddef>
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

void expectScans(const std::vector<Row>& table, bool isClosed) {
    for (const Row& row : table) {
        const LiteralScan scan = scanLiteral(row.text.data(), row.text.data() + row.text.size());
        EXPECT_EQ(scan.isClosed, isClosed) << ::testing::PrintToString(row.text);
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
        true);
}

TEST(Literal, IsNotClosedBehindTheLineEndOrTheEnd) {
    expectScans(
        {
            {"\"", 1},
            {"\"ab", 3},
            {"\"a\n\"", 2},
            {"'a\n'", 2},
            {"\"a'", 3},
            {R"("\")", 3},
        },
        false);
}

TEST(Literal, IsNotClosedBehindAContinuation) {
    expectScans({{"\"a\\\nb\"", 2}, {"'a\\\r\nb'", 2}, {"\"a\\", 2}}, false);
}

TEST(Literal, OfACharacterHoldsAtLeastOne) {
    expectScans({{"''", 1}, {"'''", 1}}, false);
}

}  // namespace
}  // namespace umpre
