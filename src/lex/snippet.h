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

    /// Returns the text, with zero bytes behind it.
    [[nodiscard]] ByteBlock block() const noexcept { return ByteBlock(bytes_.data()); }

private:
    std::array<char, kRoom> bytes_{};
    std::size_t size_ = 0;
};

}  // namespace umpre

#endif
