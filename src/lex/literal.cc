// SPDX-License-Identifier: MIT
#include "lex/literal.h"

#include <algorithm>
#include <optional>

#include "lex/byte_block.h"
#include "lex/spelling.h"

namespace umpre {

using Result = LiteralScan::Result;

namespace {

// Tells what a quote, a line feed or a backslash in a literal ends; nothing if the literal goes on
// behind the backslash and what follows it.
[[nodiscard]] std::optional<LiteralScan> scanEndingAt(const char* stop, char quote,
                                                      const char* end) noexcept {
    if (*stop == quote) {
        return LiteralScan{Result::Closed, stop + 1};
    }
    if (*stop == '\n') {
        return LiteralScan{Result::Open, stop};
    }
    if (stop + 1 >= end) {
        return LiteralScan{Result::Cut, stop};
    }
    if (isLineEndByte(stop[1])) {
        return LiteralScan{Result::Open, stop};
    }
    return std::nullopt;
}

}  // namespace

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
            if (const std::optional<LiteralScan> scan = scanEndingAt(stop, quote, end)) {
                return *scan;
            }
            stops &= ~(Block::Mask{3} << place);
            at = std::max(at, stop + 2);
        }
    }
    return {Result::Cut, end};
}

}  // namespace umpre
