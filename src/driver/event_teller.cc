// SPDX-License-Identifier: MIT
//
// All that one line does is told with that line, although reading may have gone on: a directive has
// the line of its "#", and a replacement that of the name in a file's text from which it came.
#include "driver/event_teller.h"

namespace umpre {

using Kind = Event::Kind;

void EventTeller::sourceEntered(std::string_view name) {
    files_.emplace_back(name);
    observer_({Kind::FileEntered, name, {}, 0});
}

void EventTeller::includedFile(const Event& event) {
    if (event.kind == Kind::FileEntered) {
        files_.emplace_back(event.name);
    }
    observer_({event.kind, event.name, placeFile_, placeLine_});
}

void EventTeller::fileLeft() {
    const std::string name = std::move(files_.back());
    files_.pop_back();
    const SourcePosition place = files_.empty() ? SourcePosition{} : sources_.position();
    observer_({Kind::FileLeft, name, place.fileName, place.line});
}

EventTeller::Directive::Directive(std::optional<EventTeller>& events)
    : events_(events ? &*events : nullptr) {
    if (events_ != nullptr) {
        events_->notePlace();
        events_->isInDirective_ = true;
    }
}

EventTeller::Directive::~Directive() {
    if (events_ != nullptr) {
        events_->isInDirective_ = false;
    }
}

void EventTeller::macroDefined(std::string_view name) {
    tellDefinition(Kind::MacroDefined, name);
}

void EventTeller::macroUndefined(std::string_view name) {
    tellDefinition(Kind::MacroUndefined, name);
}

// A name that comes from a replacement belongs to the name in the text that this replaced.
void EventTeller::macroMet() {
    if (!isInDirective_ && sources_.readsFile()) {
        notePlace();
    }
}

void EventTeller::macroExpanded(std::string_view name) {
    observer_({Kind::MacroExpanded, name, placeFile_, placeLine_});
}

void EventTeller::notePlace() {
    const SourcePosition place = sources_.position();
    placeFile_ = place.fileName;
    placeLine_ = place.line;
}

// A directive that is read as bytes makes a definition before its end is read. Before a source is
// open, definitions come from elsewhere.
void EventTeller::tellDefinition(Kind kind, std::string_view name) {
    if (!isInDirective_ && sources_.hasFile()) {
        notePlace();
    }
    observer_({kind, name, placeFile_, placeLine_});
}

}  // namespace umpre
