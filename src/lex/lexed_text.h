// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_LEXED_TEXT_H
#define UMPRE_LEX_LEXED_TEXT_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "lex/comment_sink.h"
#include "lex/token.h"

namespace umpre {

/// Tokens kept for reading, with the effects that reading them has: a comment's line ends and the
/// note that one is not closed happen each time its token is read. Tokens keep their bounds; two
/// that stand side by side never become one.
class LexedText {
public:
    void clear();

    /// Adds a token of a known kind.
    void append(TokenKind kind, std::string_view text) {
        text_.append(text);
        tokens_.emplace_back(kind, text_.size());
    }

    /// Adds tokens `first` up to, not including, `last` of another text, which has no effects.
    void append(const LexedText& other, std::size_t first, std::size_t last);
    /// Adds an effect of reading the token that will be added next.
    void addCommentEffect(std::size_t lineEnds, bool unterminated, std::int32_t line);

    [[nodiscard]] std::size_t size() const noexcept { return tokens_.size(); }

    [[nodiscard]] TokenKind kind(std::size_t index) const noexcept { return tokens_[index].kind(); }

    [[nodiscard]] std::string_view text(std::size_t index) const noexcept {
        const std::size_t begin = beginOf(index);
        return {text_.data() + begin, tokens_[index].end() - begin};
    }

    /// Returns the texts of all tokens, joined.
    [[nodiscard]] const std::string& joined() const noexcept { return text_; }

    [[nodiscard]] bool hasEffects() const noexcept { return !effects_.empty(); }

    /// Carries out what reading the token at `index` does beside yielding it.
    void carryOutEffects(std::size_t index, CommentSink& sink) const;

private:
    // A kind, and where the token's text ends in `text_`; it begins where the last one ends. One
    // word holds both: long bodies and arguments are mostly these.
    class Entry {
    public:
        Entry(TokenKind kind, std::size_t end) noexcept
            : bits_(end << kKindBits | static_cast<std::uint64_t>(kind)) {}

        [[nodiscard]] TokenKind kind() const noexcept {
            return static_cast<TokenKind>(bits_ & ((1U << kKindBits) - 1));
        }

        [[nodiscard]] std::size_t end() const noexcept { return bits_ >> kKindBits; }

    private:
        static constexpr unsigned kKindBits = 16;
        std::uint64_t bits_;
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

    std::string text_;
    std::vector<Entry> tokens_;
    std::vector<Effect> effects_;  // in the order of the tokens
};

}  // namespace umpre

#endif
