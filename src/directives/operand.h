// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_OPERAND_H
#define UMPRE_DIRECTIVES_OPERAND_H

#include <string>
#include <string_view>

#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "macros/macro_expander.h"

namespace umpre {

inline constexpr std::string_view kInvalidCharacters =
    "Invalid characters appear before a new-line in the preprocessor directive";

/// Returns the texts of the tokens up to the end of the line, which stays to be read.
[[nodiscard]] std::string gatherLine(ScannerStack& sources);
/// Returns the same without the continuations.
[[nodiscard]] std::string gatherUncontinuedLine(ScannerStack& sources);

/// Expands an operand's text and makes it the current source, read on its own while this object
/// lives.
class ExpandedOperand {
public:
    ExpandedOperand(ScannerStack& sources, MacroExpander& expander, TextLexer& lexer,
                    std::string_view text, LineKind kind);
    ExpandedOperand(const ExpandedOperand&) = delete;
    ExpandedOperand& operator=(const ExpandedOperand&) = delete;

    ~ExpandedOperand() { sources_.endIsolation(); }

private:
    ScannerStack& sources_;
};

}  // namespace umpre

#endif
