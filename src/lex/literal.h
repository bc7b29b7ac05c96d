// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_LITERAL_H
#define UMPRE_LEX_LITERAL_H

namespace umpre {

/// How far a string or character literal goes.
struct LiteralScan {
    const char* end;  ///< behind its closing quote; if it is not closed, where that showed
    bool isClosed;
};

/// Reads the literal whose opening quote stands at `at`, by the two literal rules: characters other
/// than line feeds, a backslash with one that is no line end, and at least one in a character
/// literal. Bytes are read up to `end`.
[[nodiscard]] inline LiteralScan scanLiteral(const char* at, const char* end) noexcept {
    const char quote = *at++;
    if (quote == '\'' && at < end && *at == quote) {
        return {at, false};
    }
    for (; at < end && *at != '\n'; ++at) {
        if (*at == quote) {
            return {at + 1, true};
        }
        if (*at == '\\') {
            if (at + 1 == end || at[1] == '\n' || at[1] == '\r') {
                break;
            }
            ++at;
        }
    }
    return {at, false};
}

}  // namespace umpre

#endif
