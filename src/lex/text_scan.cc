// SPDX-License-Identifier: MIT
//
// Looks at 64 bytes at a time, as masks. Of
//
//     x = f(2) + "N" // \n
//     1...1...............    where names begin
//     ...........11.......    strings, without their last quotes
//     ...............1....    what must be looked at itself: comments, backslashes, "#" and so on
//     ..................1.    line feeds
//
// the names outside of strings are held against the filter. A word that goes on behind the 64 bytes
// is left to the next 64, which begin with it. A string may go on; if its line turns out not to
// close it, scanning goes back to its quote.
#include "lex/text_scan.h"

#include <algorithm>
#include <bit>
#include <utility>

#include "lex/spelling.h"

namespace umpre {

// What is known of up to 64 bytes.
struct TextScan::Block {
    const char* at;
    unsigned size = 0;
    Mask letters = 0;
    Mask words = 0;  // letters and digits
    Mask lineFeeds = 0;
    Mask unusual = 0;   // still to be looked at
    Mask strings = 0;   // without their last quotes
    Mask literals = 0;  // what stands in literals
    // How far scanning comes in it, what stands there, and where to go on.
    unsigned stop = 0;
    TextMark mark = TextMark::End;
    const char* next = nullptr;
    const char* openQuote = nullptr;  // of the string that goes on there

    void end(const char* place, TextMark as, const char* goesOnAt) noexcept {
        stop = static_cast<unsigned>(place - at);
        mark = as;
        next = goesOnAt;
        openQuote = nullptr;
        unusual = 0;
    }

    [[nodiscard]] bool isInString(unsigned place) const noexcept {
        return (strings >> place & 1U) != 0;
    }

