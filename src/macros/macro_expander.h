// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_MACRO_EXPANDER_H
#define UMPRE_MACROS_MACRO_EXPANDER_H

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "lex/no_expand_set.h"
#include "lex/pieces.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "macros/arguments.h"
#include "macros/macro_body.h"
#include "macros/macro_table.h"

namespace umpre {

/// What a directive line that is expanded is for.
enum class LineKind {
    Operand,
    Condition,  ///< `defined` and its operand are kept as written
};

/// Expands one name, or one directive line. A replacement is not returned but pushed as a source,
/// so whoever reads on reads it, and brings its names back here.
class MacroExpander {
public:
    MacroExpander(ScannerStack& sources, MacroTable& macros, Reporter& reporter,
                  TextLexer& lexer) noexcept
        : sources_(sources), macros_(macros), reporter_(reporter), lexer_(lexer) {}

    /// Takes a name that was just read and returns what is to be written for it: the name itself,
    /// perhaps with blanks before it, or nothing when a replacement was pushed. Valid until the
    /// next call and the next token read.
    [[nodiscard]] std::string_view expandName(std::string_view name);

    /// Returns the rest of a directive line with all its macros expanded.
    [[nodiscard]] std::string expandLine(std::string_view text, LineKind kind);

private:
    // What looking at a name led to.
    enum class Outcome {
        Name,       // the name is just a name, with no argument list read
        Uncalled,   // a function-like macro without "(": `skipped_` comes before the name
        Pushed,     // a replacement was pushed
        Begun,      // an invocation was added to `invocations_`
        Abandoned,  // an invocation with the wrong arguments: the name is left
    };

    // A function-like macro on its way to its replacement.
    struct Invocation {
        std::shared_ptr<const MacroBody> body;
        NoExpandSet noExpand;  // of the replacement
        ArgumentList arguments;
        std::size_t step = 0;  // of the body, to be taken next
        Pieces replacement;    // as far as it is built
        // While an argument is expanded: which one, and what had been said and done before.
        Argument* expanding = nullptr;
        std::size_t effectsBefore = 0;
    };

    [[nodiscard]] Outcome lookAt(std::string_view text, MacroName*& name);
    [[nodiscard]] Outcome beginInvocation(const MacroName& name);
    [[nodiscard]] std::unique_ptr<Invocation> newInvocation();
    void finishInvocations();
    void pushReplacement();
    [[nodiscard]] bool buildReplacement(Invocation& invocation);
    [[nodiscard]] bool addArgument(Invocation& invocation, Argument& argument);
    void addJoined(Invocation& invocation, const BodyStep& step);
    void beginArgument(Invocation& invocation, Argument& argument);
    void endArgument(Invocation& invocation);
    [[nodiscard]] bool readList(Pieces& result);
    [[nodiscard]] bool readName(const Token& token, Pieces& result);
    void keepDefined(const Token& word, Pieces& result);
    [[nodiscard]] std::size_t effects() const;

    ScannerStack& sources_;
    MacroTable& macros_;
    Reporter& reporter_;
    TextLexer& lexer_;
    NoExpandSets sets_;
    LineKind lineKind_ = LineKind::Operand;
    std::vector<std::unique_ptr<Invocation>> invocations_;  // the innermost one is the last
    std::vector<std::unique_ptr<Invocation>> spare_;        // finished, to be used again
    Pieces scratch_;
    std::string skipped_;
    std::string written_;
    std::string joined_;
};

}  // namespace umpre

#endif
