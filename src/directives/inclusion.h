// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_INCLUSION_H
#define UMPRE_DIRECTIVES_INCLUSION_H

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "macros/macro_expander.h"

namespace umpre {

/// `#include` and the search for files.
class Inclusion {
public:
    Inclusion(ScannerStack& sources, MacroExpander& expander, TextLexer& lexer,
              Reporter& reporter) noexcept
        : sources_(sources), expander_(expander), lexer_(lexer), reporter_(reporter) {}

    /// Adds a directory to search, after those added before.
    void addIncludeDirectory(std::string_view directory) {
        includeDirectories_.emplace_back(directory);
    }

    /// Reads the rest of the line and enters the file that it names. The line end is read only if a
    /// file is named.
    void includeDirective();

    /// Looks for a file and enters it: a quoted name as it is first, then any name in the include
    /// directories. Returns false after reporting that it is nowhere.
    bool openInclude(const std::string& name, bool quoted);

private:
    struct Operand {
        std::string name;
        bool quoted;
    };

    [[nodiscard]] std::optional<Operand> readOperand();
    [[nodiscard]] std::optional<Operand> readName();

    ScannerStack& sources_;
    MacroExpander& expander_;
    TextLexer& lexer_;
    Reporter& reporter_;
    std::vector<std::string> includeDirectories_;
};

}  // namespace umpre

#endif
