// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_DEFINITIONS_H
#define UMPRE_DIRECTIVES_DEFINITIONS_H

#include <optional>
#include <string>

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

private:
    [[nodiscard]] std::optional<std::string> readMacroName();
    [[nodiscard]] std::optional<std::string> readParameters();
    [[nodiscard]] std::string readReplacement();

    ScannerStack& sources_;
    MacroTable& macros_;
    Reporter& reporter_;
};

}  // namespace umpre

#endif
