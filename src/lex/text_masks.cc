// SPDX-License-Identifier: MIT
#include "lex/text_masks.h"

// Not with clang++, which takes the header for C alone.
#if __has_include(<sys/platform/x86.h>) && !defined(__clang__)
#include <sys/platform/x86.h>
#define UMPRE_LEX_LIBRARY_KNOWS_CPU
#endif

namespace umpre {
namespace {

#ifdef UMPRE_LEX_LIBRARY_KNOWS_CPU
// The C library has asked the processor already. To ask it once more takes long in virtual
// machines.
[[nodiscard]] bool hasWideVectors() noexcept {
    return CPU_FEATURE_ACTIVE(AVX2) && CPU_FEATURE_ACTIVE(POPCNT) && CPU_FEATURE_ACTIVE(PCLMULQDQ);
}

// The first processors with AVX-512 lower their clock for it. They lack VBMI2.
[[nodiscard]] bool hasWidestVectors() noexcept {
    return hasWideVectors() && CPU_FEATURE_ACTIVE(AVX512BW) && CPU_FEATURE_ACTIVE(AVX512_VBMI2)
           && CPU_FEATURE_ACTIVE(BMI1) && CPU_FEATURE_ACTIVE(BMI2);
}
#elif defined(__x86_64__)
[[nodiscard]] bool hasWideVectors() noexcept {
    return __builtin_cpu_supports("avx2") != 0 && __builtin_cpu_supports("popcnt") != 0
           && __builtin_cpu_supports("pclmul") != 0;
}

[[nodiscard]] bool hasWidestVectors() noexcept {
    return hasWideVectors() && __builtin_cpu_supports("avx512bw") != 0
           && __builtin_cpu_supports("avx512vbmi2") != 0 && __builtin_cpu_supports("bmi") != 0
           && __builtin_cpu_supports("bmi2") != 0;
}
#else
[[nodiscard]] bool hasWideVectors() noexcept {
    return false;
}

[[nodiscard]] bool hasWidestVectors() noexcept {
    return false;
}
#endif

[[nodiscard]] const TextMaskFinder& fastestFinder() noexcept {
    const TextMaskFinder* const widest = widestTextMaskFinder();
    if (widest != nullptr && hasWidestVectors()) {
        return *widest;
    }
    const TextMaskFinder* const wide = wideTextMaskFinder();
    return wide != nullptr && hasWideVectors() ? *wide : baseTextMaskFinder();
}

}  // namespace

const TextMaskFinder& textMaskFinder() noexcept {
    static const TextMaskFinder& finder = fastestFinder();
    return finder;
}

}  // namespace umpre
