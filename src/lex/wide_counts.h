// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_WIDE_COUNTS_H
#define UMPRE_LEX_WIDE_COUNTS_H

#include <cstddef>
#include <cstdint>
#include <immintrin.h>

#include "lex/text_masks.h"

namespace umpre {

/// What processors with wide vectors can do with masks. Only for files that are compiled for such;
/// `Vector` is a type of one file, so that nothing that is made of it here is shared with others.
template <typename Vector>
struct WideCounts {
    [[nodiscard]] static std::size_t count(TextMasks::Mask mask) noexcept {
        return static_cast<std::size_t>(__builtin_popcountll(mask));
    }

    /// Returns where the number of bits at and below a place is odd. A product without carries,
    /// with a number that is all bits, sums them up.
    [[nodiscard]] static TextMasks::Mask parities(TextMasks::Mask mask) noexcept {
        const __m128i product = _mm_clmulepi64_si128(
            _mm_cvtsi64_si128(static_cast<std::int64_t>(mask)), _mm_set1_epi8(-1), 0);
        return static_cast<TextMasks::Mask>(_mm_cvtsi128_si64(product));
    }
};

}  // namespace umpre

#endif
