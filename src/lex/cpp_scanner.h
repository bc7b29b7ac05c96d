// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_CPP_SCANNER_H
#define UMPRE_LEX_CPP_SCANNER_H

#include "lex/no_expand_set.h"
#include "lex/token.h"

namespace umpre {

/// A source of tokens with one token of look-ahead. A token is scanned when it is first peeked or
/// taken, not before. The end, once met, stays the end.
class CppScanner {
public:
    CppScanner() = default;
    CppScanner(const CppScanner&) = delete;
    CppScanner& operator=(const CppScanner&) = delete;
    virtual ~CppScanner() = default;

    /// Returns the kind of the next token without consuming it.
    [[nodiscard]] TokenKind peek() {
        if (!hasPeek_) {
            peeked_ = scan();
            hasPeek_ = true;
        }
        return peeked_.kind;
    }

    /// Consumes the next token. Its text is valid until the next `peek` or `next`.
    [[nodiscard]] Token next() {
        if (!hasPeek_) {
            peeked_ = scan();
        }
        hasPeek_ = peeked_.kind == TokenKind::END_OF_INPUT;
        return peeked_;
    }

    /// Returns the names that must not be expanded in the token last read or peeked.
    [[nodiscard]] virtual NoExpandSet noExpandSet() const = 0;

    [[nodiscard]] virtual bool isFile() const noexcept { return false; }

    [[nodiscard]] virtual bool isTokenList() const noexcept { return false; }

protected:
    [[nodiscard]] bool hasPeek() const noexcept { return hasPeek_; }

    /// Makes a source that is used again forget its look-ahead.
    void restart() noexcept { hasPeek_ = false; }

private:
    /// Returns the next token; after the last one, END_OF_INPUT.
    [[nodiscard]] virtual Token scan() = 0;

    Token peeked_;
    bool hasPeek_ = false;
};

}  // namespace umpre

#endif
