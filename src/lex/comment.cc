// SPDX-License-Identifier: MIT
#include "lex/comment.h"

#include "lex/byte_block.h"

namespace umpre {

using Stop = CommentScan::Stop;

CommentScan scanBlockComment(const char* begin, const char* end) noexcept {
    const char* at = begin;
    // Behind "*", for the next block; a slash there closes the comment.
    ByteBlock::Mask behindStar = 0;
    std::size_t lineFeeds = 0;
    while (at < end) {
        const ByteBlock block = ByteBlock::between(at, end);
        const ByteBlock::Mask stars = block.any('*');
        const ByteBlock::Mask closing = block.any('/') & (stars << 1U | behindStar);
        const ByteBlock::Mask stops = closing | block.any('\r');
        const ByteBlock::Mask feeds = block.any('\n');
        if (stops != 0) {
            const unsigned stop = firstBit(stops);
            lineFeeds += countBits(feeds & bitsBelow(stop));
            if ((closing >> stop & 1U) != 0) {
                return {Stop::Closed, at + stop + 1, lineFeeds};
            }
            return {Stop::CarriageReturn, at + stop, lineFeeds};
        }
        lineFeeds += countBits(feeds);
        behindStar = stars >> (ByteBlock::kSize - 1);
        at += ByteBlock::kSize;
    }
    const bool cutsPair = end > begin && end[-1] == '*';
    return {Stop::Cut, cutsPair ? end - 1 : end, lineFeeds};
}

const char* findLineEnd(const char* at, const char* end) noexcept {
    for (; at < end; at += ByteBlock::kSize) {
        const ByteBlock::Mask lineEnds = ByteBlock::between(at, end).any('\n', '\r');
        if (lineEnds != 0) {
            return at + firstBit(lineEnds);
        }
    }
    return end;
}

}  // namespace umpre
