// SPDX-License-Identifier: MIT
//
// This file is compiled for processors with AVX2 (and what comes with it) where there are such.
// What it makes must stay in it: of functions that several files make, the linker keeps one for
// all. So all of it hangs on WideVector, which nobody else can see, and nothing of the standard
// library is called.
#include "lex/text_masks.h"

#if defined(__AVX2__)
#include <immintrin.h>

#include "lex/text_mask_loop.h"
#include "lex/wide_counts.h"
#endif

namespace umpre {

#if defined(__AVX2__)
namespace {

struct WideVector : WideCounts<WideVector> {
    using Bytes = __m256i;

    static constexpr std::size_t kSize = sizeof(Bytes);

    [[nodiscard]] static Bytes load(const char* at) noexcept {
        return _mm256_loadu_si256(
            reinterpret_cast<const __m256i_u*>(at));  // NOLINT(*-reinterpret-cast): as it wants it
    }

    [[nodiscard]] static Bytes all(char byte) noexcept { return _mm256_set1_epi8(byte); }

    [[nodiscard]] static Bytes equal(Bytes some, Bytes others) noexcept {
        return _mm256_cmpeq_epi8(some, others);
    }

    /// Compares signed numbers.
    [[nodiscard]] static Bytes less(Bytes some, Bytes others) noexcept {
        return _mm256_cmpgt_epi8(others, some);
    }

    [[nodiscard]] static Bytes difference(Bytes some, Bytes others) noexcept {
        return _mm256_sub_epi8(some, others);
    }

    [[nodiscard]] static Bytes either(Bytes some, Bytes others) noexcept {
        return _mm256_or_si256(some, others);
    }

    [[nodiscard]] static std::uint32_t bits(Bytes bytes) noexcept {
        return static_cast<std::uint32_t>(_mm256_movemask_epi8(bytes));
    }
};

}  // namespace

const TextMaskFinder* wideTextMaskFinder() noexcept {
    return &TextMaskLoop<WideVector>::kFinder;
}
#else
const TextMaskFinder* wideTextMaskFinder() noexcept {
    return nullptr;
}
#endif

}  // namespace umpre
