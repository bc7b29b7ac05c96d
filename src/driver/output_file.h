// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_OUTPUT_FILE_H
#define UMPRE_DRIVER_OUTPUT_FILE_H

#include <string>
#include <string_view>
#include <unistd.h>

#include "lex/byte_sink.h"

namespace umpre {

/// Where the result goes: standard output, or the file that took its place.
class OutputFile final : public ByteSink {
public:
    OutputFile() = default;
    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;
    ~OutputFile() override;

    /// Creates a file, or empties the one there is, and writes to it from now on. Returns false if
    /// it cannot be opened.
    [[nodiscard]] bool open(const std::string& name);
    [[nodiscard]] bool write(std::string_view bytes) override;
    /// Closes the output. Returns whether everything written has arrived.
    [[nodiscard]] bool close();
    /// Returns what to say when something has not.
    [[nodiscard]] std::string failureMessage() const;

private:
    int descriptor_ = STDOUT_FILENO;
    std::string name_;  // empty: standard output
    bool failed_ = false;
};

}  // namespace umpre

#endif
