// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_RUN_OPTIONS_H
#define UMPRE_LEX_RUN_OPTIONS_H

#include <cstddef>

namespace umpre {

/// How a run does its work. No option changes what comes out; tests use them to hold the roads
/// against each other.
struct RunOptions {
    bool plainRoad = false;                           ///< every shortcut past the scanner is off
    std::size_t windowSize = std::size_t{64} * 1024;  ///< bytes of input held at a time, about
};

}  // namespace umpre

#endif
