// SPDX-License-Identifier: MIT
#include "expr/literals.h"

#include <cstdint>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/recording_reporter.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using testing::RecordingReporter;
using enum TokenKind;

constexpr bool kSigned = true;
constexpr bool kUnsigned = false;

struct Number {
    TokenKind kind;
    std::string_view text;
    std::uint32_t value;
    bool isSigned;
};

void expectNumbers(const std::vector<Number>& table) {
    for (const Number& row : table) {
        const ExprValue value = integerValue({row.kind, row.text});
        EXPECT_EQ(value.value, row.value) << row.text;
        EXPECT_EQ(value.isSigned, row.isSigned) << row.text;
    }
}

struct Character {
    std::string_view text;
    std::uint32_t value;
    bool isSigned;
};

void expectCharacters(const std::vector<Character>& table) {
    for (const Character& row : table) {
        RecordingReporter reporter;
        const ExprValue value = characterValue(row.text, reporter);
        EXPECT_EQ(value.value, row.value) << row.text;
        EXPECT_EQ(value.isSigned, row.isSigned) << row.text;
        EXPECT_EQ(reporter.report(), "") << row.text;
    }
}

TEST(IntegerValue, IsReadInTheBaseOfItsKind) {
    expectNumbers({
        {INT_DEC, "10", 10, kSigned},
        {INT_DEC, "123456789", 123456789, kSigned},
        {INT_OCT, "0", 0, kSigned},
        {INT_OCT, "010", 8, kSigned},
        {INT_OCT, "01234567", 342391, kSigned},
        {INT_HEX, "0x10", 16, kSigned},
        {INT_HEX, "0XaBcDeF", 0xABCDEF, kSigned},
        {INT_HEX, "0x0123456", 0x123456, kSigned},
    });
}

TEST(IntegerValue, IgnoresALongSuffix) {
    expectNumbers({
        {INT_DEC, "10l", 10, kSigned},
        {INT_DEC, "10L", 10, kSigned},
        {INT_OCT, "07L", 7, kSigned},
        {INT_HEX, "0x1FL", 31, kSigned},
    });
}

TEST(IntegerValue, IsUnsignedWithAnUnsignedSuffix) {
    expectNumbers({
        {UINT_DEC, "10u", 10, kUnsigned},
        {UINT_DEC, "10UL", 10, kUnsigned},
        {UINT_DEC, "10lu", 10, kUnsigned},
        {UINT_OCT, "0u", 0, kUnsigned},
        {UINT_OCT, "017u", 15, kUnsigned},
        {UINT_HEX, "0x1Fu", 31, kUnsigned},
        {UINT_HEX, "0XFFLU", 255, kUnsigned},
    });
}

TEST(IntegerValue, IsUnsignedFromTheTopBitOn) {
    expectNumbers({
        {INT_DEC, "2147483647", 2147483647U, kSigned},
        {INT_DEC, "2147483648", 2147483648U, kUnsigned},
        {INT_HEX, "0x7FFFFFFF", 0x7FFFFFFFU, kSigned},
        {INT_HEX, "0x80000000", 0x80000000U, kUnsigned},
        {INT_OCT, "017777777777", 0x7FFFFFFFU, kSigned},
        {INT_OCT, "020000000000", 0x80000000U, kUnsigned},
        {INT_DEC, "4294967295", 4294967295U, kUnsigned},
    });
}

TEST(IntegerValue, IsTheLargestNumberForAllThatAreTooLarge) {
    expectNumbers({
        {INT_DEC, "4294967296", 4294967295U, kUnsigned},
        {INT_DEC, "99999999999999999999999999999999", 4294967295U, kUnsigned},
        {INT_DEC, "18446744073709551616", 4294967295U, kUnsigned},
        {INT_OCT, "040000000000", 4294967295U, kUnsigned},
        {INT_HEX, "0x100000000", 4294967295U, kUnsigned},
        {INT_HEX, "0x10000000000000000", 4294967295U, kUnsigned},
        {UINT_HEX, "0x123456789u", 4294967295U, kUnsigned},
        {INT_HEX, "0x00000000000000000000001", 1, kSigned},
    });
}

