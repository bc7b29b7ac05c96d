// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_READER_H
#define UMPRE_LEX_TEXT_READER_H

#include <string_view>

#include "lex/cpp_file_scanner.h"
#include "lex/name_filter.h"
#include "lex/name_reader.h"
#include "lex/output_writer.h"
#include "lex/text_copy.h"
#include "lex/token.h"

namespace umpre {

/// The byte-level road through a file's text: copies what the scanner would only have copied, and
/// stops at everything else, at the beginning of a token.
class TextReader {
public:
    using Stop = TextCopy::Stop;

    TextReader(OutputWriter& output, const NameFilter& macroNames, NameReader& nameReader) noexcept
        : output_(output), macroNames_(macroNames), nameReader_(nameReader) {}

    /// Copies text from the file to the output, from a line's start or from within a line, up to a
    /// name that may be a macro, a directive, or anything else out of the ordinary.
    [[nodiscard]] Stop copyText(CppFileScanner& file, Stop from);

    /// Returns the name behind which copying stopped, until the file is read on.
    [[nodiscard]] Token name() const noexcept { return {TokenKind::IDENTIFIER, name_}; }

private:
    OutputWriter& output_;
    const NameFilter& macroNames_;
    NameReader& nameReader_;
    std::string_view name_;
};

}  // namespace umpre

#endif
