// SPDX-License-Identifier: MIT
#include "lex/spelling.h"

#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>

#include "lex/byte_block.h"

namespace umpre {
namespace {

using enum TokenKind;

constexpr std::size_t kLongestWord = 7;

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

// The words that are no identifiers, each in the place that its number leads to.
struct Words {
    struct Word {
        std::uint64_t bytes = 0;
        TokenKind kind = IDENTIFIER;
    };

    [[nodiscard]] static constexpr std::size_t placeOf(std::uint64_t bytes) noexcept {
        return bytes * 0x44D565AD0A4E8BD5U >> 60U;  // found by trying: all places differ
    }

    constexpr void add(std::string_view word, TokenKind kind) {
        Word& place = places[placeOf(packed(word))];
        place = place.bytes == 0 ? Word{packed(word), kind} : throw kind;
    }

    std::array<Word, 16> places{};
};

constexpr Words kWords = [] {
    Words words;
    words.add("if", KW_IF);
    words.add("ifdef", KW_IFDEF);
    words.add("ifndef", KW_IFNDEF);
    words.add("else", KW_ELSE);
    words.add("elif", KW_ELIF);
    words.add("endif", KW_ENDIF);
    words.add("include", KW_INCLUDE);
    words.add("define", KW_DEFINE);
    words.add("undef", KW_UNDEF);
    words.add("line", KW_LINE);
    words.add("error", KW_ERROR);
    words.add("pragma", KW_PRAGMA);
    words.add("ident", KW_IDENT);
    words.add("defined", KW_DEFINED);
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
    const Words::Word& word = kWords.places[Words::placeOf(bytes)];
    return word.bytes == bytes ? word.kind : IDENTIFIER;
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
