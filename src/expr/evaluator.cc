// SPDX-License-Identifier: MIT
//
// The grammar has thirteen levels, and conditions may nest a million brackets deep, so what waits
// for a value lies on a stack of its own instead of the machine's. With "1 + 2 * (3" read, the
// stack is
//
//     Binary +, left 1    Binary *, left 2    Parenthesis            and the value in hand is 3
//
// When a value is complete, the operators before it that bind at least as tightly as the one behind
// it are applied. Nothing is skipped: both sides of && and of ?: are evaluated in full.
#include "expr/evaluator.h"

#include "expr/literals.h"

namespace umpre {

using enum TokenKind;

template <typename Tokens>
ExprValue Evaluator<Tokens>::evaluate(bool& ok) {
    pending_.clear();
    ok_ = true;
    ExprValue value = operand();
    while (!isComplete(value)) {
        value = operand();
    }
    ok = ok && ok_;
    return value;
}

// Reads an operand, with the unary operators and the opening brackets before it.
template <typename Tokens>
ExprValue Evaluator<Tokens>::operand() {
    for (;;) {
        tokens_.skipBlanks();
        const TokenKind kind = tokens_.peek();
        switch (kind) {
        case BANG:
        case TILDE:
        case PLUS:
        case MINUS: pending_.push_back({Pending::Kind::Unary, kind, 0, {}, {}}); break;
        case LEFT_PARENTHESIS:
            pending_.push_back({Pending::Kind::Parenthesis, kind, 0, {}, {}});
            break;
        default: return primary(kind);
        }
        tokens_.next();
    }
}

template <typename Tokens>
ExprValue Evaluator<Tokens>::primary(TokenKind kind) {
    const Token token = tokens_.next();
    if (kind == KW_DEFINED) {
        return definedOperator();
    }
    if (kind >= INT_DEC && kind <= UINT_HEX) {
        return integerValue(token);
    }
    if (kind == CHAR_LITERAL) {
        return characterValue(token.text, reporter_);
    }
    if (isName(kind)) {
        rejectCall();
        return {};
    }
    return syntaxError("Lexical element expected");
}

template <typename Tokens>
ExprValue Evaluator<Tokens>::definedOperator() {
    tokens_.skipBlanks();
    const bool parenthesized = tokens_.peek() == LEFT_PARENTHESIS;
    if (parenthesized) {
        tokens_.next();
        tokens_.skipBlanks();
    }
    const Token name = tokens_.next();
    if (name.kind != IDENTIFIER) {
        return syntaxError("Identifier expected for 'defined' operator");
    }
    const bool isDefined = macros_.find(name.text) != nullptr;
    if (parenthesized) {
        tokens_.skipBlanks();
        if (tokens_.next().kind != RIGHT_PARENTHESIS) {
            return syntaxError(R"text(")" expected for "defined" operator)text");
        }
    }
    return {isDefined ? 1U : 0U, true};
}

template <typename Tokens>
void Evaluator<Tokens>::rejectCall() {
    tokens_.skipBlanks();
    if (tokens_.peek() == LEFT_PARENTHESIS) {
        syntaxError("A function call is not allowed in a constant expression");
    }
}

// Takes a complete operand as far as it goes. Returns true when it is the value of the whole
// expression, false when another operand must be read first.
template <typename Tokens>
bool Evaluator<Tokens>::isComplete(ExprValue& value) {
    do {
        applyTightest(value);
        tokens_.skipBlanks();
        const TokenKind kind = tokens_.peek();
        const int precedence = precedenceOf(kind);
        if (precedence > 0) {
            applyBinaries(precedence, value);
            tokens_.next();
            pending_.push_back({Pending::Kind::Binary, kind, precedence, value, {}});
            return false;
        }
        applyBinaries(1, value);
        if (kind == QUESTION) {
            tokens_.next();
            pending_.push_back({Pending::Kind::Middle, kind, 0, value, {}});
            return false;
        }
    } while (closesBracket(value));
    return pending_.empty();
}

// Takes a value that no operator goes on with. Returns true when it closed a parenthesis, whose
// value is an operand again; otherwise an operand must be read, or nothing is pending.
template <typename Tokens>
bool Evaluator<Tokens>::closesBracket(ExprValue& value) {
    while (!pending_.empty()) {
        Pending& bracket = pending_.back();
        if (bracket.kind == Pending::Kind::Middle) {
            tokens_.skipBlanks();
            if (tokens_.next().kind == COLON) {
                bracket.kind = Pending::Kind::Third;
                bracket.middle = value;
                return false;
            }
            value = syntaxError(R"(":" expected in constant expression)");
        } else if (bracket.kind == Pending::Kind::Third) {
            value = bracket.value.value != 0 ? bracket.middle : value;
        } else {
            pending_.pop_back();
            tokens_.skipBlanks();
            if (tokens_.next().kind == RIGHT_PARENTHESIS) {
                rejectCall();
            } else {
                value = syntaxError(R"text(")" expected)text");
            }
            return true;
        }
        pending_.pop_back();
    }
    return false;
}

// Applies what no operator behind the value can come before. A division fault happens here, before
// anything more is read.
template <typename Tokens>
void Evaluator<Tokens>::applyTightest(ExprValue& value) {
    while (!pending_.empty() && pending_.back().kind == Pending::Kind::Unary) {
        value = applyUnary(pending_.back().operation, value);
        pending_.pop_back();
    }
    applyBinaries(kTightest, value);
}

// Applies the binary operators before the value that bind at least that tightly.
template <typename Tokens>
void Evaluator<Tokens>::applyBinaries(int precedence, ExprValue& value) {
    while (!pending_.empty() && pending_.back().precedence >= precedence) {
        value = applyBinary(pending_.back().operation, pending_.back().value, value);
        pending_.pop_back();
    }
}

template <typename Tokens>
ExprValue Evaluator<Tokens>::syntaxError(std::string_view message) {
    reporter_.reportError(message);
    ok_ = false;
    return {};
}

template class Evaluator<ScannerStack>;
template class Evaluator<ConditionTokens>;

}  // namespace umpre
