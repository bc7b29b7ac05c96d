// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_FILE_FIXTURE_H
#define UMPRE_TESTS_UNIT_SUPPORT_FILE_FIXTURE_H

#include <cstddef>
#include <string>
#include <string_view>

#include "lex/cpp_file_scanner.h"
#include "lex/output_writer.h"
#include "support/recording_comment_sink.h"
#include "support/recording_sink.h"
#include "support/temporary_directory.h"

namespace umpre::testing {

/// The file "main" that is read through windows, and an output in step with it.
struct FileFixture {
    FileFixture(std::string_view text, std::size_t windowSize)
        : file(comments, {false, windowSize}) {
        isOpen = file.open(directory.write("main", text));
        file.setFileName("main");
        output.redirect(sink);
        output.countLines(1);
    }

    /// Returns what was written so far.
    [[nodiscard]] const std::string& written() {
        output.flush();
        return sink.bytes();
    }

    [[nodiscard]] bool isInStep() const { return output.isAt(file.position()); }

    TemporaryDirectory directory;
    RecordingCommentSink comments;
    CppFileScanner file;
    bool isOpen = false;
    RecordingSink sink;
    OutputWriter output;
};

}  // namespace umpre::testing

#endif
