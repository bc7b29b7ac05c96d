// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TOKEN_H
#define UMPRE_LEX_TOKEN_H

#include <cstdint>
#include <string_view>

namespace umpre {

struct Name;

/// What a token is. A punctuator of one character has that character's code; the named kinds start
/// at 257. The directive words keep their own kinds wherever they stand.
enum class TokenKind : std::int32_t {
    END_OF_INPUT = 0,
    BANG = '!',
    HASH = '#',
    PERCENT = '%',
    AMPERSAND = '&',
    LEFT_PARENTHESIS = '(',
    RIGHT_PARENTHESIS = ')',
    STAR = '*',
    PLUS = '+',
    COMMA = ',',
    MINUS = '-',
    SLASH = '/',
    COLON = ':',
    LESS = '<',
    GREATER = '>',
    QUESTION = '?',
    CARET = '^',
    BAR = '|',
    TILDE = '~',
    NEWLINE = 257,       ///< a line end of any form; its text is one line feed
    WHITESPACE = 258,    ///< one blank character, or a whole comment as one space
    CONTINUATION = 259,  ///< a backslash and the line end behind it, as they stood
    PASTE = 260,         ///< "##"
    KW_IF = 261,
    KW_IFDEF = 262,
    KW_IFNDEF = 263,
    KW_ELSE = 264,
    KW_ELIF = 265,
    KW_ENDIF = 266,
    KW_INCLUDE = 267,
    KW_DEFINE = 268,
    KW_UNDEF = 269,
    KW_LINE = 270,
    KW_ERROR = 271,
    KW_PRAGMA = 272,
    KW_IDENT = 273,
    IDENTIFIER = 274,
    STRING_LITERAL = 275,
    OTHER = 276,  ///< any single character that no other kind covers
    OROR = 277,
    ANDAND = 278,
    EQ = 279,
    NE = 280,
    LE = 281,
    GE = 282,
    LSHIFT = 283,
    RSHIFT = 284,
    KW_DEFINED = 285,
    CHAR_LITERAL = 286,
    INT_DEC = 287,
    INT_OCT = 288,
    INT_HEX = 289,
    UINT_DEC = 290,
    UINT_OCT = 291,
    UINT_HEX = 292,
};

/// A kind and the exact characters matched. The text is borrowed from the source that the token was
/// read from and dies with the next token read there.
struct Token {
    TokenKind kind = TokenKind::END_OF_INPUT;
    std::string_view text;
    /// The entry of a name, if its source knows it.
    Name* name = nullptr;
};

/// Tells whether a token may name a macro: an identifier or a directive word, but not `defined`.
[[nodiscard]] constexpr bool isName(TokenKind kind) noexcept {
    return kind >= TokenKind::KW_IF && kind <= TokenKind::IDENTIFIER;
}

/// Tells whether a token separates others within a line.
[[nodiscard]] constexpr bool isBlank(TokenKind kind) noexcept {
    return kind == TokenKind::WHITESPACE || kind == TokenKind::CONTINUATION;
}

/// Tells whether a token separates others where line ends do not matter.
[[nodiscard]] constexpr bool isBlankOrNewline(TokenKind kind) noexcept {
    return kind >= TokenKind::NEWLINE && kind <= TokenKind::CONTINUATION;
}

/// Tells whether a token ends a directive line.
[[nodiscard]] constexpr bool endsLine(TokenKind kind) noexcept {
    return kind == TokenKind::NEWLINE || kind == TokenKind::END_OF_INPUT;
}

}  // namespace umpre

#endif
