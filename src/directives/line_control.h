// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_LINE_CONTROL_H
#define UMPRE_DIRECTIVES_LINE_CONTROL_H

#include <string_view>

#include "lex/output_writer.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "macros/macro_expander.h"

namespace umpre {

/// `#line`, `#pragma` and `#error`.
class LineControl {
public:
    LineControl(ScannerStack& sources, MacroExpander& expander, TextLexer& lexer,
                OutputWriter& output, Reporter& reporter) noexcept
        : sources_(sources),
          expander_(expander),
          lexer_(lexer),
          output_(output),
          reporter_(reporter) {}

    /// Reads the line, its end included, and gives the line that follows its number and name.
    void lineDirective();
    /// Writes the line; its end is left to the main loop.
    void pragmaDirective();
    /// Reports the line; its end is left to the main loop.
    void errorDirective();

private:
    void changeLine(std::string_view number);
    void rejectRest(std::string_view message);

    ScannerStack& sources_;
    MacroExpander& expander_;
    TextLexer& lexer_;
    OutputWriter& output_;
    Reporter& reporter_;
};

}  // namespace umpre

#endif
