// SPDX-License-Identifier: MIT
#include "lex/plain_text.h"

#include "lex/literal.h"
#include "lex/spelling.h"

namespace umpre {

const char* unusualTokenEnd(const char* at, const char* end) noexcept {
    switch (*at) {
    case '\n':
    case '\r':
    case '\0': return nullptr;
    case '\\': return isLineEndByte(at[1]) ? nullptr : at + 1;
    case '/': return isCommentSign(at[1]) ? nullptr : at + 1;
    case '"':
    case '\'': {
        const LiteralScan literal = scanLiteral(at, end);
        return literal.result == LiteralScan::Result::Closed ? literal.end : nullptr;
    }
    default: return isDigit(*at) ? at + numberAt(at).text.size() : at + 1;
    }
}

}  // namespace umpre
