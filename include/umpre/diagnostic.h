// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIAGNOSTIC_H
#define UMPRE_DIAGNOSTIC_H

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

#include "umpre/export.h"

namespace umpre {

/// How much a message weighs.
enum class Severity {
    Note,     ///< worth knowing; changes nothing
    Warning,  ///< changes nothing either
    Error,    ///< the run goes on, and its outcome will be Outcome::Errors
    Fatal,    ///< the source cannot be opened
    Failure   ///< the input cannot be read on
};

/// A problem in the input. The views are valid during the call that brings it.
struct Diagnostic {
    Severity severity = Severity::Error;  ///< how much it weighs
    std::string_view file;                ///< as messages name it; empty before a file is open
    std::int32_t line = 0;                ///< how far reading has come; 0 before a file is open
    std::string_view text;                ///< without a period at its end
};

/// Takes a problem. It must not throw, and it must not use the Preprocessing that runs.
using DiagnosticSink = std::function<void(const Diagnostic&)>;

/// Returns the line that the program umpre prints for a problem, with its line end.
[[nodiscard]] UMPRE_API std::string messageOf(const Diagnostic& diagnostic);

}  // namespace umpre

#endif
