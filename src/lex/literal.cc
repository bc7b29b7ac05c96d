// SPDX-License-Identifier: MIT
#include "lex/literal.h"

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
        const ByteBlock::Mask stops = ByteBlock::between(at, end).any(quote, '\\', '\n');
        if (stops == 0) {
            at += ByteBlock::kSize;
            continue;
        }
        at += firstBit(stops);
        if (*at == quote) {
            return {Result::Closed, at + 1};
        }
        if (*at == '\n') {
            return {Result::Open, at};
        }
        if (at + 1 >= end) {
            return {Result::Cut, at};
        }
        if (isLineEndByte(at[1])) {
            return {Result::Open, at};
        }
        at += 2;
    }
    return {Result::Cut, end};
}

}  // namespace umpre
