// SPDX-License-Identifier: MIT
#ifndef UMPRE_EXPR_EVALUATOR_H
#define UMPRE_EXPR_EVALUATOR_H

#include <string_view>
#include <vector>

#include "expr/condition_tokens.h"
#include "expr/expr_value.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "macros/macro_table.h"

namespace umpre {

/// Evaluates a condition while it reads its tokens, from a ScannerStack or ConditionTokens.
template <typename Tokens>
class Evaluator {
public:
    Evaluator(Tokens& tokens, MacroTable& macros, Reporter& reporter) noexcept
        : tokens_(tokens), macros_(macros), reporter_(reporter) {}

    /// Reads one expression, up to the first token that cannot go on with it, and returns its
    /// value. Sets `ok` to false after a syntax error, which is reported; reading goes on all the
    /// same. Throws ArithmeticFault where the machine's division would fail.
    [[nodiscard]] ExprValue evaluate(bool& ok);

private:
    // What waits for a value: its operator with what is known of the left side, or a bracket.
    struct Pending {
        enum class Kind { Unary, Binary, Parenthesis, Middle, Third };
        Kind kind = Kind::Unary;
        TokenKind operation = TokenKind::END_OF_INPUT;  // of Unary and Binary
        int precedence = 0;                             // of Binary
        ExprValue value;   // left operand; of Middle and Third, the condition
        ExprValue middle;  // of Third
    };

    [[nodiscard]] ExprValue operand();
    [[nodiscard]] ExprValue primary(TokenKind kind);
    [[nodiscard]] ExprValue definedOperator();
    void rejectCall();
    [[nodiscard]] bool isComplete(ExprValue& value);
    [[nodiscard]] bool closesBracket(ExprValue& value);
    void applyTightest(ExprValue& value);
    void applyBinaries(int precedence, ExprValue& value);
    ExprValue syntaxError(std::string_view message);

    Tokens& tokens_;
    MacroTable& macros_;
    Reporter& reporter_;
    std::vector<Pending> pending_;
    bool ok_ = true;  // no syntax error yet
};

extern template class Evaluator<ScannerStack>;
extern template class Evaluator<ConditionTokens>;

}  // namespace umpre

#endif
