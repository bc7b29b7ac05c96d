// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_INCLUSION_H
#define UMPRE_DIRECTIVES_INCLUSION_H

#include <optional>
#include <string>

#include "directives/include_form.h"
#include "directives/include_lines.h"
#include "directives/included_files.h"
#include "lex/cpp_file_scanner.h"
#include "lex/directive_line.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "macros/macro_expander.h"
#include "macros/macro_table.h"

namespace umpre {

/// `#include`: from the line to the name.
class Inclusion {
public:
    Inclusion(ScannerStack& sources, MacroExpander& expander, TextLexer& lexer, MacroTable& macros,
              IncludedFiles& files, Reporter& reporter) noexcept
        : sources_(sources),
          expander_(expander),
          lexer_(lexer),
          lines_(macros),
          files_(files),
          reporter_(reporter) {}

    /// Reads the rest of the line and enters the file that it names. The line end is read only if a
    /// file is named.
    void includeDirective();

    /// Does the same for a line that was read as bytes up to its word.
    [[nodiscard]] DirectiveLine::Outcome includeDirective(DirectiveLine& line);

    /// Does the same for lines of a file that are known from their bytes, from a line's start, up
    /// to one that enters a file. Returns whether there were any.
    [[nodiscard]] bool includeLines(CppFileScanner& file);

private:
    struct Operand {
        std::string name;
        IncludeForm form;
    };

    [[nodiscard]] std::optional<Operand> readOperand();
    [[nodiscard]] std::optional<Operand> readName();

    ScannerStack& sources_;
    MacroExpander& expander_;
    TextLexer& lexer_;
    IncludeLines lines_;
    IncludedFiles& files_;
    Reporter& reporter_;
};

}  // namespace umpre

#endif
