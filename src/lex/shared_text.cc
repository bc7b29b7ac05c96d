// SPDX-License-Identifier: MIT
#include "lex/shared_text.h"

namespace umpre {
namespace {

// A few texts are very long; they are not kept for ever.
constexpr std::size_t kLargest = std::size_t{1} << 20U;

}  // namespace

void SharedText::giveBack() noexcept {
    std::unique_ptr<Counted> counted(counted_);
    TextPool* const pool = counted->pool;
    if (pool != nullptr && pool->spare_.size() < TextPool::kSpares
        && counted->text.size() < kLargest) {
        counted->text.clear();
        pool->spare_.push_back(std::move(counted));
    }
}

}  // namespace umpre
