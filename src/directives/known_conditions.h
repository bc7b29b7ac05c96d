// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_KNOWN_CONDITIONS_H
#define UMPRE_DIRECTIVES_KNOWN_CONDITIONS_H

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace umpre {

/// Conditions that were met before, by their bytes, with what came out of them. That holds for one
/// version of the macro table, in which all names that a condition hangs on are watched. To watch
/// them is worth it only for conditions that come again: what comes out is kept the second time.
class KnownConditions {
public:
    /// A condition, and where it has its place. Valid until the next call.
    struct Place {
        std::string_view text;
        std::uint32_t hash = 0;
        bool comesAgain = false;    ///< it was met before: its names should be watched
        std::optional<bool> value;  ///< if it is known
    };

    /// Longer conditions are hardly met again.
    static constexpr std::size_t kLongest = 1024;

    /// Looks for a condition and notes that it was met, unless it is empty or longer than that.
    [[nodiscard]] Place meet(std::string_view text, std::uint64_t version);

    /// Keeps what came out of a condition that comes again, and whose names are watched.
    void keep(const Place& place, bool value, std::uint64_t version);

private:
    static constexpr std::size_t kSets = 1024;

    // With version 0, that of no table, the condition was only met.
    struct Slot {
        std::uint64_t version = 0;
        std::uint32_t hash = 0;
        std::uint32_t at = 0;  // of its text in texts_
        std::uint32_t size = 0;
        bool value = false;
    };

    using Set = std::array<Slot, 4>;

    [[nodiscard]] Set& setOf(std::uint32_t hash) noexcept { return sets_[hash % kSets]; }

    [[nodiscard]] Slot* find(std::uint32_t hash) noexcept;
    [[nodiscard]] bool holds(const Slot& slot, std::string_view text) const noexcept;

    std::vector<Set> sets_;
    std::string texts_;
};

}  // namespace umpre

#endif
