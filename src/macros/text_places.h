// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_TEXT_PLACES_H
#define UMPRE_MACROS_TEXT_PLACES_H

#include <array>
#include <bit>
#include <cstddef>
#include <string_view>

#include "lex/byte_block.h"
#include "lex/spelling.h"

namespace umpre {

/// Which places a reader of a text looks at, beside those where names, numbers and literals begin,
/// and those of slashes, backslashes, line ends and zero bytes.
enum class PlacesFor {
    Tokens,
    Arguments,  ///< "(", ")", ",", and blanks that are more than a space before a token
};

/// Finds the places in a text where a reader of its tokens has something to look at, many bytes at
/// a time unless few are left. A place that is none of them may be among them. A token begins at
/// each place that it is asked for.
template <PlacesFor kFor>
class TextPlaces {
public:
    /// Returns the first place from `at` on, or `end`.
    [[nodiscard]] const char* next(const char* at, const char* end) noexcept {
        for (;;) {
            if (isSeen(at)) {
                const Mask left = places_ >> (at - begin_);
                if (left != 0) {
                    const char* const place = at + firstBit(left);
                    return place < end ? place : end;
                }
                at = behind_;
            }
            if (end - at < static_cast<std::ptrdiff_t>(Block::kSize)) {
                return nextOfFew(at, end);
            }
            look(at);
        }
    }

    /// Returns the end of the name that begins at `at`, the place that was found last.
    [[nodiscard]] const char* nameEndAt(const char* at) const noexcept {
        if (!isSeen(at)) {
            return nameEnd(at);
        }
        const char* const behind = at + std::countr_one(words_ >> (at - begin_));
        return isSeen(behind) ? behind : nameEnd(behind);
    }

    /// Returns the end of the number that begins at `at`, the place that was found last.
    [[nodiscard]] const char* numberEndAt(const char* at) noexcept {
        if (isSeen(at)) {
            const char* const behind = at + std::countr_one(digits_ >> (at - begin_));
            if (isSeen(behind) && !isWordByte(*behind)) {
                return behind;
            }
            behind_ = nullptr;  // the next token may begin within the word
        }
        return at + numberAt(at).text.size();
    }

private:
    using Block = BasicByteBlock<BaseVector, 32>;
    using Mask = Block::Mask;

    static constexpr std::array<bool, 256> kArePlaces = [] {
        std::array<bool, 256> arePlaces{};
        for (std::size_t at = 0; at != arePlaces.size(); ++at) {
            const char byte = static_cast<char>(at);
            const auto isOneOf = [byte](std::string_view bytes) {
                return bytes.find(byte) != std::string_view::npos;
            };
            arePlaces[at] =
                isWordByte(byte) || isOneOf({"\n\r\0\\/\"'", 7})
                || (kFor == PlacesFor::Arguments && (isBlankByte(byte) || isOneOf("(),")));
        }
        return arePlaces;
    }();

    [[nodiscard]] bool isSeen(const char* at) const noexcept { return at < behind_; }

    [[nodiscard]] static const char* nextOfFew(const char* at, const char* end) noexcept {
        while (at < end && !kArePlaces[static_cast<unsigned char>(*at)]) {
            ++at;
        }
        return at < end ? at : end;
    }

    void look(const char* at) noexcept {
        const Block bytes(at);
        begin_ = at;
        behind_ = at + Block::kSize;
        digits_ = bytes.digits();
        words_ = bytes.letters() | digits_;
        const Mask wordStarts = words_ & ~(words_ << 1U);
        const Mask blanks = bytes.blanksAndUnusual();
        if constexpr (kFor == PlacesFor::Arguments) {
            constexpr Mask kLast = Mask{1} << (Block::kSize - 1);
            const Mask spaces = bytes.any(' ') & ~(blanks >> 1U | kLast);
            places_ =
                wordStarts | (blanks & ~spaces) | bytes.any('"', '\'', '\\', '/', '(', ')', ',');
        } else {
            places_ = wordStarts | (blanks & ~bytes.any(' ')) | bytes.any('"', '\'', '\\', '/');
        }
    }

    // What was looked at last. No place before it is asked for.
    const char* begin_ = nullptr;
    const char* behind_ = nullptr;  // null: nothing was
    Mask places_ = 0;
    Mask words_ = 0;
    Mask digits_ = 0;
};

}  // namespace umpre

#endif
