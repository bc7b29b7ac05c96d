// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_LARGE_PAGES_H
#define UMPRE_MACROS_LARGE_PAGES_H

#include <cstddef>
#include <memory_resource>

namespace umpre {

/// Memory from the heap, in large pages where there is much of it and the system has such pages.
/// They take less time to come than the many small ones, and to find again for who looks here and
/// there in them.
class LargePages final : public std::pmr::memory_resource {
private:
    [[nodiscard]] void* do_allocate(std::size_t size, std::size_t alignment) override;
    void do_deallocate(void* memory, std::size_t size, std::size_t alignment) override;
    [[nodiscard]] bool do_is_equal(const memory_resource& other) const noexcept override;
};

}  // namespace umpre

#endif
