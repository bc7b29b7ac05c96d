// SPDX-License-Identifier: MIT
#include "lines/json_string.h"

#include <array>
#include <cstddef>

namespace umpre {
namespace {

// The bytes of a character of UTF-8 by its first one; `second` bounds the next, which keeps out
// characters written too long, halves of pairs and what lies beyond the last character.
struct Form {
    unsigned char firstFrom;
    unsigned char firstTo;
    unsigned char secondFrom;
    unsigned char secondTo;
    std::size_t size;
};

constexpr std::array<Form, 8> kForms{{{0xC2, 0xDF, 0x80, 0xBF, 2},
                                      {0xE0, 0xE0, 0xA0, 0xBF, 3},
                                      {0xE1, 0xEC, 0x80, 0xBF, 3},
                                      {0xED, 0xED, 0x80, 0x9F, 3},
                                      {0xEE, 0xEF, 0x80, 0xBF, 3},
                                      {0xF0, 0xF0, 0x90, 0xBF, 4},
                                      {0xF1, 0xF3, 0x80, 0xBF, 4},
                                      {0xF4, 0xF4, 0x80, 0x8F, 4}}};

unsigned char byteAt(std::string_view bytes, std::size_t at) {
    return at < bytes.size() ? static_cast<unsigned char>(bytes[at]) : 0;
}

bool isBetween(unsigned char from, unsigned char byte, unsigned char to) {
    return from <= byte && byte <= to;
}

// Returns the size of the character of UTF-8 that the bytes begin with; 0 if they begin with none.
std::size_t characterSize(std::string_view bytes) {
    const unsigned char first = byteAt(bytes, 0);
    if (first < 0x80) {
        return 1;
    }
    for (const Form& form : kForms) {
        if (isBetween(form.firstFrom, first, form.firstTo)) {
            bool good = isBetween(form.secondFrom, byteAt(bytes, 1), form.secondTo);
            for (std::size_t at = 2; at < form.size; ++at) {
                good = good && isBetween(0x80, byteAt(bytes, at), 0xBF);
            }
            return good ? form.size : 0;
        }
    }
    return 0;
}

void appendEscape(std::string& text, std::string_view page, unsigned char byte) {
    constexpr std::string_view kHex = "0123456789abcdef";
    text.append("\\u").append(page).append({kHex[byte >> 4U], kHex[byte & 0xFU]});
}

}  // namespace

std::string jsonString(std::string_view bytes) {
    std::string text = "\"";
    while (!bytes.empty()) {
        const std::size_t size = characterSize(bytes);
        const unsigned char first = byteAt(bytes, 0);
        if (size == 0) {
            appendEscape(text, "dc", first);
        } else if (first < ' ') {
            appendEscape(text, "00", first);
        } else {
            text.append(first == '"' || first == '\\' ? "\\" : "").append(bytes.substr(0, size));
        }
        bytes.remove_prefix(size == 0 ? 1 : size);
    }
    return text + "\"";
}

}  // namespace umpre
