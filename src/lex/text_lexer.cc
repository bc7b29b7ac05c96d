// SPDX-License-Identifier: MIT
#include "lex/text_lexer.h"

namespace umpre {

void TextLexer::append(LexedText& to, std::string_view text) {
    const bool isAll = to.size() == 0;
    to_ = &to;
    memory_.assign(text);
    memory_.append(2, '\0');
    lexer_.scan(memory_.data(), memory_.data() + text.size());
    for (Token token = lexer_.lex(); token.kind != TokenKind::END_OF_INPUT; token = lexer_.lex()) {
        to.append(token.kind, token.text);
    }
    if (isAll) {
        to.noteLexedAsOne();
    }
}

bool TextLexer::commentLineEnds(std::size_t count) {
    to_->addCommentEffect(count, false, 0);
    return true;
}

void TextLexer::unterminatedComment(std::int32_t line) {
    to_->addCommentEffect(0, true, line);
}

}  // namespace umpre
