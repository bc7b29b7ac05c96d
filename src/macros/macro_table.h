// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_MACRO_TABLE_H
#define UMPRE_MACROS_MACRO_TABLE_H

#include <cstddef>
#include <cstdint>
#include <deque>
#include <string>
#include <string_view>
#include <vector>

#include "lex/name_filter.h"
#include "macros/macro.h"

namespace umpre {

/// All definitions of a run, by name. Names are bytes and are compared as such.
class MacroTable {
public:
    MacroTable();

    /// What became of a definition.
    enum class Definition { Added, Same, Replaced };

    /// Returns the entry of a defined name, otherwise null. It lives as long as the table; what it
    /// points to changes with its definition.
    [[nodiscard]] MacroName* find(std::string_view name);

    /// Enters an object-like macro with this text unless the name is defined.
    void defineMacro(std::string_view name, std::string_view text);

    /// Enters a definition. If the name is defined with the same text, that definition stays as it
    /// is; with another text, it is replaced.
    Definition define(std::string_view name, Macro macro);

    /// Removes a name; does nothing if it is not defined.
    void undefine(std::string_view name);

    /// Returns the filter that every defined name passes.
    [[nodiscard]] const NameFilter& filter() const noexcept { return filter_; }

private:
    struct Slot {
        std::uint32_t hash = 0;
        std::uint32_t number = 0;  // of the name, counted from 1; 0: free
    };

    [[nodiscard]] std::size_t slotOf(std::string_view name, std::uint32_t hash) const;
    [[nodiscard]] MacroName& enter(std::string_view name);
    void grow();

    std::deque<MacroName> names_;
    std::vector<Slot> slots_;  // open addressing; at most half of them are taken
    NameFilter filter_;
};

}  // namespace umpre

#endif
