// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_LEXED_TEXT_H
#define UMPRE_LEX_LEXED_TEXT_H

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <vector>

#include "lex/comment_sink.h"
#include "lex/growing_array.h"
#include "lex/no_expand_set.h"
#include "lex/token.h"

namespace umpre {

struct TextOutline;

/// Tokens kept for reading, with the effects that reading them has: a comment's line ends and the
/// note that one is not closed happen each time its token is read. Tokens keep their bounds; two
/// that stand side by side never become one.
class LexedText {
public:
    void clear();

    /// Takes the memory for so many tokens and bytes of theirs.
    void reserve(std::size_t tokens, std::size_t bytes) {
        tokens_.reserve(tokens);
        text_.reserve(bytes);
    }

    /// Adds a token of a known kind. `name` is the entry of a name, if it is known.
    void append(TokenKind kind, std::string_view text, Name* name = nullptr);

    /// Adds tokens `first` up to, not including, `last` of another text, which has no effects.
    void append(const LexedText& other, std::size_t first, std::size_t last);

    /// Notes that the tokens so far are all that lexing one text gave.
    void noteLexedAsOne() noexcept { lexedAsOne_ = size(); }

    /// Adds an effect of reading the token that will be added next.
    void addCommentEffect(std::size_t lineEnds, bool unterminated, std::int32_t line);

    /// Notes the entry of a token that is a name.
    void setName(std::size_t index, Name* name) noexcept { tokens_[index].setName(name); }

    [[nodiscard]] std::size_t size() const noexcept { return tokens_.size(); }

    [[nodiscard]] TokenKind kind(std::size_t index) const noexcept { return tokens_[index].kind(); }

    [[nodiscard]] std::string_view text(std::size_t index) const noexcept {
        return joined(index, index + 1);
    }

    /// Returns the entry of a name; null if it is not known, and for all other tokens.
    [[nodiscard]] Name* name(std::size_t index) const noexcept { return tokens_[index].name(); }

    [[nodiscard]] Token token(std::size_t index) const noexcept {
        return {kind(index), text(index), name(index)};
    }

    /// Tells that a token stays itself if its text and those before it are joined and lexed again,
    /// and, if it is a blank, that it is one space between two other tokens.
    [[nodiscard]] bool isClean(std::size_t index) const noexcept {
        return !tokens_[index].has(Entry::kUnclean);
    }

    /// Tells that a token stays itself wherever a part of this text is joined and lexed again. One
    /// that is not clean does if all was lexed as one: what comes before it was seen then. A blank
    /// must be clean.
    [[nodiscard]] bool staysItself(std::size_t index) const noexcept {
        return isClean(index) || (lexedAsOne_ == size() && !isBlankOrNewline(kind(index)));
    }

    /// Returns the first token from `first` on, and before `last`, that a reader may have to do
    /// something about: a name, a line end, `defined`. If there is none, returns `last`.
    [[nodiscard]] std::size_t nextNotable(std::size_t first, std::size_t last) const noexcept {
        while (first < last && !tokens_[first].has(Entry::kNotable)) {
            ++first;
        }
        return first;
    }

    /// Returns the texts of all tokens, joined.
    [[nodiscard]] std::string_view joined() const noexcept { return {text_.data(), text_.size()}; }

    /// Returns the texts of tokens `first` up to, not including, `last`, joined.
    [[nodiscard]] std::string_view joined(std::size_t first, std::size_t last) const noexcept {
        const std::size_t begin = beginOf(first);
        return {text_.data() + begin, beginOf(last) - begin};
    }

    [[nodiscard]] bool hasEffects() const noexcept { return !effects_.empty(); }

    /// Returns the outline of a text to which nothing more is added, made at the first call.
    [[nodiscard]] const TextOutline& outline() const;

    /// Carries out what reading the token at `index` does beside yielding it.
    void carryOutEffects(std::size_t index, CommentSink& sink) const;

private:
    // A kind, what readers want to know quickly, and where the token's text ends in `text_`; it
    // begins where the last one ends. One word holds all: long bodies and arguments are mostly
    // these.
    class Entry {
    public:
        static constexpr std::uint64_t kNotable = 1U << 10U;
        static constexpr std::uint64_t kUnclean = 1U << 11U;

        // cppcheck-suppress uninitMemberVar ; arrays grow by entries that are then written to
        Entry() = default;

        Entry(TokenKind kind, std::size_t end, Name* name) noexcept
            : bits_(end << kLowBits | static_cast<std::uint64_t>(kind)), name_(name) {}

        [[nodiscard]] TokenKind kind() const noexcept {
            return static_cast<TokenKind>(bits_ & (kNotable - 1));
        }

        [[nodiscard]] bool has(std::uint64_t mark) const noexcept { return (bits_ & mark) != 0; }

        void set(std::uint64_t mark, bool isSet) noexcept {
            bits_ = (bits_ & ~mark) | (isSet ? mark : 0);
        }

        [[nodiscard]] std::size_t end() const noexcept { return bits_ >> kLowBits; }

        /// Returns the token with its end moved; a shift that is negative wraps.
        [[nodiscard]] Entry shifted(std::size_t by) const noexcept {
            Entry result = *this;
            result.bits_ += by << kLowBits;
            return result;
        }

        [[nodiscard]] Name* name() const noexcept { return name_; }

        void setName(Name* name) noexcept { name_ = name; }

    private:
        static constexpr unsigned kLowBits = 16;
        std::uint64_t bits_;
        Name* name_;
    };

    struct Effect {
        std::size_t token;
        std::size_t lineEnds;
        bool unterminated;
        std::int32_t line;
    };

    [[nodiscard]] std::size_t beginOf(std::size_t index) const noexcept {
        return index == 0 ? 0 : tokens_[index - 1].end();
    }

    void copyText(const char* from, std::size_t size);
    void markUnclean(std::size_t index);
    [[nodiscard]] bool isFoundUnclean(std::size_t index) const;

    GrowingArray<char> text_;
    GrowingArray<Entry> tokens_;
    std::vector<Effect> effects_;  // in the order of the tokens
    std::size_t lexedAsOne_ = 0;   // so many tokens; 0 if they were not
    mutable std::shared_ptr<const TextOutline> outline_;
};

}  // namespace umpre

#endif
