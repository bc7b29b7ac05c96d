// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_LITERAL_H
#define UMPRE_LEX_LITERAL_H

namespace umpre {

/// How far a string or character literal goes.
struct LiteralScan {
    enum class Result {
        Closed,  ///< it ends behind its closing quote
        Open,    ///< its line does not close it: the quote is a token by itself
        Cut,     ///< the bytes at hand do not tell
    };

    Result result;
    const char* end;  ///< behind the literal; if it is not closed, where that showed
};

/// Reads the literal whose opening quote stands at `at`, by the two literal rules: characters other
/// than line feeds, a backslash with one that is no line end, and at least one in a character
/// literal. Reads up to `end`.
[[nodiscard]] LiteralScan scanLiteral(const char* at, const char* end) noexcept;

/// Finds literals, and remembers between which places quotes are known to be open. That is found
/// only once for a line: a later quote of that kind before the same line end was passed by the
/// first attempt as half of an escaped pair, so its own attempt would go the same way.
class LiteralFinder {
public:
    /// Reads as `scanLiteral` does. If `isLast`, nothing follows the bytes up to `end`, and no
    /// literal is cut.
    [[nodiscard]] LiteralScan find(const char* quote, const char* end, bool isLast) noexcept {
        Range& open = *quote == '"' ? openStrings_ : openCharacters_;
        if (isOpen(quote)) {
            return {LiteralScan::Result::Open, open.end};
        }
        LiteralScan scan = scanLiteral(quote, end);
        if (scan.result == LiteralScan::Result::Cut && isLast) {
            scan.result = LiteralScan::Result::Open;
        }
        if (scan.result == LiteralScan::Result::Open) {
            open = {quote, scan.end};
        }
        return scan;
    }

    /// Tells whether the literal that this quote opens is known not to be closed.
    [[nodiscard]] bool isOpen(const char* quote) const noexcept {
        const Range& open = *quote == '"' ? openStrings_ : openCharacters_;
        return quote >= open.begin && quote < open.end;
    }

    /// Must be called when the bytes move.
    void forget() noexcept { openStrings_ = openCharacters_ = {}; }

private:
    struct Range {
        const char* begin = nullptr;
        const char* end = nullptr;
    };

    Range openStrings_;
    Range openCharacters_;
};

}  // namespace umpre

#endif
