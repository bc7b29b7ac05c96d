// SPDX-License-Identifier: MIT
#ifndef UMPRE_FUZZ_CONDITION_RULES_H
#define UMPRE_FUZZ_CONDITION_RULES_H

#include <cstdint>
#include <functional>
#include <set>
#include <string>
#include <string_view>

namespace umpre::fuzz {

/// What a condition comes to.
struct RuledCondition {
    std::uint64_t value = 0;  ///< below 2 to the power of 32
    bool isSigned = true;
    bool isCorrect = true;  ///< no syntax error
    bool isFault = false;   ///< a division ended it, and nothing else but `messages` counts
    std::string messages;   ///< a line each
    std::string left;       ///< the tokens that were not read
};

/// Evaluates a text in which these names are macros. This is the evaluator once more, as plain as
/// it can be: it climbs from the loosest operators to the tightest and computes in 64 bits.
[[nodiscard]] RuledCondition conditionOf(std::string_view text,
                                         const std::set<std::string, std::less<>>& macros);

}  // namespace umpre::fuzz

#endif
