// SPDX-License-Identifier: MIT
#ifndef UMPRE_DEPS_COMMAND_LINE_H
#define UMPRE_DEPS_COMMAND_LINE_H

#include <optional>
#include <string>
#include <vector>

#include "lex/byte_sink.h"

namespace umpre {

/// What is asked for beside what umpre does itself.
struct DepsOptions {
    enum class Task { Help, Version, Rule };

    Task task = Task::Rule;
    std::vector<std::string> targets;  ///< as they are to be written
    std::string ruleName;              ///< empty or "-": standard output
    std::string outputName;            ///< of the text; empty: there is none
    bool phonyFiles = false;
    bool absent = false;
    std::vector<std::string> words;  ///< the command line for umpre, its name included
};

/// Reads the command line. Returns nothing after telling what is wrong with it.
[[nodiscard]] std::optional<DepsOptions> readDepsOptions(int argc, const char* const* argv,
                                                         ByteSink& errors);

/// Returns the help text.
[[nodiscard]] std::string depsUsage();

/// Returns the name of a file with the suffix of its last part replaced.
[[nodiscard]] std::string withSuffix(const std::string& name, const std::string& suffix);

}  // namespace umpre

#endif
