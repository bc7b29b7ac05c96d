// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_TEXT_BUFFER_H
#define UMPRE_MACROS_TEXT_BUFFER_H

#include <algorithm>
#include <array>
#include <cstddef>
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

    TextBuffer() { grow(0); }

    void clear() noexcept {
        end_ = begin_;
        settled_.clear();
    }

    [[nodiscard]] std::size_t size() const noexcept {
        return static_cast<std::size_t>(end_ - begin_);
    }

    [[nodiscard]] char operator[](std::size_t place) const noexcept { return begin_[place]; }

    /// Adds a text from whose first byte 16 can be read.
    [[gnu::always_inline]] void append(std::string_view text) {
        const std::size_t size = text.size();
        char* const to = extend(size);
        if (size <= sizeof(Unit)) {
            std::memcpy(to, text.data(), sizeof(Unit));
        } else if (size <= 2 * sizeof(Unit)) {
            Unit last;
            std::memcpy(&last, text.data() + size - sizeof(Unit), sizeof(Unit));
            std::memcpy(to, text.data(), sizeof(Unit));
            std::memcpy(to + size - sizeof(Unit), &last, sizeof(Unit));
        } else {
            std::memcpy(to, text.data(), size);
        }
    }

    void append(char byte) { *extend(1) = byte; }

    /// Adds a text of which no more can be read.
    void appendAlone(std::string_view text) { text.copy(extend(text.size()), text.size()); }

    /// Takes away what was added behind the first `size` bytes, of which nothing is settled.
    void truncate(std::size_t size) noexcept { end_ = begin_ + size; }

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
        return size() == 0
               || (!settled_.empty() && settled_.front().begin == 0
                   && settled_.front().end == size());
    }

    /// Returns the text. A zero byte follows it, and from each of its bytes 32 can be read.
    [[nodiscard]] std::string_view view() noexcept {
        *end_ = '\0';
        return {begin_, size()};
    }

private:
    using Unit = std::array<char, 16>;

    static constexpr std::size_t kBehind = 32;

    // Adds so many bytes and returns where they are to be written.
    [[nodiscard]] char* extend(std::size_t count) {
        if (count > static_cast<std::size_t>(limit_ - end_)) {
            grow(count);
        }
        char* const added = end_;
        end_ += count;
        return added;
    }

    // Makes room for at least so many bytes.
    [[gnu::noinline]] void grow(std::size_t count) {
        const std::size_t used = size();
        memory_.truncate(used);
        (void)memory_.extend(count + kBehind);
        (void)memory_.extend(memory_.room());
        begin_ = memory_.data();
        end_ = begin_ + used;
        limit_ = begin_ + memory_.size() - kBehind;
    }

    GrowingArray<char> memory_;
    char* begin_ = nullptr;
    char* end_ = nullptr;
    char* limit_ = nullptr;      // behind it is some room more
    std::vector<Part> settled_;  // in order
};

}  // namespace umpre

#endif
