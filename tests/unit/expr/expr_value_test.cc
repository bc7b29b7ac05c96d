// SPDX-License-Identifier: MIT
#include "expr/expr_value.h"

#include <array>
#include <cstdint>
#include <ostream>
#include <vector>

#include <gtest/gtest.h>

#include "support/lexeme.h"

namespace umpre {

void PrintTo(const ExprValue& value, std::ostream* out) {
    *out << value.value << (value.isSigned ? " signed" : " unsigned");
}

namespace {

using enum TokenKind;

constexpr std::uint32_t kTop = 0x80000000U;
constexpr std::uint32_t kAll = 0xFFFFFFFFU;

// Signed and unsigned values, written as in a condition.
[[nodiscard]] constexpr ExprValue s(std::int64_t value) {
    return {static_cast<std::uint32_t>(value), true};
}

[[nodiscard]] constexpr ExprValue u(std::uint32_t value) {
    return {value, false};
}

struct Binary {
    ExprValue left;
    TokenKind operation;
    ExprValue right;
    ExprValue result;
};

void expectResults(const std::vector<Binary>& table) {
    for (const Binary& row : table) {
        EXPECT_EQ(applyBinary(row.operation, row.left, row.right), row.result)
            << ::testing::PrintToString(row.left) << " " << ::testing::PrintToString(row.operation)
            << " " << ::testing::PrintToString(row.right);
    }
}

struct Unary {
    TokenKind operation;
    ExprValue operand;
    ExprValue result;
};

void expectResults(const std::vector<Unary>& table) {
    for (const Unary& row : table) {
        EXPECT_EQ(applyUnary(row.operation, row.operand), row.result)
            << ::testing::PrintToString(row.operation) << " "
            << ::testing::PrintToString(row.operand);
    }
}

TEST(ExprValue, IsASignedZeroAtFirst) {
    EXPECT_EQ(ExprValue(), s(0));
}

TEST(ExprValue, FromBitsAloneIsSignedIfTheTopBitIsClear) {
    EXPECT_EQ(ExprValue::fromPattern(0), s(0));
    EXPECT_EQ(ExprValue::fromPattern(kTop - 1), s(2147483647));
    EXPECT_EQ(ExprValue::fromPattern(kTop), u(kTop));
    EXPECT_EQ(ExprValue::fromPattern(kAll), u(kAll));
}

TEST(ExprValue, AUnaryOperatorKeepsTheFlag) {
    expectResults(std::vector<Unary>{
        {BANG, s(0), s(1)},
        {BANG, s(5), s(0)},
        {BANG, u(0), u(1)},
        {BANG, u(kTop), u(0)},
        {TILDE, s(0), s(-1)},
        {TILDE, u(0), u(kAll)},
        {TILDE, s(5), s(-6)},
        {MINUS, s(5), s(-5)},
        {MINUS, u(1), u(kAll)},
        {MINUS, s(-2147483648), s(-2147483648)},
        {MINUS, s(0), s(0)},
        {PLUS, s(-5), s(-5)},
        {PLUS, u(5), u(5)},
    });
}

TEST(ExprValue, ABinaryResultIsSignedIfBothOperandsAre) {
    constexpr auto kOperations =
        std::to_array<TokenKind>({OROR, ANDAND, BAR, CARET, AMPERSAND, EQ, NE, LESS, GREATER, LE,
                                  GE, LSHIFT, RSHIFT, PLUS, MINUS, STAR, SLASH, PERCENT});
    for (const TokenKind operation : kOperations) {
        SCOPED_TRACE(::testing::PrintToString(operation));
        EXPECT_TRUE(applyBinary(operation, s(7), s(2)).isSigned);
        EXPECT_FALSE(applyBinary(operation, u(7), s(2)).isSigned);
        EXPECT_FALSE(applyBinary(operation, s(7), u(2)).isSigned);
        EXPECT_FALSE(applyBinary(operation, u(7), u(2)).isSigned);
    }
}

TEST(ExprValue, LogicalOperatorsGiveOneOrZero) {
    expectResults(std::vector<Binary>{
        {s(0), OROR, s(0), s(0)},
        {s(0), OROR, s(-3), s(1)},
        {s(9), OROR, s(0), s(1)},
        {s(9), OROR, s(9), s(1)},
        {s(0), ANDAND, s(0), s(0)},
        {s(0), ANDAND, s(3), s(0)},
        {s(9), ANDAND, s(0), s(0)},
        {s(9), ANDAND, s(-1), s(1)},
        {u(0), OROR, s(2), u(1)},
    });
}

TEST(ExprValue, BitOperatorsWorkOnThePatterns) {
    expectResults(std::vector<Binary>{
        {s(12), BAR, s(10), s(14)},
        {s(12), CARET, s(10), s(6)},
        {s(12), AMPERSAND, s(10), s(8)},
        {s(-1), AMPERSAND, s(255), s(255)},
        {u(kTop), BAR, s(1), u(kTop + 1)},
        {s(-1), CARET, s(-1), s(0)},
    });
}

TEST(ExprValue, EqualityComparesThePatterns) {
    expectResults(std::vector<Binary>{
        {s(3), EQ, s(3), s(1)},
        {s(3), EQ, s(4), s(0)},
        {u(kAll), EQ, s(-1), u(1)},
        {s(3), NE, s(3), s(0)},
        {s(3), NE, s(4), s(1)},
        {u(kAll), NE, s(-1), u(0)},
    });
}

TEST(ExprValue, ComparisonIsSignedIfBothOperandsAre) {
    expectResults(std::vector<Binary>{
        {s(-1), LESS, s(0), s(1)},
        {s(-1), LESS, u(0), u(0)},
        {u(kAll), LESS, s(0), u(0)},
        {s(2), LESS, s(2), s(0)},
        {s(-1), GREATER, s(0), s(0)},
        {s(-1), GREATER, u(0), u(1)},
        {s(2), GREATER, s(2), s(0)},
        {s(-1), LE, s(0), s(1)},
        {s(-1), LE, u(0), u(0)},
        {s(2), LE, s(2), s(1)},
        {s(-1), GE, s(0), s(0)},
        {s(-1), GE, u(0), u(1)},
        {s(2), GE, s(2), s(1)},
        {s(-2147483648), LESS, s(2147483647), s(1)},
    });
}

TEST(ExprValue, ShiftsTakeTheirCountModulo32) {
    expectResults(std::vector<Binary>{
        {s(1), LSHIFT, s(4), s(16)},
        {s(1), LSHIFT, s(31), s(-2147483648)},
        {s(1), LSHIFT, s(32), s(1)},
        {s(1), LSHIFT, s(33), s(2)},
        {s(1), LSHIFT, s(-1), s(-2147483648)},
        {s(256), RSHIFT, s(4), s(16)},
        {s(256), RSHIFT, s(36), s(16)},
        {u(kTop), RSHIFT, s(31), u(1)},
        {s(5), RSHIFT, u(64), u(5)},
    });
}

TEST(ExprValue, ARightShiftFillsWithZeros) {
    expectResults(std::vector<Binary>{
        {s(-8), RSHIFT, s(1), s(2147483644)},
        {s(-16), RSHIFT, s(2), s(1073741820)},
        {s(-1), RSHIFT, s(31), s(1)},
        {s(-1), RSHIFT, s(0), s(-1)},
    });
}

TEST(ExprValue, ArithmeticWrapsAround) {
    expectResults(std::vector<Binary>{
        {s(2), PLUS, s(3), s(5)},
        {s(2147483647), PLUS, s(1), s(-2147483648)},
        {u(kAll), PLUS, s(2), u(1)},
        {s(2), MINUS, s(3), s(-1)},
        {u(2), MINUS, s(3), u(kAll)},
        {s(-2147483648), MINUS, s(1), s(2147483647)},
        {s(-3), STAR, s(4), s(-12)},
        {s(65536), STAR, s(65536), s(0)},
        {s(2147483647), STAR, s(2147483647), s(1)},
        {u(kAll), STAR, u(kAll), u(1)},
    });
}

TEST(ExprValue, SignedDivisionTruncatesTowardZero) {
    expectResults(std::vector<Binary>{
        {s(7), SLASH, s(2), s(3)},
        {s(-7), SLASH, s(2), s(-3)},
        {s(7), SLASH, s(-2), s(-3)},
        {s(-7), SLASH, s(-2), s(3)},
        {s(7), PERCENT, s(2), s(1)},
        {s(-7), PERCENT, s(2), s(-1)},
        {s(7), PERCENT, s(-2), s(1)},
        {s(-7), PERCENT, s(-2), s(-1)},
        {s(-2147483648), SLASH, s(1), s(-2147483648)},
        {s(2147483647), SLASH, s(-1), s(-2147483647)},
    });
}

TEST(ExprValue, DivisionIsUnsignedIfOneOperandIs) {
    expectResults(std::vector<Binary>{
        {s(-1), SLASH, u(2), u(2147483647)},
        {u(kAll), SLASH, s(2), u(2147483647)},
        {s(-1), PERCENT, u(10), u(5)},
        {s(-2147483648), SLASH, u(kAll), u(0)},
        {u(kTop), PERCENT, s(-1), u(kTop)},
    });
}

TEST(ExprValue, DivisionThatTheMachineCannotCarryOutThrows) {
    for (const TokenKind operation : {SLASH, PERCENT}) {
        EXPECT_THROW((void)applyBinary(operation, s(1), s(0)), ArithmeticFault);
        EXPECT_THROW((void)applyBinary(operation, u(1), s(0)), ArithmeticFault);
        EXPECT_THROW((void)applyBinary(operation, s(0), u(0)), ArithmeticFault);
        EXPECT_THROW((void)applyBinary(operation, s(-2147483648), s(-1)), ArithmeticFault);
        EXPECT_NO_THROW((void)applyBinary(operation, u(kTop), s(-1)));
        EXPECT_NO_THROW((void)applyBinary(operation, s(-2147483648), u(kAll)));
    }
}

TEST(ExprValue, BinaryOperatorsBindInTenLevels) {
    const std::vector<std::vector<TokenKind>> levels{
        {OROR},
        {ANDAND},
        {BAR},
        {CARET},
        {AMPERSAND},
        {EQ, NE},
        {LESS, GREATER, LE, GE},
        {LSHIFT, RSHIFT},
        {PLUS, MINUS},
        {STAR, SLASH, PERCENT},
    };
    ASSERT_EQ(levels.size(), static_cast<std::size_t>(kTightest));
    for (std::size_t level = 0; level < levels.size(); ++level) {
        for (const TokenKind operation : levels[level]) {
            EXPECT_EQ(precedenceOf(operation), static_cast<int>(level) + 1)
                << ::testing::PrintToString(operation);
        }
    }
}

TEST(ExprValue, OtherTokensDoNotBind) {
    for (const TokenKind kind :
         {END_OF_INPUT, BANG, HASH, LEFT_PARENTHESIS, RIGHT_PARENTHESIS, COMMA, COLON, QUESTION,
          TILDE, NEWLINE, WHITESPACE, PASTE, KW_IF, IDENTIFIER, OTHER, KW_DEFINED, INT_DEC}) {
        EXPECT_EQ(precedenceOf(kind), 0) << ::testing::PrintToString(kind);
    }
}

}  // namespace
}  // namespace umpre
