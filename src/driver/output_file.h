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
    /// The name of the program stands in front of its messages.
    explicit OutputFile(std::string_view program = "umpre") noexcept : program_(program) {}

    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;
    ~OutputFile() override;

    /// Creates a file, or empties the one there is, and writes to it from now on. Returns false if
    /// it cannot be opened.
    [[nodiscard]] bool open(const std::string& name);
    [[nodiscard]] bool write(std::string_view bytes) override;
    [[nodiscard]] std::optional<FileIdentity> target() const override;
    /// Closes the output. Returns whether everything written has arrived.
    [[nodiscard]] bool close();
    /// Returns what to say when something has not.
    [[nodiscard]] std::string failureMessage() const;
    /// Returns what to say when a file of this name cannot be opened.
    [[nodiscard]] std::string openFailureMessage(const std::string& name) const;

private:
    std::string_view program_;
    int descriptor_ = STDOUT_FILENO;
    std::string name_;  // empty: standard output
    bool failed_ = false;
};

}  // namespace umpre

#endif
