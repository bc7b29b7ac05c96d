// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_ARGUMENT_LISTS_H
#define UMPRE_TESTS_UNIT_SUPPORT_ARGUMENT_LISTS_H

#include <cstddef>
#include <string>
#include <vector>

#include "macros/arguments.h"

namespace umpre::testing {

using Texts = std::vector<std::string>;

/// Returns the arguments of a call as they were written.
[[nodiscard]] inline Texts textsOf(ArgumentList& arguments) {
    Texts texts;
    for (std::size_t index = 0; index < arguments.size(); ++index) {
        texts.emplace_back(arguments[index].raw.joined());
    }
    return texts;
}

}  // namespace umpre::testing

#endif
