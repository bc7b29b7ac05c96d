// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_NAME_FILTER_H
#define UMPRE_LEX_NAME_FILTER_H

#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>
#include <vector>

namespace umpre {

/// Reads as many bytes as an unsigned number has.
template <typename Number>
[[nodiscard]] Number bytesAt(const char* at) noexcept {
    Number bytes = 0;
    std::memcpy(&bytes, at, sizeof bytes);
    return bytes;
}

/// Returns a hash of a name, made from all its bytes, eight at a time.
[[nodiscard]] inline std::uint32_t hashOfName(std::string_view name) noexcept {
    using Chunk = std::uint64_t;
    using HalfChunk = std::uint32_t;
    constexpr Chunk kFactor = 0x9E3779B97F4A7C15U;
    const char* const last = name.data() + name.size();
    Chunk hash = name.size() * kFactor;
    // A multiplication carries bits upwards, a shift brings them down again: the last bytes of a
    // chunk, which stand highest, often make the difference between names.
    const auto mix = [&hash](Chunk chunk) {
        hash = (hash ^ chunk) * kFactor;
        hash ^= hash >> 32U;
    };
    // What is read twice does no harm: the size tells which bytes these are.
    if (name.size() >= sizeof(Chunk)) {
        for (const char* at = name.data(); at + sizeof(Chunk) < last; at += sizeof(Chunk)) {
            mix(bytesAt<Chunk>(at));
        }
        mix(bytesAt<Chunk>(last - sizeof(Chunk)));
    } else if (name.size() >= sizeof(HalfChunk)) {
        mix(Chunk{bytesAt<HalfChunk>(last - sizeof(HalfChunk))} << 32U
            | bytesAt<HalfChunk>(name.data()));
    } else if (!name.empty()) {
        const auto byteAt = [name](std::size_t at) { return bytesAt<unsigned char>(&name[at]); };
        mix(Chunk{byteAt(0)} | Chunk{byteAt(name.size() / 2)} << 8U
            | Chunk{byteAt(name.size() - 1)} << 16U);
    }
    return static_cast<std::uint32_t>(hash * kFactor >> 32U);
}

/// Tells whether two names are the same. For short ones, a call would take longer.
[[nodiscard, gnu::always_inline]] inline bool isSameName(std::string_view name,
                                                         std::string_view other) noexcept {
    const std::size_t size = name.size();
    if (size != other.size()) {
        return false;
    }
    const auto haveSameEnds = [&](auto unit) {
        using Unit = decltype(unit);
        const std::size_t last = size - sizeof(Unit);
        return ((bytesAt<Unit>(name.data()) ^ bytesAt<Unit>(other.data()))
                | (bytesAt<Unit>(name.data() + last) ^ bytesAt<Unit>(other.data() + last)))
               == 0;
    };
    if (size > 2 * sizeof(std::uint64_t)) {
        return name == other;
    }
    if (size >= sizeof(std::uint64_t)) {
        return haveSameEnds(std::uint64_t{});
    }
    if (size >= sizeof(std::uint32_t)) {
        return haveSameEnds(std::uint32_t{});
    }
    return size == 0 || (haveSameEnds(std::uint8_t{}) && name[size / 2] == other[size / 2]);
}

/// Tells quickly of most names that they are not in a set of names. It may be wrong the other way.
class NameFilter {
public:
    NameFilter();

    void add(std::string_view name);

    void clear() noexcept;

    /// Returns how many names were added.
    [[nodiscard]] std::size_t size() const noexcept { return size_; }

    /// Returns false only if the name was never added.
    [[nodiscard]] bool mayHold(std::string_view name) const noexcept {
        std::array<char, kChunk> bytes{};
        if (name.size() >= kChunk) {
            return mayHoldAmongBytes(name);
        }
        // For so few bytes, a loop is quicker than a call.
        for (std::size_t index = 0; index < name.size(); ++index) {
            bytes[index] = name[index];
        }
        return mayHoldAmongBytes({bytes.data(), name.size()});
    }

    /// The same for a name from whose first eight bytes can be read.
    [[nodiscard]] bool mayHoldAmongBytes(std::string_view name) const noexcept {
        const std::uint32_t bit = hashOf(name) >> shift_;
        // As a pointer: folders that are built with assertions would check the index for all.
        const std::uint64_t* const bits = bits_.data();
        return (bits[bit / 64] >> bit % 64 & 1U) != 0;
    }

private:
    static constexpr std::size_t kChunk = sizeof(std::uint64_t);

    // Returns the name, in a place from which eight bytes can be read.
    [[nodiscard]] static std::string_view padded(std::string_view name,
                                                 std::array<char, kChunk>& bytes) noexcept {
        if (name.size() >= kChunk) {
            return name;
        }
        return {bytes.data(), name.copy(bytes.data(), name.size())};
    }

    // Of the first eight bytes of a name, its last eight and its size.
    [[nodiscard]] static std::uint32_t hashOf(std::string_view name) noexcept {
        const std::size_t behind = name.size() > kChunk ? name.size() - kChunk : 0;
        const auto first = bytesAt<std::uint64_t>(name.data());
        const auto last = bytesAt<std::uint64_t>(name.data() + behind);
        const std::uint64_t mask = kFirstBytes[name.size() < kChunk ? name.size() : kChunk];
        const std::uint64_t sum = (first & mask) + std::rotl(last & mask, 32) + name.size();
        return static_cast<std::uint32_t>(sum * 0x9E3779B97F4A7C15U >> 32U);
    }

    void addBit(std::uint32_t hash) noexcept {
        const std::uint32_t bit = hash >> shift_;
        bits_[bit / 64] |= std::uint64_t{1} << bit % 64;
    }

    void grow();

    // The masks of the first bytes in memory of a chunk.
    static constexpr std::array<std::uint64_t, 9> kFirstBytes = [] {
        std::array<std::uint64_t, 9> masks{};
        for (unsigned count = 1; count <= 8; ++count) {
            masks[count] = std::endian::native == std::endian::little
                               ? ~std::uint64_t{0} >> (64 - 8 * count)
                               : ~std::uint64_t{0} << (64 - 8 * count);
        }
        return masks;
    }();

    std::vector<std::uint64_t> bits_;
    unsigned shift_;                     // a hash shifted by this is the place of its bit
    std::size_t size_ = 0;               // names
    std::vector<std::uint32_t> hashes_;  // of the names added, while it may grow
};

}  // namespace umpre

#endif
