// SPDX-License-Identifier: MIT
#include "lex/line_beginning.h"

#include <algorithm>

#include "lex/byte_block.h"
#include "lex/spelling.h"

namespace umpre {

const char* blanksEnd(const char* at, const char* end) noexcept {
    using Block = BasicByteBlock<BaseVector, 16>;
    for (; at < end; at += Block::kSize) {
        const auto others = ~Block(at).any(' ', '\t', '\v', '\f') & bitsBelow(Block::kSize);
        if (others != 0) {
            return std::min(at + firstBit(others), end);
        }
    }
    return end;
}

LineBeginning lineBeginning(const char* behindBlanks, TextPass& pass) {
    const char* const end = pass.end();
    LineBeginning beginning;
    const char* next = behindBlanks;
    while (beginsComment(next, end)) {
        const TextMap::Comment comment = pass.commentAt(next);
        if (comment.end == nullptr) {
            return {};
        }
        beginning.hasComments = true;
        beginning.commentLines += comment.lineFeeds;
        next = *comment.end == '\n' ? comment.end : blanksEnd(comment.end, end);
    }
    const bool isContinuation = next < end && *next == '\\' && isLineEndByte(next[1]);
    beginning.first = isContinuation ? nullptr : next;
    return beginning;
}

}  // namespace umpre
