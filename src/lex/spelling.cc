// SPDX-License-Identifier: MIT
#include "lex/spelling.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>

#include "lex/byte_block.h"

namespace umpre {
namespace {

using enum TokenKind;

struct Word {
    std::string_view text;
    TokenKind kind;
};

// The words that are no identifiers, of two to eight bytes each.
constexpr std::array kWords{
    Word{"if", KW_IF},           Word{"ifdef", KW_IFDEF},     Word{"ifndef", KW_IFNDEF},
    Word{"else", KW_ELSE},       Word{"elif", KW_ELIF},       Word{"endif", KW_ENDIF},
    Word{"include", KW_INCLUDE}, Word{"define", KW_DEFINE},   Word{"undef", KW_UNDEF},
    Word{"line", KW_LINE},       Word{"error", KW_ERROR},     Word{"pragma", KW_PRAGMA},
    Word{"ident", KW_IDENT},     Word{"defined", KW_DEFINED},
};

constexpr std::size_t kLongestWord =
    std::ranges::max(kWords, {}, [](const Word& word) { return word.text.size(); }).text.size();

// A word of up to eight bytes as a number, the first byte in the lowest bits.
[[nodiscard]] constexpr std::uint64_t packed(std::string_view word) noexcept {
    std::uint64_t bytes = 0;
    for (std::size_t at = word.size(); at > 0; --at) {
        bytes = bytes << 8U | static_cast<unsigned char>(word[at - 1]);
    }
    return bytes;
}

// The same for two to eight bytes that may be read together.
[[nodiscard]] std::uint64_t packedQuickly(std::string_view word) noexcept {
    if constexpr (std::endian::native != std::endian::little) {
        return packed(word);
    }
    const auto join = [word](auto part) {
        const std::size_t rest = word.size() - sizeof(part);
        std::memcpy(&part, word.data(), sizeof(part));
        const std::uint64_t first = part;
        std::memcpy(&part, word.data() + rest, sizeof(part));
        return first | std::uint64_t{part} << 8 * rest;  // bytes that both hold are the same
    };
    return word.size() < sizeof(std::uint32_t) ? join(std::uint16_t{}) : join(std::uint32_t{});
}

// The words, each in the place that its number and the factor lead to.
struct WordPlaces {
    struct Place {
        std::uint64_t bytes = 0;
        TokenKind kind = IDENTIFIER;
    };

    [[nodiscard]] constexpr std::size_t placeOf(std::uint64_t bytes) const noexcept {
        return bytes * factor >> 59U;
    }

    // Returns whether all places differ.
    [[nodiscard]] constexpr bool fill() noexcept {
        places = {};
        for (const Word& word : kWords) {
            const std::uint64_t bytes = packed(word.text);
            Place& place = places[placeOf(bytes)];
            if (place.bytes != 0) {
                return false;
            }
            place = {bytes, word.kind};
        }
        return true;
    }

    std::uint64_t factor = 0x9E3779B97F4A7C15U;
    std::array<Place, 32> places{};
};

constexpr WordPlaces kWordPlaces = [] {
    WordPlaces words;
    while (!words.fill()) {
        words.factor = words.factor * 0x5851F42D4C957F2DU + 2;  // another odd number
    }
    return words;
}();

[[nodiscard]] bool isHexDigit(char byte) noexcept {
    const char lower = static_cast<char>(byte | 0x20);
    return isDigit(byte) || (lower >= 'a' && lower <= 'f');
}

[[nodiscard]] bool isEither(char byte, char lower) noexcept {
    return (byte | 0x20) == lower;
}

// Returns the end of the suffix that may stand at `at`: "u" or "l" or one of each, in any case.
[[nodiscard]] const char* suffixEnd(const char* at, bool& isUnsigned) noexcept {
    if (isEither(*at, 'u')) {
        isUnsigned = true;
        return isEither(at[1], 'l') ? at + 2 : at + 1;
    }
    if (isEither(*at, 'l')) {
        isUnsigned = isEither(at[1], 'u');
        return isUnsigned ? at + 2 : at + 1;
    }
    return at;
}

// The kinds of all bytes as tokens by themselves.
constexpr std::array<TokenKind, 256> kSingles = [] {
    std::array<TokenKind, 256> kinds{};
    kinds.fill(OTHER);
    for (const char byte : std::string_view("#(),?:|^&<>+-*/%!~")) {
        kinds[static_cast<unsigned char>(byte)] = static_cast<TokenKind>(byte);
    }
    return kinds;
}();

// Returns the kind of a punctuator of two characters, or OTHER if these are none.
[[nodiscard]] TokenKind kindOfPair(char first, char second) noexcept {
    if (second == '=') {
        switch (first) {
        case '=': return EQ;
        case '!': return NE;
        case '<': return LE;
        case '>': return GE;
        default: return OTHER;
        }
    }
    if (second != first) {
        return OTHER;
    }
    switch (first) {
    case '#': return PASTE;
    case '|': return OROR;
    case '&': return ANDAND;
    case '<': return LSHIFT;
    case '>': return RSHIFT;
    default: return OTHER;
    }
}

}  // namespace

TokenKind kindOfName(std::string_view name) noexcept {
    if (name.size() < 2 || name.size() > kLongestWord) {
        return IDENTIFIER;
    }
    const std::uint64_t bytes = packedQuickly(name);
    const WordPlaces::Place& place = kWordPlaces.places[kWordPlaces.placeOf(bytes)];
    return place.bytes == bytes ? place.kind : IDENTIFIER;
}

const char* nameEndAhead(const char* at) noexcept {
    using Block = BasicByteBlock<BaseVector, 16>;
    for (;; at += Block::kSize) {
        const Block block(at);
        const auto others = ~(block.letters() | block.digits()) & bitsBelow(Block::kSize);
        if (others != 0) {
            return at + firstBit(others);
        }
    }
}

Token numberAt(const char* at) noexcept {
    const char* end = at;
    TokenKind kind = INT_DEC;
    TokenKind unsignedKind = UINT_DEC;
    if (*at != '0') {
        while (isDigit(*end)) {
            ++end;
        }
    } else if (isEither(at[1], 'x') && isHexDigit(at[2])) {
        kind = INT_HEX;
        unsignedKind = UINT_HEX;
        for (end += 2; isHexDigit(*end);) {
            ++end;
        }
    } else {
        kind = INT_OCT;
        unsignedKind = UINT_OCT;
        while (*end >= '0' && *end <= '7') {
            ++end;
        }
    }
    bool isUnsigned = false;
    end = suffixEnd(end, isUnsigned);
    return {isUnsigned ? unsignedKind : kind, {at, static_cast<std::size_t>(end - at)}};
}

Token tokenAt(const char* at) noexcept {
    if (isNameStart(*at)) {
        const std::string_view name(at, static_cast<std::size_t>(nameEnd(at) - at));
        return {kindOfName(name), name};
    }
    if (isDigit(*at)) {
        return numberAt(at);
    }
    const TokenKind pair = kindOfPair(*at, at[1]);
    if (pair != OTHER) {
        return {pair, {at, 2}};
    }
    const bool isComment = *at == '/' && (at[1] == '/' || at[1] == '*');
    return {isComment ? OTHER : kSingles[static_cast<unsigned char>(*at)], {at, 1}};
}

}  // namespace umpre
