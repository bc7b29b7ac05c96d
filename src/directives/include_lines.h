// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_INCLUDE_LINES_H
#define UMPRE_DIRECTIVES_INCLUDE_LINES_H

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "directives/file_finder.h"
#include "directives/include_form.h"
#include "lex/directive_line.h"
#include "lex/name_filter.h"
#include "macros/macro_table.h"

namespace umpre {

/// What an `#include` line names. The name is a view of the line.
struct IncludeOperand {
    std::string_view name;
    IncludeForm form = IncludeForm::Brackets;
    bool isLasting = true;  ///< a line of the same bytes says the same, unless macros are added
};

/// Reads `#include` lines as bytes.
class IncludeLines {
public:
    /// A line that was met before.
    struct Known {
        std::string bytes;           ///< its line end included
        Search* search = nullptr;    ///< what it leads to
        std::size_t macroNames = 0;  ///< that there were so far
    };

    explicit IncludeLines(MacroTable& macros) noexcept : macros_(macros) {}

    /// Reads a line from behind its word up to its end. Returns nothing if the scanner or a macro
    /// could make something else of it.
    [[nodiscard]] std::optional<IncludeOperand> read(DirectiveLine& line) const;

    /// Keeps where the line leads that a file's text begins with, if it can be kept.
    void keep(std::string_view text, const IncludeOperand& operand, Search* search);

    /// Returns what is known of the line that a file's text begins with, or null. It is valid until
    /// `keep` is called.
    [[nodiscard]] const Known* find(std::string_view text);

private:
    static constexpr std::size_t kFewestSlots = 256;
    static constexpr std::size_t kMostSlots = 65536;

    [[nodiscard]] bool isPartOfName(const Token& token, IncludeOperand& operand) const;
    [[nodiscard]] Known& slotOf(std::string_view line) noexcept;
    void makeRoom();

    MacroTable& macros_;
    // By their hashes: each line stands in the first free slot from the one that its hash says. At
    // most half of the slots are in use, whose number is a power of two.
    std::vector<Known> slots_;
    std::size_t used_ = 0;
};

}  // namespace umpre

#endif
