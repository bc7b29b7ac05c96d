// SPDX-License-Identifier: MIT
#include "lex/text_masks.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <random>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "lex/spelling.h"

namespace umpre {
namespace {

constexpr std::size_t kBlock = 64;

// The masks as they are defined, found byte by byte.
[[nodiscard]] std::vector<TextMasks> expectedMasks(std::string_view bytes) {
    std::vector<TextMasks> found(bytes.size() / kBlock);
    bool isEscaped = false;
    bool isOdd = false;
    std::size_t lineFeeds = 0;
    for (std::size_t at = 0; at < bytes.size(); ++at) {
        TextMasks& masks = found[at / kBlock];
        const bool isLast = at % kBlock == kBlock - 1;
        if (at % kBlock == 0) {
            masks = {};
            masks.lineFeedsBefore = lineFeeds;
            isOdd = false;
        }
        const TextMasks::Mask bit = TextMasks::Mask{1} << at % kBlock;
        const auto set = [bit](TextMasks::Mask& mask, bool isSet) { mask |= isSet ? bit : 0; };
        const char byte = bytes[at];
        const char next = isLast ? '/' : bytes[at + 1];
        const char last = at == 0 ? ' ' : bytes[at - 1];
        const bool isLineEnd = byte == '\n' || byte == '\r';
        isOdd ^= byte == '"' && !isEscaped;
        lineFeeds += byte == '\n' ? 1 : 0;
        set(masks.lineFeeds, byte == '\n');
        set(masks.lineEnds, isLineEnd);
        set(masks.special, std::string_view("'\\#\r").find(byte) != std::string_view::npos
                               || (byte == '/' && (next == '/' || next == '*')));
        set(masks.strings, isOdd);
        set(masks.characterStops, isLineEnd || (byte == '\'' && !isEscaped));
        set(masks.commentStops, byte == '\r' || (byte == '/' && last == '*'));
        isEscaped = byte == '\\' && !isEscaped;
    }
    return found;
}

[[nodiscard]] std::array<std::size_t, 7> numbersOf(const TextMasks& masks) {
    return {masks.lineFeeds,      masks.lineEnds,     masks.special,        masks.strings,
            masks.characterStops, masks.commentStops, masks.lineFeedsBefore};
}

[[nodiscard]] std::string soup(unsigned seed, std::size_t size) {
    constexpr std::string_view kBytes = "\"\"'\\\\\\/*/*\n\n\r#ab 1\x80\xFF";
    std::mt19937 random(seed);
    std::string bytes(size, ' ');
    for (char& byte : bytes) {
        byte = kBytes[random() % kBytes.size()];
    }
    return bytes;
}

void expectMasks(const TextMaskFinder& finder, std::string_view bytes, std::size_t blocksTogether) {
    std::vector<TextMasks> found(bytes.size() / kBlock);
    BytesBefore before;
    for (std::size_t at = 0; at < found.size(); at += blocksTogether) {
        finder.findText(bytes.data() + at * kBlock, std::min(blocksTogether, found.size() - at),
                        before, found.data() + at);
    }
    const std::vector<TextMasks> expected = expectedMasks(bytes);
    for (std::size_t at = 0; at < found.size(); ++at) {
        ASSERT_EQ(numbersOf(found[at]), numbersOf(expected[at])) << at;
    }
}

// The finders that work on this processor: those of the lesser ones, too.
[[nodiscard]] std::vector<const TextMaskFinder*> finders() {
    std::vector<const TextMaskFinder*> all{&baseTextMaskFinder(), &textMaskFinder()};
    if (&textMaskFinder() == widestTextMaskFinder()) {
        all.push_back(wideTextMaskFinder());
    }
    return all;
}

void expectMasks(std::string_view bytes, std::size_t blocksTogether) {
    for (const TextMaskFinder* const finder : finders()) {
        expectMasks(*finder, bytes, blocksTogether);
    }
}

TEST(TextMasks, SayWhatStandsWhere) {
    for (unsigned seed = 0; seed < 50; ++seed) {
        const std::string bytes = soup(seed, 16 * kBlock);
        expectMasks(bytes, 1 + seed % 3);
    }
}

TEST(TextMasks, FollowBackslashesOverBlocks) {
    for (std::size_t first = 60; first < 68; ++first) {
        for (std::size_t count = 1; count < 140; ++count) {
            std::string bytes(4 * kBlock, ' ');
            bytes.replace(first, count + 2, std::string(count, '\\') + "\"'");
            expectMasks(bytes, 2);
        }
    }
}

// All 256 bytes, 64 at a time.
template <typename Masks, typename Test>
void expectMask(Masks (*TextMaskFinder::*find)(const char*), TextMasks::Mask Masks::*mask,
                Test test) {
    for (unsigned first = 0; first < 256; first += kBlock) {
        std::array<char, kBlock> bytes{};
        TextMasks::Mask expected = 0;
        for (unsigned place = 0; place < kBlock; ++place) {
            bytes[place] = static_cast<char>(first + place);
            expected |= static_cast<TextMasks::Mask>(test(bytes[place])) << place;
        }
        for (const TextMaskFinder* const finder : finders()) {
            EXPECT_EQ((finder->*find)(bytes.data()).*mask, expected) << first;
        }
    }
}

TEST(TextMasks, KnowWords) {
    expectMask(&TextMaskFinder::wordsIn, &WordMasks::letters, isNameStart);
    expectMask(&TextMaskFinder::wordsIn, &WordMasks::digits, isDigit);
    expectMask(&TextMaskFinder::wordsIn, &WordMasks::blanksAndUnusual, [](char byte) {
        const auto code = static_cast<unsigned char>(byte);
        return code <= ' ' || code > 127;
    });
}

TEST(TextMasks, KnowWhatNumbersAreToldBy) {
    const auto isOneOf = [](std::string_view bytes) {
        return [bytes](char byte) { return bytes.find(byte) != std::string_view::npos; };
    };
    expectMask(&TextMaskFinder::numbersIn, &NumberMasks::zeros, isOneOf("0"));
    expectMask(&TextMaskFinder::numbersIn, &NumberMasks::xs, isOneOf("xX"));
    expectMask(&TextMaskFinder::numbersIn, &NumberMasks::us, isOneOf("uU"));
    expectMask(&TextMaskFinder::numbersIn, &NumberMasks::ls, isOneOf("lL"));
    expectMask(&TextMaskFinder::numbersIn, &NumberMasks::hexLetters, isOneOf("abcdefABCDEF"));
}

}  // namespace
}  // namespace umpre
