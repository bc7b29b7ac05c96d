// SPDX-License-Identifier: MIT
//
// The condition that comes next is mostly one of a few, "defined(DEBUG)" or what tells one
// processor from another. What is kept is bounded: a set of four places holds the last four
// conditions that its number leads to.
#include "directives/known_conditions.h"

#include <algorithm>

#include "lex/name_filter.h"

namespace umpre {
namespace {

constexpr std::size_t kMostBytes = std::size_t{1} << 20U;

}  // namespace

KnownConditions::Place KnownConditions::meet(std::string_view text, std::uint64_t version) {
    if (text.empty() || text.size() > kLongest) {
        return {};
    }
    if (sets_.empty()) {
        sets_.resize(kSets);
    }
    Place place{text, hashOfName(text), false, {}};
    Slot* const slot = find(place.hash);
    if (slot == nullptr) {
        Set& set = setOf(place.hash);
        std::rotate(set.begin(), set.end() - 1, set.end());
        set.front() = {0, place.hash, 0, 0, false};
    } else if (slot->version == 0) {
        place.comesAgain = true;
    } else if (slot->version != version) {
        slot->version = 0;  // its names change: it is not watched again at once
    } else if (holds(*slot, text)) {
        place.value = slot->value;
    }
    return place;
}

void KnownConditions::keep(const Place& place, bool value, std::uint64_t version) {
    if (texts_.size() + place.text.size() > kMostBytes) {
        sets_.assign(kSets, {});
        texts_.clear();
        return;
    }
    Slot* const slot = find(place.hash);
    if (slot == nullptr) {
        return;
    }
    slot->version = version;
    slot->value = value;
    if (!holds(*slot, place.text)) {
        slot->at = static_cast<std::uint32_t>(texts_.size());
        slot->size = static_cast<std::uint32_t>(place.text.size());
        texts_.append(place.text);
    }
}

KnownConditions::Slot* KnownConditions::find(std::uint32_t hash) noexcept {
    Set& set = setOf(hash);
    auto* const slot = std::find_if(set.begin(), set.end(),
                                    [hash](const Slot& each) { return each.hash == hash; });
    return slot == set.end() ? nullptr : &*slot;
}

bool KnownConditions::holds(const Slot& slot, std::string_view text) const noexcept {
    return std::string_view(texts_).substr(slot.at, slot.size) == text;
}

}  // namespace umpre
