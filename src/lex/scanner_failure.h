// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_SCANNER_FAILURE_H
#define UMPRE_LEX_SCANNER_FAILURE_H

namespace umpre {

/// Thrown where scanning cannot go on; ends the run. The message is a constant text.
struct ScannerFailure {
    const char* message;
};

}  // namespace umpre

#endif
