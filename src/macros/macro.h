// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_MACRO_H
#define UMPRE_MACROS_MACRO_H

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "lex/no_expand_set.h"

namespace umpre {

struct MacroBody;

/// One definition. What it says never changes; its body is worked out at its first use.
struct Macro {
    Macro(std::string replacement, std::vector<std::string> names, bool hasParameterList)
        : text(std::move(replacement)),
          parameters(std::move(names)),
          functionLike(hasParameterList) {}

    /// The replacement: the tokens' texts with one space where blanks stood between two.
    const std::string text;
    /// In the order written; empty too for a list without names.
    const std::vector<std::string> parameters;
    /// A "(" followed the name at once.
    const bool functionLike;

    /// The text made ready for use; null until then.
    mutable std::shared_ptr<const MacroBody> body;
};

/// A name that was defined at least once. Null: it is not defined now.
struct MacroName : Name {
    std::shared_ptr<const Macro> macro;
};

}  // namespace umpre

#endif
