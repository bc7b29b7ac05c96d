// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_BYTE_BLOCK_H
#define UMPRE_LEX_BYTE_BLOCK_H

#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <simde/x86/sse2.h>

namespace umpre {

/// 64 bytes looked at together. What it tells comes as a mask: bit N stands for byte N.
class ByteBlock {
public:
    using Mask = std::uint64_t;

    static constexpr std::size_t kSize = 64;

    /// Takes the 64 bytes from `at`.
    explicit ByteBlock(const char* at) noexcept
        : first_(simde_mm_loadu_si128(at)),
          second_(simde_mm_loadu_si128(at + 16)),
          third_(simde_mm_loadu_si128(at + 32)),
          fourth_(simde_mm_loadu_si128(at + 48)) {}

    /// Takes the bytes from `at` up to `end`; if these are fewer than 64, zero bytes behind them.
    [[nodiscard]] static ByteBlock between(const char* at, const char* end) noexcept {
        const auto size = static_cast<std::size_t>(end - at);
        if (size >= kSize) {
            return ByteBlock(at);
        }
        std::array<char, kSize> bytes{};
        std::memcpy(bytes.data(), at, size);
        return ByteBlock(bytes.data());
    }

    /// Writes the 64 bytes to `at`.
    void copyTo(char* at) const noexcept {
        simde_mm_storeu_si128(at, first_);
        simde_mm_storeu_si128(at + 16, second_);
        simde_mm_storeu_si128(at + 32, third_);
        simde_mm_storeu_si128(at + 48, fourth_);
    }

    /// Returns where any of some bytes stand.
    template <typename... Bytes>
    [[nodiscard]] Mask any(Bytes... bytes) const noexcept {
        return maskOf([bytes...](Part part) noexcept { return either(equal(part, bytes)...); });
    }

    /// Returns where both blocks have the same bytes.
    [[nodiscard]] Mask same(const ByteBlock& other) const noexcept {
        const auto bits = [](Part part, Part otherPart) noexcept {
            const int mask = simde_mm_movemask_epi8(simde_mm_cmpeq_epi8(part, otherPart));
            return static_cast<Mask>(static_cast<unsigned>(mask));
        };
        return bits(first_, other.first_) | bits(second_, other.second_) << 16U
               | bits(third_, other.third_) << 32U | bits(fourth_, other.fourth_) << 48U;
    }

    /// Returns where ASCII letters and underscores stand.
    [[nodiscard]] Mask letters() const noexcept {
        return maskOf([](Part part) noexcept {
            const Part lower = simde_mm_or_si128(part, simde_mm_set1_epi8(0x20));
            return either(within<'a', 26>(lower), equal(part, '_'));
        });
    }

    [[nodiscard]] Mask digits() const noexcept {
        return maskOf([](Part part) noexcept { return within<'0', 10>(part); });
    }

    /// Returns where blanks, control characters and bytes above 127 stand.
    [[nodiscard]] Mask blanksAndUnusual() const noexcept {
        return maskOf([](Part part) noexcept {
            return simde_mm_cmplt_epi8(part, simde_mm_set1_epi8(' ' + 1));
        });
    }

private:
    using Part = simde__m128i;

    [[nodiscard]] static Part equal(Part part, char byte) noexcept {
        return simde_mm_cmpeq_epi8(part, simde_mm_set1_epi8(byte));
    }

    [[nodiscard]] static Part either(Part only) noexcept { return only; }

    template <typename... Parts>
    [[nodiscard]] static Part either(Part first, Parts... others) noexcept {
        return simde_mm_or_si128(first, either(others...));
    }

    // Comparisons are signed: the range is moved to where the smallest numbers are.
    template <char kFirst, int kCount>
    [[nodiscard]] static Part within(Part part) noexcept {
        const Part moved =
            simde_mm_sub_epi8(part, simde_mm_set1_epi8(static_cast<char>(kFirst + INT8_MIN)));
        return simde_mm_cmplt_epi8(moved, simde_mm_set1_epi8(INT8_MIN + kCount));
    }

    template <typename Test>
    [[nodiscard]] Mask maskOf(Test test) const noexcept {
        const auto bits = [&test](Part part) noexcept {
            return static_cast<Mask>(static_cast<unsigned>(simde_mm_movemask_epi8(test(part))));
        };
        return bits(first_) | bits(second_) << 16U | bits(third_) << 32U | bits(fourth_) << 48U;
    }

    Part first_;
    Part second_;
    Part third_;
    Part fourth_;
};

/// Returns the place of the lowest bit of a mask that has one.
[[nodiscard]] inline unsigned firstBit(ByteBlock::Mask mask) noexcept {
    return static_cast<unsigned>(std::countr_zero(mask));
}

/// Returns the mask of the places below `place`, which is at most 64.
[[nodiscard]] inline ByteBlock::Mask bitsBelow(std::size_t place) noexcept {
    return place >= ByteBlock::kSize ? ~ByteBlock::Mask{0} : (ByteBlock::Mask{1} << place) - 1;
}

/// Returns how many bits a mask has. Not every processor of the kind has an instruction for it, and
/// std::popcount would be a call.
[[nodiscard]] inline unsigned countBits(ByteBlock::Mask mask) noexcept {
    mask -= mask >> 1U & 0x5555555555555555U;
    mask = (mask & 0x3333333333333333U) + (mask >> 2U & 0x3333333333333333U);
    mask = (mask + (mask >> 4U)) & 0x0F0F0F0F0F0F0F0FU;
    return static_cast<unsigned>(mask * 0x0101010101010101U >> 56U);
}

}  // namespace umpre

#endif