    // Returns how many bytes up to a place, and with it, one string holds.
    [[nodiscard]] unsigned stringBytesUpTo(unsigned place) const noexcept {
        return static_cast<unsigned>(std::countl_one(strings << (ByteBlock::kSize - 1 - place)));
    }
};

namespace {

// Passes over numbers within a word. What remains is a name or nothing.
[[nodiscard]] const char* behindNumbers(const char* at, const char* wordEnd) noexcept {
    while (at < wordEnd && isDigit(*at)) {
        at += numberAt(at).text.size();
    }
    return at;
}

}  // namespace

TextMark TextScan::next() {
    TextMark mark = TextMark::End;
    do {
        if (at_ < end_) {
            mark = scanBlock();
        } else if (openQuote_ == nullptr) {
            return TextMark::End;
        } else if (!returnToQuote()) {
            return TextMark::Literal;
        }
    } while (mark == TextMark::End);
    return mark;
}

// Goes on over up to 64 bytes. Returns End if no mark was found in them.
TextMark TextScan::scanBlock() {
    Block block = blockAt(at_);
    if (block.size == 0) {
        return passLongWord() ? TextMark::Name : TextMark::End;
    }
    if (block.unusual != 0) {
        passUnusual(block);
    }
    findNames(block);
    at_ = block.next;
    openQuote_ = block.openQuote;
    return block.mark;
}

TextScan::Block TextScan::blockAt(const char* at) {
    const bool goesOn = openQuote_ != nullptr;
    const TextMap::Window window = map_.windowAt(at, end_, goesOn);
    Block block{at};
    block.size = static_cast<unsigned>(
        std::min<std::size_t>(static_cast<std::size_t>(end_ - at), ByteBlock::kSize));
    const Mask all = bitsBelow(block.size);
    block.literals = block.strings = window.strings & all;
    block.lineFeeds = window.lineFeeds & all;
    const WordMasks words = map_.finder().wordsIn(at);
    block.letters = words.letters & all;
    block.words = block.letters | (words.digits & all);
    block.size -= static_cast<unsigned>(std::countl_one(block.words & ~block.strings));
    const Mask inside = bitsBelow(block.size);
    block.letters &= inside;
    block.words &= inside;
    // What stands before these 64 bytes is not known here.
    const Mask blanks = words.blanksAndUnusual & ~block.lineFeeds;
    const Mask suspects = marksLineFeeds_ ? ~Mask{0} : blanks << 1U | 1U;
    const Mask escapedQuote = at[-1] == '\\' && !goesOn && *at == '"' ? 1 : 0;
    block.unusual = (((window.special | (block.lineFeeds & suspects)) & ~block.strings)
                     | (window.lineEnds & block.strings) | escapedQuote)
                    & inside;
    block.stop = block.size;
    block.next = at + block.size;
    const unsigned inString = block.stringBytesUpTo((block.size - 1) % ByteBlock::kSize);
    const char* const quote = inString == block.size ? openQuote_ : nullptr;
    const char* const opened = quote == nullptr ? block.next - inString : quote;
    block.openQuote = inString == 0 ? nullptr : opened;
    return block;
}

// Looks at what is unusual in a block, up to the first that scanning must stop at.
void TextScan::passUnusual(Block& block) {
    do {
        const unsigned place = firstBit(block.unusual);
        block.unusual &= block.unusual - 1;
        if (block.isInString(place)) {
            passBrokenString(block, place);
        } else {
            passAt(block, block.at + place);
        }
    } while (block.unusual != 0);
}

void TextScan::passAt(Block& block, const char* place) {
    const auto stop = [&block, place](TextMark mark) { block.end(place, mark, place); };
    switch (*place) {
    case '"': passLiteral(block, place); return;
    case '\'': passCharacter(block, place); return;
    case '/':
        if (isCommentSign(place[1])) {
            stop(TextMark::Comment);
        }
        return;
    case '\\':
        if (isLineEndByte(place[1])) {
            stop(TextMark::Continuation);
        } else if (place[1] == '"' && !literals_.isOpen(place + 1)) {
            block.end(place + 1, TextMark::End, place + 1);
        }
        return;
    case '\r': stop(TextMark::CarriageReturn); return;
    case '#':
        if (place[1] != '#' && lineStart(place) != nullptr) {
            stop(TextMark::Hash);
        }
        return;
    default: break;
    }
    const char* const blanks = lineStart(place);
    if (blanks != nullptr && blanks != place) {
        stop(TextMark::BlankLine);
    } else if (marksLineFeeds_) {
        stop(TextMark::LineFeed);
    }
}

// A string holds a line end: it is not closed, or holds a carriage return.
void TextScan::passBrokenString(Block& block, unsigned lineEnd) {
    const unsigned size = block.stringBytesUpTo(lineEnd);
    if (size == lineEnd + 1 && openQuote_ != nullptr) {
        block.end(block.at, TextMark::End, end_);
        block.openQuote = openQuote_;  // as if it had gone on up to the end
    } else {
        passLiteral(block, block.at + (lineEnd + 1 - size));
    }
}

// Ends the block before a literal and goes on behind it, or behind its quote if it is none. Stops
// at it if the bytes at hand do not hold it whole.
void TextScan::passLiteral(Block& block, const char* quote) {
    const LiteralScan literal = literals_.find(quote, end_, false);
    switch (literal.result) {
    case LiteralScan::Result::Closed: block.end(quote, TextMark::End, literal.end); break;
    case LiteralScan::Result::Open: block.end(quote, TextMark::End, quote + 1); break;
    case LiteralScan::Result::Cut: block.end(quote, TextMark::Literal, quote); break;
    }
}

// Double quotes in a character literal belong to no string, which the masks do not know: if their
// number is odd, the block ends.
void TextScan::passCharacter(Block& block, const char* quote) {
    if (literals_.isOpen(quote)) {
        return;
    }
    const char* const end = map_.characterEnd(quote, end_);
    if (end == nullptr) {
        passLiteral(block, quote);
        return;
    }
    const auto size = static_cast<unsigned>(end - block.at);
    if (end > block.next || block.isInString(size - 1)) {
        block.end(quote, TextMark::End, end);
        return;
    }
    const Mask passed = bitsBelow(size);
    block.literals |= passed & ~bitsBelow(static_cast<std::size_t>(quote - block.at));
    block.unusual &= ~passed;
}

// Goes back to the quote of the string that goes on here, and on behind it as `passLiteral` does.
bool TextScan::returnToQuote() {
    const LiteralScan literal = literals_.find(openQuote_, end_, false);
    at_ = std::exchange(openQuote_, nullptr);
    if (literal.result == LiteralScan::Result::Cut) {
        return false;
    }
    at_ = literal.result == LiteralScan::Result::Closed ? literal.end : at_ + 1;
    return true;
}

void TextScan::findNames(Block& block) {
    const Mask names = namesIn(block);
    if (names != 0) {
        const char* const name = block.at + firstBit(names);
        block.end(name, TextMark::Name, name);
        nameEnd_ = name + std::countr_one(block.words >> block.stop);
    }
}

// Returns where names begin that may be macros. Of several only the first counts.
ByteBlock::Mask TextScan::namesIn(const Block& block) const noexcept {
    const Mask text = bitsBelow(block.stop) & ~block.literals;
    const Mask wordStarts = block.words & ~(block.words << 1U) & text;
    const Mask numbers = wordStarts & ~block.letters;
    const Mask digits = block.words & ~block.letters;
    // The sum carries the beginning of each number behind its leading digits.
    const Mask tails = (digits + numbers) & ~digits & block.letters;
    Mask starts = wordStarts & block.letters;
    Mask found = 0;
    if (tails != 0) {
        starts |= namesBehindNumbers(block, numbers, tails, found);
    }
    Mask ends = (block.words + starts) & ~block.words;
    while (starts != 0) {
        const unsigned start = firstBit(starts);
        const std::string_view name(block.at + start, firstBit(ends) - start);
        if (names_.mayHoldAmongBytes(name)) {
            return found | Mask{1} << start;
        }
        starts &= starts - 1;
        ends &= ends - 1;
    }
    return found;
}

// Of words that begin with digits and go on with letters, at `tails`, returns where names begin. A
// word with digits behind a suffix holds several numbers; what is behind these is added to `found`
// if it may be a macro.
ByteBlock::Mask TextScan::namesBehindNumbers(const Block& block, Mask numbers, Mask tails,
                                             Mask& found) const noexcept {
    const NumberMasks of = map_.finder().numbersIn(block.at);
    const Mask digits = block.words & ~block.letters;
    const Mask hexDigits = digits | (of.hexLetters & block.letters);
    const Mask firstHexDigits = (((numbers & of.zeros) << 1U & of.xs) << 1U) & hexDigits;
    const Mask behindHexDigits = (hexDigits + firstHexDigits) & ~hexDigits;
    const Mask behindDigits = (tails & ~(firstHexDigits >> 1U)) | behindHexDigits;
    const Mask firstSuffixes = behindDigits & (of.us | of.ls);
    const Mask secondSuffixes =
        ((firstSuffixes & of.us) << 1U & of.ls) | ((firstSuffixes & of.ls) << 1U & of.us);
    const Mask behind = (behindDigits & ~firstSuffixes) | ((firstSuffixes << 1U) & ~secondSuffixes)
                        | secondSuffixes << 1U;
    for (Mask others = behind & block.words & ~block.letters; others != 0; others &= others - 1) {
        const unsigned place = firstBit(others);
        const char* const wordEnd = block.at + place + std::countr_one(block.words >> place);
        const char* const name = behindNumbers(block.at + place, wordEnd);
        if (name < wordEnd
            && names_.mayHoldAmongBytes({name, static_cast<std::size_t>(wordEnd - name)})) {
            found |= Mask{1} << static_cast<unsigned>(name - block.at);
        }
    }
    return behind & block.letters;
}

// Passes over a word of more than 64 bytes. Returns true if it is a name that may be a macro, or
// ends with one; scanning then stops there.
bool TextScan::passLongWord() noexcept {
    const char* wordEnd = at_;
    unsigned size = ByteBlock::kSize;
    while (size == ByteBlock::kSize && wordEnd < end_) {
        const ByteBlock bytes = ByteBlock::between(wordEnd, end_);
        size = static_cast<unsigned>(std::countr_one(bytes.letters() | bytes.digits()));
        wordEnd += size;
    }
    const char* const name = behindNumbers(at_, wordEnd);
    const bool found =
        name < wordEnd
        && names_.mayHoldAmongBytes({name, static_cast<std::size_t>(wordEnd - name)});
    at_ = found ? name : wordEnd;
    nameEnd_ = wordEnd;
    return found;
}

}  // namespace umpre
