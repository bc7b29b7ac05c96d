// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_INCLUSION_H
#define UMPRE_DIRECTIVES_INCLUSION_H

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "macros/macro_expander.h"
#include "umpre/event.h"

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

    /// Asks before a file is looked for on the disk; nobody, if empty.
    void setResolver(IncludeResolver resolver) { resolver_ = std::move(resolver); }

    /// Tells which files are entered and which are missed; nobody, if empty.
    void setObserver(Observer observer) { observer_ = std::move(observer); }

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

    [[nodiscard]] bool enter(const std::string& path);
    [[nodiscard]] bool open(const std::string& path);
    [[nodiscard]] std::optional<Operand> readOperand();
    [[nodiscard]] std::optional<Operand> readName();

    ScannerStack& sources_;
    MacroExpander& expander_;
    TextLexer& lexer_;
    Reporter& reporter_;
    std::vector<std::string> includeDirectories_;
    IncludeResolver resolver_;
    Observer observer_;
};

}  // namespace umpre

#endif
