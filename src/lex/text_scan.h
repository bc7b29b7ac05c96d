// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_SCAN_H
#define UMPRE_LEX_TEXT_SCAN_H

#include <cstddef>
#include <string_view>
#include <utility>

#include "lex/byte_block.h"
#include "lex/literal.h"
#include "lex/name_filter.h"

namespace umpre {

/// What stands where a scan of text stopped.
enum class TextMark {
    End,             ///< nothing: the bytes are used up
    Name,            ///< a name that may be a macro's
    Literal,         ///< a literal that the bytes at hand do not hold whole
    Comment,         ///< "//" or "/*"
    Continuation,    ///< a backslash before a line end
    CarriageReturn,  ///< a line end, alone or with a line feed
    Hash,            ///< "#" as the first token of a line
    BlankLine,       ///< the line feed of a line that holds blanks and nothing else
    LineFeed,        ///< any other line feed
};

/// Finds what matters in a file's text, 64 bytes at a time: passes over everything else, and over
/// whole literals, splitting names and numbers where the scanner does.
class TextScan {
public:
    /// Begins at the beginning of `text`, where a token begins, the first of its line if
    /// `atLineStart`. Eight bytes behind the text can be read. `names` are those that may be
    /// macros; if there are none, the text is not to be copied, and blank lines do not matter.
    TextScan(std::string_view text, bool atLineStart, LiteralFinder& literals,
             const NameFilter* names) noexcept
        : end_(text.data() + text.size()),
          at_(text.data()),
          floor_(at_),
          startsLine_(atLineStart),
          literals_(literals),
          names_(names) {}

    /// Goes on to the next mark.
    [[nodiscard]] TextMark next();

    /// Makes every line feed a mark, or only those that end blank lines.
    void markLineFeeds(bool every) noexcept { marksLineFeeds_ = every; }

    /// Returns the place of the mark.
    [[nodiscard]] const char* at() const noexcept { return at_; }

    /// Returns the end of the name, at a `Name`.
    [[nodiscard]] const char* nameEnd() const noexcept { return nameEnd_; }

    [[nodiscard]] const char* end() const noexcept { return end_; }

    /// Returns the line feeds passed since the last call.
    [[nodiscard]] std::size_t takeLineFeeds() noexcept { return std::exchange(lineFeeds_, 0); }

    /// Returns where the blanks before `place` begin if nothing else stands before it on its line,
    /// otherwise null.
    [[nodiscard]] const char* lineStart(const char* place) const noexcept;

    /// Goes on at `place`, where a token begins, the first of its line if `atLineStart`.
    void resume(const char* place, bool atLineStart) noexcept {
        at_ = floor_ = place;
        startsLine_ = atLineStart;
    }

private:
    using Mask = ByteBlock::Mask;
    struct Block;

    template <bool kCopies>
    [[nodiscard]] TextMark scan();
    template <bool kCopies>
    [[nodiscard]] Block blockAt(const char* at) const noexcept;
    void passUnusual(Block& block);
    [[nodiscard]] bool passAt(Block& block, const char* place);
    [[nodiscard]] bool passLiteral(Block& block, const char* quote);
    void findNames(Block& block);
    [[nodiscard]] Mask namesIn(const Block& block) const noexcept;
    [[nodiscard]] bool passLongWord() noexcept;

    const char* end_;
    const char* at_;
    const char* nameEnd_ = nullptr;
    const char* floor_;  // where this stretch of scanning began
    bool startsLine_;    // a line begins at floor_
    bool marksLineFeeds_ = false;
    LiteralFinder& literals_;
    const NameFilter* names_;
    std::size_t lineFeeds_ = 0;
};

}  // namespace umpre

#endif
