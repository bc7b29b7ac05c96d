// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_SCAN_H
#define UMPRE_LEX_TEXT_SCAN_H

#include <cstddef>
#include <string_view>

#include "lex/byte_block.h"
#include "lex/line_start.h"
#include "lex/literal.h"
#include "lex/name_filter.h"
#include "lex/spelling.h"
#include "lex/text_map.h"

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
    /// `atLineStart`. Eight bytes before the text and 64 behind it can be read. The map is of this
    /// text. `names` are those that may be macros.
    TextScan(std::string_view text, bool atLineStart, TextMap& map, LiteralFinder& literals,
             const NameFilter& names) noexcept
        : end_(text.data() + text.size()),
          at_(text.data()),
          lineStart_(at_, atLineStart),
          map_(map),
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

    /// Returns where the blanks before `place` begin if nothing else stands before it on its line,
    /// otherwise null.
    [[nodiscard]] const char* lineStart(const char* place) const noexcept {
        return lineStart_.before(place);
    }

    /// Goes on at `place`, where a token begins, the first of its line if `atLineStart`.
    void resume(const char* place, bool atLineStart) noexcept {
        at_ = place;
        lineStart_ = {place, atLineStart};
    }

    /// Tells whether the line ends here and the next one begins with this name, which is then the
    /// mark: in lists, line after line begins with one name.
    [[nodiscard]] bool passToSame(std::string_view name) noexcept {
        const char* const next = at_ + 1;
        if (*at_ != '\n' || marksLineFeeds_
            || static_cast<std::size_t>(end_ - at_) <= name.size() + 1
            || !isSameName({next, name.size()}, name) || isWordByte(next[name.size()])) {
            return false;
        }
        at_ = next;
        nameEnd_ = next + name.size();
        return true;
    }

private:
    using Mask = ByteBlock::Mask;
    struct Block;

    [[nodiscard]] TextMark scanBlock();
    [[nodiscard]] Block blockAt(const char* at);
    void passUnusual(Block& block);
    void passAt(Block& block, const char* place);
    void passCharacter(Block& block, const char* quote);
    void passLiteral(Block& block, const char* quote);
    void passBrokenString(Block& block, unsigned lineEnd);
    [[nodiscard]] bool returnToQuote();
    void findNames(Block& block);
    [[nodiscard]] Mask namesIn(const Block& block) const noexcept;
    [[nodiscard]] Mask namesBehindNumbers(const Block& block, Mask numbers, Mask tails,
                                          Mask& found) const noexcept;
    [[nodiscard]] bool passLongWord() noexcept;

    const char* end_;
    const char* at_;
    const char* nameEnd_ = nullptr;
    const char* openQuote_ = nullptr;  // of the string that goes on at at_
    LineStart lineStart_;
    bool marksLineFeeds_ = false;
    TextMap& map_;
    LiteralFinder& literals_;
    const NameFilter& names_;
};

}  // namespace umpre

#endif
