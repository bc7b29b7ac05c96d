// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_MACRO_TABLE_H
#define UMPRE_MACROS_MACRO_TABLE_H

#include <cstddef>
#include <cstdint>
#include <deque>
#include <memory_resource>
#include <span>
#include <string_view>
#include <vector>

#include "lex/lexed_text.h"
#include "lex/name_filter.h"
#include "macros/large_pages.h"
#include "macros/macro.h"
#include "macros/macro_events.h"

namespace umpre {

/// All definitions of a run, by name. Names are bytes and are compared as such.
class MacroTable {
public:
    MacroTable();

    /// What became of a definition.
    enum class Definition { Added, Same, Replaced };

    /// Returns the entry of a defined name, otherwise null. It lives as long as the table; what it
    /// says changes with its definition.
    [[nodiscard]] MacroName* find(std::string_view name);

    /// Returns the entry of a name that was defined or entered at least once, otherwise null.
    [[nodiscard]] MacroName* findEntry(std::string_view name);
    /// Returns what is noted in a text for a name: its entry or, if it was never defined, one
    /// without text that stands for all such names. That one counts as defined once another name
    /// was, because it may be that name.
    [[nodiscard]] Name& noteOf(std::string_view name);

    /// Returns the entry that was noted in a text.
    [[nodiscard]] static MacroName& entryOf(Name& name) noexcept {
        // NOLINTNEXTLINE(cppcoreguidelines-pro-type-static-cast-downcast): the table makes no other
        return static_cast<MacroName&>(name);
    }

    /// Notes in a text, from token `first` on, what is known of its names.
    void setNames(LexedText& text, std::size_t first = 0);
    /// Notes in a text the entries of its names, making those that are missing.
    void enterNames(LexedText& text);

    /// Enters an object-like macro with this text unless the name is defined.
    void defineMacro(std::string_view name, std::string_view text);

    /// Enters a definition. If the name is defined with the same text, that definition stays as it
    /// is; with another text, it is replaced.
    Definition define(std::string_view name, const MacroText& definition);

    /// Replaces what a name is defined as. The views must not be of the name's own bytes.
    void replace(MacroName& name, const MacroText& definition);

    /// Returns where what is worked out for the uses of a definition is kept.
    [[nodiscard]] MacroUse& useOf(const Macro& macro) {
        if (macro.use_ == nullptr) {
            macro.use_ = &uses_.emplace_back();
        }
        return *macro.use_;
    }

    /// Says that a name will be looked for soon.
    void prefetch(std::string_view name) const noexcept {
        __builtin_prefetch(&slots_[hashOfName(name) & (slots_.size() - 1)]);
    }

    /// Returns how many names were entered.
    [[nodiscard]] std::size_t size() const noexcept { return nameCount_; }

    /// A name that will be looked for soon, and the entry that is probably its own.
    struct Sought {
        std::string_view name;
        MacroName* entry = nullptr;
        std::uint32_t hash = 0;
    };

    /// Asks for what uses of some names look at, waiting for memory once for all of them.
    void prefetchUses(std::span<Sought> names) noexcept;

    /// Removes a name; does nothing if it is not defined.
    void undefine(std::string_view name);

    /// Makes the version change when this name is defined, redefined or undefined.
    void watch(std::string_view name) {
        if (!watched_.mayHold(name)) {
            watched_.add(name);
        }
    }

    /// Tells of each definition that there is, and from now on of each that is made, replaced or
    /// removed.
    void setEvents(MacroEvents& events);

    /// Returns a number, not 0, that stays the same while the watched names keep their definitions.
    /// With another version, no names are watched at first.
    [[nodiscard]] std::uint64_t version() const noexcept { return version_; }

    /// Returns a number, not 0, that is another one after each time that a name came to be defined
    /// or undefined.
    [[nodiscard]] std::uint64_t changes() const noexcept { return changes_; }

    /// Returns the filter that every defined name passes.
    [[nodiscard]] const NameFilter& filter() const noexcept { return filter_; }

private:
    struct Slot {
        std::uint32_t hash = 0;
        std::uint32_t number = 0;  // of the name; 0: free
    };

    // A name's number tells where it stands: how many units from the first one, counted from 1.
    static constexpr std::size_t kUnit = alignof(MacroName);
    static constexpr std::size_t kUnitsTogether = 4096;

    [[nodiscard]] MacroName& nameIn(Slot slot) noexcept {
        const std::size_t unit = slot.number - 1;
        void* const place = names_[unit / kUnitsTogether] + unit % kUnitsTogether * kUnit;
        return *static_cast<MacroName*>(place);
    }

    [[nodiscard]] MacroName* firstWith(std::uint32_t hash) noexcept;
    [[nodiscard]] std::size_t slotOf(std::string_view name, std::uint32_t hash);
    [[nodiscard]] bool holds(Slot slot, std::string_view name);
    [[nodiscard]] MacroName& enter(std::string_view name);
    [[nodiscard]] std::uint32_t newName(std::string_view name);
    void addNames(std::size_t units);
    [[nodiscard]] char* newBytes(std::size_t size);
    [[nodiscard]] void* newBlock(std::size_t size, std::size_t alignment);
    static void dropUse(const Macro& macro) noexcept;
    void addToFilter(const Name& name);
    void noteChange(std::string_view name);
    void tellDefined(const MacroName& name);
    void grow();

    LargePages pages_;
    std::pmr::monotonic_buffer_resource bytes_{&pages_};  // of names and definitions
    char* free_ = nullptr;                                // the rest of the last block
    std::size_t left_ = 0;
    std::size_t blockBytes_ = 0;  // of all blocks
    std::vector<char*> names_;    // blocks of `kUnitsTogether`, or of one name with more
    std::size_t unitsTaken_ = kUnitsTogether;  // of the last block
    std::deque<MacroUse> uses_;
    std::size_t nameCount_ = 0;
    std::pmr::vector<Slot> slots_;  // open addressing; at most three of four are taken
    NameFilter filter_;
    NameFilter watched_;  // by readers of definitions
    std::uint64_t version_ = 1;
    std::uint64_t changes_ = 1;
    MacroEvents* events_ = nullptr;
    std::deque<Name> unknown_;  // the last one stands for what was never defined
    bool unknownIsNoted_ = false;
};

}  // namespace umpre

#endif
