// SPDX-License-Identifier: MIT
#include "token_rules.h"

#include <algorithm>
#include <array>
#include <utility>

namespace umpre::fuzz {

using enum TokenKind;

namespace {

constexpr std::string_view kDigits = "0123456789";
constexpr std::string_view kLetters = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz_";
constexpr std::string_view kHexDigits = "0123456789ABCDEFabcdef";

// Returns how many bytes at the beginning of the text are among these.
[[nodiscard]] std::size_t run(std::string_view text, std::string_view of) {
    return std::min(text.find_first_not_of(of), text.size());
}

[[nodiscard]] bool isOneOf(std::string_view text, std::size_t at, std::string_view of) {
    return at < text.size() && of.find(text[at]) != std::string_view::npos;
}

// The size of an identifier, or 0.
[[nodiscard]] std::size_t name(std::string_view text) {
    return run(text.substr(0, 1), kLetters) == 0 ? 0
                                                 : run(text, std::string(kLetters).append(kDigits));
}

// The size of a literal between two of these quotes, or 0.
[[nodiscard]] std::size_t literal(std::string_view text, char quote, std::size_t leastItems) {
    if (text.front() != quote) {
        return 0;
    }
    std::size_t at = 1;
    for (std::size_t items = 0; at < text.size(); ++items) {
        if (text[at] == quote) {
            return items >= leastItems ? at + 1 : 0;
        }
        if (text[at] == '\n') {
            return 0;
        }
        if (text[at] == '\\') {
            ++at;
            if (at == text.size() || isOneOf(text, at, "\r\n")) {
                return 0;
            }
        }
        ++at;
    }
    return 0;
}

enum class Base { Decimal, Octal, Hexadecimal };

[[nodiscard]] std::size_t digits(std::string_view text, Base base) {
    if (base == Base::Decimal) {
        return isOneOf(text, 0, "123456789") ? run(text, kDigits) : 0;
    }
    if (text.front() != '0') {
        return 0;
    }
    if (base == Base::Octal) {
        return 1 + run(text.substr(1), "01234567");
    }
    const std::size_t size = isOneOf(text, 1, "xX") ? run(text.substr(2), kHexDigits) : 0;
    return size == 0 ? 0 : 2 + size;
}

[[nodiscard]] std::size_t signedNumber(std::string_view text, Base base) {
    const std::size_t size = digits(text, base);
    return size != 0 && isOneOf(text, size, "lL") ? size + 1 : size;
}

[[nodiscard]] std::size_t unsignedNumber(std::string_view text, Base base) {
    const std::size_t size = digits(text, base);
    if (size == 0) {
        return 0;
    }
    if (isOneOf(text, size, "uU")) {
        return size + (isOneOf(text, size + 1, "lL") ? 2 : 1);
    }
    return isOneOf(text, size, "lL") && isOneOf(text, size + 1, "uU") ? size + 2 : 0;
}

struct Word {
    std::string_view spelling;
    TokenKind kind;
};

constexpr auto kWords = std::to_array<Word>({
    {"##", PASTE},
    {"||", OROR},
    {"&&", ANDAND},
    {"==", EQ},
    {"!=", NE},
    {"<=", LE},
    {">=", GE},
    {"<<", LSHIFT},
    {">>", RSHIFT},
    {"defined", KW_DEFINED},
    {"if", KW_IF},
    {"ifdef", KW_IFDEF},
    {"ifndef", KW_IFNDEF},
    {"else", KW_ELSE},
    {"elif", KW_ELIF},
    {"endif", KW_ENDIF},
    {"include", KW_INCLUDE},
    {"define", KW_DEFINE},
    {"undef", KW_UNDEF},
    {"line", KW_LINE},
    {"error", KW_ERROR},
    {"pragma", KW_PRAGMA},
    {"ident", KW_IDENT},
});

// The longest match so far.
struct Match {
    TokenKind kind = OTHER;
    std::size_t size = 0;

    void offer(TokenKind otherKind, std::size_t otherSize) {
        if (otherSize > size) {
            *this = {otherKind, otherSize};
        }
    }
};

[[nodiscard]] Match longestMatch(std::string_view text) {
    Match match;
    if (isOneOf(text, 0, "#(),?:|^&<>+-*/%!~")) {
        match.offer(static_cast<TokenKind>(text.front()), 1);
    }
    for (const Word& word : kWords) {
        match.offer(word.kind, text.starts_with(word.spelling) ? word.spelling.size() : 0);
    }
    match.offer(STRING_LITERAL, literal(text, '"', 0));
    match.offer(CHAR_LITERAL, literal(text, '\'', 1));
    match.offer(IDENTIFIER, name(text));
    match.offer(INT_DEC, signedNumber(text, Base::Decimal));
    match.offer(INT_OCT, signedNumber(text, Base::Octal));
    match.offer(INT_HEX, signedNumber(text, Base::Hexadecimal));
    match.offer(UINT_DEC, unsignedNumber(text, Base::Decimal));
    match.offer(UINT_OCT, unsignedNumber(text, Base::Octal));
    match.offer(UINT_HEX, unsignedNumber(text, Base::Hexadecimal));
    match.offer(OTHER, 1);
    return match;
}

// Returns the size of a line end at the beginning of the text, or 0.
[[nodiscard]] std::size_t lineEnd(std::string_view text) {
    if (text.starts_with("\r\n")) {
        return 2;
    }
    return text.starts_with("\n") || text.starts_with("\r") ? 1 : 0;
}

[[nodiscard]] RuledToken blockComment(std::string_view text) {
    const std::size_t close = text.find("*/", 2);
    RuledToken token{WHITESPACE, " ", close, 0, true, false};
    if (close == std::string_view::npos) {
        token.size = text.size();
        token.isUnterminated = true;
    } else {
        token.size += 2;
    }
    for (std::size_t at = 0; at < token.size; ++at) {
        const std::size_t size = lineEnd(text.substr(0, token.size).substr(at));
        token.lineEnds += size > 0 ? 1 : 0;
        at += size > 0 ? size - 1 : 0;
    }
    return token;
}

[[nodiscard]] RuledToken lineComment(std::string_view text) {
    std::size_t size = std::min(text.find_first_of("\r\n"), text.size());
    if (text.substr(size) == "\r") {
        ++size;  // nothing follows that it could end a line before
    }
    return {WHITESPACE, " ", size, 0, true, false};
}

}  // namespace

RuledToken firstToken(std::string_view text) {
    if (text.starts_with("/*")) {
        return blockComment(text);
    }
    if (text.starts_with("//")) {
        return lineComment(text);
    }
    if (const std::size_t size = lineEnd(text); size > 0) {
        return {NEWLINE, "\n", size, 1, false, false};
    }
    if (text.front() == '\\') {
        if (const std::size_t size = lineEnd(text.substr(1)); size > 0) {
            return {CONTINUATION, std::string(text.substr(0, 1 + size)), 1 + size, 1, false, false};
        }
    }
    if (isOneOf(text, 0, " \t\v\f")) {
        return {WHITESPACE, std::string(text.substr(0, 1)), 1, 0, false, false};
    }
    const Match match = longestMatch(text);
    return {match.kind, std::string(text.substr(0, match.size)), match.size, 0, false, false};
}

std::vector<RuledToken> allTokens(std::string_view text) {
    std::vector<RuledToken> tokens;
    while (!text.empty()) {
        tokens.push_back(firstToken(text));
        text.remove_prefix(tokens.back().size);
    }
    return tokens;
}

}  // namespace umpre::fuzz
