// SPDX-License-Identifier: MIT
//
// Most directive lines hold nothing that needs the scanner: a name, some text, a comment that ends
// on the line. What matters of
//
//     #define  SIZE   (4 *  N)   /* bytes */
//
// is that blanks separate, that comments are blanks, that both may stand in literals, where they
// are neither, and where the line ends. Comments that reach into another line, carriage returns and
// a line that is not whole in memory are left to the scanner.
#include "lex/directive_line.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <utility>

#include "lex/byte_block.h"
#include "lex/spelling.h"

namespace umpre {
namespace {

// What a byte may begin outside of literals.
enum class Class : std::uint8_t { Plain, Blank, Quote, Slash, Backslash, LineEnd };

constexpr std::array<Class, 256> kClasses = [] {
    std::array<Class, 256> classes{};
    const auto set = [&classes](std::string_view bytes, Class as) {
        for (const char byte : bytes) {
            classes[static_cast<unsigned char>(byte)] = as;
        }
    };
    set(" \t\v\f", Class::Blank);
    set("\"'", Class::Quote);
    set("/", Class::Slash);
    set("\\", Class::Backslash);
    set("\n\r", Class::LineEnd);
    return classes;
}();

[[nodiscard]] Class classOf(char byte) noexcept {
    return kClasses[static_cast<unsigned char>(byte)];
}

// Returns the end of the comment that begins at `at`, or null if it does not end on its line. A
// line comment ends before the line end.
[[nodiscard]] const char* commentEnd(const char* at) noexcept {
    const bool isBlock = at[1] == '*';
    for (at += 2; classOf(*at) != Class::LineEnd; ++at) {
        if (isBlock && *at == '*' && at[1] == '/') {
            return at + 2;
        }
    }
    return isBlock || *at == '\r' ? nullptr : at;
}

[[nodiscard]] bool beginsContinuation(const char* at) noexcept {
    return *at == '\\' && classOf(at[1]) == Class::LineEnd;
}

}  // namespace

DirectiveLine::DirectiveLine(CppFileScanner& file) : file_(file) {
    const std::string_view text = file.wholeLines();
    begin_ = at_ = text.data();
    limit_ = begin_ + (text.rfind('\n') + 1);
    if (begin_ == limit_) {
        return;
    }
    if (skipBlanks() && !isOneLine()) {
        return;
    }
    if (next().kind == TokenKind::HASH) {
        skipBlanks();
        const TokenKind kind = next().kind;
        if (isName(kind)) {
            word_ = kind;
        }
    }
}

Token DirectiveLine::next() {
    if (isNameStart(*at_)) {
        const char* const begin = std::exchange(at_, nameEndAhead(at_));
        const std::string_view name(begin, static_cast<std::size_t>(at_ - begin));
        return {kindOfName(name), name};
    }
    const Token token = tokenAt(at_);
    at_ += isAtEnd() ? 0 : token.text.size();
    return token;
}

std::optional<std::string_view> DirectiveLine::readText(std::string& memory) {
    memory.clear();
    const char* begin = at_;  // what is not in `memory` yet
    for (;;) {
        const char* const end = runEnd(at_);
        const Blanks blanks = blanksEnd(end);
        at_ = blanks.end;
        const std::string_view run(begin, static_cast<std::size_t>(end - begin));
        if (isAtEnd()) {
            return memory.empty() ? run : memory.append(run);
        }
        if (at_ == end) {
            return std::nullopt;
        }
        if (at_ != end + 1 || *end != ' ') {
            memory.append(run);
            if (blanks.separate) {
                memory.push_back(' ');
            }
            begin = at_;
        }
    }
}

std::string_view DirectiveLine::bytesToLineFeed(std::size_t most) const noexcept {
    for (std::size_t size = 0; size < most; size += ByteBlock::kSize) {
        if (const ByteBlock::Mask lineFeeds = ByteBlock(at_ + size).any('\n'); lineFeeds != 0) {
            return {at_, size + firstBit(lineFeeds)};
        }
    }
    return {};
}

bool DirectiveLine::skipRest() {
    const char* end = nullptr;
    while (!isAtEnd() && at_ != end) {
        end = runEnd(at_);
        at_ = blanksEnd(end).end;
    }
    return isAtEnd();
}

void DirectiveLine::takeEnd() {
    ++at_;
    ++lines_;
    file_.advance(static_cast<std::size_t>(at_ - begin_), lines_, true);
}

DirectiveLine::Blanks DirectiveLine::blanksEnd(const char* at) {
    bool separate = false;
    for (;;) {
        if (classOf(*at) == Class::Blank) {
            ++at;
            separate = true;
        } else if (beginsComment(at)) {
            const char* const end = commentEnd(at);
            if (end == nullptr) {
                return {at, separate};
            }
            at = end;
            separate = true;
        } else if (*at == '\\' && at[1] == '\n' && at + 2 != limit_) {
            at += 2;
            ++lines_;
        } else {
            return {at, separate};
        }
    }
}

// Returns the end of the text that begins at `at` and holds no blanks outside of literals.
const char* DirectiveLine::runEnd(const char* at) {
    using Block = BasicByteBlock<BaseVector, 16>;
    for (;;) {
        const Block block(at);
        const auto stops = block.blanksAndUnusual() | block.any('"', '\'', '/', '\\');
        if (stops == 0) {
            at += Block::kSize;
            continue;
        }
        at += firstBit(stops);
        switch (classOf(*at)) {
        case Class::Plain: ++at; break;
        case Class::Quote: at += std::max<std::size_t>(file_.literalSize(at), 1); break;
        case Class::Slash:
        case Class::Backslash:
            if (beginsComment(at) || beginsContinuation(at)) {
                return at;
            }
            ++at;
            break;
        case Class::Blank:
        case Class::LineEnd: return at;
        }
    }
}

}  // namespace umpre
