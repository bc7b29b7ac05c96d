// SPDX-License-Identifier: MIT
#include "directives/conditionals.h"

#include "directives/operand.h"

namespace umpre {

using enum TokenKind;
using Outcome = DirectiveLine::Outcome;

bool Conditionals::carryOut(TokenKind word) {
    switch (word) {
    case KW_IF: ifDirective(); return true;
    case KW_IFDEF:
        ifdefDirective(Wanted::Defined, R"(An identifier is expected after "#ifdef")");
        return true;
    case KW_IFNDEF:
        ifdefDirective(Wanted::Undefined, R"(An identifier is expected after "#ifndef")");
        return true;
    case KW_ELIF: elifDirective(); return true;
    case KW_ELSE: elseDirective(); return true;
    case KW_ENDIF: endifDirective(); return true;
    default: return false;
    }
}

void Conditionals::closeFileGroups() {
    if (groups_.conditionalDepth() > 0) {
        reporter_.reportError(R"(Unterminated "#if" conditional)");
    }
    groups_.leaveFile();
}

// Returns false, the line read, if the group is dead: its condition is not looked at.
bool Conditionals::openGroup() {
    const bool isDead = groups_.skipping();
    groups_.open();
    if (isDead) {
        sources_.skipToEndOfLine();
    }
    return !isDead;
}

void Conditionals::ifDirective() {
    if (openGroup()) {
        decideByCondition();
    }
}

void Conditionals::ifdefDirective(Wanted wanted, std::string_view missingName) {
    if (!openGroup()) {
        return;
    }
    sources_.skipBlanks();
    const Token name = sources_.next();
    if (!isName(name.kind)) {
        reporter_.reportError(missingName);
        sources_.skipToEndOfLine();
        decide(false);
        return;
    }
    const MacroName* const found = macros_.find(name.text);
    if (wanted == Wanted::Defined) {
        decide(found != nullptr);
    } else {
        decide(found == nullptr, found);
    }
    sources_.skipBlanks();
    if (sources_.peek() != NEWLINE) {
        reporter_.reportError(kInvalidCharacters);
    }
}

void Conditionals::elifDirective() {
    if (groups_.conditionalDepth() == 0) {
        reporter_.reportError(R"(No "#if" directive associated to "elif")");
        sources_.skipToEndOfLine();
        return;
    }
    switch (groups_.groupState()) {
    case GroupState::AfterElse:
        reporter_.reportError(R"(Cannot use an "#elif" directive after an "#else")");
        sources_.skipToEndOfLine();
        break;
    case GroupState::Dead: sources_.skipToEndOfLine(); break;
    case GroupState::Taking:
        sources_.skipToEndOfLine();
        groups_.passOver();
        break;
    case GroupState::Seeking: decideByCondition(); break;
    }
}

void Conditionals::elseDirective() {
    if (groups_.conditionalDepth() == 0) {
        reporter_.reportError(R"(No "#if" directive associated to "#else")");
    } else if (groups_.groupState() == GroupState::AfterElse) {
        reporter_.reportError(R"(Cannot use another "#else" directive after an "#else")");
    } else {
        groups_.takeElse();
    }
}

void Conditionals::endifDirective() {
    if (groups_.conditionalDepth() == 0) {
        reporter_.reportError(R"(No "#if" directive associated to "#endif")");
    } else {
        groups_.close();
    }
}

void Conditionals::decideByCondition() {
    const std::string condition = gatherLine(sources_);
    const ExpandedOperand operand(sources_, expander_, lexer_, condition, LineKind::Condition);
    bool ok = true;
    const ExprValue value = evaluator_.evaluate(ok);
    if (!ok) {
        sources_.skipToEndOfLine();
    }
    decide(ok && value.value != 0);
    sources_.skipBlanks();
    if (sources_.peek() != END_OF_INPUT) {
        reporter_.reportError(kInvalidCharacters);
    }
}

// From bytes, nothing is done before it is clear that nothing has to be reported for the line; only
// what its word alone leads to is.
Outcome Conditionals::carryOut(DirectiveLine& line) {
    switch (line.word()) {
    case KW_IF:
    case KW_IFDEF:
    case KW_IFNDEF: return beginGroup(line);
    case KW_ELIF: return beginBranch(line);
    case KW_ELSE:
    case KW_ENDIF:
        line.skipBlanks();
        if (!line.isAtEnd() || !line.isOneLine()) {
            return Outcome::Untold;
        }
        carryOut(line.word());
        return Outcome::EndLeft;
    default: return Outcome::Untold;
    }
}

Outcome Conditionals::beginGroup(DirectiveLine& line) {
    if (groups_.skipping()) {
        if (!line.skipRest()) {
            return Outcome::Untold;
        }
        groups_.open();
        line.takeEnd();
        return Outcome::EndTaken;
    }
    const std::optional<bool> isTaken = condition(line);
    if (!isTaken) {
        return Outcome::Untold;
    }
    groups_.open();
    decide(*isTaken, line.word() == KW_IFNDEF ? tested_ : nullptr);
    return Outcome::EndLeft;
}

Outcome Conditionals::beginBranch(DirectiveLine& line) {
    const GroupState state = groups_.groupState();
    if (groups_.conditionalDepth() == 0 || state == GroupState::AfterElse) {
        return Outcome::Untold;
    }
    if (state == GroupState::Seeking) {
        const std::optional<bool> isTaken = condition(line);
        if (isTaken) {
            decide(*isTaken);
        }
        return isTaken ? Outcome::EndLeft : Outcome::Untold;
    }
    if (!line.skipRest()) {
        return Outcome::Untold;
    }
    if (state == GroupState::Taking) {
        groups_.passOver();
    }
    line.takeEnd();
    return Outcome::EndTaken;
}

// Returns whether the line's branch is taken, or nothing if that cannot be told.
std::optional<bool> Conditionals::condition(DirectiveLine& line) {
    switch (line.word()) {
    case KW_IFDEF: return isDefined(line);
    case KW_IFNDEF: {
        const std::optional<bool> known = isDefined(line);
        return known ? std::optional(!*known) : std::nullopt;
    }
    default: return isTrue(line);
    }
}

std::optional<bool> Conditionals::isDefined(DirectiveLine& line) {
    line.skipBlanks();
    const Token name = line.next();
    line.skipBlanks();
    if (!isName(name.kind) || !line.isAtEnd()) {
        return std::nullopt;
    }
    tested_ = macros_.find(name.text);
    return tested_ != nullptr;
}

std::optional<bool> Conditionals::isTrue(DirectiveLine& line) {
    const KnownConditions::Place known =
        knownConditions_.meet(line.bytesToLineFeed(KnownConditions::kLongest), macros_.version());
    if (known.value) {
        line.passBytes(known.text.size());
        return known.value;
    }
    const std::optional<bool> value = valueOf(line, known.comesAgain);
    if (value && known.comesAgain && line.isOneLine()) {
        knownConditions_.keep(known, *value, macros_.version());
    }
    return value;
}

std::optional<bool> Conditionals::valueOf(DirectiveLine& line, bool watchesNames) {
    byteTokens_.read(line, watchesNames);
    bool ok = true;
    ExprValue value;
    try {
        value = byteEvaluator_.evaluate(ok);
    } catch (const ArithmeticFault&) {
        return std::nullopt;  // the token road may have something to report before it comes to this
    }
    if (byteTokens_.peek() != END_OF_INPUT || !byteTokens_.isTold()) {
        return std::nullopt;
    }
    return value.value != 0;
}

void Conditionals::decide(bool taken, const Name* guard) {
    groups_.decide(taken);
    ++decisions_;
    lastGuard_ = guard;
}

}  // namespace umpre
