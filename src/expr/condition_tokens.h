// SPDX-License-Identifier: MIT
#ifndef UMPRE_EXPR_CONDITION_TOKENS_H
#define UMPRE_EXPR_CONDITION_TOKENS_H

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

#include "lex/directive_line.h"
#include "lex/reporter.h"
#include "lex/token.h"
#include "macros/macro_table.h"

namespace umpre {

/// The tokens of a condition, macros expanded and blanks left out, straight from the bytes of its
/// line. It is a reporter, too: what would have to be reported is for the scanner to find.
class ConditionTokens final : public Reporter {
public:
    /// Where each macro must be expanded by itself, none is here.
    explicit ConditionTokens(MacroTable& macros, bool tellsMacros = false) noexcept
        : macros_(macros), deepest_(tellsMacros ? 0 : kDeepest) {}

    /// Begins to read a line where its reading stands. The line is borrowed. The names met are
    /// watched, or not.
    void read(DirectiveLine& line, bool watchesNames = false);

    /// Returns false once something was met that cannot be told from the bytes. The condition seems
    /// to end there.
    [[nodiscard]] bool isTold() const noexcept { return isTold_; }

    [[nodiscard]] TokenKind peek() {
        if (!hasPeek_) {
            scan();
            hasPeek_ = true;
        }
        return peeked_.kind;
    }

    /// Returns the next token, which is valid until another one is asked for.
    const Token& next() {
        (void)peek();
        hasPeek_ = false;
        return peeked_;
    }

    /// There are none.
    void skipBlanks() {}

    void reportError(std::string_view /*message*/) override { isTold_ = false; }

    void reportWarning(std::string_view /*message*/) override { isTold_ = false; }

    void noteUnterminatedComment(std::int32_t /*line*/) override { isTold_ = false; }

    [[nodiscard]] std::size_t reportCount() const override { return isTold_ ? 0 : 1; }

private:
    // A macro's text that is read in the place of its name.
    struct Replacement {
        const MacroName* macro;
        const char* at;
        const char* end;
    };

    // What the tokens behind `defined` are.
    enum class Expected { Anything, Operand, ParenthesizedOperand };

    // Deeper nesting is left to the token road, which has a quicker way to know the names around a
    // text.
    static constexpr std::size_t kDeepest = 16;

    void scan();
    [[nodiscard]] Token scanUnexpanded();
    [[nodiscard]] bool isProtected(TokenKind kind);
    [[nodiscard]] bool beginReplacement(std::string_view name);

    MacroTable& macros_;
    std::size_t deepest_;  // nesting of texts
    DirectiveLine* line_ = nullptr;
    std::vector<Replacement> replacements_;  // the innermost one is the last
    Token peeked_;         // comes next if `hasPeek_`, otherwise it was the last one
    bool isApart_ = true;  // blanks were passed since
    bool meets_ = false;   // a replacement began or ended since
    Expected expected_ = Expected::Anything;
    bool hasPeek_ = false;
    bool isTold_ = true;
    bool watchesNames_ = false;
};

}  // namespace umpre

#endif
