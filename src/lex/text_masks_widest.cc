// SPDX-License-Identifier: MIT
//
// This file is compiled for processors with AVX-512 where there are such. What it makes must stay
// in it, as in text_masks_wide.cc.
#include "lex/text_masks.h"

#if defined(__AVX512BW__)
#include <immintrin.h>

#include "lex/text_mask_loop.h"
#include "lex/wide_counts.h"
#endif

namespace umpre {

#if defined(__AVX512BW__)
namespace {

struct WidestVector : WideCounts<WidestVector> {
    using Bytes = __m512i;
    using Found = __mmask64;

    static constexpr std::size_t kSize = sizeof(Bytes);

    [[nodiscard]] static Bytes load(const char* at) noexcept { return _mm512_loadu_si512(at); }

    [[nodiscard]] static Bytes all(char byte) noexcept { return _mm512_set1_epi8(byte); }

    [[nodiscard]] static Found equal(Bytes some, Bytes others) noexcept {
        return _mm512_cmpeq_epi8_mask(some, others);
    }

    /// Compares signed numbers.
    [[nodiscard]] static Found less(Bytes some, Bytes others) noexcept {
        return _mm512_cmplt_epi8_mask(some, others);
    }

    [[nodiscard]] static Bytes difference(Bytes some, Bytes others) noexcept {
        return _mm512_sub_epi8(some, others);
    }

    [[nodiscard]] static Bytes either(Bytes some, Bytes others) noexcept {
        return _mm512_or_si512(some, others);
    }

    [[nodiscard]] static Found either(Found some, Found others) noexcept { return some | others; }

    [[nodiscard]] static TextMasks::Mask bits(Found found) noexcept { return found; }
};

}  // namespace

const TextMaskFinder* widestTextMaskFinder() noexcept {
    return &TextMaskLoop<WidestVector>::kFinder;
}
#else
const TextMaskFinder* widestTextMaskFinder() noexcept {
    return nullptr;
}
#endif

}  // namespace umpre
