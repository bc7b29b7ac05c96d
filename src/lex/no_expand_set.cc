// SPDX-License-Identifier: MIT
//
// A set is a chain of nodes, each with one name. Sets are small as a rule: as many names as macros
// lie around the text. But a macro that names the next one, which names the next, and so on, makes
// sets as large as that chain is long, and each is asked only a little after the one that it
// extends. So the names of one large set are kept marked, and going over to another marks and
// clears no more than where the two differ.
#include "lex/no_expand_set.h"

#include <functional>

namespace umpre {
namespace {

// Sets up to this size are searched name by name, and shared between all that make the same.
constexpr std::size_t kSmall = 32;

}  // namespace

bool NoExpandSets::holds(const Node& set, const Name& name) {
    if (set.size > kSmall) {
        mark(set);
        return name.isMarked;
    }
    for (const Node* node = &set; node != nullptr; node = node->rest) {
        if (node->name == &name) {
            return true;
        }
    }
    return false;
}

void NoExpandSets::mark(const Node& set) {
    const auto sizeOf = [](const Node* node) { return node == nullptr ? 0 : node->size; };
    path_.clear();
    const Node* to = &set;
    while (marked_ != to) {
        if (sizeOf(marked_) >= sizeOf(to)) {
            marked_->name->isMarked = false;
            marked_ = marked_->rest;
        } else {
            path_.push_back(to);
            to = to->rest;
        }
    }
    for (const Node* const node : path_) {
        node->name->isMarked = true;
    }
    marked_ = &set;
}

std::size_t NoExpandSets::KeyHash::operator()(const Key& key) const noexcept {
    // Multiplication by 2^64 divided by the golden ratio spreads the addresses (Knuth, The Art of
    // Computer Programming, volume 3, 6.4).
    constexpr std::uint64_t kGolden = 0x9E3779B97F4A7C15U;
    const std::hash<const void*> address;
    const std::uint64_t first = address(key.first) * kGolden;
    return (first ^ first >> 32U ^ address(key.second)) * kGolden >> 16U;
}

NoExpandSet NoExpandSets::with(NoExpandSet set, const Name& name) {
    if (name.extension == nullptr) {
        name.extension = &extensions_.emplace_back();
    }
    NameExtension& last = *name.extension;
    if (last.result == NoExpandSet() || last.of != set) {
        last = {set, contains(set, name) ? set : extend(set, name)};
    }
    return last.result;
}

NoExpandSet NoExpandSets::extend(NoExpandSet set, const Name& name) {
    const Node* const rest = set.node_;
    if (rest != nullptr && rest->size >= kSmall) {
        return NoExpandSet(add(rest, name));
    }
    const Node*& node = extended_[{rest, &name}];
    if (node == nullptr) {
        node = add(rest, name);
    }
    return NoExpandSet(node);
}

const NoExpandSet::Node* NoExpandSets::add(const Node* rest, const Name& name) {
    const std::uint64_t mask = rest == nullptr ? 0 : rest->mask;
    const std::size_t size = rest == nullptr ? 0 : rest->size;
    nodes_.push_back({rest, &name, mask | NoExpandSet::maskOf(name), size + 1});
    return &nodes_.back();
}

// Tells whether a set is another one with names added. As a rule it is: an argument was read in the
// text that its call stands in.
bool NoExpandSets::extends(const Node* set, const Node* other) noexcept {
    while (set->size > other->size) {
        set = set->rest;
    }
    return set == other;
}

NoExpandSet NoExpandSets::newUnion(NoExpandSet set, NoExpandSet other) {
    if (extends(set.node_, other.node_)) {
        return set;
    }
    if (extends(other.node_, set.node_)) {
        return other;
    }
    for (const Node* node = other.node_; node != nullptr; node = node->rest) {
        set = with(set, *node->name);
    }
    return set;
}

NoExpandSet NoExpandSets::unionOf(NoExpandSet set, NoExpandSet other) {
    const Key key{set.node_, other.node_};
    if (lastUnited_ != key) {
        const auto [entry, isNew] = unions_.try_emplace(key, set);
        if (isNew) {
            entry->second = newUnion(set, other);
        }
        lastUnited_ = key;
        lastUnion_ = entry->second;
    }
    return lastUnion_;
}

}  // namespace umpre
