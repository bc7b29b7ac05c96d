// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_KNOWN_LINES_H
#define UMPRE_DIRECTIVES_KNOWN_LINES_H

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

#include "directives/file_finder.h"
#include "directives/included_files.h"
#include "lex/snippet.h"

namespace umpre {

/// `#include` lines that were met before, by their bytes. Lines of more than 64 bytes are not kept.
class KnownLines {
public:
    struct Line {
        Snippet text;                ///< its line end included
        Search* search = nullptr;    ///< what it leads to
        std::size_t macroNames = 0;  ///< that there were so far
        Passage passage;             ///< over what it leads to
    };

    /// Keeps what is known of the line that a text begins with. Of this text and that of `find`, 64
    /// bytes can be read behind its end.
    void keep(std::string_view text, Search& search, std::size_t macroNames);

    /// Returns what is known of the line that a text begins with, or null. It is valid until `keep`
    /// is called.
    [[nodiscard]] Line* find(std::string_view text) noexcept;

private:
    static constexpr std::size_t kMostSlots = std::size_t{1} << 17U;

    struct Slot {
        std::uint32_t hash = 0;
        std::uint32_t number = 0;  // of a line, counted from 1; 0: the slot is free
    };

    [[nodiscard]] static std::size_t sizeOfLine(std::string_view text) noexcept;
    [[nodiscard]] static std::uint32_t hashOf(std::string_view line) noexcept;
    [[nodiscard]] std::size_t slotOf(std::string_view line, std::uint32_t hash) const noexcept;
    void makeRoom();

    // Each line has the first slot that was free from the one that its hash says. At most a quarter
    // of the slots, whose number is a power of two, are in use.
    std::vector<Slot> slots_;
    std::vector<Line> lines_;
};

}  // namespace umpre

#endif
