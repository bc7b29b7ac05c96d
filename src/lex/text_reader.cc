// SPDX-License-Identifier: MIT
//
// Most of a file is text that comes out as it went in. Of it the scanner would make tokens only for
// the main loop to write them one after the other. This reader finds the bytes that could matter
// and copies what stands between them in one piece:
//
//     value = table[N] + 0x1f;   // N a macro
//     -------------^             copied up to here; N is left to the scanner
//
// Its results are equal because it splits the text where the scanner would: a name begins where no
// name and no number goes on, and a literal ends at the first quote that no backslash escapes. What
// it does not know (comments, continuations, carriage returns) it leaves to the scanner, at the
// beginning of a token.
#include "lex/text_reader.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "lex/spelling.h"

namespace umpre {
namespace {

enum class Class : std::uint8_t {
    Plain,
    Blank,
    Name,
    Digit,
    Quote,
    Slash,
    Backslash,
    LineFeed,
    Return
};

constexpr std::array<Class, 256> kClasses = [] {
    std::array<Class, 256> classes{};
    const auto set = [&classes](std::string_view bytes, Class as) {
        for (const char byte : bytes) {
            classes[static_cast<unsigned char>(byte)] = as;
        }
    };
    set("ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz_", Class::Name);
    set("0123456789", Class::Digit);
    set(" \t\v\f", Class::Blank);
    set("\"'", Class::Quote);
    set("/", Class::Slash);
    set("\\", Class::Backslash);
    set("\n", Class::LineFeed);
    set("\r", Class::Return);
    return classes;
}();

[[nodiscard]] Class classOf(char byte) noexcept {
    return kClasses[static_cast<unsigned char>(byte)];
}

// The functions below read up to two bytes behind the text; zero bytes stand there.

// Tells whether a comment or a continuation begins at `at`.
[[nodiscard]] bool isSpecial(const char* at) noexcept {
    if (*at == '/') {
        return at[1] == '/' || at[1] == '*';
    }
    return *at == '\\' && (at[1] == '\n' || at[1] == '\r');
}

[[nodiscard]] const char* blanksEnd(const char* at) noexcept {
    while (classOf(*at) == Class::Blank) {
        ++at;
    }
    return at;
}

// Passes over the rest of a line, up to and including its line feed, or up to a byte that it must
// not pass. `mustStop` says of a name whether it is such.
template <typename MustStop>
[[nodiscard]] const char* passLine(CppFileScanner& file, const char* at, const char* end,
                                   MustStop mustStop) {
    while (at < end) {
        switch (classOf(*at)) {
        case Class::Plain:
        case Class::Blank: ++at; break;
        case Class::Name: {
            const char* const next = nameEnd(at);
            if (mustStop(std::string_view(at, static_cast<std::size_t>(next - at)))) {
                return at;
            }
            at = next;
            break;
        }
        case Class::Digit: at += numberAt(at).text.size(); break;
        case Class::Quote: at += std::max<std::size_t>(file.literalSize(at), 1); break;
        case Class::Slash:
        case Class::Backslash:
            if (isSpecial(at)) {
                return at;
            }
            ++at;
            break;
        case Class::LineFeed: return at + 1;
        case Class::Return: return at;
        }
    }
    return at;
}

// Tells whether what was passed, from `begin` to `at`, reached the line's end.
[[nodiscard]] bool endsLine(const char* begin, const char* at) noexcept {
    return at != begin && at[-1] == '\n';
}

// Tells whether a line can be read here whose first token stands at `first`.
[[nodiscard]] bool isOrdinary(const char* first, const char* end) noexcept {
    return first < end && *first != '#' && *first != '\r' && !isSpecial(first);
}

[[nodiscard]] std::size_t distance(const char* from, const char* to) noexcept {
    return static_cast<std::size_t>(to - from);
}

}  // namespace

TextReader::Stop TextReader::copyText(CppFileScanner& file, Stop from) {
    Stop stop = from;
    while (copyLines(file, stop) && !output_.failed()) {
    }
    return stop;
}

// Copies from the lines in memory, from where the last reading stopped. Returns true if they are
// used up, so that more may follow.
bool TextReader::copyLines(CppFileScanner& file, Stop& stop) {
    const std::string_view text = file.wholeLines();
    const char* const end = text.data() + text.size();
    const char* at = text.data();
    const char* run = at;  // what is not written yet begins here
    std::size_t lines = 0;
    // Lines leave the two in step as they are; if they are not, the next line wants a marker.
    const bool inStep = output_.isAt(file.position());
    while (at < end) {
        if (stop == Stop::LineStart) {
            const char* const first = blanksEnd(at);
            if (!inStep || !isOrdinary(first, end)) {
                break;
            }
            if (*first == '\n') {
                // Blanks alone on a line are dropped.
                output_.write({run, distance(run, at)});
                run = at = first;
            }
        }
        const char* const begin = at;
        at = passLine(file, begin, end,
                      [this](std::string_view name) { return macroNames_.mayHold(name); });
        stop = endsLine(begin, at) ? Stop::LineStart : Stop::InLine;
        if (stop == Stop::InLine) {
            break;
        }
        ++lines;
    }
    output_.write({run, distance(run, at)});
    output_.countLines(lines);
    return leave(file, text, at, lines, stop);
}

TextReader::Stop TextReader::skipText(CppFileScanner& file) {
    Stop stop = Stop::LineStart;
    while (skipLines(file, stop) && !output_.failed()) {
    }
    return stop;
}

// Passes over the lines in memory; returns as above.
bool TextReader::skipLines(CppFileScanner& file, Stop& stop) {
    const std::string_view text = file.wholeLines();
    const char* const end = text.data() + text.size();
    const char* at = text.data();
    std::size_t lines = 0;
    while (at < end && isOrdinary(blanksEnd(at), end)) {
        const char* const begin = at;
        at = passLine(file, begin, end, [](std::string_view) { return false; });
        stop = endsLine(begin, at) ? Stop::LineStart : Stop::InLine;
        if (stop == Stop::InLine) {
            break;
        }
        ++lines;
    }
    output_.endLines(lines);
    return leave(file, text, at, lines, stop);
}

// Tells the file how far its text was read, to `at`. Returns whether that was all of it.
bool TextReader::leave(CppFileScanner& file, std::string_view text, const char* at,
                       std::size_t lines, Stop stop) {
    const std::size_t used = distance(text.data(), at);
    if (used > 0) {
        file.advance(used, lines, stop == Stop::LineStart);
    }
    return used > 0 && used == text.size() && stop == Stop::LineStart;
}

}  // namespace umpre
