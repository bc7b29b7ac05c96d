// SPDX-License-Identifier: MIT
#include "lex/byte_block.h"
#include "lex/text_mask_loop.h"
#include "lex/text_masks.h"

namespace umpre {
namespace {

struct Vector : BaseVector {
    [[nodiscard]] static std::size_t count(TextMasks::Mask mask) noexcept {
        return countBits(mask);
    }

    /// Returns where the number of bits at and below a place is odd.
    [[nodiscard]] static TextMasks::Mask parities(TextMasks::Mask mask) noexcept {
        for (unsigned distance = 1; distance < ByteBlock::kSize; distance *= 2) {
            mask ^= mask << distance;
        }
        return mask;
    }
};

}  // namespace

const TextMaskFinder& baseTextMaskFinder() noexcept {
    return TextMaskLoop<Vector>::kFinder;
}

}  // namespace umpre
