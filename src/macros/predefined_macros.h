// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_PREDEFINED_MACROS_H
#define UMPRE_MACROS_PREDEFINED_MACROS_H

#include <cstddef>

#include "lex/source_position.h"
#include "macros/macro_table.h"

namespace umpre {

/// Enters `__FILE__`, `__LINE__`, `__DATE__` and `__TIME__`, the last two with the local time of
/// now.
void definePredefinedMacros(MacroTable& macros);

/// Tells quickly of most names that `refreshPredefined` leaves them alone.
[[nodiscard]] inline bool mayBeRefreshed(const MacroName& name) noexcept {
    // Of `__FILE__` as of `__LINE__`.
    constexpr std::size_t kLength = 8;
    return name.text.size() == kLength;
}

/// Tells whether `refreshPredefined` gives this macro a text.
[[nodiscard]] bool isRefreshed(const MacroName& name) noexcept;

/// Gives `__FILE__` and `__LINE__` their current text; leaves every other macro of the table alone.
void refreshPredefined(MacroTable& macros, MacroName& name, const SourcePosition& position);

}  // namespace umpre

#endif
