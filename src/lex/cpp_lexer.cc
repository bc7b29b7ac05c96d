// SPDX-License-Identifier: MIT
//
// The hand-written half of the scanner: where it reads, and what its rules do. The generated half
// keeps its place in `yy_c_buf_p` and zeroes the byte there while it works; `yy_hold_char` is that
// byte. Between calls the byte is put back, so that others may read the same memory.
#include "lex/cpp_lexer.h"

#include <array>
#include <cassert>

#include "lex/literal.h"
#include "lex/source_position.h"

namespace umpre {
namespace {

// The text of every comment's token; the generated scanner wants a pointer to non-const.
std::array<char, 2> blank{' ', '\0'};

[[nodiscard]] bool isLineEnd(char byte) noexcept {
    return byte == '\n' || byte == '\r';
}

}  // namespace

CppLexer::CppLexer(CommentSink& commentSink, const RunOptions& options)
    : commentSink_(commentSink), plainRoad_(options.plainRoad) {
    // As after the first call of the generated half, which would go back to the buffer's beginning.
    yy_init = 1;
    yy_start = 1;
}

void CppLexer::read(InputBuffer& input) {
    input_ = &input;
    line_ = 1;
    yy_c_buf_p = lineLimit_ = input.begin();  // the first call of `lex` reads the first window
}

void CppLexer::scan(char* begin, char* end) {
    input_ = nullptr;
    line_ = 1;
    lineLimit_ = end;
    install(begin, end);
}

bool CppLexer::refill(char* position, InputBuffer::Need need) {
    if (input_ == nullptr) {
        return false;
    }
    const bool more = input_->refill(position, need);
    install(input_->begin(), input_->end());
    lineLimit_ = input_->lineLimit();
    return more;
}

void CppLexer::moveTo(char* position) noexcept {
    yy_c_buf_p = position;
    yy_hold_char = *position;
}

Token CppLexer::lex() {
    if (yy_c_buf_p >= lineLimit_ && !refill(yy_c_buf_p, InputBuffer::Need::Line)) {
        return {};
    }
    if (!plainRoad_ && (yy_hold_char == '"' || yy_hold_char == '\'')) {
        return quoted();
    }
    const auto kind = static_cast<TokenKind>(yylex());
    *yy_c_buf_p = yy_hold_char;
    switch (kind) {
    case TokenKind::NEWLINE: return {kind, "\n"};
    case TokenKind::WHITESPACE: return {kind, {yytext, 1}};
    default: return {kind, {yytext, static_cast<std::size_t>(yy_c_buf_p - yytext)}};
    }
}

// The two literal rules, by hand: the generated scanner starts a long literal anew at each zero
// byte in it, and tries each quote of a line of unclosed quotes up to the line's end. That a quote
// is unclosed is found only once: a later quote of that kind before the same line end was passed by
// the first attempt as half of an escaped pair, so its own attempt would go the same way.
std::size_t CppLexer::literalSize(const char* quote) {
    Unclosed& unclosed = *quote == '"' ? unclosedStrings_ : unclosedCharacters_;
    if (quote >= unclosed.begin && quote < unclosed.end) {
        return 0;
    }
    const LiteralScan literal = scanLiteral(quote, end_);
    if (!literal.isClosed) {
        unclosed = {quote, literal.end};
        return 0;
    }
    return static_cast<std::size_t>(literal.end - quote);
}

Token CppLexer::quoted() {
    char* const begin = yy_c_buf_p;
    const std::size_t size = literalSize(begin);
    if (size == 0) {
        moveTo(begin + 1);
        return {TokenKind::OTHER, {begin, 1}};
    }
    moveTo(begin + size);
    return {*begin == '"' ? TokenKind::STRING_LITERAL : TokenKind::CHAR_LITERAL, {begin, size}};
}

std::string_view CppLexer::wholeLines() {
    if (yy_c_buf_p >= lineLimit_ && !refill(yy_c_buf_p, InputBuffer::Need::Line)) {
        return {};
    }
    return {yy_c_buf_p, static_cast<std::size_t>(lineLimit_ - yy_c_buf_p)};
}

void CppLexer::advance(std::size_t bytes, std::size_t lines) {
    assert(bytes <= static_cast<std::size_t>(lineLimit_ - yy_c_buf_p));
    moveTo(yy_c_buf_p + bytes);
    line_ = addLines(line_, lines);
}

TokenKind CppLexer::lineEnd() {
    line_ = addLines(line_, 1);
    return TokenKind::NEWLINE;
}

TokenKind CppLexer::continuation() {
    line_ = addLines(line_, 1);
    return TokenKind::CONTINUATION;
}

TokenKind CppLexer::blockComment() {
    *yy_c_buf_p = yy_hold_char;
    char* at = yy_c_buf_p;
    std::size_t lineEnds = 0;
    bool star = false;
    bool closed = false;
    // To the next byte, or false at the end of the input; reading on moves the bytes.
    const auto more = [&] {
        if (at == end_ && input_ != nullptr) {
            (void)refill(at, InputBuffer::Need::Bytes);
            at = yy_c_buf_p;
        }
        return at != end_;
    };
    while (!closed && more()) {
        const char byte = *at++;
        if (isLineEnd(byte)) {
            if (byte == '\r' && more() && *at == '\n') {
                ++at;
            }
            ++lineEnds;
        }
        closed = star && byte == '/';
        star = byte == '*';
    }
    moveTo(at);
    yytext = blank.data();
    line_ = addLines(line_, lineEnds);
    if (lineEnds > 0) {
        commentSink_.commentLineEnds(lineEnds);
    }
    if (!closed) {
        commentSink_.unterminatedComment(line_);
    }
    return TokenKind::WHITESPACE;
}

TokenKind CppLexer::lineComment() {
    *yy_c_buf_p = yy_hold_char;
    char* at = yy_c_buf_p;
    while (at < end_ && !isLineEnd(*at)) {
        ++at;
    }
    if (at + 1 == end_ && *at == '\r') {
        ++at;  // a carriage return that ends the input ends no line
    }
    moveTo(at);
    yytext = blank.data();
    return TokenKind::WHITESPACE;
}

}  // namespace umpre
