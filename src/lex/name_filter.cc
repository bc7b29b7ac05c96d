// SPDX-License-Identifier: MIT
#include "lex/name_filter.h"

namespace umpre {
namespace {

constexpr unsigned kLeastBits = 16;  // as powers of two
constexpr unsigned kMostBits = 21;   // what stays close to the processor
constexpr std::size_t kLeastWords = (std::size_t{1} << kLeastBits) / 64;
constexpr std::size_t kBitsForEach = 16;

}  // namespace

NameFilter::NameFilter() : bits_(kLeastWords), shift_(32 - kLeastBits) {}

void NameFilter::add(std::string_view name) {
    std::array<char, kChunk> bytes{};
    const std::uint32_t hash = hashOf(padded(name, bytes));
    ++size_;
    if (shift_ > 32 - kMostBits) {
        hashes_.push_back(hash);
        if (size_ * kBitsForEach > bits_.size() * 64) {
            grow();
        }
    }
    addBit(hash);
}

// A filter that is cleared again and again need not be as large as it once was.
void NameFilter::clear() noexcept {
    size_ = 0;
    hashes_.clear();
    shift_ = 32 - kLeastBits;
    bits_.assign(kLeastWords, 0);
}

void NameFilter::grow() {
    --shift_;
    bits_.assign(2 * bits_.size(), 0);
    for (const std::uint32_t hash : hashes_) {
        addBit(hash);
    }
    if (shift_ == 32 - kMostBits) {
        hashes_ = {};
    }
}

}  // namespace umpre
