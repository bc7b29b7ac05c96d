// SPDX-License-Identifier: MIT
//
// A name that is an object-like macro is simple: its body is pushed, with the set of names that
// must not be expanded in it. A function-like one is an invocation, which may have to expand
// arguments first, and these may hold invocations. Nothing here calls itself for that:
// `invocations_` is the stack, and two kinds of work take turns until the outermost replacement is
// pushed,
//
//     buildReplacement   takes the steps of the innermost body, until an argument must be expanded
//     readList           reads that argument, alone, until its end or until an invocation begins
//
// For P(P(x)) in text: P begins; its step "Argument 0" has "P(x)" read alone; there the inner P
// begins, has "x" read, and pushes "x"; the reading of "P(x)" goes on with it and ends; the outer P
// pushes its result.
#include "macros/macro_expander.h"

#include <utility>

#include "macros/predefined_macros.h"
#include "macros/stringize.h"

namespace umpre {

using enum TokenKind;

std::string_view MacroExpander::expandName(std::string_view name) {
    MacroName* macroName = nullptr;
    switch (lookAt(name, macroName)) {
    case Outcome::Name: return name;
    case Outcome::Uncalled: written_.assign(skipped_).append(macroName->text); return written_;
    case Outcome::Pushed: return {};
    case Outcome::Begun: finishInvocations(); return {};
    case Outcome::Abandoned: return macroName->text;
    }
    return {};
}

std::string MacroExpander::expandLine(std::string_view text, LineKind kind) {
    lineKind_ = kind;
    Pieces pieces;
    lexer_.append(pieces.open(), text);
    pieces.close({});
    sources_.isolate(pieces);
    Pieces result;
    while (!readList(result)) {
        finishInvocations();
    }
    sources_.endIsolation();
    lineKind_ = LineKind::Operand;
    return result.tokens().joined();
}

MacroExpander::Outcome MacroExpander::lookAt(std::string_view text, MacroName*& name) {
    name = macros_.find(text);
    if (name == nullptr || sets_.contains(sources_.noExpandSet(), *name)) {
        return Outcome::Name;
    }
    refreshPredefined(macros_, *name, sources_.position());
    if (name->macro.functionLike()) {
        return beginInvocation(*name);
    }
    const std::shared_ptr<const MacroBody>& body = bodyOf(name->macro, lexer_);
    sources_.pushShared({body, &body->tokens}, sets_.with(sources_.noExpandSet(), *name));
    return Outcome::Pushed;
}

MacroExpander::Outcome MacroExpander::beginInvocation(const MacroName& name) {
    const NoExpandSet inherited = sources_.noExpandSet();
    // The definition stays the same while arguments are read: they hold no directives.
    const Macro& macro = name.macro;
    (void)sources_.skipBlanksAndNewlines(skipped_);
    if (sources_.peek() != LEFT_PARENTHESIS) {
        return Outcome::Uncalled;
    }
    std::unique_ptr<Invocation> invocation = newInvocation();
    if (!collectArguments(sources_, reporter_, macro.parameterCount(), invocation->arguments)) {
        spare_.push_back(std::move(invocation));
        return Outcome::Abandoned;
    }
    invocation->body = bodyOf(macro, lexer_);
    invocation->noExpand = sets_.with(inherited, name);
    invocations_.push_back(std::move(invocation));
    return Outcome::Begun;
}

std::unique_ptr<MacroExpander::Invocation> MacroExpander::newInvocation() {
    if (spare_.empty()) {
        return std::make_unique<Invocation>();
    }
    std::unique_ptr<Invocation> invocation = std::move(spare_.back());
    spare_.pop_back();
    invocation->step = 0;
    invocation->replacement.clear();
    return invocation;
}

void MacroExpander::finishInvocations() {
    while (!invocations_.empty()) {
        Invocation& invocation = *invocations_.back();
        if (invocation.expanding != nullptr) {
            if (readList(invocation.expanding->expansion)) {
                endArgument(invocation);
            }
        } else if (buildReplacement(invocation)) {
            pushReplacement();
        }
    }
}

void MacroExpander::pushReplacement() {
    constexpr std::size_t kSpares = 64;
    std::unique_ptr<Invocation> finished = std::move(invocations_.back());
    invocations_.pop_back();
    sources_.pushPieces(finished->replacement);
    if (spare_.size() < kSpares) {
        spare_.push_back(std::move(finished));
    }
}

// Returns false when an argument must be read first; the step is then taken again.
bool MacroExpander::buildReplacement(Invocation& invocation) {
    const MacroBody& body = *invocation.body;
    while (invocation.step < body.steps.size()) {
        const BodyStep& step = body.steps[invocation.step];
        switch (step.kind) {
        case BodyStep::Kind::Tokens:
            invocation.replacement.append(body.tokens, step.first, step.last, invocation.noExpand);
            break;
        case BodyStep::Kind::Effects: sources_.carryOutEffects(body.source, step.first); break;
        case BodyStep::Kind::Argument:
            if (!addArgument(invocation, invocation.arguments[step.first])) {
                return false;
            }
            break;
        case BodyStep::Kind::Joined: addJoined(invocation, step); break;
        case BodyStep::Kind::Misplaced:
            reporter_.reportError("Macro variable expected after '#' operator");
            break;
        case BodyStep::Kind::PasteFirst:
            reporter_.reportError(
                "'##' operator cannot be at the beginning of the replacement list");
            break;
        case BodyStep::Kind::PasteLast:
            reporter_.reportError("'##' operator cannot be at the end of the replacement list");
            break;
        }
        ++invocation.step;
    }
    return true;
}

// Adds an argument's expansion. Returns false, having begun to read it, if it is not known.
bool MacroExpander::addArgument(Invocation& invocation, Argument& argument) {
    if (argument.state == Argument::Expansion::Unknown) {
        beginArgument(invocation, argument);
        return false;
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

void MacroExpander::beginArgument(Invocation& invocation, Argument& argument) {
    scratch_.clear();
    lexer_.append(scratch_.open(), argument.text);
    scratch_.close(argument.noExpand);
    argument.expansion.clear();
    invocation.expanding = &argument;
    invocation.effectsBefore = effects();
    sources_.isolate(scratch_);
}

// An expansion that reported something, or wrote the line ends of a comment, must do so at each
// use.
void MacroExpander::endArgument(Invocation& invocation) {
    sources_.endIsolation();
    invocation.expanding->state = effects() == invocation.effectsBefore
                                      ? Argument::Expansion::Known
                                      : Argument::Expansion::ForOneUse;
    invocation.expanding = nullptr;
}

void MacroExpander::addJoined(Invocation& invocation, const BodyStep& step) {
    const MacroBody& body = *invocation.body;
    joined_.clear();
    for (std::size_t index = step.first; index < step.last; ++index) {
        const BodyOperand operand = body.operands[index];
        switch (operand.kind) {
        case BodyOperand::Kind::Token: joined_ += body.tokens.text(operand.index); break;
        case BodyOperand::Kind::RawArgument:
            joined_ += invocation.arguments[operand.index].text;
            break;
        case BodyOperand::Kind::Stringized:
            stringize(invocation.arguments[operand.index].text, joined_);
            break;
        }
    }
    lexer_.append(invocation.replacement.open(), joined_);
    invocation.replacement.close(invocation.noExpand);
}

// Reads the isolated source to its end and returns true, or returns false when an invocation began
// that must be finished first; the reading goes on with its replacement.
bool MacroExpander::readList(Pieces& result) {
    for (Token token = sources_.next(); token.kind != END_OF_INPUT; token = sources_.next()) {
        if (isName(token.kind)) {
            if (!readName(token, result)) {
                return false;
            }
        } else if (token.kind == KW_DEFINED && lineKind_ == LineKind::Condition) {
            keepDefined(token, result);
        } else {
            result.append(token.kind, token.text, sources_.noExpandSet());
        }
    }
    return true;
}

bool MacroExpander::readName(const Token& token, Pieces& result) {
    const NoExpandSet noExpand = sources_.noExpandSet();
    MacroName* name = nullptr;
    switch (lookAt(token.text, name)) {
    case Outcome::Name: result.append(token.kind, token.text, noExpand); break;
    case Outcome::Uncalled:
        lexer_.append(result.open(), skipped_);
        result.append(token.kind, name->text, noExpand);
        break;
    case Outcome::Pushed: break;
    case Outcome::Begun: return false;
    case Outcome::Abandoned: result.append(token.kind, name->text, noExpand); break;
    }
    return true;
}

// The operand is what follows, or what follows "(", whatever it is.
void MacroExpander::keepDefined(const Token& word, Pieces& result) {
    const auto keep = [&](const Token& token) {
        if (token.kind != END_OF_INPUT) {
            result.append(token.kind, token.text, sources_.noExpandSet());
        }
    };
    const auto keepBlanks = [&] {
        while (isBlank(sources_.peek())) {
            keep(sources_.next());
        }
    };
    keep(word);
    keepBlanks();
    const bool parenthesized = sources_.peek() == LEFT_PARENTHESIS;
    if (parenthesized) {
        keep(sources_.next());
        keepBlanks();
    }
    keep(sources_.next());
    if (parenthesized) {
        keepBlanks();
        if (sources_.peek() == RIGHT_PARENTHESIS) {
            keep(sources_.next());
        }
    }
}

std::size_t MacroExpander::effects() const {
    return reporter_.reportCount() + sources_.commentEffects();
}

}  // namespace umpre
