// SPDX-License-Identifier: MIT
#include "lex/page_request.h"

#include <bit>
#include <cstdint>
#include <sys/mman.h>

namespace umpre {

#ifdef MADV_POPULATE_WRITE

// The last page is left alone unless it belongs to the memory whole: who has the rest of it may
// never write there.
void requestPages(void* memory, std::size_t size) noexcept {
    constexpr std::uintptr_t kPage = 4096;  // where it is larger, the system refuses most requests
    const std::size_t before = std::bit_cast<std::uintptr_t>(memory) % kPage;
    const std::size_t whole = (before + size) / kPage * kPage;
    constexpr std::size_t kFewPages = 4;
    if (whole < kFewPages * kPage) {
        return;
    }
    (void)::madvise(static_cast<char*>(memory) - before, whole, MADV_POPULATE_WRITE);
}

#else

void requestPages(void* /*memory*/, std::size_t /*size*/) noexcept {}

#endif

}  // namespace umpre
