// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_MASKS_H
#define UMPRE_LEX_TEXT_MASKS_H

#include <cstddef>
#include <cstdint>

namespace umpre {

/// Where what matters in text stands among 64 bytes: in each mask, bit N stands for byte N.
/// "Escaped" is what stands behind an odd number of backslashes.
struct TextMasks {
    using Mask = std::uint64_t;

    Mask lineFeeds;
    Mask lineEnds;  ///< line feeds and carriage returns
    /// What is more than itself outside of strings: single quotes, carriage returns, "#",
    /// backslashes and the beginnings of comments. A slash that is the last of the bytes is among
    /// them, whatever follows it.
    Mask special;
    /// Where an odd number of double quotes stands at or before a byte, escaped ones not counted:
    /// the string literals without their last quotes, if none is open before the bytes.
    Mask strings;
    Mask characterStops;          ///< single quotes that are not escaped, line ends
    Mask commentStops;            ///< slashes behind "*", carriage returns
    std::size_t lineFeedsBefore;  ///< in the blocks before
};

/// What finding masks needs to know of the bytes before.
struct BytesBefore {
    std::size_t lineFeeds = 0;
    bool endWithStar = false;
    bool escape = false;  ///< they end with a backslash that is not escaped
};

/// Finds the masks of `count` blocks of 64 bytes that follow each other. Makes of `before` what is
/// to be known of the bytes before those that follow.
using TextMaskFinder = void (*)(const char* bytes, std::size_t count, BytesBefore& before,
                                TextMasks* masks);

/// Returns the finder that is the fastest one on this processor.
[[nodiscard]] TextMaskFinder textMaskFinder() noexcept;

/// Returns the finder that works on every processor of the kind.
[[nodiscard]] TextMaskFinder baseTextMaskFinder() noexcept;

/// Returns the finder for processors with wide vectors (AVX2), or null if there is none for this
/// kind of processor.
[[nodiscard]] TextMaskFinder wideTextMaskFinder() noexcept;

/// The same for processors with the widest vectors (AVX-512).
[[nodiscard]] TextMaskFinder widestTextMaskFinder() noexcept;

}  // namespace umpre

#endif
