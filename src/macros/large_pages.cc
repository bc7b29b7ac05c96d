// SPDX-License-Identifier: MIT
#include "macros/large_pages.h"

#include <algorithm>
#include <sys/mman.h>

namespace umpre {
namespace {

constexpr std::size_t kLargePage = std::size_t{2} << 20U;  // where it is another, nothing is lost

// Only what fills a large page begins with one.
[[nodiscard]] std::size_t alignmentFor(std::size_t size, std::size_t alignment) noexcept {
    return size < kLargePage ? alignment : std::max(alignment, kLargePage);
}

}  // namespace

void* LargePages::do_allocate(std::size_t size, std::size_t alignment) {
    void* const memory =
        std::pmr::new_delete_resource()->allocate(size, alignmentFor(size, alignment));
#ifdef MADV_HUGEPAGE
    if (size >= kLargePage) {
        (void)::madvise(memory, size / kLargePage * kLargePage, MADV_HUGEPAGE);
    }
#endif
    return memory;
}

void LargePages::do_deallocate(void* memory, std::size_t size, std::size_t alignment) {
    std::pmr::new_delete_resource()->deallocate(memory, size, alignmentFor(size, alignment));
}

bool LargePages::do_is_equal(const memory_resource& other) const noexcept {
    return this == &other;
}

}  // namespace umpre
