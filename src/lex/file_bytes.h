// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_FILE_BYTES_H
#define UMPRE_LEX_FILE_BYTES_H

#include <cstddef>
#include <memory>
#include <string_view>

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
        : memory_(std::make_unique<char[]>(kBytesBefore + bytes.size() + kBytesBehind)),
          size_(bytes.size()) {
        bytes.copy(begin(), size_);
    }

    [[nodiscard]] char* begin() const noexcept { return memory_.get() + kBytesBefore; }

    [[nodiscard]] std::size_t size() const noexcept { return size_; }

private:
    std::unique_ptr<char[]> memory_;  // NOLINT(modernize-avoid-c-arrays): its size never changes
    std::size_t size_;
};

}  // namespace umpre

#endif
