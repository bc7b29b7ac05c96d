// SPDX-License-Identifier: MIT
#ifndef UMPRE_FUZZ_MEMORY_LIMIT_H
#define UMPRE_FUZZ_MEMORY_LIMIT_H

#include <cstddef>

namespace umpre::fuzz {

/// While it lives, memory beyond so many bytes more than are held now is refused, as by a machine
/// that has no more. One can live at a time.
class MemoryLimit {
public:
    explicit MemoryLimit(std::size_t bytes) noexcept;
    MemoryLimit(const MemoryLimit&) = delete;
    MemoryLimit& operator=(const MemoryLimit&) = delete;
    ~MemoryLimit();

    /// Tells whether memory was refused.
    [[nodiscard]] bool wasMet() const noexcept;
};

}  // namespace umpre::fuzz

#endif
