// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_EVENT_TELLER_H
#define UMPRE_DRIVER_EVENT_TELLER_H

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "lex/scanner_stack.h"
#include "macros/macro_events.h"
#include "umpre/event.h"

namespace umpre {

/// Tells an observer what a run does, and where.
class EventTeller final : public MacroEvents {
public:
    /// While it lives, a directive is carried out, and all that happens has its place: that where
    /// reading stood when this was made.
    class Directive {
    public:
        /// It may be that nobody is told.
        explicit Directive(std::optional<EventTeller>& events);
        Directive(const Directive&) = delete;
        Directive& operator=(const Directive&) = delete;
        ~Directive();

    private:
        EventTeller* events_;
    };

    EventTeller(Observer observer, const ScannerStack& sources)
        : observer_(std::move(observer)), sources_(sources) {}

    /// The source was entered, by the name that it was opened by.
    void sourceEntered(std::string_view name);
    /// An included file was entered or missed; where, is left to be told here.
    void includedFile(const Event& event);
    /// The end of the current file was reached, and its includer, if there is one, goes on.
    void fileLeft();

    void macroDefined(std::string_view name) override;
    void macroUndefined(std::string_view name) override;
    void macroMet() override;
    void macroExpanded(std::string_view name) override;

private:
    void notePlace();
    void tellDefinition(Event::Kind kind, std::string_view name);

    Observer observer_;
    const ScannerStack& sources_;
    std::vector<std::string> files_;  // that are open, by the names that they were opened by
    std::string placeFile_;
    std::int32_t placeLine_ = 0;
    bool isInDirective_ = false;
};

}  // namespace umpre

#endif
