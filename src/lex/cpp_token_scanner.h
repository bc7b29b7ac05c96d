// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_CPP_TOKEN_SCANNER_H
#define UMPRE_LEX_CPP_TOKEN_SCANNER_H

#include <cstddef>
#include <memory>

#include "lex/comment_sink.h"
#include "lex/cpp_scanner.h"
#include "lex/pieces.h"

namespace umpre {

/// The tokens of a sequence of pieces.
class CppTokenScanner final : public CppScanner {
public:
    explicit CppTokenScanner(CommentSink& commentSink) : commentSink_(commentSink) {}

    /// Reads pieces, which it takes over; `pieces` is left with memory to use again.
    void read(Pieces& pieces);
    /// Reads one piece whose text is shared with its owner.
    void read(std::shared_ptr<const LexedText> text, NoExpandSet noExpand);

    /// Tells whether all tokens have been taken.
    [[nodiscard]] bool isExhausted() const noexcept {
        return index_ == text_->size() && (!hasPeek() || peekedEnd_);
    }

    [[nodiscard]] NoExpandSet noExpandSet() const override;

    [[nodiscard]] bool isTokenList() const noexcept override { return true; }

private:
    [[nodiscard]] Token scan() override;
    void start(const LexedText& text);

    CommentSink& commentSink_;
    Pieces pieces_;                            // when it reads pieces of its own
    std::shared_ptr<const LexedText> shared_;  // when it reads a shared text, all in the set below
    NoExpandSet sharedSet_;
    const LexedText* text_ = nullptr;
    std::size_t index_ = 0;  // of the next token
    std::size_t run_ = 0;    // of `pieces_`, that the last token belongs to
    bool peekedEnd_ = false;
};

}  // namespace umpre

#endif
