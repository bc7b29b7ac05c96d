// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_LINE_SKIPPER_H
#define UMPRE_DIRECTIVES_LINE_SKIPPER_H

#include "directives/conditional_stack.h"
#include "lex/cpp_file_scanner.h"
#include "lex/output_writer.h"
#include "lex/text_reader.h"

namespace umpre {

/// The byte-level road through skipped lines: passes over all but the directives that end the
/// skipping, or might.
class LineSkipper {
public:
    using Stop = TextReader::Stop;

    LineSkipper(OutputWriter& output, ConditionalStack& groups) noexcept
        : output_(output), groups_(groups) {}

    /// Passes over skipped lines, from a line's start or from within a line, and writes a line feed
    /// for each that gets one. Opens and closes the groups within them. Stops before a directive,
    /// or within a line before what only the scanner can read.
    [[nodiscard]] Stop skip(CppFileScanner& file, Stop from);

private:
    class Pass;

    OutputWriter& output_;
    ConditionalStack& groups_;
};

}  // namespace umpre

#endif
