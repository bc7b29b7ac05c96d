// SPDX-License-Identifier: MIT
#include "macros/macro_table.h"

#include <memory>
#include <utility>

namespace umpre {
namespace {

constexpr std::size_t kFirstSlots = 256;

}  // namespace

MacroTable::MacroTable() : slots_(kFirstSlots) {}

MacroName* MacroTable::find(std::string_view name) {
    const Slot slot = slots_[slotOf(name, hashOfName(name))];
    if (slot.number == 0) {
        return nullptr;
    }
    MacroName& found = names_[slot.number - 1];
    return found.macro == nullptr ? nullptr : &found;
}

void MacroTable::defineMacro(std::string_view name, std::string_view text) {
    MacroName& entry = enter(name);
    if (entry.macro == nullptr) {
        entry.macro =
            std::make_shared<const Macro>(std::string(text), std::vector<std::string>(), false);
    }
}

MacroTable::Definition MacroTable::define(std::string_view name, Macro macro) {
    MacroName& entry = enter(name);
    if (entry.macro != nullptr && entry.macro->text == macro.text) {
        return Definition::Same;
    }
    const bool added = entry.macro == nullptr;
    entry.macro = std::make_shared<const Macro>(std::move(macro));
    return added ? Definition::Added : Definition::Replaced;
}

void MacroTable::undefine(std::string_view name) {
    MacroName* const entry = find(name);
    if (entry != nullptr) {
        entry->macro.reset();
    }
}

std::size_t MacroTable::slotOf(std::string_view name, std::uint32_t hash) const {
    const std::size_t mask = slots_.size() - 1;
    std::size_t at = hash & mask;
    while (slots_[at].number != 0
           && (slots_[at].hash != hash || names_[slots_[at].number - 1].text != name)) {
        at = (at + 1) & mask;
    }
    return at;
}

MacroName& MacroTable::enter(std::string_view name) {
    const std::uint32_t hash = hashOfName(name);
    std::size_t at = slotOf(name, hash);
    if (slots_[at].number == 0) {
        if (2 * (names_.size() + 1) > slots_.size()) {
            grow();
            at = slotOf(name, hash);
        }
        names_.push_back({{std::string(name), false}, nullptr});
        slots_[at] = {hash, static_cast<std::uint32_t>(names_.size())};
        filter_.add(name);
    }
    return names_[slots_[at].number - 1];
}

void MacroTable::grow() {
    std::vector<Slot> old(2 * slots_.size());
    old.swap(slots_);
    const std::size_t mask = slots_.size() - 1;
    for (const Slot& slot : old) {
        if (slot.number != 0) {
            std::size_t at = slot.hash & mask;
            while (slots_[at].number != 0) {
                at = (at + 1) & mask;
            }
            slots_[at] = slot;
        }
    }
}

}  // namespace umpre
