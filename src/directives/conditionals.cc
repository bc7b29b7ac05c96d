// SPDX-License-Identifier: MIT
#include "directives/conditionals.h"

#include "directives/operand.h"

namespace umpre {

using enum TokenKind;

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
        groups_.decide(false);
        return;
    }
    const bool isDefined = macros_.find(name.text) != nullptr;
    groups_.decide(isDefined == (wanted == Wanted::Defined));
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
    groups_.decide(ok && value.value != 0);
    sources_.skipBlanks();
    if (sources_.peek() != END_OF_INPUT) {
        reporter_.reportError(kInvalidCharacters);
    }
}

}  // namespace umpre
