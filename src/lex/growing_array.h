// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_GROWING_ARRAY_H
#define UMPRE_LEX_GROWING_ARRAY_H

#include <algorithm>
#include <cstddef>
#include <type_traits>
#include <utility>
#include <vector>

namespace umpre {

/// An array that grows at its end by several elements at a time, which the caller then writes. What
/// a `std::vector` by itself would do beyond that (to set them to zero first, to ask for room for
/// each) shows where tokens are copied in small groups.
template <typename Element>
class GrowingArray {
    static_assert(std::is_trivially_copyable_v<Element>);

public:
    GrowingArray() = default;

    GrowingArray(GrowingArray&& other) noexcept { swap(other); }

    GrowingArray& operator=(GrowingArray&& other) noexcept {
        swap(other);
        return *this;
    }

    GrowingArray(const GrowingArray&) = delete;
    GrowingArray& operator=(const GrowingArray&) = delete;
    ~GrowingArray() = default;

    /// So many elements behind the last one may be read and written, to no effect.
    static constexpr std::size_t kSlack = 16 / sizeof(Element);

    void clear() noexcept { size_ = 0; }

    /// Takes away all but the first `size` elements.
    void truncate(std::size_t size) noexcept { size_ = size; }

    /// Adds `count` elements and returns where they are to be written.
    [[nodiscard]] Element* extend(std::size_t count) {
        if (count > capacity_ - size_) {
            grow(size_ + count);
        }
        Element* const added = elements_.data() + size_;
        size_ += count;
        return added;
    }

    /// Makes that so many elements behind the last one may be read.
    void reserveBehind(std::size_t count) {
        if (count > capacity_ - size_) {
            grow(size_ + count);
        }
    }

    [[nodiscard]] std::size_t size() const noexcept { return size_; }

    [[nodiscard]] const Element* data() const noexcept { return elements_.data(); }

    [[nodiscard]] Element& operator[](std::size_t index) noexcept { return elements_[index]; }

    [[nodiscard]] const Element& operator[](std::size_t index) const noexcept {
        return elements_[index];
    }

private:
    void swap(GrowingArray& other) noexcept {
        std::swap(elements_, other.elements_);
        std::swap(size_, other.size_);
        std::swap(capacity_, other.capacity_);
    }

    void grow(std::size_t needed) {
        constexpr std::size_t kFirst = 32 / sizeof(Element);
        const std::size_t capacity = std::max({needed, 2 * capacity_, kFirst});
        elements_.resize(capacity + kSlack);
        capacity_ = capacity;
    }

    std::vector<Element> elements_;
    std::size_t size_ = 0;
    std::size_t capacity_ = 0;
};

}  // namespace umpre

#endif
