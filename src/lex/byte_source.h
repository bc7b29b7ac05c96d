// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_BYTE_SOURCE_H
#define UMPRE_LEX_BYTE_SOURCE_H

#include <cstddef>
#include <optional>

namespace umpre {

/// Where bytes of the source come from if that is neither a file nor a text.
class ByteSource {
public:
    virtual ~ByteSource() = default;
    /// Brings up to `size` bytes, at least one unless the end is reached. Returns how many, or
    /// nothing if reading fails.
    [[nodiscard]] virtual std::optional<std::size_t> read(char* to, std::size_t size) = 0;
};

}  // namespace umpre

#endif
