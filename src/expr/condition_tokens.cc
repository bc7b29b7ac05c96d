// SPDX-License-Identifier: MIT
//
// On the token road a condition is lexed, its macros are expanded, the texts of the result are
// joined and lexed again. Most conditions come out of this as what they were, with the texts of a
// few object-like macros in the places of their names:
//
//     #define BITS (8 * BYTES)
//     #define BYTES 4
//     #if BITS > 16 && !defined(TINY)       reads as  ( 8 * 4 ) > 16 && ! defined ( TINY )
//
// These are read here, each macro's text in its place. It is the same as long as no two tokens that
// meet where a text begins or ends would be one when lexed together; where they might, the
// condition is not told. The names that must not be expanded in a text are those of the texts
// around it.
#include "expr/condition_tokens.h"

#include <algorithm>

#include "lex/spelling.h"
#include "lex/token_join.h"
#include "macros/predefined_macros.h"

namespace umpre {
using enum TokenKind;

void ConditionTokens::read(DirectiveLine& line, bool watchesNames) {
    line_ = &line;
    watchesNames_ = watchesNames;
    replacements_.clear();
    peeked_ = {};
    isApart_ = true;
    meets_ = false;
    expected_ = Expected::Anything;
    hasPeek_ = false;
    isTold_ = true;
}

// Reads the token behind `peeked_` into its place.
void ConditionTokens::scan() {
    while (isTold_) {
        const Token token = scanUnexpanded();
        if (token.kind == END_OF_INPUT) {
            break;
        }
        if (watchesNames_ && isName(token.kind)) {
            macros_.watch(token.text);
        }
        if (!isProtected(token.kind) && isName(token.kind) && beginReplacement(token.text)) {
            continue;
        }
        if (token.kind == OTHER || (meets_ && !isApart_ && mayJoin(peeked_, token))) {
            isTold_ = false;
            break;
        }
        peeked_ = token;
        isApart_ = false;
        meets_ = false;
        return;
    }
    peeked_ = {};
}

// Returns the next token of the innermost text that has one.
Token ConditionTokens::scanUnexpanded() {
    while (!replacements_.empty()) {
        Replacement& text = replacements_.back();
        if (text.at == text.end) {
            replacements_.pop_back();
            meets_ = true;
        } else if (*text.at == ' ') {
            ++text.at;
            isApart_ = true;
        } else {
            const Token token = tokenAt(text.at);
            text.at += token.text.size();
            return token;
        }
    }
    isApart_ |= line_->skipBlanks();
    return line_->isAtEnd() ? Token{} : line_->next();
}

// Tells whether a token is the operand of `defined`, which is not expanded: what follows the word,
// or what follows it and "(".
bool ConditionTokens::isProtected(TokenKind kind) {
    switch (expected_) {
    case Expected::Anything:
        if (kind == KW_DEFINED) {
            expected_ = Expected::Operand;
        }
        return false;
    case Expected::Operand:
        expected_ = kind == LEFT_PARENTHESIS ? Expected::ParenthesizedOperand : Expected::Anything;
        return true;
    case Expected::ParenthesizedOperand: expected_ = Expected::Anything; return true;
    }
    return false;
}

// Begins to read a name's text in its place. Returns false if the name stays.
bool ConditionTokens::beginReplacement(std::string_view name) {
    const MacroName* const macro = macros_.find(name);
    const auto isOf = [macro](const Replacement& text) { return text.macro == macro; };
    if (macro == nullptr || std::any_of(replacements_.begin(), replacements_.end(), isOf)) {
        return false;
    }
    if (macro->macro.functionLike() || isRefreshed(*macro) || replacements_.size() == deepest_) {
        isTold_ = false;
        return true;
    }
    const std::string_view text = macro->macro.text();
    replacements_.push_back({macro, text.data(), text.data() + text.size()});
    meets_ = true;
    return true;
}

}  // namespace umpre
