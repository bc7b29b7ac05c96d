// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_SNIPPET_H
#define UMPRE_LEX_SNIPPET_H

#include <array>
#include <cstddef>
#include <string_view>

#include "lex/byte_block.h"

namespace umpre {

/// A text of at most 64 bytes that is copied often: all 64 are, whatever its size.
class Snippet {
public:
    static constexpr std::size_t kRoom = ByteBlock::kSize;

    Snippet() = default;

    /// Takes a text; a longer one makes the snippet empty.
    explicit Snippet(std::string_view text) noexcept
        : size_(text.size() <= kRoom ? text.size() : 0) {
        text.copy(bytes_.data(), size_);
    }

    [[nodiscard]] bool isEmpty() const noexcept { return size_ == 0; }

    [[nodiscard]] std::size_t size() const noexcept { return size_; }

    [[nodiscard]] std::string_view text() const noexcept { return {bytes_.data(), size_}; }

    /// Writes the text to `at`, and zero bytes behind it, 64 bytes in all.
    void copyTo(char* at) const noexcept {
        // Compilers make a slow instruction of a copy that says how much it copies.
        const Part first = part(0);
        const Part second = part(1);
        const Part third = part(2);
        const Part fourth = part(3);
        BaseVector::store(at, first);
        BaseVector::store(at + kPart, second);
        BaseVector::store(at + 2 * kPart, third);
        BaseVector::store(at + 3 * kPart, fourth);
    }

    /// Tells whether the text stands at `at`, from where 64 bytes can be read.
    [[nodiscard]] bool standsAt(const char* at) const noexcept {
        const ByteBlock::Mask same =
            samePart(at, 0) | samePart(at, 1) | samePart(at, 2) | samePart(at, 3);
        return (~same & bitsBelow(size_)) == 0;
    }

private:
    using Part = BaseVector::Bytes;

    static constexpr std::size_t kPart = BaseVector::kSize;

    [[nodiscard]] Part part(std::size_t number) const noexcept {
        return BaseVector::load(bytes_.data() + number * kPart);
    }

    // Returns where the bytes of a part are those that stand there.
    [[nodiscard]] ByteBlock::Mask samePart(const char* at, std::size_t number) const noexcept {
        const Part other = BaseVector::load(at + number * kPart);
        return ByteBlock::Mask{BaseVector::bits(BaseVector::equal(part(number), other))}
               << number * kPart;
    }

    std::array<char, kRoom> bytes_{};
    std::size_t size_ = 0;
};

}  // namespace umpre

#endif
