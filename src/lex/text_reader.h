// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_READER_H
#define UMPRE_LEX_TEXT_READER_H

#include <cstddef>
#include <string_view>

#include "lex/cpp_file_scanner.h"
#include "lex/name_filter.h"
#include "lex/output_writer.h"

namespace umpre {

/// The byte-level road through a file: passes over what the scanner would only copy or drop, and
/// stops in front of everything else, at the beginning of a token.
class TextReader {
public:
    /// Where reading stopped.
    enum class Stop {
        LineStart,  ///< before a line's first token, its blanks included
        InLine,     ///< within a line that has been begun
    };

    TextReader(OutputWriter& output, const NameFilter& macroNames) noexcept
        : output_(output), macroNames_(macroNames) {}

    /// Copies text from the file to the output, from a line's start or from within a line, up to a
    /// name that may be a macro, a directive, or anything else out of the ordinary.
    Stop copyText(CppFileScanner& file, Stop from);

    /// Passes over skipped lines, from a line's start, and writes a line feed for each.
    Stop skipText(CppFileScanner& file);

private:
    [[nodiscard]] bool copyLines(CppFileScanner& file, Stop& stop);
    [[nodiscard]] bool skipLines(CppFileScanner& file, Stop& stop);
    [[nodiscard]] static bool leave(CppFileScanner& file, std::string_view text, const char* at,
                                    std::size_t lines, Stop stop);

    OutputWriter& output_;
    const NameFilter& macroNames_;
};

}  // namespace umpre

#endif
