// SPDX-License-Identifier: MIT
//
// Looks at 64 bytes at a time, as masks. Of
//
//     x = f(2) + "N";\n
//     1...1...........        where names begin
//     ...........1....        what must be looked at itself: quotes, slashes, backslashes, "#"
//     ...............1        line feeds
//
// the names are held against the filter, the literal is taken out (N is none of the names), and the
// line feed is counted. A word that goes on behind the 64 bytes is left to the next 64, which begin
// with it.
#include "lex/text_scan.h"

#include <algorithm>

#include "lex/spelling.h"

namespace umpre {

// What is known of up to 64 bytes.
struct TextScan::Block {
    const char* at;
    unsigned size;
    Mask letters;
    Mask words;  // letters and digits
    Mask lineFeeds;
    Mask unusual;       // still to be looked at
    Mask literals = 0;  // what stands in them
    // How far scanning comes in it, what stands there, and where to go on.
    unsigned stop;
    TextMark mark = TextMark::End;
    const char* next;
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
    return names_ != nullptr ? scan<true>() : scan<false>();
}

template <bool kCopies>
TextMark TextScan::scan() {
    while (at_ < end_) {
        Block block = blockAt<kCopies>(at_);
        if (kCopies && block.size == 0) {
            if (passLongWord()) {
                return TextMark::Name;
            }
            continue;
        }
        if (block.unusual != 0) {
            passUnusual(block);
        }
        if (kCopies) {
            findNames(block);
        }
        lineFeeds_ += countBits(block.lineFeeds & bitsBelow(block.stop));
        at_ = block.next;
        if (block.mark != TextMark::End) {
            return block.mark;
        }
    }
    return TextMark::End;
}

template <bool kCopies>
TextScan::Block TextScan::blockAt(const char* at) const noexcept {
    const ByteBlock bytes = ByteBlock::between(at, end_);
    Block block{};
    block.at = at;
    block.size = static_cast<unsigned>(
        std::min<std::size_t>(static_cast<std::size_t>(end_ - at), ByteBlock::kSize));
    block.lineFeeds = bytes.any('\n');
    block.unusual = bytes.any('"', '\'', '/', '\\', '\r', '#');
    if (kCopies) {
        // What stands before these 64 bytes is not known here.
        const Mask blanks = bytes.blanksAndUnusual() & ~block.lineFeeds;
        const Mask suspects = marksLineFeeds_ ? ~Mask{0} : blanks << 1U | 1U;
        block.unusual |= block.lineFeeds & suspects;
        block.letters = bytes.letters();
        block.words = block.letters | bytes.digits();
        block.size -= static_cast<unsigned>(std::countl_one(block.words));
        const Mask inside = bitsBelow(block.size);
        block.letters &= inside;
        block.words &= inside;
    }
    block.stop = block.size;
    block.next = at + block.size;
    return block;
}

// Looks at what is unusual in a block, up to the first that scanning must stop at.
void TextScan::passUnusual(Block& block) {
    do {
        const char* const place = block.at + firstBit(block.unusual);
        block.unusual &= block.unusual - 1;
        if (place >= block.next || !passAt(block, place)) {
            return;
        }
    } while (block.unusual != 0);
}

// Returns false if scanning does not go on in this block.
bool TextScan::passAt(Block& block, const char* place) {
    const auto stop = [&block, place](TextMark mark) {
        block.stop = static_cast<unsigned>(place - block.at);
        block.mark = mark;
        block.next = place;
        return false;
    };
    switch (*place) {
    case '"':
    case '\'': return passLiteral(block, place) || stop(TextMark::Literal);
    case '/': return (place[1] != '/' && place[1] != '*') || stop(TextMark::Comment);
    case '\\': return !isLineEndByte(place[1]) || stop(TextMark::Continuation);
    case '\r': return stop(TextMark::CarriageReturn);
    case '#': return place[1] == '#' || lineStart(place) == nullptr || stop(TextMark::Hash);
    default: break;
    }
    const char* const blanks = lineStart(place);
    if (blanks != nullptr && blanks != place) {
        return stop(TextMark::BlankLine);
    }
    return !marksLineFeeds_ || stop(TextMark::LineFeed);
}

// Returns false if the bytes at hand do not hold the literal whole.
bool TextScan::passLiteral(Block& block, const char* quote) {
    const LiteralScan literal = literals_.find(quote, end_, false);
    if (literal.result == LiteralScan::Result::Closed) {
        const auto first = static_cast<unsigned>(quote - block.at);
        if (literal.end >= block.next) {
            block.stop = first;
            block.next = literal.end;
            block.unusual = 0;
        } else {
            const Mask passed = bitsBelow(static_cast<std::size_t>(literal.end - block.at));
            block.literals |= passed & ~bitsBelow(first);
            block.unusual &= ~passed;
        }
    }
    return literal.result != LiteralScan::Result::Cut;
}

void TextScan::findNames(Block& block) {
    const Mask names = namesIn(block);
    if (names != 0) {
        block.stop = firstBit(names);
        block.mark = TextMark::Name;
        block.next = block.at + block.stop;
        nameEnd_ = block.next + std::countr_one(block.words >> block.stop);
    }
}

// Returns where names begin that may be macros. Of several only the first counts.
ByteBlock::Mask TextScan::namesIn(const Block& block) const noexcept {
    const Mask text = bitsBelow(block.stop) & ~block.literals;
    const Mask wordStarts = block.words & ~(block.words << 1U);
    Mask starts = wordStarts & block.letters & text;
    // The sum carries each start to the end of its word.
    Mask ends = (block.words + starts) & ~block.words;
    Mask found = 0;
    while (starts != 0) {
        const unsigned start = firstBit(starts);
        const std::string_view name(block.at + start, firstBit(ends) - start);
        found |= static_cast<Mask>(names_->mayHoldAmongBytes(name)) << start;
        starts &= starts - 1;
        ends &= ends - 1;
    }
    // Letters behind the leading digits of a word: it may go on as a name.
    const Mask digits = block.words & ~block.letters;
    const Mask numbers = wordStarts & digits & text;
    Mask tails = (digits + numbers) & ~digits & block.letters;
    while (tails != 0) {
        const unsigned tail = firstBit(tails);
        tails &= tails - 1;
        const unsigned start =
            63U - static_cast<unsigned>(std::countl_zero(numbers & bitsBelow(tail)));
        const char* const wordEnd = block.at + tail + std::countr_one(block.words >> tail);
        const char* const name = behindNumbers(block.at + start, wordEnd);
        if (name < wordEnd
            && names_->mayHoldAmongBytes({name, static_cast<std::size_t>(wordEnd - name)})) {
            found |= Mask{1} << static_cast<unsigned>(name - block.at);
        }
    }
    return found;
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
        && names_->mayHoldAmongBytes({name, static_cast<std::size_t>(wordEnd - name)});
    at_ = found ? name : wordEnd;
    nameEnd_ = wordEnd;
    return found;
}

const char* TextScan::lineStart(const char* place) const noexcept {
    const char* at = place;
    while (at != floor_ && isBlankByte(at[-1])) {
        --at;
    }
    const bool isStart = at == floor_ ? startsLine_ : at[-1] == '\n';
    return isStart ? at : nullptr;
}

}  // namespace umpre
