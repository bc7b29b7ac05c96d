// SPDX-License-Identifier: MIT
//
// Every double quote gets a backslash; a backslash is doubled inside literals only. A second
// backslash in a row counts as escaping what follows it, too: with "\\" (two backslashes between
// quotes) the closing quote is taken for an escaped one, and the literal for going on.
#include "macros/stringize.h"

#include <algorithm>

namespace umpre {

void stringize(std::string_view rawText, std::string& result) {
    const auto isSpecial = [](char byte) { return byte == '"' || byte == '\'' || byte == '\\'; };
    if (std::none_of(rawText.begin(), rawText.end(), isSpecial)) {
        result.append("\"").append(rawText).append("\"");
        return;
    }
    bool insideLiteral = false;
    bool escaped = false;
    result.push_back('"');
    for (const char byte : rawText) {
        const bool isQuote = byte == '"' || byte == '\'';
        const bool doubled = byte == '\\' && insideLiteral;
        if (isQuote && !escaped) {
            insideLiteral = !insideLiteral;
        }
        if (byte == '"' || doubled) {
            result.push_back('\\');
        }
        result.push_back(byte);
        escaped = doubled;
    }
    result.push_back('"');
}

}  // namespace umpre
