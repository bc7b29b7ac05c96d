// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_LEXEME_H
#define UMPRE_TESTS_UNIT_SUPPORT_LEXEME_H

#include <cstddef>
#include <ostream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "lex/lexed_text.h"
#include "lex/token.h"

namespace umpre {

inline void PrintTo(TokenKind kind, std::ostream* out) {
    const auto code = static_cast<int>(kind);
    if (code > ' ' && code < 127) {
        *out << "'" << static_cast<char>(code) << "'";
    } else {
        *out << "kind " << code;
    }
}

namespace testing {

/// A token that owns its text.
struct Lexeme {
    TokenKind kind;
    std::string text;

    friend bool operator==(const Lexeme&, const Lexeme&) = default;

    friend void PrintTo(const Lexeme& lexeme, std::ostream* out) {
        PrintTo(lexeme.kind, out);
        *out << " " << ::testing::PrintToString(lexeme.text);
    }
};

using Lexemes = std::vector<Lexeme>;

[[nodiscard]] inline Lexeme lexemeOf(const Token& token) {
    return {token.kind, std::string(token.text)};
}

/// Returns the tokens of a text that was lexed.
[[nodiscard]] inline Lexemes lexemesOf(const LexedText& text) {
    Lexemes lexemes;
    for (std::size_t index = 0; index < text.size(); ++index) {
        lexemes.push_back({text.kind(index), std::string(text.text(index))});
    }
    return lexemes;
}

/// Returns all tokens of a source, up to and without its END_OF_INPUT.
template <typename Source>
[[nodiscard]] Lexemes readLexemes(Source& source) {
    Lexemes lexemes;
    for (Token token = source.next(); token.kind != TokenKind::END_OF_INPUT;
         token = source.next()) {
        lexemes.push_back(lexemeOf(token));
    }
    return lexemes;
}

/// Returns the texts of all tokens that are left in a source, joined.
template <typename Source>
[[nodiscard]] std::string readText(Source& source) {
    std::string text;
    for (Token token = source.next(); token.kind != TokenKind::END_OF_INPUT;
         token = source.next()) {
        text.append(token.text);
    }
    return text;
}

}  // namespace testing
}  // namespace umpre

#endif
