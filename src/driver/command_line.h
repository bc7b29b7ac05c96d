// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_COMMAND_LINE_H
#define UMPRE_DRIVER_COMMAND_LINE_H

#include <memory>
#include <string>
#include <string_view>

#include "driver/output_file.h"
#include "driver/preprocessor.h"
#include "lex/byte_sink.h"

namespace umpre {

/// What the command line talks to beside the preprocessor.
struct Console {
    OutputFile& output;  ///< standard output until the command line names a file
    ByteSink& errors;
    std::string_view program = "umpre";  ///< its name in messages
};

/// Carries out the command line: definitions, directories, the output file, the source, which is
/// opened. Returns true if the preprocessor is to run; otherwise all has been said that there is to
/// say.
[[nodiscard]] bool parseCommandLine(Preprocessor& preprocessor, const Console& console, int argc,
                                    const char* const* argv);

}  // namespace umpre

#endif
