// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_MASKS_H
#define UMPRE_LEX_TEXT_MASKS_H

#include <cstddef>
#include <cstdint>

namespace umpre {

/// Where what matters in text stands among 64 bytes: in each mask, bit N stands for byte N.
/// "Escaped" is what stands behind an odd number of backslashes. Aligned to a power of two, so that
/// the masks of a block are found by a shift.
struct alignas(64) TextMasks {
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

/// Where words stand among 64 bytes.
struct WordMasks {
    TextMasks::Mask letters;  ///< ASCII letters and underscores
    TextMasks::Mask digits;
    TextMasks::Mask blanksAndUnusual;  ///< blanks, control characters and bytes above 127
};

/// Where among 64 bytes stands what numbers are told by, of letters both cases.
struct NumberMasks {
    TextMasks::Mask zeros;
    TextMasks::Mask xs;
    TextMasks::Mask us;
    TextMasks::Mask ls;
    TextMasks::Mask hexLetters;  ///< A to F
};

/// The functions that find masks with one kind of vectors.
struct TextMaskFinder {
    /// Finds the masks of `count` blocks of 64 bytes that follow each other. Makes of `before` what
    /// is to be known of the bytes before those that follow.
    void (*findText)(const char* bytes, std::size_t count, BytesBefore& before, TextMasks* masks);

    /// Returns the masks of 64 bytes.
    WordMasks (*wordsIn)(const char* bytes);
    NumberMasks (*numbersIn)(const char* bytes);
};

/// Returns the finder that is the fastest one on this processor.
[[nodiscard]] const TextMaskFinder& textMaskFinder() noexcept;

/// Returns the finder that works on every processor of the kind.
[[nodiscard]] const TextMaskFinder& baseTextMaskFinder() noexcept;

/// Returns the finder for processors with wide vectors (AVX2), or null if there is none for this
/// kind of processor.
[[nodiscard]] const TextMaskFinder* wideTextMaskFinder() noexcept;

/// The same for processors with the widest vectors (AVX-512).
[[nodiscard]] const TextMaskFinder* widestTextMaskFinder() noexcept;

}  // namespace umpre

#endif
