// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_MAP_H
#define UMPRE_LEX_TEXT_MAP_H

#include <cstddef>
#include <vector>

#include "lex/byte_block.h"
#include "lex/text_masks.h"

namespace umpre {

/// Tells where what matters in text stands among the bytes ahead. That is found for some kilobytes
/// at a time and kept, so that readers may come and go.
class TextMap {
public:
    using Mask = TextMasks::Mask;

    /// Must be called when the bytes move, or other ones come to stand where they stood.
    void forget() noexcept { size_ = 0; }

    /// Returns the first place from `from` on that stands in one of some kinds of masks, or `end`,
    /// where the bytes end.
    template <typename... Kinds>
    [[nodiscard]] const char* find(const char* from, const char* end, Kinds... kinds) {
        while (from < end) {
            const TextMasks* masks = &masksOf(from, end);
            const auto place = static_cast<std::size_t>(from - begin_) % ByteBlock::kSize;
            // Lines often end among the next 64 bytes; in which block they do cannot be predicted.
            Mask found = ((masks->*kinds) | ...) >> place
                         | ((masks[1].*kinds) | ...) << 1U << (ByteBlock::kSize - 1 - place);
            if (found == 0) {
                from -= place;
                while (found == 0) {
                    ++masks;
                    from += ByteBlock::kSize;
                    found = ((masks->*kinds) | ...);
                }
            }
            if (from + firstBit(found) < begin_ + size_) {
                return from + firstBit(found);
            }
            from = begin_ + size_;
        }
        return end;
    }

    /// Returns the first special place from `from` on, or `end`, where the bytes end. No literal
    /// is open at `from`. String literals are passed over; of one that is not closed, or has a
    /// carriage return, the quote is the place.
    [[nodiscard]] const char* findSpecial(const char* from, const char* end);

    /// Returns the end of the character literal that begins at `quote` if its line closes it and
    /// no carriage return is in it, otherwise null.
    [[nodiscard]] const char* characterEnd(const char* quote, const char* end) {
        const char* const stop = find(quote + 1, end, &TextMasks::characterStops);
        return stop < end && *stop == '\'' && stop != quote + 1 ? stop + 1 : nullptr;
    }

    /// Where a comment ends, and how many line feeds are in it.
    struct Comment {
        const char* end;
        std::size_t lineFeeds;
    };

    /// Returns the comment that begins at `comment`. The end is null if it is one for the scanner:
    /// one that the bytes do not hold whole, one with carriage returns, or a line comment whose end
    /// they do not tell.
    [[nodiscard]] Comment commentAt(const char* comment, const char* end);

    /// Returns the finder that the masks are found with.
    [[nodiscard]] const TextMaskFinder& finder() const noexcept { return finder_; }

    /// The masks of 64 bytes that begin anywhere. What stands behind the end is not told.
    struct Window {
        Mask lineFeeds;
        Mask lineEnds;
        Mask special;
        Mask strings;  ///< where strings are open, behind their first quotes and at these
    };

    /// Returns the masks of the bytes from `at` on, which stands before `end`. A string is open
    /// there or not.
    [[nodiscard]] Window windowAt(const char* at, const char* end, bool isOpen) {
        const TextMasks* const first = &masksOf(at, end);
        const TextMasks* const last = &masks_[known_ - 1];
        const TextMasks* const second = first == last ? &behind_ : first + 1;
        const auto place = static_cast<unsigned>(at - begin_) % ByteBlock::kSize;
        const auto joined = [place](Mask low, Mask high) {
            return low >> place | high << 1U << (ByteBlock::kSize - 1 - place);
        };
        const bool isOdd = (first->strings << 1U >> place & 1U) != 0;
        const Mask strings = isOdd == isOpen ? first->strings : ~first->strings;
        const Mask carried = 0 - (strings >> (ByteBlock::kSize - 1));
        const Mask lineEnds = joined(first->lineEnds, second->lineEnds);
        const Mask special = joined(first->special, second->special);
        return {lineEnds & ~special, lineEnds, special, joined(strings, second->strings ^ carried)};
    }

    /// Returns a number that is larger by one behind each line feed between two places.
    [[nodiscard]] std::size_t lineFeedsBefore(const char* place, const char* end) {
        const TextMasks& masks = masksOf(place, end);
        const std::size_t at = static_cast<std::size_t>(place - begin_) % ByteBlock::kSize;
        return masks.lineFeedsBefore + countBits(masks.lineFeeds & bitsBelow(at));
    }

private:
    static constexpr std::size_t kBlocks = 128;  // found together

    // Returns the masks of the block that a place stands in; it may be the end.
    [[nodiscard]] const TextMasks& masksOf(const char* place, const char* end) {
        if (static_cast<std::size_t>(place - begin_) >= size_) {
            cover(place, end);
        }
        // Too often to check the place each time.
        return masks_.data()[static_cast<std::size_t>(place - begin_) / ByteBlock::kSize];
    }

    [[nodiscard]] const char* placeOf(const TextMasks& masks) const noexcept {
        return begin_ + static_cast<std::size_t>(&masks - masks_.data()) * ByteBlock::kSize;
    }

    [[nodiscard]] const char* openQuote(const TextMasks* masks, const char* before) const noexcept;
    void cover(const char* place, const char* end);
    void findPart(const char* bytes, std::size_t size, BytesBefore& before, TextMasks& masks) const;
    void findMasks(const char* end);

    const TextMaskFinder& finder_ = textMaskFinder();
    const char* begin_ = nullptr;  // of what is known
    std::size_t size_ = 0;
    BytesBefore before_;     // what follows
    std::size_t known_ = 0;  // blocks
    TextMasks behind_{};     // of the block that follows, if there is one
    // Behind those of the bytes stand masks that end every search.
    std::vector<TextMasks> masks_;
};

}  // namespace umpre

#endif
