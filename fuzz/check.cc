// SPDX-License-Identifier: MIT
#include "check.h"

#include <cstdlib>
#include <iostream>

namespace umpre::fuzz {

void fail(std::string_view message) {
    std::cerr << message << std::endl;
    std::abort();
}

std::string printable(std::string_view bytes) {
    static constexpr std::string_view kDigits = "0123456789ABCDEF";
    std::string text;
    for (const char byte : bytes) {
        const auto code = static_cast<unsigned char>(byte);
        if (byte == '\n') {
            text += "\\n\n    ";
        } else if (code >= ' ' && code < 127) {
            text += byte;
        } else {
            text.append("\\x").append({kDigits[code / 16], kDigits[code % 16]});
        }
    }
    return text;
}

std::string differenceOf(std::string_view what, std::string_view found, std::string_view expected) {
    return found == expected ? std::string()
                             : std::string(what)
                                   .append(" differs\n  is:\n    ")
                                   .append(printable(found))
                                   .append("\n  should be:\n    ")
                                   .append(printable(expected));
}

void expectSame(std::string_view what, std::string_view found, std::string_view expected) {
    const std::string difference = differenceOf(what, found, expected);
    if (!difference.empty()) {
        fail(difference);
    }
}

}  // namespace umpre::fuzz
