// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_GROWING_ARRAY_H
#define UMPRE_LEX_GROWING_ARRAY_H

#include <algorithm>
#include <cstddef>
#include <cstdlib>
#include <memory>
#include <new>
#include <type_traits>
#include <utility>

#include "lex/page_request.h"

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

    /// Takes the memory for `count` elements, all of which will be added.
    void reserve(std::size_t count) {
        if (count > capacity_) {
            setCapacity(count);
            requestPages(elements_.get(), count * sizeof(Element));
        }
    }

    /// Takes away all but the first `size` elements.
    void truncate(std::size_t size) noexcept { size_ = size; }

    /// Adds `count` elements and returns where they are to be written.
    [[nodiscard]] Element* extend(std::size_t count) {
        if (count > capacity_ - size_) {
            grow(size_ + count);
        }
        Element* const added = elements_.get() + size_;
        size_ += count;
        return added;
    }

    [[nodiscard]] std::size_t size() const noexcept { return size_; }

    /// Returns how many elements can be added without taking more memory.
    [[nodiscard]] std::size_t room() const noexcept { return capacity_ - size_; }

    [[nodiscard]] Element* data() noexcept { return elements_.get(); }

    [[nodiscard]] const Element* data() const noexcept { return elements_.get(); }

    [[nodiscard]] Element& operator[](std::size_t index) noexcept { return elements_.get()[index]; }

    [[nodiscard]] const Element& operator[](std::size_t index) const noexcept {
        return elements_.get()[index];
    }

private:
    struct Free {
        void operator()(Element* elements) const noexcept {
            std::free(elements);  // NOLINT(cppcoreguidelines-no-malloc): grown with realloc
        }
    };

    void swap(GrowingArray& other) noexcept {
        std::swap(elements_, other.elements_);
        std::swap(size_, other.size_);
        std::swap(capacity_, other.capacity_);
    }

    // An array of many pages has those at once that it grows by, and a large one grows by less.
    void grow(std::size_t needed) {
        constexpr std::size_t kFirst = 32 / sizeof(Element);
        constexpr std::size_t kManyPages = (std::size_t{64} << 10U) / sizeof(Element);
        constexpr std::size_t kLarge = (std::size_t{256} << 10U) / sizeof(Element);
        const std::size_t before = capacity_;
        setCapacity(needed < kLarge ? std::max({needed, 2 * capacity_, kFirst})
                                    : needed + needed / 4);
        if (needed > kManyPages) {
            requestPages(elements_.get() + before, (capacity_ - before) * sizeof(Element));
        }
    }

    // A large array grows where its pages are: nothing is copied.
    void setCapacity(std::size_t capacity) {
        const std::size_t size = (capacity + kSlack) * sizeof(Element);
        // NOLINTNEXTLINE(cppcoreguidelines-no-malloc): only realloc leaves pages where they are
        void* const memory = std::realloc(elements_.get(), size);
        if (memory == nullptr) {
            throw std::bad_alloc();
        }
        (void)elements_.release();
        elements_.reset(static_cast<Element*>(memory));
        capacity_ = capacity;
    }

    std::unique_ptr<Element, Free> elements_;
    std::size_t size_ = 0;
    std::size_t capacity_ = 0;
};

}  // namespace umpre

#endif
