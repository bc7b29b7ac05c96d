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
#elif defined(__x86_64__)
[[nodiscard]] bool hasWideVectors() noexcept {
    return __builtin_cpu_supports("avx2") != 0 && __builtin_cpu_supports("popcnt") != 0
           && __builtin_cpu_supports("pclmul") != 0;
}
#else
[[nodiscard]] bool hasWideVectors() noexcept {
    return false;
}
#endif

[[nodiscard]] TextMaskFinder fastestFinder() noexcept {
    const TextMaskFinder wide = wideTextMaskFinder();
    return wide != nullptr && hasWideVectors() ? wide : baseTextMaskFinder();
}

}  // namespace

TextMaskFinder textMaskFinder() noexcept {
    static const TextMaskFinder finder = fastestFinder();
    return finder;
}

}  // namespace umpre
