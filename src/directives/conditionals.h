// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_CONDITIONALS_H
#define UMPRE_DIRECTIVES_CONDITIONALS_H

#include <cstddef>
#include <optional>
#include <string_view>

#include "directives/conditional_stack.h"
#include "directives/known_conditions.h"
#include "expr/evaluator.h"
#include "lex/directive_line.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "macros/macro_expander.h"
#include "macros/macro_table.h"

namespace umpre {

/// The six conditional directives, which act in active and in skipped text alike. Each reads what
/// it needs of its line; the rest is text for the main loop.
class Conditionals {
public:
    Conditionals(ScannerStack& sources, MacroTable& macros, MacroExpander& expander,
                 TextLexer& lexer, Reporter& reporter) noexcept
        : sources_(sources),
          macros_(macros),
          expander_(expander),
          lexer_(lexer),
          reporter_(reporter),
          evaluator_(sources, macros, reporter),
          byteTokens_(macros, sources.tellsMacros()),
          byteEvaluator_(byteTokens_, macros, byteTokens_) {}

    /// Tells whether lines are being skipped.
    [[nodiscard]] bool skipping() const noexcept { return groups_.skipping(); }

    /// Returns the open groups, for a reader of skipped lines.
    [[nodiscard]] ConditionalStack& groups() noexcept { return groups_; }

    /// Carries out the directive of this word, which was just read. Returns false if it is not a
    /// conditional one.
    bool carryOut(TokenKind word);

    /// Carries out a conditional directive that was read as bytes up to its word.
    [[nodiscard]] DirectiveLine::Outcome carryOut(DirectiveLine& line);

    /// Returns how many conditions were decided so far.
    [[nodiscard]] std::size_t decisions() const noexcept { return decisions_; }

    /// Returns the name of the `#ifndef` that was decided last, if that name was defined; null
    /// after any other decision.
    [[nodiscard]] const Name* lastGuard() const noexcept { return lastGuard_; }

    /// A file begins, with no open groups.
    void enterFileGroups() { groups_.enterFile(); }

    /// A file ends: reports its open groups, once, and closes them.
    void closeFileGroups();

private:
    enum class Wanted { Defined, Undefined };

    void ifDirective();
    void ifdefDirective(Wanted wanted, std::string_view missingName);
    void elifDirective();
    void elseDirective();
    void endifDirective();
    [[nodiscard]] bool openGroup();
    void decideByCondition();
    void decide(bool taken, const Name* guard = nullptr);

    // For lines that are read as bytes.
    [[nodiscard]] DirectiveLine::Outcome beginGroup(DirectiveLine& line);
    [[nodiscard]] DirectiveLine::Outcome beginBranch(DirectiveLine& line);
    [[nodiscard]] std::optional<bool> condition(DirectiveLine& line);
    [[nodiscard]] std::optional<bool> isDefined(DirectiveLine& line);
    [[nodiscard]] std::optional<bool> isTrue(DirectiveLine& line);
    [[nodiscard]] std::optional<bool> valueOf(DirectiveLine& line, bool watchesNames);

    ScannerStack& sources_;
    MacroTable& macros_;
    MacroExpander& expander_;
    TextLexer& lexer_;
    Reporter& reporter_;
    Evaluator<ScannerStack> evaluator_;
    ConditionTokens byteTokens_;
    Evaluator<ConditionTokens> byteEvaluator_;
    KnownConditions knownConditions_;
    ConditionalStack groups_;
    std::size_t decisions_ = 0;
    const Name* lastGuard_ = nullptr;
    const Name* tested_ = nullptr;  // by `isDefined`; null if it is not defined
};

}  // namespace umpre

#endif
