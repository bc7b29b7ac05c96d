// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_LINE_SKIPPER_H
#define UMPRE_LEX_LINE_SKIPPER_H

#include "lex/cpp_file_scanner.h"
#include "lex/output_writer.h"
#include "lex/text_reader.h"

namespace umpre {

/// The byte-level road through skipped lines: passes over all but directives.
class LineSkipper {
public:
    using Stop = TextReader::Stop;

    explicit LineSkipper(OutputWriter& output) noexcept : output_(output) {}

    /// Passes over skipped lines, from a line's start or from within a line, and writes a line feed
    /// for each. Stops before a directive, or within a line before what only the scanner can read.
    [[nodiscard]] Stop skip(CppFileScanner& file, Stop from);

private:
    class Pass;

    OutputWriter& output_;
};

}  // namespace umpre

#endif
