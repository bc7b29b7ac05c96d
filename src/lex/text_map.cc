// SPDX-License-Identifier: MIT
#include "lex/text_map.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>

namespace umpre {

TextMap::Comment TextMap::commentAt(const char* comment, const char* end) {
    const char* const text = comment + 2;
    if (comment[1] == '/') {
        const char* const lineEnd = find(text, end, &TextMasks::lineEnds);
        // A carriage return that ends the input belongs to the comment.
        const bool isKnown = lineEnd < end && (*lineEnd == '\n' || lineEnd + 1 < end);
        return {isKnown ? lineEnd : nullptr, 0};
    }
    const std::size_t lineFeeds = lineFeedsBefore(comment, end);
    const char* stop = find(text, end, &TextMasks::commentStops);
    if (stop == text && *stop == '/') {
        stop = find(text + 1, end, &TextMasks::commentStops);
    }
    if (stop == end || *stop != '/') {
        return {nullptr, 0};
    }
    return {stop + 1, lineFeedsBefore(stop, end) - lineFeeds};
}

// A string may reach into the next blocks: `carried` has all bits then. If it reached into these,
// `open` is its quote.
const char* TextMap::findSpecial(const char* from, const char* end) {
    if (from < end && from[-1] == '\\' && (*from == '"' || *from == '\'')) {
        return from;  // escaped, say the masks, but not if a token begins here
    }
    const char* open = nullptr;
    Mask carried = 0;
    while (from < end) {
        const TextMasks* masks = &masksOf(from, end);
        const auto first = static_cast<unsigned>(from - begin_) % ByteBlock::kSize;
        const Mask ahead = ~Mask{0} << first;
        // No string is open at `from`, whatever the masks say of what stands before it.
        const Mask before = 0 - (masks->strings << 1U >> first & 1U);
        Mask strings = (masks->strings ^ carried ^ before) & ahead;
        Mask found = (masks->special & ahead & ~strings) | (masks->lineEnds & strings);
        while (found == 0) {
            carried = 0 - (strings >> (ByteBlock::kSize - 1));
            ++masks;
            strings = masks->strings ^ carried;
            found = (masks->special & ~strings) | (masks->lineEnds & strings);
        }
        const char* const block = placeOf(*masks);
        if (block < begin_ + size_) {
            const unsigned place = firstBit(found);
            const auto inString =
                static_cast<unsigned>(std::countl_one(strings << (ByteBlock::kSize - 1 - place)));
            const bool opensBefore = inString == place + 1 && carried != 0;
            // If it is in a string, at that one's quote.
            return opensBefore ? openQuote(masks, open)
                               : block + (place - std::max(inString, 1U) + 1);
        }
        if (carried != 0) {
            open = openQuote(masks, open);
        }
        from = begin_ + size_;
    }
    return carried != 0 ? open : end;
}

// Returns the quote of the string that is open before a block; `before` if that stands before all
// known blocks.
const char* TextMap::openQuote(const TextMasks* masks, const char* before) const noexcept {
    while (masks != masks_.data()) {
        --masks;
        // At the end of this block, too, the string is open.
        const bool wasOpen = masks->strings >> (ByteBlock::kSize - 1) == 0;
        const auto size =
            static_cast<unsigned>(std::countl_one(wasOpen ? ~masks->strings : masks->strings));
        if (!wasOpen || size < ByteBlock::kSize) {
            return placeOf(*masks) + (ByteBlock::kSize - size);
        }
    }
    return before;
}

// Line feeds are counted on from stretch to stretch, so that the numbers told earlier still hold.
void TextMap::cover(const char* place, const char* end) {
    if (size_ == 0) {
        begin_ = place;
        before_ = {};
        findMasks(end);
    } else if (place < begin_) {
        const auto between = static_cast<std::size_t>(std::count(place, begin_, '\n'));
        before_ = {masks_[0].lineFeedsBefore - between, false, false};
        begin_ = place;
        findMasks(end);
    }
    while (static_cast<std::size_t>(place - begin_) >= size_ && begin_ + size_ < end) {
        begin_ += size_;
        findMasks(end);
    }
}

// Finds the masks of fewer bytes than a block has; what stands behind them is not looked at.
void TextMap::findPart(const char* bytes, std::size_t size, BytesBefore& before,
                       TextMasks& masks) const {
    std::array<char, ByteBlock::kSize> part{};
    std::memcpy(part.data(), bytes, size);
    finder_.findText(part.data(), 1, before, &masks);
}

// Finds the masks from begin_ on. Of what stands behind the end they tell nothing.
void TextMap::findMasks(const char* end) {
    size_ = std::min(static_cast<std::size_t>(end - begin_), kBlocks * ByteBlock::kSize);
    const std::size_t whole = size_ / ByteBlock::kSize;
    const std::size_t rest = size_ % ByteBlock::kSize;
    if (masks_.size() < whole + 2) {
        masks_.resize(whole + 2);
    }
    TextMasks* behind = masks_.data() + whole;
    finder_.findText(begin_, whole, before_, masks_.data());
    if (rest != 0) {
        findPart(begin_ + whole * ByteBlock::kSize, rest, before_, *behind++);
    }
    known_ = static_cast<std::size_t>(behind - masks_.data());
    BytesBefore before = before_;
    const char* const next = begin_ + size_;
    findPart(next, std::min(static_cast<std::size_t>(end - next), ByteBlock::kSize), before,
             behind_);
    constexpr Mask kAll = ~Mask{0};
    *behind = {kAll, kAll, kAll, 0, kAll, kAll, before_.lineFeeds};
}

}  // namespace umpre
