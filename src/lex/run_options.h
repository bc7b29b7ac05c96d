// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_RUN_OPTIONS_H
#define UMPRE_LEX_RUN_OPTIONS_H

#include <cstddef>
#include <cstdint>
#include <limits>

namespace umpre {

/// How a run does its work. No option changes what comes out; tests use them to hold the roads
/// against each other.
struct RunOptions {
    bool plainRoad = false;                           ///< every shortcut past the scanner is off
    std::size_t windowSize = std::size_t{64} * 1024;  ///< bytes of input held at a time, about
    /// For so many nanoseconds after its last change, a file is not told apart by its times.
    std::int64_t settlingTime = 20'000'000;
    /// With more macros than these, text has the names of several looked up together.
    std::size_t manyMacros = 4096;
    bool tellsMacros = false;  ///< each macro is expanded by itself, so that it can be told of
    static constexpr std::int64_t kAlwaysSettled = std::numeric_limits<std::int64_t>::min();
};

}  // namespace umpre

#endif
