// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_INCLUDE_LINES_H
#define UMPRE_DIRECTIVES_INCLUDE_LINES_H

#include <optional>
#include <string_view>

#include "directives/file_finder.h"
#include "directives/include_form.h"
#include "directives/known_lines.h"
#include "lex/directive_line.h"
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
    explicit IncludeLines(MacroTable& macros) noexcept : macros_(macros) {}

    /// Reads a line from behind its word up to its end. Returns nothing if the scanner or a macro
    /// could make something else of it.
    [[nodiscard]] std::optional<IncludeOperand> read(DirectiveLine& line) const;

    /// Keeps where the line leads that a file's text begins with, if it can be kept.
    void keep(std::string_view text, const IncludeOperand& operand, Search* search);

    /// Returns what is known of the line that a file's text begins with, or null. It is valid until
    /// `keep` is called.
    [[nodiscard]] KnownLines::Line* find(std::string_view text) noexcept {
        KnownLines::Line* const line = known_.find(text);
        return line != nullptr && line->macroNames == macros_.filter().size() ? line : nullptr;
    }

private:
    [[nodiscard]] bool isPartOfName(const Token& token, IncludeOperand& operand) const;

    MacroTable& macros_;
    KnownLines known_;
};

}  // namespace umpre

#endif
