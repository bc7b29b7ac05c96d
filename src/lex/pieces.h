// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_PIECES_H
#define UMPRE_LEX_PIECES_H

#include <cstddef>
#include <string_view>
#include <utility>
#include <vector>

#include "lex/lexed_text.h"
#include "lex/no_expand_set.h"
#include "lex/shared_text.h"

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

    Pieces() = default;

    /// Builds on a text that is empty.
    explicit Pieces(SharedText text) : text_(std::move(text)) {}

    /// Begins anew with a text that is empty; without one, lets go of what there was.
    void restart(SharedText text = {}) {
        text_ = std::move(text);
        runs_.clear();
    }

    /// Adds one token.
    void append(const Token& token, NoExpandSet noExpand) {
        LexedText& tokens = open();
        tokens.append(token.kind, token.text, token.name);
        close(tokens.size(), noExpand);
    }

    /// Adds tokens `first` up to, not including, `last` of a text.
    void append(const LexedText& text, std::size_t first, std::size_t last, NoExpandSet noExpand) {
        LexedText& tokens = open();
        tokens.append(text, first, last);
        close(tokens.size(), noExpand);
    }

    /// Gives access for adding tokens, which `close` then makes a piece.
    [[nodiscard]] LexedText& open() {
        if (!text_) {
            text_ = SharedText::alone();
        }
        return text_.edit();
    }

    /// Gives the tokens added since the last piece their set.
    void close(NoExpandSet noExpand) { close(open().size(), noExpand); }

    /// Hands the tokens and their runs over, in exchange for memory to use again.
    void moveTo(SharedText& text, std::vector<Run>& runs) {
        (void)open();
        text = std::move(text_);
        runs.swap(runs_);
    }

    [[nodiscard]] const LexedText& tokens() { return open(); }

    [[nodiscard]] const std::vector<Run>& runs() const noexcept { return runs_; }

private:
    void close(std::size_t end, NoExpandSet noExpand) {
        if (!runs_.empty() && runs_.back().noExpand == noExpand) {
            runs_.back().end = end;
        } else {
            runs_.push_back({end, noExpand});
        }
    }

    SharedText text_;
    std::vector<Run> runs_;
};

}  // namespace umpre

#endif
