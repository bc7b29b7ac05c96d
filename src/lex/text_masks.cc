// SPDX-License-Identifier: MIT
#include "lex/text_masks.h"

namespace umpre {
namespace {

[[nodiscard]] TextMaskFinder fastestFinder() noexcept {
#if defined(__x86_64__)
    const TextMaskFinder wide = wideTextMaskFinder();
    if (wide != nullptr && __builtin_cpu_supports("avx2") != 0
        && __builtin_cpu_supports("popcnt") != 0 && __builtin_cpu_supports("pclmul") != 0) {
        return wide;
    }
#endif
    return baseTextMaskFinder();
}

}  // namespace

TextMaskFinder textMaskFinder() noexcept {
    static const TextMaskFinder finder = fastestFinder();
    return finder;
}

}  // namespace umpre
