// SPDX-License-Identifier: MIT
#include "lex/byte_block.h"

#include <array>
#include <cstddef>
#include <string>

#include <gtest/gtest.h>

#include "lex/spelling.h"

namespace umpre {
namespace {

using Mask = ByteBlock::Mask;

// All 256 bytes, 64 at a time.
template <typename Test>
void expectMasks(Mask (ByteBlock::*mask)() const noexcept, Test test) {
    for (unsigned first = 0; first < 256; first += 64) {
        std::array<char, 64> bytes{};
        Mask expected = 0;
        for (unsigned place = 0; place < 64; ++place) {
            bytes[place] = static_cast<char>(first + place);
            expected |= static_cast<Mask>(test(bytes[place])) << place;
        }
        EXPECT_EQ((ByteBlock(bytes.data()).*mask)(), expected) << first;
    }
}

TEST(ByteBlock, KnowsLetters) {
    expectMasks(&ByteBlock::letters, isNameStart);
}

TEST(ByteBlock, KnowsDigits) {
    expectMasks(&ByteBlock::digits, isDigit);
}

TEST(ByteBlock, KnowsBlanksAndUnusualBytes) {
    expectMasks(&ByteBlock::blanksAndUnusual, [](char byte) {
        const auto code = static_cast<unsigned char>(byte);
        return code <= ' ' || code > 127;
    });
}

TEST(ByteBlock, FindsAnyOfSomeBytes) {
    const std::string text = "a,b;" + std::string(58, ' ') + ";,";
    const ByteBlock block(text.data());
    EXPECT_EQ(block.any(','), Mask{1} << 63U | 2U);
    EXPECT_EQ(block.any(',', ';'), Mask{3} << 62U | 10U);
    EXPECT_EQ(block.any('x', '\0'), 0U);
}

TEST(ByteBlock, TakesNoBytesBehindTheEnd) {
    const std::string text(80, 'a');
    for (std::size_t size = 0; size <= 70; ++size) {
        const ByteBlock block = ByteBlock::between(text.data(), text.data() + size);
        EXPECT_EQ(block.any('a'), bitsBelow(size)) << size;
    }
}

TEST(ByteBlock, FindsAndCountsBits) {
    EXPECT_EQ(firstBit(1), 0U);
    EXPECT_EQ(firstBit(Mask{5} << 61U), 61U);
    EXPECT_EQ(bitsBelow(0), 0U);
    EXPECT_EQ(bitsBelow(3), 7U);
    EXPECT_EQ(bitsBelow(64), ~Mask{0});
    EXPECT_EQ(countBits(0), 0U);
    EXPECT_EQ(countBits(~Mask{0}), 64U);
    EXPECT_EQ(countBits(0x8000000100010101U), 5U);
}

}  // namespace
}  // namespace umpre
