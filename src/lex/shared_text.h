// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_SHARED_TEXT_H
#define UMPRE_LEX_SHARED_TEXT_H

#include <cstddef>
#include <memory>
#include <utility>
#include <vector>

#include "lex/lexed_text.h"

namespace umpre {

class TextPool;

/// A `LexedText` that several readers hold: the body of a macro and whoever replays it, the tokens
/// around an invocation and its arguments. It counts its holders without locks, so all of them
/// belong to one thread. The last one gives the text back to its pool.
class SharedText {
public:
    /// No text.
    SharedText() = default;

    /// A text that belongs to no pool.
    [[nodiscard]] static SharedText alone() {
        return SharedText(std::make_unique<Counted>().release());
    }

    SharedText(const SharedText& other) noexcept : counted_(other.counted_) {
        if (counted_ != nullptr) {
            ++counted_->holders;
        }
    }

    SharedText(SharedText&& other) noexcept : counted_(std::exchange(other.counted_, nullptr)) {}

    SharedText& operator=(SharedText other) noexcept {
        std::swap(counted_, other.counted_);
        return *this;
    }

    ~SharedText() {
        if (counted_ != nullptr && --counted_->holders == 0) {
            giveBack();
        }
    }

    [[nodiscard]] explicit operator bool() const noexcept { return counted_ != nullptr; }

    [[nodiscard]] const LexedText& operator*() const noexcept { return counted_->text; }

    [[nodiscard]] const LexedText* operator->() const noexcept { return &counted_->text; }

    /// Gives access for building the text, before it is handed to others.
    [[nodiscard]] LexedText& edit() const noexcept { return counted_->text; }

private:
    friend class TextPool;

    struct Counted {
        LexedText text;
        std::size_t holders = 1;
        TextPool* pool = nullptr;
    };

    explicit SharedText(Counted* counted) noexcept : counted_(counted) {}

    void giveBack() noexcept;

    Counted* counted_ = nullptr;
};

/// Keeps texts that nobody holds any more, with their memory, for use again. It must outlive all
/// the texts taken from it.
class TextPool {
public:
    /// Takes the room for the spare texts, because giving one back must not ask for memory.
    TextPool() { spare_.reserve(kSpares); }

    /// Returns an empty text.
    [[nodiscard]] SharedText take() {
        if (spare_.empty()) {
            SharedText fresh = SharedText::alone();
            fresh.counted_->pool = this;
            return fresh;
        }
        SharedText used(spare_.back().release());
        spare_.pop_back();
        used.counted_->holders = 1;
        return used;
    }

private:
    friend class SharedText;

    // Deep nesting needs more texts at a time, but not for long.
    static constexpr std::size_t kSpares = 64;

    std::vector<std::unique_ptr<SharedText::Counted>> spare_;
};

/// Tokens `first` up to, not including, `last` of a text.
struct TextSlice {
    SharedText text;
    std::size_t first = 0;
    std::size_t last = 0;

    /// The whole of a text.
    [[nodiscard]] static TextSlice whole(SharedText text) {
        const std::size_t size = text->size();
        return {std::move(text), 0, size};
    }

    /// The texts of its tokens, joined.
    [[nodiscard]] std::string_view joined() const noexcept { return text->joined(first, last); }
};

}  // namespace umpre

#endif
