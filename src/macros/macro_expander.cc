// SPDX-License-Identifier: MIT
//
// What bytes tell of a name in a file's text is read as bytes (`readName`). All else comes as
// tokens.
//
// A name that is an object-like macro is simple: its body is pushed, with the set of names that
// must not be expanded in it. A function-like one is an invocation, which may have to expand
// arguments first, and these may hold invocations. Nothing here calls itself for that:
// `invocations_` is the stack, and two kinds of work take turns until the outermost replacement is
// pushed,
//
//     Substitution       takes the steps of the innermost body, until an argument must be expanded
//     readList           reads that argument, alone, until its end or until an invocation begins
//
// For P(P(x)) in text: P begins; its step "Argument 0" has "P(x)" read alone; there the inner P
// begins, has "x" read, and pushes "x"; the reading of "P(x)" goes on with it and ends; the outer P
// pushes its result.
#include "macros/macro_expander.h"

#include <utility>

#include "macros/argument_slices.h"
#include "macros/predefined_macros.h"

namespace umpre {

using enum TokenKind;

NameReader::Outcome MacroExpander::readName(std::string_view name, const char* end) {
    const char* const behind = name.data() + name.size();
    const MacroName* const macro = macroToRead(name);
    if (macro == nullptr) {
        return {name, behind};
    }
    if (macro->macro.functionLike()) {
        call_.clear();
        const char* const callEnd = texts_.expandCall(*macro, behind, end, call_);
        return {call_.view(), callEnd};
    }
    const std::optional<std::string_view> text = memo_.textOf(*macro);
    return text ? NameReader::Outcome{*text, behind} : NameReader::Outcome{{}, nullptr};
}

// Returns the macro of this name, or null. Lists call one macro again and again.
const MacroName* MacroExpander::macroToRead(std::string_view name) {
    if (nextNoticed_ < noticed_.size()) {
        lastRead_ = noticed_[nextNoticed_].entry;
        ++nextNoticed_;
    }
    if (lastRead_ == nullptr || !isSameName(lastRead_->text, name)) {
        lastRead_ = macros_.findEntry(name);
    }
    return lastRead_ != nullptr && lastRead_->isDefined ? lastRead_ : nullptr;
}

void MacroExpander::notice(std::span<const std::string_view> names) {
    noticed_.resize(names.size());
    for (std::size_t index = 0; index < names.size(); ++index) {
        noticed_[index].name = names[index];
    }
    nextNoticed_ = 0;
    macros_.prefetchUses(noticed_);
}

std::string_view MacroExpander::expandName(const Token& token) {
    MacroName* const name = entryOf(token);
    switch (lookAt(name)) {
    case Outcome::Name: return token.text;
    case Outcome::Uncalled: written_.assign(skipped_).append(name->text); return written_;
    case Outcome::Text: return text_->joined();
    case Outcome::Pushed: return {};
    case Outcome::Begun: finishInvocations(); return {};
    case Outcome::Abandoned: return name->text;
    }
    return {};
}

std::string_view MacroExpander::takeText() {
    CppTokenScanner* const list = sources_.listReadNow();
    if (list == nullptr) {
        return {};
    }
    const std::size_t first = list->takePlain(macros_.filter(), NEWLINE);
    return list->text()->joined(first, list->position());
}

std::string MacroExpander::expandLine(std::string_view text, LineKind kind) {
    lineKind_ = kind;
    SharedText line = lexer_.lexed(text);
    macros_.setNames(line.edit());
    sources_.isolate(TextSlice::whole(std::move(line)), {});
    Pieces result(lexer_.texts().take());
    while (!readList(result)) {
        finishInvocations();
    }
    sources_.endIsolation();
    lineKind_ = LineKind::Operand;
    return std::string(result.tokens().joined());
}

MacroExpander::Outcome MacroExpander::lookAt(MacroName* name) {
    if (name == nullptr || sets_.contains(sources_.noExpandSet(), *name)) {
        return Outcome::Name;
    }
    if (mayBeRefreshed(*name)) {
        refresh(*name);
    }
    return events_ == nullptr ? replace(*name) : replaceAndTell(*name);
}

MacroExpander::Outcome MacroExpander::replace(const MacroName& name) {
    return name.macro.functionLike() ? beginInvocation(name) : replaceObject(name);
}

MacroExpander::Outcome MacroExpander::replaceAndTell(const MacroName& name) {
    events_->macroMet();
    const Outcome outcome = replace(name);
    if (outcome != Outcome::Uncalled && outcome != Outcome::Abandoned) {
        events_->macroExpanded(name.text);
    }
    return outcome;
}

MacroName* MacroExpander::entryOf(const Token& token) {
    if (token.name == nullptr || token.name->text.empty() || sources_.plainRoad()) {
        return macros_.find(token.text);
    }
    return token.name->isDefined ? &MacroTable::entryOf(*token.name) : nullptr;
}

void MacroExpander::refresh(MacroName& name) {
    const MacroUse& use = macros_.useOf(name.macro);
    std::shared_ptr<const MacroBody> before = use.body;
    refreshPredefined(macros_, name, sources_.position());
    if (!invocations_.empty() && before != use.body) {
        retired_.push_back(std::move(before));
    }
}

MacroExpander::Outcome MacroExpander::replaceObject(const MacroName& name) {
    text_ = bodies_.tokensOf(name.macro);
    if (!sources_.plainRoad() && isText(*text_)) {
        return Outcome::Text;
    }
    const NoExpandSet noExpand = sets_.with(sources_.noExpandSet(), name);
    sources_.pushSlice(TextSlice::whole(std::move(text_)), noExpand);
    return Outcome::Pushed;
}

// Tells whether reading a text again would find nothing to do in it.
bool MacroExpander::isText(const LexedText& text) const {
    if (text.hasEffects()) {
        return false;
    }
    const auto isPlainName = [&](std::size_t index) {
        return isName(text.kind(index)) && !mayBeMacro(text, index, macros_.filter());
    };
    std::size_t at = text.nextNotable(0, text.size());
    while (at < text.size() && isPlainName(at)) {
        at = text.nextNotable(at + 1, text.size());
    }
    return at == text.size();
}

MacroExpander::Outcome MacroExpander::beginInvocation(const MacroName& name) {
    const NoExpandSet inherited = sources_.noExpandSet();
    skipped_.clear();
    if (sources_.peek() != LEFT_PARENTHESIS) {
        skipped_ = sources_.skipBlanksAndNewlines();
        if (sources_.peek() != LEFT_PARENTHESIS) {
            return Outcome::Uncalled;
        }
    }
    std::unique_ptr<Invocation> invocation = newInvocation();
    // The definition stays the same while arguments are read: they hold no directives.
    if (!collect(name.macro, invocation->arguments)) {
        keepInvocation(std::move(invocation));
        return Outcome::Abandoned;
    }
    invocation->body = &bodies_.bodyOf(name.macro);
    invocation->noExpand = sets_.with(inherited, name);
    invocations_.push_back(std::move(invocation));
    return Outcome::Begun;
}

bool MacroExpander::collect(const Macro& macro, ArgumentList& arguments) {
    CppTokenScanner* const list = sources_.listReadNow();
    if (list != nullptr && takeArgumentSlices(*list, macro.parameterCount(), arguments)) {
        return true;
    }
    arguments.release();
    return collector_.collect(macro.parameterCount(), arguments);
}

std::unique_ptr<Invocation> MacroExpander::newInvocation() {
    std::unique_ptr<Invocation> invocation;
    if (spare_.empty()) {
        invocation = std::make_unique<Invocation>();
    } else {
        invocation = std::move(spare_.back());
        spare_.pop_back();
    }
    invocation->step = 0;
    invocation->replacement.restart(lexer_.texts().take());
    return invocation;
}

void MacroExpander::keepInvocation(std::unique_ptr<Invocation> invocation) {
    constexpr std::size_t kSpares = 64;
    if (spare_.size() < kSpares) {
        invocation->arguments.release();
        spare_.push_back(std::move(invocation));
    }
}

void MacroExpander::finishInvocations() {
    while (!invocations_.empty()) {
        Invocation& invocation = *invocations_.back();
        if (invocation.expanding != nullptr) {
            if (readList(invocation.expanding->expansion)) {
                endArgument(invocation);
            }
        } else if (Argument* const needed = substitution_.build(invocation)) {
            beginArgument(invocation, *needed);
        } else {
            pushReplacement();
        }
    }
    retired_.clear();
}

void MacroExpander::pushReplacement() {
    std::unique_ptr<Invocation> finished = std::move(invocations_.back());
    invocations_.pop_back();
    sources_.pushPieces(std::move(finished->replacement));
    keepInvocation(std::move(finished));
}

void MacroExpander::beginArgument(Invocation& invocation, Argument& argument) {
    TextSlice slice = argument.raw;
    if (argument.mustBeLexed || sources_.plainRoad()) {
        slice = TextSlice::whole(lexer_.lexed(argument.raw.joined()));
        macros_.setNames(slice.text.edit());
    }
    argument.expansion.restart(lexer_.texts().take());
    invocation.expanding = &argument;
    invocation.effectsBefore = effects();
    sources_.isolate(std::move(slice), argument.noExpand);
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

// Reads the isolated source to its end and returns true, or returns false when an invocation began
// that must be finished first; the reading goes on with its replacement.
bool MacroExpander::readList(Pieces& result) {
    for (;;) {
        takeList(result);
        const Token token = sources_.next();
        if (token.kind == END_OF_INPUT) {
            return true;
        }
        if (isName(token.kind)) {
            if (!readListName(token, result)) {
                return false;
            }
        } else if (token.kind == KW_DEFINED && lineKind_ == LineKind::Condition) {
            keepDefined(token, result);
        } else {
            result.append(token, sources_.noExpandSet());
        }
    }
}

// Takes over what would be read token by token and added as it is.
void MacroExpander::takeList(Pieces& result) {
    CppTokenScanner* const list = sources_.listReadNow();
    if (list == nullptr) {
        return;
    }
    const std::size_t first = list->takePlain(macros_.filter(), KW_DEFINED);
    if (list->position() > first) {
        result.append(*list->text(), first, list->position(), list->noExpandSet());
    }
}

bool MacroExpander::readListName(const Token& token, Pieces& result) {
    const NoExpandSet noExpand = sources_.noExpandSet();
    MacroName* const name = entryOf(token);
    switch (lookAt(name)) {
    case Outcome::Name: result.append(token, noExpand); break;
    case Outcome::Uncalled:
        lexer_.append(result.open(), skipped_);
        result.append({token.kind, name->text, name}, noExpand);
        break;
    case Outcome::Text: result.append(*text_, 0, text_->size(), sets_.with(noExpand, *name)); break;
    case Outcome::Pushed: break;
    case Outcome::Begun: return false;
    case Outcome::Abandoned: result.append({token.kind, name->text, name}, noExpand); break;
    }
    return true;
}

// The operand is what follows, or what follows "(", whatever it is.
void MacroExpander::keepDefined(const Token& word, Pieces& result) {
    const auto keep = [&](const Token& token) {
        if (token.kind != END_OF_INPUT) {
            result.append(token, sources_.noExpandSet());
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
