// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_CPP_TOKEN_SCANNER_H
#define UMPRE_LEX_CPP_TOKEN_SCANNER_H

#include <cstddef>
#include <string_view>
#include <vector>

#include "lex/comment_sink.h"
#include "lex/cpp_scanner.h"
#include "lex/name_filter.h"
#include "lex/pieces.h"
#include "lex/shared_text.h"

namespace umpre {

/// The tokens of a sequence of pieces.
class CppTokenScanner final : public CppScanner {
public:
    explicit CppTokenScanner(CommentSink& commentSink) : commentSink_(commentSink) {}

    /// Reads pieces, which it takes over; `pieces` must be restarted before it is used again.
    void read(Pieces&& pieces);
    /// Reads one piece.
    void read(TextSlice slice, NoExpandSet noExpand);

    /// Lets go of what it reads.
    void release() noexcept { text_ = {}; }

    /// Tells whether all tokens have been taken.
    [[nodiscard]] bool isExhausted() const noexcept {
        return index_ == end_ && (!hasPeek() || peekedEnd_);
    }

    [[nodiscard]] NoExpandSet noExpandSet() const override { return noExpand_; }

    [[nodiscard]] bool isTokenList() const noexcept override { return true; }

    /// For readers of many tokens at a time: the text that is read, whose tokens from `position()`
    /// to `end()` are still to come.
    [[nodiscard]] const SharedText& text() const noexcept { return text_; }

    [[nodiscard]] std::size_t position() const noexcept {
        return hasPeek() && !peekedEnd_ ? index_ - 1 : index_;
    }

    [[nodiscard]] std::size_t end() const noexcept { return end_; }

    /// Returns the set of a token still to come.
    [[nodiscard]] NoExpandSet noExpandSetAt(std::size_t index) const;
    /// Consumes the tokens before `index`, at least one, and none with effects among them.
    void moveTo(std::size_t index);
    /// Consumes tokens with one set that nothing needs to be done for, and returns where the first
    /// stands; `position()` is behind the last. Stops before names that may be macros and, if told
    /// so, before `stop`.
    [[nodiscard]] std::size_t takePlain(const NameFilter& macroNames, TokenKind stop);

private:
    [[nodiscard]] Token scan() override;
    void start();
    void findRun();

    CommentSink& commentSink_;
    SharedText text_;
    std::vector<Pieces::Run> runs_;  // empty: all tokens have the set below
    std::size_t run_ = 0;            // that the last token belongs to
    std::size_t runEnd_ = 0;
    NoExpandSet noExpand_;
    std::size_t index_ = 0;  // of the next token to be scanned
    std::size_t end_ = 0;
    bool peekedEnd_ = false;
};

/// Tells whether a token of a text is a name that may be a macro.
[[nodiscard]] inline bool mayBeMacro(const LexedText& text, std::size_t index,
                                     const NameFilter& macroNames) {
    if (!isName(text.kind(index))) {
        return false;
    }
    const Name* const name = text.name(index);
    return name != nullptr ? name->isDefined : macroNames.mayHold(text.text(index));
}

}  // namespace umpre

#endif
