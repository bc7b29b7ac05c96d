// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_BYTE_BLOCK_H
#define UMPRE_LEX_BYTE_BLOCK_H

#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <simde/x86/sse2.h>
#include <type_traits>
#include <utility>

namespace umpre {

/// 16 bytes looked at together, with what every processor of the kind has.
struct BaseVector {
    using Bytes = simde__m128i;

    static constexpr std::size_t kSize = sizeof(Bytes);

    [[nodiscard]] static Bytes load(const char* at) noexcept { return simde_mm_loadu_si128(at); }

    static void store(char* at, Bytes bytes) noexcept { simde_mm_storeu_si128(at, bytes); }

    [[nodiscard]] static Bytes all(char byte) noexcept { return simde_mm_set1_epi8(byte); }

    [[nodiscard]] static Bytes equal(Bytes some, Bytes others) noexcept {
        return simde_mm_cmpeq_epi8(some, others);
    }

    /// Compares signed numbers.
    [[nodiscard]] static Bytes less(Bytes some, Bytes others) noexcept {
        return simde_mm_cmplt_epi8(some, others);
    }

    [[nodiscard]] static Bytes difference(Bytes some, Bytes others) noexcept {
        return simde_mm_sub_epi8(some, others);
    }

    [[nodiscard]] static Bytes either(Bytes some, Bytes others) noexcept {
        return simde_mm_or_si128(some, others);
    }

    /// Returns the highest bit of each byte.
    [[nodiscard]] static std::uint32_t bits(Bytes bytes) noexcept {
        return static_cast<std::uint32_t>(simde_mm_movemask_epi8(bytes));
    }
};

/// 64 bytes looked at together, or fewer. What it tells comes as a mask: bit N stands for byte N.
template <typename Vector, std::size_t kBytes = 64>
class BasicByteBlock {
public:
    using Mask = std::uint64_t;

    static constexpr std::size_t kSize = kBytes;

    /// Takes the bytes from `at`.
    explicit BasicByteBlock(const char* at) noexcept {
        forEachPart([&](auto part) { parts_[part] = Vector::load(at + part * Vector::kSize); });
    }

    /// Takes the bytes from `at` up to `end`; if these are fewer, zero bytes behind them.
    [[nodiscard]] static BasicByteBlock between(const char* at, const char* end) noexcept {
        const auto size = static_cast<std::size_t>(end - at);
        if (size >= kSize) {
            return BasicByteBlock(at);
        }
        std::array<char, kSize> bytes{};
        std::memcpy(bytes.data(), at, size);
        return BasicByteBlock(bytes.data());
    }

    /// Returns where any of some bytes stand.
    template <typename... Bytes>
    [[nodiscard]] Mask any(Bytes... bytes) const noexcept {
        return maskOf([bytes...](Part part) noexcept { return either(equal(part, bytes)...); });
    }

    /// Returns where bytes stand that, with these bits set, are any of some.
    template <typename... Bytes>
    [[nodiscard]] Mask anyWith(char bits, Bytes... bytes) const noexcept {
        return maskOf([bits, bytes...](Part part) noexcept {
            const Part changed = Vector::either(part, Vector::all(bits));
            return either(equal(changed, bytes)...);
        });
    }

    /// Returns where ASCII letters and underscores stand.
    [[nodiscard]] Mask letters() const noexcept {
        return maskOf([](Part part) noexcept {
            const Part lower = Vector::either(part, Vector::all(0x20));
            return either(within<'a', 26>(lower), equal(part, '_'));
        });
    }

    [[nodiscard]] Mask digits() const noexcept {
        return maskOf([](Part part) noexcept { return within<'0', 10>(part); });
    }

    /// Returns the bytes with ASCII letters in lower case. What is no letter does not become one.
    [[nodiscard]] BasicByteBlock lower() const noexcept {
        BasicByteBlock lowered = *this;
        forEachPart([&](auto part) {
            lowered.parts_[part] = Vector::either(parts_[part], Vector::all(0x20));
        });
        return lowered;
    }

    /// Returns where the first letters of the alphabet stand, in lower case.
    template <int kCount>
    [[nodiscard]] Mask firstLetters() const noexcept {
        return maskOf([](Part part) noexcept { return within<'a', kCount>(part); });
    }

    /// Returns where blanks, control characters and bytes above 127 stand.
    [[nodiscard]] Mask blanksAndUnusual() const noexcept {
        return maskOf([](Part part) noexcept { return Vector::less(part, Vector::all(' ' + 1)); });
    }

private:
    using Part = typename Vector::Bytes;

    static constexpr std::size_t kParts = kSize / Vector::kSize;

    // No loop: compilers would not unroll it by themselves.
    template <typename Action, std::size_t... kPart>
    static void forEach(Action action, std::index_sequence<kPart...> /*parts*/) noexcept {
        (action(std::integral_constant<std::size_t, kPart>{}), ...);
    }

    template <typename Action>
    static void forEachPart(Action action) noexcept {
        forEach(action, std::make_index_sequence<kParts>{});
    }

    // What a comparison makes is bytes or, with some kinds of vectors, a mask already.
    [[nodiscard]] static auto equal(Part part, char byte) noexcept {
        return Vector::equal(part, Vector::all(byte));
    }

    template <typename Found>
    [[nodiscard]] static Found either(Found only) noexcept {
        return only;
    }

    template <typename Found, typename... Others>
    [[nodiscard]] static Found either(Found first, Others... others) noexcept {
        return Vector::either(first, either(others...));
    }

    // Comparisons are signed: the range is moved to where the smallest numbers are.
    template <char kFirst, int kCount>
    [[nodiscard]] static auto within(Part part) noexcept {
        const Part moved =
            Vector::difference(part, Vector::all(static_cast<char>(kFirst + INT8_MIN)));
        return Vector::less(moved, Vector::all(INT8_MIN + kCount));
    }

    template <typename Test>
    [[nodiscard]] Mask maskOf(Test test) const noexcept {
        Mask mask = 0;
        forEachPart([&](auto part) {
            mask |= Mask{Vector::bits(test(parts_[part]))} << part * Vector::kSize;
        });
        return mask;
    }

    Part parts_[kParts];  // NOLINT(*-avoid-c-arrays): std::array's functions are everybody's
};

using ByteBlock = BasicByteBlock<BaseVector>;

/// Returns the place of the lowest bit of a mask that has one.
[[nodiscard]] inline unsigned firstBit(ByteBlock::Mask mask) noexcept {
    return static_cast<unsigned>(std::countr_zero(mask));
}

/// Returns the mask of the places below `place`. Without a branch: whether the place is one of the
/// 64 often cannot be predicted.
[[nodiscard]] inline ByteBlock::Mask bitsBelow(std::size_t place) noexcept {
    using Mask = ByteBlock::Mask;
    const Mask all = Mask{0} - static_cast<Mask>(place >= ByteBlock::kSize);
    return ((Mask{1} << place % ByteBlock::kSize) - 1) | all;
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
