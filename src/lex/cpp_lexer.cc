// SPDX-License-Identifier: MIT
//
// The hand-written half of the scanner: where it reads, and what its rules do. The generated half
// keeps its place in `yy_c_buf_p` and zeroes the byte there while it works; `yy_hold_char` is that
// byte. Between calls the byte is put back, so that others may read the same memory.
#include "lex/cpp_lexer.h"

#include <array>
#include <cassert>
#include <utility>

#include "lex/comment.h"
#include "lex/literal.h"
#include "lex/source_position.h"
#include "lex/spelling.h"

namespace umpre {

using Need = InputBuffer::Need;

namespace {

// The text of every comment's token; the generated scanner wants a pointer to non-const.
std::array<char, 2> blank{' ', '\0'};

// What a token's first byte tells of it. The generated scanner is for comments, continuations, line
// ends and zero bytes.
enum class Beginning : std::uint8_t { Other, Spelled, Blank, Quote };

constexpr std::array<Beginning, 256> kBeginnings = [] {
    std::array<Beginning, 256> beginnings{};
    beginnings.fill(Beginning::Spelled);
    const auto set = [&beginnings](std::string_view bytes, Beginning as) {
        for (const char byte : bytes) {
            beginnings[static_cast<unsigned char>(byte)] = as;
        }
    };
    set(" \t\v\f", Beginning::Blank);
    set("\"'", Beginning::Quote);
    set({"/\\\r\n\0", 5}, Beginning::Other);
    return beginnings;
}();

}  // namespace

// cppcheck-suppress uninitMemberVar ; the text map says itself what it knows
CppLexer::CppLexer(CommentSink& commentSink, const RunOptions& options)
    : commentSink_(commentSink), plainRoad_(options.plainRoad) {
    // As after the first call of the generated half, which would go back to the buffer's beginning.
    yy_init = 1;
    yy_start = 1;
}

void CppLexer::read(InputBuffer& input) {
    input_ = &input;
    line_ = 1;
    yy_c_buf_p = limit_ = input.begin();  // the first call of `lex` reads the first window
}

void CppLexer::scan(char* begin, char* end) {
    input_ = nullptr;
    line_ = 1;
    limit_ = end;
    install(begin, end);
}

bool CppLexer::refill(char* position, InputBuffer::Need need) {
    if (input_ == nullptr) {
        return false;
    }
    const bool more = input_->refill(position, need);
    install(input_->begin(), input_->end());
    limit_ = input_->limit();
    return more;
}

// Reads more of the input, behind what `position` and its followers are. Returns false if there is
// no more.
bool CppLexer::readOn(char*& position, InputBuffer::Need need) {
    if (input_ == nullptr || input_->isEnded()) {
        return false;
    }
    (void)refill(position, need);
    position = yy_c_buf_p;
    return true;
}

void CppLexer::moveTo(char* position) noexcept {
    yy_c_buf_p = position;
    yy_hold_char = *position;
}

Token CppLexer::lex() {
    if (yy_c_buf_p >= limit_ && !refill(yy_c_buf_p, Need::Tokens)) {
        return {};
    }
    if (!plainRoad_) {
        switch (kBeginnings[static_cast<unsigned char>(yy_hold_char)]) {
        case Beginning::Spelled: return take(tokenAt(yy_c_buf_p));
        case Beginning::Blank: return take({TokenKind::WHITESPACE, {yy_c_buf_p, 1}});
        case Beginning::Quote: return quoted();
        case Beginning::Other: break;
        }
    }
    const auto kind = static_cast<TokenKind>(yylex());
    *yy_c_buf_p = yy_hold_char;
    switch (kind) {
    case TokenKind::NEWLINE: return {kind, "\n"};
    case TokenKind::WHITESPACE: return {kind, {yytext, 1}};
    default: return {kind, {yytext, static_cast<std::size_t>(yy_c_buf_p - yytext)}};
    }
}

Token CppLexer::take(const Token& token) {
    moveTo(yy_c_buf_p + token.text.size());
    return token;
}

// The two literal rules, by hand: the generated scanner starts a long literal anew at each zero
// byte in it, and tries each quote of a line of unclosed quotes up to the line's end.
Token CppLexer::quoted() {
    using Result = LiteralScan::Result;
    LiteralScan literal{};
    do {
        const bool isLast = input_ == nullptr || input_->isEnded();
        literal = literals_.find(yy_c_buf_p, end_, isLast);
    } while (literal.result == Result::Cut && readOn(yy_c_buf_p, Need::Double));
    char* const begin = yy_c_buf_p;
    if (literal.result != Result::Closed) {
        moveTo(begin + 1);
        return {TokenKind::OTHER, {begin, 1}};
    }
    const auto size = static_cast<std::size_t>(literal.end - begin);
    moveTo(begin + size);
    return {*begin == '"' ? TokenKind::STRING_LITERAL : TokenKind::CHAR_LITERAL, {begin, size}};
}

std::string_view CppLexer::bytesAhead() {
    if (yy_c_buf_p >= limit_ && !refill(yy_c_buf_p, Need::Tokens)) {
        return {};
    }
    return {yy_c_buf_p, static_cast<std::size_t>(limit_ - yy_c_buf_p)};
}

std::string_view CppLexer::wholeLines() {
    const std::string_view ahead = bytesAhead();
    const bool isWhole = input_ == nullptr || input_->isEnded();
    // Limits stand within a line only if no line ends before them.
    return isWhole || (!ahead.empty() && ahead.back() == '\n') ? ahead : std::string_view{};
}

std::size_t CppLexer::literalSize(const char* quote) {
    const LiteralScan literal = literals_.find(quote, end_, false);
    return literal.result == LiteralScan::Result::Closed
               ? static_cast<std::size_t>(literal.end - quote)
               : 0;
}

void CppLexer::advance(std::size_t bytes, std::size_t lines) {
    assert(bytes <= static_cast<std::size_t>(limit_ - yy_c_buf_p));
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
    using Stop = CommentScan::Stop;
    *yy_c_buf_p = yy_hold_char;
    char* at = yy_c_buf_p;
    std::size_t lineEnds = 0;
    bool isWanted = true;
    // A comment may have no end, as its input may; its line ends do not wait for it.
    const auto goesOn = [&] {
        isWanted = passOnLineEnds(lineEnds);
        return isWanted && readOn(at, Need::Bytes);
    };
    CommentScan scan{};
    do {
        scan = scanBlockComment(at, end_);
        at += scan.at - at;
        lineEnds += scan.lineFeeds;
        if (scan.stop == Stop::CarriageReturn) {
            ++lineEnds;
            at = behindCarriageReturn(at);
        }
    } while (scan.stop == Stop::CarriageReturn || (scan.stop == Stop::Cut && goesOn()));
    moveTo(scan.stop == Stop::Closed ? at : end_);
    yytext = blank.data();
    isWanted = passOnLineEnds(lineEnds) && isWanted;
    if (scan.stop != Stop::Closed && isWanted) {
        commentSink_.unterminatedComment(line_);
    }
    return TokenKind::WHITESPACE;
}

// Returns where a line end ends that begins with a carriage return.
char* CppLexer::behindCarriageReturn(char* at) {
    if (at + 1 == end_) {
        (void)readOn(at, Need::Bytes);
    }
    return at + (at[1] == '\n' ? 2 : 1);
}

// Counts the line ends that were read in a comment, and begins a new count. Returns false if nobody
// wants more of it.
bool CppLexer::passOnLineEnds(std::size_t& count) {
    const std::size_t passed = std::exchange(count, 0);
    line_ = addLines(line_, passed);
    return passed == 0 || commentSink_.commentLineEnds(passed);
}

TokenKind CppLexer::lineComment() {
    *yy_c_buf_p = yy_hold_char;
    char* at = yy_c_buf_p;
    const auto isKnown = [&] { return at != end_ && (*at == '\n' || at + 1 != end_); };
    do {
        at += findLineEnd(at, end_) - at;
    } while (!isKnown() && readOn(at, Need::Bytes));
    if (!isKnown()) {
        at = end_;  // a carriage return that ends the input ends no line
    }
    moveTo(at);
    yytext = blank.data();
    return TokenKind::WHITESPACE;
}

}  // namespace umpre
