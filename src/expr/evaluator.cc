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

ExprValue Evaluator::evaluate(bool& ok) {
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
ExprValue Evaluator::operand() {
    for (;;) {
        sources_.skipBlanks();
        const TokenKind kind = sources_.peek();
        switch (kind) {
        case BANG:
        case TILDE:
        case PLUS:
        case MINUS: pending_.push_back({Pending::Kind::Unary, kind, {}, {}}); break;
        case LEFT_PARENTHESIS:
            pending_.push_back({Pending::Kind::Parenthesis, kind, {}, {}});
            break;
        default: return primary(kind);
        }
        sources_.next();
    }
}

ExprValue Evaluator::primary(TokenKind kind) {
    const Token token = sources_.next();
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

ExprValue Evaluator::definedOperator() {
    sources_.skipBlanks();
    const bool parenthesized = sources_.peek() == LEFT_PARENTHESIS;
    if (parenthesized) {
        sources_.next();
        sources_.skipBlanks();
    }
    const Token name = sources_.next();
    if (name.kind != IDENTIFIER) {
        return syntaxError("Identifier expected for 'defined' operator");
    }
    const bool isDefined = macros_.find(name.text) != nullptr;
    if (parenthesized) {
        sources_.skipBlanks();
        if (sources_.next().kind != RIGHT_PARENTHESIS) {
            return syntaxError(R"text(")" expected for "defined" operator)text");
        }
    }
    return {isDefined ? 1U : 0U, true};
}

void Evaluator::rejectCall() {
    sources_.skipBlanks();
    if (sources_.peek() == LEFT_PARENTHESIS) {
        syntaxError("A function call is not allowed in a constant expression");
    }
}

// Takes a complete operand as far as it goes. Returns true when it is the value of the whole
// expression, false when another operand must be read first.
bool Evaluator::isComplete(ExprValue& value) {
    do {
        applyTightest(value);
        sources_.skipBlanks();
        const TokenKind kind = sources_.peek();
        const int precedence = precedenceOf(kind);
        if (precedence > 0) {
            applyBinaries(precedence, value);
            sources_.next();
            pending_.push_back({Pending::Kind::Binary, kind, value, {}});
            return false;
        }
        applyBinaries(1, value);
        if (kind == QUESTION) {
            sources_.next();
            pending_.push_back({Pending::Kind::Middle, kind, value, {}});
            return false;
        }
    } while (closesBracket(value));
    return pending_.empty();
}

// Takes a value that no operator goes on with. Returns true when it closed a parenthesis, whose
// value is an operand again; otherwise an operand must be read, or nothing is pending.
bool Evaluator::closesBracket(ExprValue& value) {
    while (!pending_.empty()) {
        Pending& bracket = pending_.back();
        if (bracket.kind == Pending::Kind::Middle) {
            sources_.skipBlanks();
            if (sources_.next().kind == COLON) {
                bracket.kind = Pending::Kind::Third;
                bracket.middle = value;
                return false;
            }
            value = syntaxError(R"(":" expected in constant expression)");
        } else if (bracket.kind == Pending::Kind::Third) {
            value = bracket.value.value != 0 ? bracket.middle : value;
        } else {
            pending_.pop_back();
            sources_.skipBlanks();
            if (sources_.next().kind == RIGHT_PARENTHESIS) {
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
void Evaluator::applyTightest(ExprValue& value) {
    while (!pending_.empty() && pending_.back().kind == Pending::Kind::Unary) {
        value = applyUnary(pending_.back().operation, value);
        pending_.pop_back();
    }
    applyBinaries(kTightest, value);
}

// Applies the binary operators before the value that bind at least that tightly.
void Evaluator::applyBinaries(int precedence, ExprValue& value) {
    while (!pending_.empty() && pending_.back().kind == Pending::Kind::Binary
           && precedenceOf(pending_.back().operation) >= precedence) {
        value = applyBinary(pending_.back().operation, pending_.back().value, value);
        pending_.pop_back();
    }
}

ExprValue Evaluator::syntaxError(std::string_view message) {
    reporter_.reportError(message);
    ok_ = false;
    return {};
}

}  // namespace umpre
