// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_TEXT_PLACES_H
#define UMPRE_MACROS_TEXT_PLACES_H

#include "lex/byte_block.h"
#include "lex/spelling.h"

namespace umpre {

/// Which places a reader of a text looks at, beside those where names, numbers that are more than
/// decimal digits, and literals begin, and those of slashes, backslashes, line ends and zero bytes.
enum class PlacesFor {
    Tokens,
    Arguments,  ///< "(", ")", ",", and blanks that are more than a space before a token
};

/// Finds the places in a text where a reader of its tokens has something to look at, 32 bytes at a
/// time; from each byte of it so many can be read. A place that is none of them may be among them.
template <PlacesFor kFor>
class TextPlaces {
public:
    /// A token begins where the text does.
    explicit TextPlaces(const char* begin) noexcept : begin_(begin), behind_(begin) {}

    /// Returns the next place, or `end` if there is none before it.
    [[nodiscard]] const char* next(const char* end) noexcept {
        while (left_ == 0) {
            if (behind_ >= end) {
                return end;
            }
            look(behind_);
        }
        const char* const place = begin_ + firstBit(left_);
        if (place >= end) {
            return end;
        }
        left_ &= left_ - 1;
        return place;
    }

    /// Goes on at `at`, where a token begins, or behind it.
    void resume(const char* at) noexcept {
        if (at >= behind_) {
            // Often an argument ends here. No more is looked at yet.
            const bool isPlace = kFor == PlacesFor::Arguments && isDelimiter(*at);
            begin_ = at;
            behind_ = at + (isPlace ? 1 : 0);
            left_ = isPlace ? 1 : 0;
        } else if (at > begin_) {
            left_ &= ~Mask{0} << (at - begin_);
        }
    }

    /// Returns the end of the name that begins at `at`, the place that was found last, and goes on
    /// there.
    [[nodiscard]] const char* passName(const char* at) noexcept {
        const char* const behind = at + firstBit(~(words_ >> (at - begin_)));
        return behind < behind_ ? behind : passRest(behind);
    }

    /// Returns the end of the number that begins at `at`, the place that was found last, and goes
    /// on there.
    const char* passNumber(const char* at) noexcept {
        const char* const behind = at + numberAt(at).text.size();
        if (isWordByte(*behind)) {
            behind_ = behind;  // the next token begins within the word
        }
        resume(behind);
        return behind;
    }

private:
    using Block = BasicByteBlock<BaseVector, 32>;
    using Mask = Block::Mask;

    [[nodiscard]] static bool isDelimiter(char byte) noexcept {
        return byte == ',' || byte == '(' || byte == ')';
    }

    [[nodiscard]] const char* passRest(const char* at) noexcept {
        const char* const behind = nameEnd(at);
        resume(behind);
        return behind;
    }

    void look(const char* at) noexcept {
        const Block bytes(at);
        begin_ = at;
        behind_ = at + Block::kSize;
        const Mask letters = bytes.letters();
        const Mask digits = bytes.digits();
        words_ = letters | digits;
        const Mask blanks = bytes.blanksAndUnusual();
        left_ = wordStarts(letters, digits);
        if constexpr (kFor == PlacesFor::Arguments) {
            constexpr Mask kLast = Mask{1} << (Block::kSize - 1);
            const Mask spaces = bytes.any(' ') & ~(blanks >> 1U | kLast);
            // Parentheses, commas and quotes, and what differs from them in two bits: "-#&".
            left_ |= (blanks & ~spaces) | bytes.anyWith(5, '-', '\'') | bytes.any('\\', '/');
        } else {
            left_ |= (blanks & ~bytes.any(' ')) | bytes.any('"', '\'', '\\', '/');
        }
    }

    // Returns where words begin, but for numbers, if all of these are decimal digits alone.
    [[nodiscard]] static Mask wordStarts(Mask letters, Mask digits) noexcept {
        constexpr Mask kBehind = Mask{1} << Block::kSize;
        const Mask words = letters | digits;
        const Mask starts = words & ~(words << 1U);
        // Added to the first digit of a number, it is carried behind the last one.
        const Mask behindDigits = digits + (starts & digits);
        return (behindDigits & (letters | kBehind)) == 0 ? starts & letters : starts;
    }

    // What was looked at last, and the places there that were not found yet.
    const char* begin_;
    const char* behind_;
    Mask left_ = 0;
    Mask words_ = 0;
};

}  // namespace umpre

#endif
