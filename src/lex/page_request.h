// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_PAGE_REQUEST_H
#define UMPRE_LEX_PAGE_REQUEST_H

#include <cstddef>

namespace umpre {

/// Asks the system for the pages of memory that will be written from end to end, all at once; each
/// would else cost an interruption at its first byte. Where the system cannot do that, or has no
/// memory for it, and for a few pages, nothing happens.
void requestPages(void* memory, std::size_t size) noexcept;

}  // namespace umpre

#endif