TEST(CharacterValue, HoldsItsCharactersSideBySide) {
    expectCharacters({
        {"'a'", 0x61, kSigned},
        {"'ab'", 0x6162, kSigned},
        {"'abc'", 0x616263, kSigned},
        {"'abcd'", 0x61626364, kSigned},
        {"' '", 0x20, kSigned},
        {"'\"'", 0x22, kSigned},
        {"'\0'"sv, 0, kSigned},
        {"'\ra'", 0x0D61, kSigned},
    });
}

TEST(CharacterValue, TakesAPlainByteForANumberUpTo255) {
    expectCharacters({
        {"'\xFF'", 255, kSigned},
        {"'\x80'", 128, kSigned},
        {"'\xE9\xE9'", 0xE9E9, kSigned},
        {"'\xFFzzz'", 0xFF7A7A7AU, kSigned},
    });
}

TEST(CharacterValue, KnowsTheSimpleEscapes) {
    expectCharacters({
        {R"('\"')", 34, kSigned},
        {R"('\'')", 39, kSigned},
        {R"('\?')", 63, kSigned},
        {R"('\\')", 92, kSigned},
        {R"('\a')", 7, kSigned},
        {R"('\b')", 8, kSigned},
        {R"('\t')", 9, kSigned},
        {R"('\n')", 10, kSigned},
        {R"('\v')", 11, kSigned},
        {R"('\f')", 12, kSigned},
        {R"('\r')", 13, kSigned},
        {R"('\n\t')", 0x0A09, kSigned},
    });
}

TEST(CharacterValue, TakesAnEscapeThatMeansNothingForZero) {
    expectCharacters({
        {R"('\q')", 0, kSigned},
        {R"('\e')", 0, kSigned},
        {R"('\8')", 0, kSigned},
        {R"('\9')", 0, kSigned},
        {R"('\ ')", 0, kSigned},
        {R"('\X41')", 0x3431, kSigned},
        {R"('a\qb')", 0x610062, kSigned},
        {R"('\81')", 0x31, kSigned},
    });
}

TEST(CharacterValue, ReadsOctalEscapesOfAnyLengthIntoEightBits) {
    expectCharacters({
        {R"('\0')", 0, kSigned},
        {R"('\7')", 7, kSigned},
        {R"('\101')", 65, kSigned},
        {R"('\1011')", 9, kSigned},
        {R"('\0000000101')", 65, kSigned},
        {R"('\18')", 0x0138, kSigned},
        {R"('\12a')", 0x0A61, kSigned},
    });
}

TEST(CharacterValue, ReadsHexadecimalEscapesOfAnyLengthIntoEightBits) {
    expectCharacters({
        {R"('\x41')", 65, kSigned},
        {R"('\x4a')", 0x4A, kSigned},
        {R"('\x4A')", 0x4A, kSigned},
        {R"('\x141')", 0x41, kSigned},
        {R"('\x')", 0, kSigned},
        {R"('\xg')", 0x67, kSigned},
        {R"('\x1\x2')", 0x0102, kSigned},
    });
}

TEST(CharacterValue, ExtendsTheSignOfANumberedEscape) {
    expectCharacters({
        {R"('\377')", 4294967295U, kUnsigned},
        {R"('\200')", 0xFFFFFF80U, kUnsigned},
        {R"('\177')", 127, kSigned},
        {R"('\xFF')", 4294967295U, kUnsigned},
        {R"('\x80')", 0xFFFFFF80U, kUnsigned},
        {R"('\x7f')", 127, kSigned},
        {R"('a\xFF')", 0x60FFU, kUnsigned},
        {R"('\377a')", 0xFFFFFF61U, kUnsigned},
    });
}

TEST(CharacterValue, LeavesOutWhatComesAfterFourCharacters) {
    for (const Character& row : {
             Character{"'abcde'", 0x61626364, kSigned},
             Character{"'abcdefgh'", 0x61626364, kSigned},
             Character{R"('\n\n\n\n\n')", 0x0A0A0A0A, kSigned},
         }) {
        RecordingReporter reporter;
        const ExprValue value = characterValue(row.text, reporter);
        EXPECT_EQ(value.value, row.value) << row.text;
        EXPECT_EQ(value.isSigned, row.isSigned) << row.text;
        EXPECT_EQ(reporter.report(), "Too many characters in character literal") << row.text;
    }
}

}  // namespace
}  // namespace umpre
