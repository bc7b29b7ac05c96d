// SPDX-License-Identifier: MIT
//
// Most definitions of a large input are never used, so what one costs is what storing it costs. The
// bytes of names and definitions follow each other in large blocks; they are given back with the
// table. A name that is defined anew uses its own bytes again, or takes at least twice as many, so
// that what it takes is bounded by its longest definition, however often it is defined.
#include "macros/macro_table.h"

#include <algorithm>
#include <iterator>
#include <new>

#include "lex/page_request.h"

namespace umpre {
namespace {

constexpr std::size_t kFirstSlots = 256;

// Readers look at up to 32 bytes at a time, so that many can be read behind the last.
constexpr std::size_t kReadable = 32;

constexpr std::size_t kCacheLine = 64;

// Counts the names in a text like "a,b".
[[nodiscard]] std::uint32_t countOf(std::string_view names) noexcept {
    const auto commas = std::count(names.begin(), names.end(), ',');
    return names.empty() ? 0 : static_cast<std::uint32_t>(commas) + 1;
}

// Asks for what a use looks at.
inline void prefetchEntry(const MacroName& entry) noexcept {
    const auto* const place = static_cast<const char*>(static_cast<const void*>(&entry));
    __builtin_prefetch(place + kCacheLine);
    __builtin_prefetch(place + 2 * kCacheLine);
}

}  // namespace

MacroTable::MacroTable() : slots_(kFirstSlots, &pages_), unknown_(1) {}

MacroName* MacroTable::find(std::string_view name) {
    MacroName* const entry = findEntry(name);
    return entry != nullptr && entry->isDefined ? entry : nullptr;
}

MacroName* MacroTable::findEntry(std::string_view name) {
    const Slot slot = slots_[slotOf(name, hashOfName(name))];
    return slot.number == 0 ? nullptr : &nameIn(slot);
}

Name& MacroTable::noteOf(std::string_view name) {
    MacroName* const entry = filter_.mayHold(name) ? findEntry(name) : nullptr;
    if (entry != nullptr) {
        return *entry;
    }
    unknownIsNoted_ = true;
    return unknown_.back();
}

void MacroTable::setNames(LexedText& text, std::size_t first) {
    for (std::size_t index = first; index < text.size(); ++index) {
        if (isName(text.kind(index))) {
            text.setName(index, &noteOf(text.text(index)));
        }
    }
}

void MacroTable::enterNames(LexedText& text) {
    for (std::size_t index = 0; index < text.size(); ++index) {
        if (isName(text.kind(index))) {
            text.setName(index, &enter(text.text(index)));
        }
    }
}

void MacroTable::defineMacro(std::string_view name, std::string_view text) {
    MacroName& entry = enter(name);
    if (!entry.isDefined) {
        noteChange(name);
        replace(entry, {text, {}, false});
        tellDefined(entry);
    }
}

MacroTable::Definition MacroTable::define(std::string_view name, const MacroText& definition) {
    MacroName& entry = enter(name);
    const bool isAdded = !entry.isDefined;
    if (!isAdded && entry.macro.text() == definition.text) {
        return Definition::Same;
    }
    noteChange(name);
    replace(entry, definition);
    tellDefined(entry);
    return isAdded ? Definition::Added : Definition::Replaced;
}

void MacroTable::replace(MacroName& name, const MacroText& definition) {
    Macro& macro = name.macro;
    const std::size_t size = definition.parameters.size() + definition.text.size() + 1;
    if (size > macro.capacity_) {
        // What is too large to be told is not used again.
        const std::size_t capacity = std::max(size, std::size_t{2} * macro.capacity_);
        macro.bytes_ = newBytes(capacity);
        macro.capacity_ = static_cast<std::uint32_t>(std::min<std::size_t>(capacity, UINT32_MAX));
    }
    const std::size_t parametersSize =
        definition.parameters.copy(macro.bytes_, definition.parameters.size());
    macro.textSize_ = definition.text.copy(macro.bytes_ + parametersSize, definition.text.size());
    macro.bytes_[size - 1] = '\0';
    macro.parametersSize_ = static_cast<std::uint32_t>(parametersSize);
    macro.parameterCount_ = countOf(definition.parameters);
    macro.functionLike_ = definition.functionLike;
    dropUse(macro);
    macro.wasUsed_ = false;
    macro.isAnother_ = macro.wasDefined_;
    changes_ += name.isDefined ? 0U : 1U;
    name.isDefined = true;
    if (!macro.wasDefined_) {
        macro.wasDefined_ = true;
        addToFilter(name);
    }
}

void MacroTable::addToFilter(const Name& name) {
    filter_.add(name.text);
    if (unknownIsNoted_) {
        unknown_.back().isDefined = true;
        unknown_.emplace_back();
        unknownIsNoted_ = false;
    }
}

void MacroTable::undefine(std::string_view name) {
    MacroName* const entry = find(name);
    if (entry != nullptr) {
        noteChange(name);
        entry->isDefined = false;
        ++changes_;
        dropUse(entry->macro);
        if (events_ != nullptr) {
            events_->macroUndefined(entry->text);
        }
    }
}

void MacroTable::setEvents(MacroEvents& events) {
    events_ = &events;
    std::vector<Slot> taken;
    std::copy_if(slots_.begin(), slots_.end(), std::back_inserter(taken),
                 [](Slot slot) { return slot.number != 0; });
    std::sort(taken.begin(), taken.end(),
              [](Slot slot, Slot other) { return slot.number < other.number; });
    for (const Slot slot : taken) {
        if (nameIn(slot).isDefined) {
            tellDefined(nameIn(slot));
        }
    }
}

void MacroTable::tellDefined(const MacroName& name) {
    if (events_ != nullptr) {
        events_->macroDefined(name.text);
    }
}

// Each loop asks for what the next one looks at, of all names before it is needed of any.
void MacroTable::prefetchUses(std::span<Sought> names) noexcept {
    for (Sought& sought : names) {
        sought.hash = hashOfName(sought.name);
        __builtin_prefetch(&slots_[sought.hash & (slots_.size() - 1)]);
    }
    for (Sought& sought : names) {
        sought.entry = firstWith(sought.hash);
    }
    for (const Sought& sought : names) {
        if (sought.entry != nullptr) {
            const std::string_view text = sought.entry->expansion.text.data() != nullptr
                                              ? sought.entry->expansion.text
                                              : sought.entry->macro.text();
            __builtin_prefetch(text.data());
            __builtin_prefetch(text.data() + text.size());
        }
    }
}

void MacroTable::noteChange(std::string_view name) {
    if (watched_.size() > 0 && watched_.mayHold(name)) {
        watched_.clear();
        ++version_;
    }
}

// Returns the first entry with a hash, which is asked for; null if there is none.
inline MacroName* MacroTable::firstWith(std::uint32_t hash) noexcept {
    const std::size_t mask = slots_.size() - 1;
    std::size_t at = hash & mask;
    while (slots_[at].number != 0 && slots_[at].hash != hash) {
        at = (at + 1) & mask;
    }
    if (slots_[at].number == 0) {
        return nullptr;
    }
    MacroName& entry = nameIn(slots_[at]);
    __builtin_prefetch(&entry);
    prefetchEntry(entry);
    return &entry;
}

inline std::size_t MacroTable::slotOf(std::string_view name, std::uint32_t hash) {
    const std::size_t mask = slots_.size() - 1;
    std::size_t at = hash & mask;
    while (slots_[at].number != 0 && (slots_[at].hash != hash || !holds(slots_[at], name))) {
        at = (at + 1) & mask;
    }
    return at;
}

// Tells whether a slot is that of a name. What a use looks at is asked for at once.
bool MacroTable::holds(Slot slot, std::string_view name) {
    const MacroName& entry = nameIn(slot);
    prefetchEntry(entry);
    return isSameName(entry.text, name);
}

MacroName& MacroTable::enter(std::string_view name) {
    const std::uint32_t hash = hashOfName(name);
    std::size_t at = slotOf(name, hash);
    if (slots_[at].number == 0) {
        if (4 * (nameCount_ + 1) > 3 * slots_.size()) {
            grow();
            at = slotOf(name, hash);
        }
        slots_[at] = {hash, newName(name)};
        ++nameCount_;
    }
    return nameIn(slots_[at]);
}

// Makes the entry of a name and returns its number.
std::uint32_t MacroTable::newName(std::string_view name) {
    const std::size_t units = (sizeof(MacroName) + name.size() + kUnit - 1) / kUnit;
    if (units > kUnitsTogether - unitsTaken_) {
        addNames(units);
    }
    const std::size_t number = (names_.size() - 1) * kUnitsTogether + unitsTaken_ + 1;
    char* const place = names_.back() + unitsTaken_ * kUnit;
    char* const bytes = place + sizeof(MacroName);
    auto* const added = new (place) MacroName();
    added->text = {bytes, name.copy(bytes, name.size())};
    unitsTaken_ += std::min(units, kUnitsTogether);
    return static_cast<std::uint32_t>(number);
}

// Takes memory for names, of which the first one takes so many units.
void MacroTable::addNames(std::size_t units) {
    constexpr std::size_t kMostBlocks = UINT32_MAX / kUnitsTogether;
    if (names_.size() == kMostBlocks) {
        throw std::bad_alloc();
    }
    const std::size_t size = std::max(units, kUnitsTogether) * kUnit + kReadable;
    names_.push_back(static_cast<char*>(newBlock(size, kUnit)));
    unitsTaken_ = 0;
}

char* MacroTable::newBytes(std::size_t size) {
    constexpr std::size_t kBlock = std::size_t{32} * 1024;
    if (size + kReadable > left_) {
        left_ = std::max(size + kReadable, kBlock);
        free_ = static_cast<char*>(newBlock(left_, 1));
    }
    left_ -= size;
    free_ += size;
    return free_ - size;
}

void* MacroTable::newBlock(std::size_t size, std::size_t alignment) {
    // Small inputs use little of a block, and so does a definition that takes one by itself because
    // it was given room to grow.
    constexpr std::size_t kFew = std::size_t{128} * 1024;
    void* const block = bytes_.allocate(size, alignment);
    blockBytes_ += size;
    if (blockBytes_ > kFew && size <= kFew) {
        requestPages(block, size);
    }
    return block;
}

void MacroTable::dropUse(const Macro& macro) noexcept {
    if (macro.use_ != nullptr) {
        *macro.use_ = {};
    }
}

void MacroTable::grow() {
    std::pmr::vector<Slot> old(&pages_);
    old.reserve(2 * slots_.size());
    requestPages(old.data(), 2 * slots_.size() * sizeof(Slot));
    old.resize(2 * slots_.size());
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
