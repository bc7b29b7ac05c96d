// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_MASK_LOOP_H
#define UMPRE_LEX_TEXT_MASK_LOOP_H

#include <cstddef>

#include "lex/byte_block.h"
#include "lex/text_masks.h"

namespace umpre {

/// A TextMaskFinder with one kind of vectors. If only some processors have these, the kind must be
/// a type of one source file: then nothing that is made of it here is shared with other files. No
/// function that others share may be called.
template <typename Vector>
class TextMaskLoop {
public:
    static const TextMaskFinder kFinder;

private:
    using Block = BasicByteBlock<Vector>;
    using Mask = TextMasks::Mask;

    static void findText(const char* bytes, std::size_t count, BytesBefore& before,
                         TextMasks* masks) {
        TextMaskLoop loop(before);
        for (std::size_t index = 0; index < count; ++index) {
            loop.findIn(bytes + index * Block::kSize, masks[index]);
        }
        before = {loop.lineFeeds_, loop.behindStar_ != 0, loop.escape_ != 0};
    }

    [[nodiscard]] static WordMasks wordsIn(const char* bytes) {
        const Block block(bytes);
        return {block.letters(), block.digits(), block.blanksAndUnusual()};
    }

    [[nodiscard]] static NumberMasks numbersIn(const char* bytes) {
        const Block block(bytes);
        const Block lower = block.lower();
        return {block.any('0'), lower.any('x'), lower.any('u'), lower.any('l'),
                lower.template firstLetters<6>()};
    }

    static constexpr unsigned kLast = Block::kSize - 1;

    explicit TextMaskLoop(const BytesBefore& before) noexcept
        : lineFeeds_(before.lineFeeds),
          behindStar_(before.endWithStar ? 1 : 0),
          escape_(before.escape ? 1 : 0) {}

    void findIn(const char* bytes, TextMasks& masks) noexcept {
        const Block block(bytes);
        const Mask slashes = block.any('/');
        const Mask stars = block.any('*');
        const Mask backslashes = block.any('\\');
        const Mask lineFeeds = block.any('\n');
        const Mask carriageReturns = block.any('\r');
        const Mask singleQuotes = block.any('\'');
        const Mask plain = ~escaped(backslashes);
        constexpr Mask kUnknown = Mask{1} << kLast;
        const Mask comments = slashes & ((slashes | stars) >> 1U | kUnknown);
        masks.lineFeeds = lineFeeds;
        masks.lineEnds = lineFeeds | carriageReturns;
        masks.special = singleQuotes | carriageReturns | backslashes | comments | block.any('#');
        masks.strings = Vector::parities(block.any('"') & plain);
        masks.characterStops = (singleQuotes & plain) | masks.lineEnds;
        masks.commentStops = (slashes & (stars << 1U | behindStar_)) | carriageReturns;
        masks.lineFeedsBefore = lineFeeds_;
        behindStar_ = stars >> kLast;
        lineFeeds_ += Vector::count(lineFeeds);
    }

    // Returns what stands behind an odd number of backslashes. Taking a run of them off itself, one
    // place higher, and off the odd places makes every other bit of it change: where it is not
    // escaped, and behind the run if its size is odd. No branch asks whether there are any
    // backslashes, because in tables of literals nobody could tell.
    [[nodiscard]] Mask escaped(Mask backslashes) noexcept {
        constexpr Mask kOdd = 0xAAAAAAAAAAAAAAAAU;
        const Mask begins = backslashes & ~escape_;
        const Mask runs = ((begins << 1U | kOdd) - begins) ^ kOdd;
        const Mask escaped = runs ^ (backslashes | escape_);
        escape_ = (runs & backslashes) >> kLast;
        return escaped;
    }

    std::size_t lineFeeds_;
    Mask behindStar_;
    Mask escape_;
};

template <typename Vector>
constexpr TextMaskFinder TextMaskLoop<Vector>::kFinder{findText, wordsIn, numbersIn};

}  // namespace umpre

#endif
