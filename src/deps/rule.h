// SPDX-License-Identifier: MIT
#ifndef UMPRE_DEPS_RULE_H
#define UMPRE_DEPS_RULE_H

#include <string>
#include <string_view>
#include <vector>

namespace umpre {

/// A rule of a makefile: what is made from which files.
struct Rule {
    std::vector<std::string> targets;  ///< as they are to be written
    std::vector<std::string> files;    ///< each once, the source first; empty: standard input
    std::vector<std::string> absent;   ///< what the target will depend on when it comes to be
    bool phonyFiles = false;  ///< each file but the source is a target without a recipe, too
};

/// Returns a name as Make and Ninja want it among what a target depends on.
[[nodiscard]] std::string escapedFile(std::string_view name);

/// Returns a name as Make wants it for a target.
[[nodiscard]] std::string escapedTarget(std::string_view name);

/// Returns the rule as text.
[[nodiscard]] std::string textOf(const Rule& rule);

}  // namespace umpre

#endif
