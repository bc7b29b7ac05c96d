// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_EVENT_LIST_H
#define UMPRE_TESTS_UNIT_SUPPORT_EVENT_LIST_H

#include <string>

#include "umpre/event.h"

namespace umpre::testing {

/// Writes events as a list, like "enter main; define A main:1; ".
class EventList {
public:
    [[nodiscard]] Observer observer() {
        return [this](const Event& event) { add(event); };
    }

    [[nodiscard]] const std::string& text() const noexcept { return text_; }

private:
    void add(const Event& event) {
        text_.append(wordOf(event.kind)).append(" ").append(event.name);
        if (!event.file.empty() || event.line != 0) {
            text_.append(" ").append(event.file).append(":").append(std::to_string(event.line));
        }
        text_.append("; ");
    }

    [[nodiscard]] static const char* wordOf(Event::Kind kind) {
        switch (kind) {
        case Event::Kind::FileEntered: return "enter";
        case Event::Kind::FileMissed: return "miss";
        case Event::Kind::FileLeft: return "leave";
        case Event::Kind::MacroDefined: return "define";
        case Event::Kind::MacroUndefined: return "undefine";
        case Event::Kind::MacroExpanded: return "expand";
        }
        return "";
    }

    std::string text_;
};

}  // namespace umpre::testing

#endif
