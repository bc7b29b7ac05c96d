// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_DEFINITIONS_H
#define UMPRE_DIRECTIVES_DEFINITIONS_H

#include <optional>
#include <string>
#include <string_view>

#include "lex/directive_line.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "macros/macro_table.h"

namespace umpre {

/// `#define` and `#undef`.
class Definitions {
public:
    Definitions(ScannerStack& sources, MacroTable& macros, Reporter& reporter) noexcept
        : sources_(sources), macros_(macros), reporter_(reporter) {}

    /// Reads the rest of the line, the line end included. After "Invalid macro name" what follows
    /// is left to the main loop, as text.
    void defineDirective();
    /// Reads the name and one token more, whatever it is.
    void undefDirective();

    /// Carry out a directive that was read as bytes up to its word.
    [[nodiscard]] DirectiveLine::Outcome defineDirective(DirectiveLine& line);
    [[nodiscard]] DirectiveLine::Outcome undefDirective(DirectiveLine& line);

private:
    [[nodiscard]] std::optional<std::string> readMacroName();
    [[nodiscard]] std::string readReplacement();
    void reportIncompatible(std::string_view name);

    ScannerStack& sources_;
    MacroTable& macros_;
    Reporter& reporter_;
    std::string parameters_;
    std::string text_;
};

}  // namespace umpre

#endif
