// SPDX-License-Identifier: MIT
#include "macros/substitution.h"

#include <string_view>

#include "macros/stringize.h"

namespace umpre {

using enum TokenKind;

Argument* Substitution::build(Invocation& invocation) {
    const std::vector<BodyStep>& steps = invocation.body->steps;
    while (invocation.step < steps.size()) {
        Argument* const needed = takeStep(invocation, steps[invocation.step]);
        if (needed != nullptr) {
            return needed;
        }
        ++invocation.step;
    }
    return nullptr;
}

// Returns the argument that must be expanded first; the step is then to be taken again.
Argument* Substitution::takeStep(Invocation& invocation, const BodyStep& step) {
    const MacroBody& body = *invocation.body;
    switch (step.kind) {
    case BodyStep::Kind::Tokens:
        invocation.replacement.append(*body.tokens, step.first, step.last, invocation.noExpand);
        break;
    case BodyStep::Kind::Effects: sources_.carryOutEffects(*body.source, step.first); break;
    case BodyStep::Kind::Argument:
        if (!addArgument(invocation, invocation.arguments[step.first])) {
            return &invocation.arguments[step.first];
        }
        break;
    case BodyStep::Kind::Joined: addJoined(invocation, step); break;
    case BodyStep::Kind::Misplaced:
        reporter_.reportError("Macro variable expected after '#' operator");
        break;
    case BodyStep::Kind::PasteFirst:
        reporter_.reportError("'##' operator cannot be at the beginning of the replacement list");
        break;
    case BodyStep::Kind::PasteLast:
        reporter_.reportError("'##' operator cannot be at the end of the replacement list");
        break;
    }
    return nullptr;
}

// Adds an argument's expansion. Returns false if it is not known.
bool Substitution::addArgument(Invocation& invocation, Argument& argument) {
    if (argument.state == Argument::Expansion::Unknown && isItsOwnExpansion(argument)) {
        argument.state = Argument::Expansion::SameAsRaw;
    }
    if (argument.state == Argument::Expansion::Unknown) {
        return false;
    }
    if (argument.state == Argument::Expansion::SameAsRaw) {
        invocation.replacement.append(*argument.raw.text, argument.raw.first, argument.raw.last,
                                      sets_.united(argument.noExpand, invocation.noExpand));
        return true;
    }
    std::size_t first = 0;
    for (const Pieces::Run& run : argument.expansion.runs()) {
        invocation.replacement.append(argument.expansion.tokens(), first, run.end,
                                      sets_.united(run.noExpand, invocation.noExpand));
        first = run.end;
    }
    if (argument.state == Argument::Expansion::ForOneUse) {
        argument.state = Argument::Expansion::Unknown;
    }
    return true;
}

// Tells whether reading the argument would only yield its tokens as they are.
bool Substitution::isItsOwnExpansion(const Argument& argument) const {
    if (sources_.plainRoad() || argument.mustBeLexed) {
        return false;
    }
    const TextSlice& raw = argument.raw;
    std::size_t at = raw.text->nextNotable(raw.first, raw.last);
    while (at < raw.last && !mayBeMacro(*raw.text, at, macros_.filter())) {
        at = raw.text->nextNotable(at + 1, raw.last);
    }
    return at == raw.last;
}

void Substitution::addJoined(Invocation& invocation, const BodyStep& step) {
    const MacroBody& body = *invocation.body;
    joined_.clear();
    for (std::size_t index = step.first; index < step.last; ++index) {
        const BodyOperand operand = body.operands[index];
        switch (operand.kind) {
        case BodyOperand::Kind::Token: joined_ += body.tokens->text(operand.index); break;
        case BodyOperand::Kind::RawArgument:
            joined_ += invocation.arguments[operand.index].raw.joined();
            break;
        case BodyOperand::Kind::Stringized:
            stringize(invocation.arguments[operand.index].raw.joined(), joined_);
            break;
        }
    }
    if (!addLiteral(invocation, step)) {
        LexedText& text = invocation.replacement.open();
        const std::size_t before = text.size();
        lexer_.append(text, joined_);
        macros_.setNames(text, before);
    }
    invocation.replacement.close(invocation.noExpand);
}

// Adds the string literal of an argument, if it is clear without lexing that it is one literal.
bool Substitution::addLiteral(Invocation& invocation, const BodyStep& step) {
    const BodyOperand operand = invocation.body->operands[step.first];
    if (sources_.plainRoad() || step.last - step.first != 1
        || operand.kind != BodyOperand::Kind::Stringized) {
        return false;
    }
    const std::string_view inner = invocation.arguments[operand.index].raw.joined();
    if (inner.find_first_of("\"\\\n") != std::string_view::npos) {
        return false;
    }
    invocation.replacement.open().append(STRING_LITERAL, joined_);
    return true;
}

}  // namespace umpre
