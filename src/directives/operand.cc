// SPDX-License-Identifier: MIT
#include "directives/operand.h"

#include "lex/shared_text.h"

namespace umpre {

std::string gatherLine(ScannerStack& sources) {
    std::string line;
    while (!endsLine(sources.peek())) {
        line.append(sources.next().text);
    }
    return line;
}

std::string gatherUncontinuedLine(ScannerStack& sources) {
    std::string line;
    while (!endsLine(sources.peek())) {
        const Token token = sources.next();
        if (token.kind != TokenKind::CONTINUATION) {
            line.append(token.text);
        }
    }
    return line;
}

// The expansion is lexed anew as one text: what came from different macros may meet in one token.
ExpandedOperand::ExpandedOperand(ScannerStack& sources, MacroExpander& expander, TextLexer& lexer,
                                 std::string_view text, LineKind kind)
    : sources_(sources) {
    sources_.isolate(TextSlice::whole(lexer.lexed(expander.expandLine(text, kind))), {});
}

}  // namespace umpre
