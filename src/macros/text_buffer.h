// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_TEXT_BUFFER_H
#define UMPRE_MACROS_TEXT_BUFFER_H

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>
#include <vector>

#include "lex/growing_array.h"

namespace umpre {

/// A text that grows by short parts, which are copied without a call, and which of its parts are
/// settled: no macros are left in them. Where a part ends, a token ends.
class TextBuffer {
public:
    struct Part {
        std::size_t begin;
        std::size_t end;
    };

    void clear() noexcept {
        bytes_.clear();
        settled_.clear();
    }

    [[nodiscard]] std::size_t size() const noexcept { return bytes_.size(); }

    [[nodiscard]] bool empty() const noexcept { return bytes_.size() == 0; }

    /// Returns the last byte of a text that is not empty.
    [[nodiscard]] char back() const noexcept { return bytes_[bytes_.size() - 1]; }

    void append(std::string_view text) {
        char* const to = bytes_.extend(text.size());
        const char* const from = text.data();
        const std::size_t size = text.size();
        if (size > 2 * sizeof(Word)) {
            std::memcpy(to, from, size);
        } else if (size >= sizeof(Word)) {
            copyEnds<Word>(to, from, size);
        } else if (size >= sizeof(HalfWord)) {
            copyEnds<HalfWord>(to, from, size);
        } else {
            for (std::size_t index = 0; index < size; ++index) {
                to[index] = from[index];
            }
        }
    }

    /// Takes away what was added behind the first `size` bytes, of which nothing is settled.
    void truncate(std::size_t size) noexcept { bytes_.truncate(size); }

    /// Notes that the bytes from `begin` on are settled.
    void settleFrom(std::size_t begin) {
        if (begin == size()) {
            return;
        }
        if (!settled_.empty() && settled_.back().end == begin) {
            settled_.back().end = size();
        } else {
            settled_.push_back({begin, size()});
        }
    }

    [[nodiscard]] const std::vector<Part>& settled() const noexcept { return settled_; }

    [[nodiscard]] bool isSettled() const noexcept {
        return empty()
               || (!settled_.empty() && settled_.front().begin == 0
                   && settled_.front().end == size());
    }

    /// Returns the text. A zero byte follows it.
    [[nodiscard]] std::string_view view() noexcept {
        if (empty()) {
            return "";
        }
        bytes_[size()] = '\0';
        return {bytes_.data(), size()};
    }

private:
    using Word = std::uint64_t;
    using HalfWord = std::uint32_t;

    // Copies as one unit from each end; they may overlap.
    template <typename Unit>
    static void copyEnds(char* to, const char* from, std::size_t size) noexcept {
        Unit first = 0;
        Unit last = 0;
        std::memcpy(&first, from, sizeof(Unit));
        std::memcpy(&last, from + size - sizeof(Unit), sizeof(Unit));
        std::memcpy(to, &first, sizeof(Unit));
        std::memcpy(to + size - sizeof(Unit), &last, sizeof(Unit));
    }

    GrowingArray<char> bytes_;
    std::vector<Part> settled_;  // in order
};

}  // namespace umpre

#endif
