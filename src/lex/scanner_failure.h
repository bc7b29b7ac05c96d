// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_SCANNER_FAILURE_H
#define UMPRE_LEX_SCANNER_FAILURE_H

namespace umpre {

/// What is said when there is no memory left.
constexpr const char* kNoMemory = "out of dynamic memory in yy_create_buffer()";

/// Thrown where scanning cannot go on; ends the run. The message is a constant text.
struct ScannerFailure {
    const char* message;
};

}  // namespace umpre

#endif
