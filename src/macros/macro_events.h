// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_MACRO_EVENTS_H
#define UMPRE_MACROS_MACRO_EVENTS_H

#include <string_view>

namespace umpre {

/// The port for who wants to know what becomes of macros.
class MacroEvents {
public:
    virtual ~MacroEvents() = default;
    /// A name got a definition, or another one.
    virtual void macroDefined(std::string_view name) = 0;
    /// A name lost its definition.
    virtual void macroUndefined(std::string_view name) = 0;
    /// The name of a macro was read that may be replaced. Nothing behind it was looked at.
    virtual void macroMet() = 0;
    /// The macro that was met last is replaced.
    virtual void macroExpanded(std::string_view name) = 0;
};

}  // namespace umpre

#endif
