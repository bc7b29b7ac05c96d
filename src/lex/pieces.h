// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_PIECES_H
#define UMPRE_LEX_PIECES_H

#include <cstddef>
#include <string_view>
#include <vector>

#include "lex/lexed_text.h"
#include "lex/no_expand_set.h"

namespace umpre {

/// A sequence of pieces. A piece is a text, kept as its tokens, with the set of macro names that
/// must not be expanded in it; no token reaches from one piece into the next. Pieces with equal
/// sets that stand side by side are kept as one run.
class Pieces {
public:
    /// Tokens up to, not including, `end`, all with one set.
    struct Run {
        std::size_t end;
        NoExpandSet noExpand;
    };

    void clear() {
        tokens_.clear();
        runs_.clear();
    }

    /// Adds one token.
    void append(TokenKind kind, std::string_view text, NoExpandSet noExpand) {
        tokens_.append(kind, text);
        close(noExpand);
    }

    /// Adds tokens `first` up to, not including, `last` of a text.
    void append(const LexedText& text, std::size_t first, std::size_t last, NoExpandSet noExpand) {
        tokens_.append(text, first, last);
        close(noExpand);
    }

    /// Gives access for adding tokens, which `close` then makes a piece.
    [[nodiscard]] LexedText& open() noexcept { return tokens_; }

    /// Gives the tokens added since the last piece their set.
    void close(NoExpandSet noExpand) {
        if (!runs_.empty() && runs_.back().noExpand == noExpand) {
            runs_.back().end = tokens_.size();
        } else {
            runs_.push_back({tokens_.size(), noExpand});
        }
    }

    [[nodiscard]] const LexedText& tokens() const noexcept { return tokens_; }

    [[nodiscard]] const std::vector<Run>& runs() const noexcept { return runs_; }

private:
    LexedText tokens_;
    std::vector<Run> runs_;
};

}  // namespace umpre

#endif
