// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_CPP_LEXER_H
#define UMPRE_LEX_CPP_LEXER_H

#include <cstddef>
#include <cstdint>
#include <string_view>

#ifndef yyFlexLexerOnce
#define yyFlexLexer yyCppFlexLexer
#include <FlexLexer.h>
#endif

#include "lex/comment_sink.h"
#include "lex/input_buffer.h"
#include "lex/literal.h"
#include "lex/run_options.h"
#include "lex/text_map.h"
#include "lex/token.h"

namespace umpre {

/// The scanner: turns bytes into tokens and counts lines. It reads in place, over memory that
/// somebody else owns and that must be writable: a byte is set to zero while a token is matched.
/// The rules stand in cpp_lexer.l.
class CppLexer final : public yyCppFlexLexer {
public:
    explicit CppLexer(CommentSink& commentSink, const RunOptions& options = {});

    /// Reads an input from its beginning, from line 1. The input is borrowed.
    void read(InputBuffer& input);
    /// Scans a text that ends at `end`, where two zero bytes stand. The text is borrowed.
    void scan(char* begin, char* end);

    /// Returns the next token; at the end, END_OF_INPUT however often it is asked. Its text is
    /// valid until the next call. Throws ScannerFailure if the input cannot be read.
    [[nodiscard]] Token lex();

    /// Returns the number of the line that the next token begins on.
    [[nodiscard]] std::int32_t line() const noexcept { return line_; }

    void setLine(std::int32_t line) noexcept { line_ = line; }

    /// For readers of bytes: what lies ahead in memory, up to a place where a token begins; empty
    /// at the end of input. 64 bytes behind it and 8 before it can be read.
    [[nodiscard]] std::string_view bytesAhead();
    /// Returns the whole lines among the bytes ahead; at the end of input, all of them.
    [[nodiscard]] std::string_view wholeLines();

    /// Returns the size of the literal that the quote at this place of `wholeLines()` opens, or 0
    /// if its line does not close it; the quote is then a token by itself.
    [[nodiscard]] std::size_t literalSize(const char* quote);

    /// Returns the finder of literals among the bytes ahead.
    [[nodiscard]] LiteralFinder& literals() noexcept { return literals_; }

    /// Returns the map of the bytes ahead.
    [[nodiscard]] TextMap& textMap() noexcept { return textMap_; }

    /// Passes over bytes ahead, up to the beginning of a token, `lines` line ends among them.
    void advance(std::size_t bytes, std::size_t lines);

private:
    // Generated.
    int yylex() override;
    void LexerError(const char* message) override;

    // The actions of the rules.
    [[nodiscard]] TokenKind lineEnd();
    [[nodiscard]] TokenKind continuation();
    [[nodiscard]] TokenKind blockComment();
    [[nodiscard]] char* behindCarriageReturn(char* at);
    [[nodiscard]] bool passOnLineEnds(std::size_t& count);
    [[nodiscard]] TokenKind lineComment();

    void install(char* begin, char* end);
    void moveTo(char* position) noexcept;
    [[nodiscard]] bool refill(char* position, InputBuffer::Need need);
    [[nodiscard]] bool readOn(char*& position, InputBuffer::Need need);
    [[nodiscard]] Token take(const Token& token);
    [[nodiscard]] Token quoted();

    CommentSink& commentSink_;
    InputBuffer* input_ = nullptr;  // null while a text is scanned
    char* end_ = nullptr;           // of the bytes in memory
    char* limit_ = nullptr;         // of what can be scanned of them
    LiteralFinder literals_;
    TextMap textMap_;
    bool plainRoad_;
    std::int32_t line_ = 1;
};

}  // namespace umpre

#endif
