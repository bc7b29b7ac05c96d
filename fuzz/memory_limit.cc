// SPDX-License-Identifier: MIT
//
// A few macros can stand for more text than there is memory in the world. A program meets that
// limit sooner or later; a fuzzer must not have to wait for it. Both forms of `new` that the
// program uses, with and without an alignment, are therefore counted here, and `realloc` and
// `free`, whose calls the linker leads here (`--wrap`).
#include "memory_limit.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <malloc.h>
#include <new>

// NOLINTBEGIN(bugprone-reserved-identifier): these names are the linker's
extern "C" void* __real_realloc(void* memory, std::size_t size);
extern "C" void __real_free(void* memory);

namespace umpre::fuzz {
namespace {

constexpr std::size_t kNone = SIZE_MAX;

std::size_t held = 0;
std::size_t most = kNone;
bool met = false;

[[nodiscard]] void* counted(void* memory) {
    if (memory == nullptr) {
        throw std::bad_alloc();
    }
    held += ::malloc_usable_size(memory);
    return memory;
}

[[nodiscard]] bool isRefused(std::size_t size) noexcept {
    const bool refused = held > most || size > most - held;
    met = met || refused;
    return refused;
}

}  // namespace

MemoryLimit::MemoryLimit(std::size_t bytes) noexcept {
    met = false;
    most = held + bytes;
}

MemoryLimit::~MemoryLimit() {
    most = kNone;
}

bool MemoryLimit::wasMet() const noexcept {
    return met;
}

namespace {

[[nodiscard]] void* allocate(std::size_t size) {
    return counted(isRefused(size) ? nullptr : std::malloc(size == 0 ? 1 : size));
}

[[nodiscard]] void* allocate(std::size_t size, std::align_val_t alignment) {
    const auto unit = static_cast<std::size_t>(alignment);
    const std::size_t rounded = (size / unit + 1) * unit;
    return counted(isRefused(rounded) ? nullptr : std::aligned_alloc(unit, rounded));
}

void release(void* memory) noexcept {
    if (memory != nullptr) {
        held -= std::min(held, ::malloc_usable_size(memory));
        __real_free(memory);
    }
}

[[nodiscard]] void* reallocate(void* memory, std::size_t size) {
    const std::size_t before = memory == nullptr ? 0 : ::malloc_usable_size(memory);
    if (size > before && isRefused(size - before)) {
        return nullptr;
    }
    void* const moved = __real_realloc(memory, size);
    if (moved != nullptr) {
        held = held - std::min(held, before) + ::malloc_usable_size(moved);
    }
    return moved;
}

}  // namespace
}  // namespace umpre::fuzz

extern "C" void* __wrap_realloc(void* memory, std::size_t size) {
    return umpre::fuzz::reallocate(memory, size);
}

extern "C" void __wrap_free(void* memory) {
    umpre::fuzz::release(memory);
}

// NOLINTEND(bugprone-reserved-identifier)

void* operator new(std::size_t size) {
    return umpre::fuzz::allocate(size);
}

void* operator new[](std::size_t size) {
    return umpre::fuzz::allocate(size);
}

void* operator new(std::size_t size, std::align_val_t alignment) {
    return umpre::fuzz::allocate(size, alignment);
}

void* operator new[](std::size_t size, std::align_val_t alignment) {
    return umpre::fuzz::allocate(size, alignment);
}

void operator delete(void* memory) noexcept {
    umpre::fuzz::release(memory);
}

void operator delete[](void* memory) noexcept {
    umpre::fuzz::release(memory);
}

void operator delete(void* memory, std::size_t /*size*/) noexcept {
    umpre::fuzz::release(memory);
}

void operator delete[](void* memory, std::size_t /*size*/) noexcept {
    umpre::fuzz::release(memory);
}

void operator delete(void* memory, std::align_val_t /*alignment*/) noexcept {
    umpre::fuzz::release(memory);
}

void operator delete[](void* memory, std::align_val_t /*alignment*/) noexcept {
    umpre::fuzz::release(memory);
}

void operator delete(void* memory, std::size_t /*size*/, std::align_val_t /*alignment*/) noexcept {
    umpre::fuzz::release(memory);
}

void operator delete[](void* memory, std::size_t /*size*/,
                       std::align_val_t /*alignment*/) noexcept {
    umpre::fuzz::release(memory);
}

extern "C" const char* __asan_default_options() {
    return "alloc_dealloc_mismatch=0";
}
