// SPDX-License-Identifier: MIT
#include "lex/literal.h"

#include <algorithm>
#include <cstddef>

#include "lex/byte_block.h"
#include "lex/spelling.h"

namespace umpre {

using Result = LiteralScan::Result;

LiteralScan scanLiteral(const char* at, const char* end) noexcept {
    const char quote = *at++;
    if (quote == '\'' && at < end && *at == quote) {
        return {Result::Open, at};
    }
    while (at < end) {
        const char* const block = at;
        ByteBlock::Mask stops = ByteBlock::between(block, end).any(quote, '\\', '\n');
        at += ByteBlock::kSize;
        while (stops != 0) {
            const char* const stop = block + firstBit(stops);
            if (*stop == quote) {
                return {Result::Closed, stop + 1};
            }
            if (*stop == '\n') {
                return {Result::Open, stop};
            }
            if (stop + 1 >= end) {
                return {Result::Cut, stop};
            }
            if (isLineEndByte(stop[1])) {
                return {Result::Open, stop};
            }
            const char* const behind = stop + 2;
            at = std::max(at, behind);
            stops &= ~bitsBelow(static_cast<std::size_t>(behind - block));
        }
    }
    return {Result::Cut, end};
}

}  // namespace umpre
