// SPDX-License-Identifier: MIT
#ifndef UMPRE_LINES_COMMAND_LINE_H
#define UMPRE_LINES_COMMAND_LINE_H

#include <optional>
#include <string>

#include "lex/byte_sink.h"

namespace umpre {

/// What the filter is to do, and on which files.
struct LinesOptions {
    enum class Task { Help, Version, Gnu, Strip, Map, MapStripped };

    Task task;
    std::string sourceName;  ///< empty: standard input
    std::string outputName;  ///< empty: standard output
};

/// Reads the command line of the filter. Returns nothing after telling what is wrong with it.
[[nodiscard]] std::optional<LinesOptions> readLinesOptions(int argc, const char* const* argv,
                                                           ByteSink& errors);

/// Returns the help text.
[[nodiscard]] std::string linesUsage();

}  // namespace umpre

#endif
