// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_SOURCE_POSITION_H
#define UMPRE_LEX_SOURCE_POSITION_H

#include <cstdint>
#include <string_view>

namespace umpre {

/// Where the file that is being read stands.
struct SourcePosition {
    std::string_view fileName;  ///< borrowed from the file's source
    std::int32_t line = 0;      ///< counts what has been read, the token looked ahead at included
};

/// Adds to a line counter; counters wrap around, like the unsigned numbers they are added as.
[[nodiscard]] constexpr std::int32_t addLines(std::int32_t line, std::size_t count) noexcept {
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(line)
                                     + static_cast<std::uint32_t>(count));
}

}  // namespace umpre

#endif
