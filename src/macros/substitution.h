// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_SUBSTITUTION_H
#define UMPRE_MACROS_SUBSTITUTION_H

#include <cstddef>
#include <string>

#include "lex/no_expand_set.h"
#include "lex/pieces.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "macros/arguments.h"
#include "macros/macro_body.h"
#include "macros/macro_table.h"

namespace umpre {

/// A function-like macro on its way to its replacement.
struct Invocation {
    const MacroBody* body = nullptr;
    NoExpandSet noExpand;  ///< of the replacement
    ArgumentList arguments;
    Pieces replacement;    ///< as far as it is built
    std::size_t step = 0;  ///< of the body, to be taken next
    /// While an argument is expanded: which one, and what had been said and done before.
    Argument* expanding = nullptr;
    std::size_t effectsBefore = 0;
};

/// Builds replacements of function-like macros out of their bodies and arguments.
class Substitution {
public:
    Substitution(ScannerStack& sources, MacroTable& macros, Reporter& reporter, TextLexer& lexer,
                 NoExpandSets& sets) noexcept
        : sources_(sources), macros_(macros), reporter_(reporter), lexer_(lexer), sets_(sets) {}

    /// Goes on with the replacement. Returns the argument that must be expanded before more can be
    /// done, or null when the replacement is complete.
    [[nodiscard]] Argument* build(Invocation& invocation);

private:
    [[nodiscard]] Argument* takeStep(Invocation& invocation, const BodyStep& step);
    [[nodiscard]] bool addArgument(Invocation& invocation, Argument& argument);
    [[nodiscard]] bool isItsOwnExpansion(const Argument& argument) const;
    void addJoined(Invocation& invocation, const BodyStep& step);
    [[nodiscard]] bool addLiteral(Invocation& invocation, const BodyStep& step);

    ScannerStack& sources_;
    MacroTable& macros_;
    Reporter& reporter_;
    TextLexer& lexer_;
    NoExpandSets& sets_;
    std::string joined_;
};

}  // namespace umpre

#endif
