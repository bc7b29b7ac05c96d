// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_NO_EXPAND_SET_H
#define UMPRE_LEX_NO_EXPAND_SET_H

#include <bit>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace umpre {

struct Name;

/// An immutable set of macro names, a value as small as a pointer. Sets share their nodes: a set is
/// another set and one name more.
class NoExpandSet {
public:
    /// The empty set.
    NoExpandSet() = default;

    friend bool operator==(const NoExpandSet&, const NoExpandSet&) = default;

private:
    friend class NoExpandSets;

    struct Node {
        const Node* rest;    // null: nothing but the name
        const Name* name;    // the name that this node adds
        std::uint64_t mask;  // one bit for each name of the set; names may share a bit
        std::size_t size;    // of the set
    };

    explicit NoExpandSet(const Node* node) noexcept : node_(node) {}

    [[nodiscard]] static std::uint64_t maskOf(const Name& name) noexcept {
        // The low bits of an address are alike for all objects, and its high bits too.
        const auto address = std::bit_cast<std::uintptr_t>(&name);
        return std::uint64_t{1} << ((address >> 4U ^ address >> 10U) & 63U);
    }

    const Node* node_ = nullptr;
};

/// Which set a name was last added to, and what that gave.
struct NameExtension {
    NoExpandSet of;
    NoExpandSet result;
};

/// A name that is or was a macro's, or that may become one. There is one such object for each
/// spelling, so its address says which name it is.
struct Name {
    std::string_view text;
    bool isDefined = false;         ///< there is a macro of this name now
    mutable bool isMarked = false;  ///< by NoExpandSets, which looks into large sets that way
    mutable NameExtension* extension = nullptr;  ///< NoExpandSets' own
};

/// Makes and owns the sets of a run. Small sets made by adding the same names in the same order are
/// equal.
class NoExpandSets {
public:
    /// Tells whether the set holds the name.
    [[nodiscard]] bool contains(NoExpandSet set, const Name& name) {
        const NoExpandSet::Node* const node = set.node_;
        return node != nullptr && (node->mask & NoExpandSet::maskOf(name)) != 0
               && holds(*node, name);
    }

    /// Returns `set` and `name`.
    [[nodiscard]] NoExpandSet with(NoExpandSet set, const Name& name);

    /// Returns the names of both.
    [[nodiscard]] NoExpandSet united(NoExpandSet set, NoExpandSet other) {
        if (set == other || other.node_ == nullptr) {
            return set;
        }
        return set.node_ == nullptr ? other : unionOf(set, other);
    }

private:
    struct Key {
        const void* first;
        const void* second;
        friend bool operator==(const Key&, const Key&) = default;
    };

    struct KeyHash {
        [[nodiscard]] std::size_t operator()(const Key& key) const noexcept;
    };

    using Node = NoExpandSet::Node;

    [[nodiscard]] bool holds(const Node& set, const Name& name);
    void mark(const Node& set);
    [[nodiscard]] static bool extends(const Node* set, const Node* other) noexcept;
    [[nodiscard]] NoExpandSet newUnion(NoExpandSet set, NoExpandSet other);
    [[nodiscard]] NoExpandSet unionOf(NoExpandSet set, NoExpandSet other);
    [[nodiscard]] NoExpandSet extend(NoExpandSet set, const Name& name);
    [[nodiscard]] const Node* add(const Node* rest, const Name& name);

    std::deque<Node> nodes_;
    std::deque<NameExtension> extensions_;                    // of the names that were added
    std::unordered_map<Key, const Node*, KeyHash> extended_;  // (set, name) to set
    std::unordered_map<Key, NoExpandSet, KeyHash> unions_;    // (set, set) to set
    Key lastUnited_{nullptr, nullptr};
    NoExpandSet lastUnion_;
    const Node* marked_ = nullptr;  // the set whose names are marked
    std::vector<const Node*> path_;
};

}  // namespace umpre

#endif
