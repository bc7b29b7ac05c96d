// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_NAME_FILTER_H
#define UMPRE_LEX_NAME_FILTER_H

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>
#include <vector>

namespace umpre {

/// Returns a hash of a name, made from all its bytes, eight at a time.
[[nodiscard]] inline std::uint32_t hashOfName(std::string_view name) noexcept {
    constexpr std::size_t kChunk = sizeof(std::uint64_t);
    constexpr std::uint64_t kFactor = 0x9E3779B97F4A7C15U;
    std::uint64_t hash = name.size() * kFactor;
    // A multiplication carries bits upwards, a shift brings them down again: the last bytes of a
    // chunk, which stand highest, often make the difference between names.
    const auto mix = [&hash](std::uint64_t chunk) {
        hash = (hash ^ chunk) * kFactor;
        hash ^= hash >> 32U;
    };
    const auto mixChunkAt = [&](std::size_t at) {
        std::uint64_t chunk = 0;
        std::memcpy(&chunk, name.data() + at, kChunk);
        mix(chunk);
    };
    if (name.size() < kChunk) {
        std::uint64_t chunk = 0;
        for (const char byte : name) {
            chunk = chunk << 8U | static_cast<unsigned char>(byte);
        }
        mix(chunk);
    } else {
        for (std::size_t at = 0; at + kChunk < name.size(); at += kChunk) {
            mixChunkAt(at);
        }
        mixChunkAt(name.size() - kChunk);
    }
    return static_cast<std::uint32_t>(hash * kFactor >> 32U);
}

/// Tells quickly of most names that they are not in a set of names. It may be wrong the other way.
class NameFilter {
public:
    NameFilter() : bits_(kWords) {}

    void add(std::string_view name) {
        const std::uint32_t bit = hashOfName(name) % kBits;
        bits_[bit / 64] |= std::uint64_t{1} << bit % 64;
    }

    /// Returns false only if the name was never added.
    [[nodiscard]] bool mayHold(std::string_view name) const noexcept {
        const std::uint32_t bit = hashOfName(name) % kBits;
        return (bits_[bit / 64] >> bit % 64 & 1U) != 0;
    }

private:
    static constexpr std::uint32_t kBits = 1U << 16U;
    static constexpr std::size_t kWords = kBits / 64;

    std::vector<std::uint64_t> bits_;
};

}  // namespace umpre

#endif
