// SPDX-License-Identifier: MIT
#include "lex/literal.h"

#include <algorithm>

#include "lex/byte_block.h"
#include "lex/spelling.h"

namespace umpre {

using Result = LiteralScan::Result;

LiteralScan scanLiteral(const char* at, const char* end) noexcept {
    using Block = BasicByteBlock<BaseVector, 32>;
    const char quote = *at++;
    if (quote == '\'' && at < end && *at == quote) {
        return {Result::Open, at};
    }
    while (at < end) {
        const char* const block = at;
        Block::Mask stops = Block::between(block, end).any(quote, '\\', '\n');
        at += Block::kSize;
        while (stops != 0) {
            const unsigned place = firstBit(stops);
            const char* const stop = block + place;
            if (*stop == quote) {
                return {Result::Closed, stop + 1};
            }
            if (*stop == '\n' || (stop + 1 < end && isLineEndByte(stop[1]))) {
                return {Result::Open, stop};
            }
            if (stop + 1 >= end) {
                return {Result::Cut, stop};
            }
            stops &= ~(Block::Mask{3} << place);
            at = std::max(at, stop + 2);
        }
    }
    return {Result::Cut, end};
}

}  // namespace umpre
