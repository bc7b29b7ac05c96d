// SPDX-License-Identifier: MIT
#include "lex/shared_text.h"

namespace umpre {
namespace {

// Deep nesting needs many texts at a time, and a few are very long; neither is kept for ever.
constexpr std::size_t kSpares = 64;
constexpr std::size_t kLargest = std::size_t{1} << 20U;

}  // namespace

void SharedText::giveBack() noexcept {
    std::unique_ptr<Counted> counted(counted_);
    TextPool* const pool = counted->pool;
    if (pool != nullptr && pool->spare_.size() < kSpares && counted->text.size() < kLargest) {
        counted->text.clear();
        pool->spare_.push_back(std::move(counted));
    }
}

}  // namespace umpre
