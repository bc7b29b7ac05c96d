// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_PROGRAM_H
#define UMPRE_DRIVER_PROGRAM_H

namespace umpre {

/// Runs a program with its standard descriptors open. Returns its exit status, or 2 after saying on
/// standard error that there is no memory for it.
[[nodiscard]] int runProgram(int (*program)(int argc, char** argv), int argc, char** argv);

}  // namespace umpre

#endif
