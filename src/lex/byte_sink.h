// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_BYTE_SINK_H
#define UMPRE_LEX_BYTE_SINK_H

#include <string_view>

namespace umpre {

/// Where bytes leave the program: a descriptor, or a string in tests.
class ByteSink {
public:
    virtual ~ByteSink() = default;
    /// Takes all the bytes. Returns false if some could not be written.
    [[nodiscard]] virtual bool write(std::string_view bytes) = 0;
};

/// Writes to a borrowed file descriptor, going on after interruptions and short writes.
class DescriptorSink final : public ByteSink {
public:
    explicit DescriptorSink(int descriptor) noexcept : descriptor_(descriptor) {}

    [[nodiscard]] bool write(std::string_view bytes) override;

private:
    int descriptor_;
};

}  // namespace umpre

#endif
