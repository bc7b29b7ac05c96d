// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_FILE_BYTES_H
#define UMPRE_LEX_FILE_BYTES_H

#include <cstddef>
#include <string_view>
#include <vector>

namespace umpre {

// What readers of several bytes at a time may read besides the bytes; those before are zero, and
// the generated scanner wants two of those behind to be, too.
constexpr std::size_t kBytesBefore = 8;
constexpr std::size_t kBytesBehind = 64;

/// All bytes of a file, kept for any number of readers, who leave them as they are between their
/// steps.
class FileBytes {
public:
    explicit FileBytes(std::string_view bytes)
        : memory_(kBytesBefore + bytes.size() + kBytesBehind) {
        bytes.copy(begin(), bytes.size());
    }

    [[nodiscard]] char* begin() noexcept { return memory_.data() + kBytesBefore; }

    [[nodiscard]] std::size_t size() const noexcept {
        return memory_.size() - kBytesBefore - kBytesBehind;
    }

private:
    std::vector<char> memory_;
};

}  // namespace umpre

#endif
