// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_BYTE_SINK_H
#define UMPRE_LEX_BYTE_SINK_H

#include <optional>
#include <string_view>

#include "lex/file_identity.h"

namespace umpre {

/// Where bytes leave the program: a descriptor, or a string in tests.
class ByteSink {
public:
    virtual ~ByteSink() = default;
    /// Takes all the bytes. Returns false if some could not be written.
    [[nodiscard]] virtual bool write(std::string_view bytes) = 0;

    /// Returns what the bytes are written to if nobody can keep the writer waiting there, as with a
    /// regular file.
    [[nodiscard]] virtual std::optional<FileIdentity> target() const { return std::nullopt; }
};

/// Writes to a borrowed file descriptor, going on after interruptions and short writes.
class DescriptorSink final : public ByteSink {
public:
    explicit DescriptorSink(int descriptor) noexcept : descriptor_(descriptor) {}

    [[nodiscard]] bool write(std::string_view bytes) override;
    [[nodiscard]] std::optional<FileIdentity> target() const override;

private:
    int descriptor_;
};

}  // namespace umpre

#endif
