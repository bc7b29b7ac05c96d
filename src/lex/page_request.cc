// SPDX-License-Identifier: MIT
#include "lex/page_request.h"

#include <memory>
#include <sys/mman.h>

namespace umpre {

#ifdef MADV_POPULATE_WRITE

// Only pages that belong to the memory whole: who has the rest of the others may never write there.
void requestPages(void* memory, std::size_t size) noexcept {
    constexpr std::size_t kPage = 4096;  // where it is larger, the system refuses most requests
    constexpr std::size_t kFewPages = 4;
    void* const first = std::align(kPage, kFewPages * kPage, memory, size);
    if (first != nullptr) {
        (void)::madvise(first, size / kPage * kPage, MADV_POPULATE_WRITE);
    }
}

#else

void requestPages(void* /*memory*/, std::size_t /*size*/) noexcept {}

#endif

}  // namespace umpre
