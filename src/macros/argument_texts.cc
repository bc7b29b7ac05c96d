// SPDX-License-Identifier: MIT
#include "macros/argument_texts.h"

#include <algorithm>
#include <functional>

#include "lex/plain_text.h"
#include "macros/text_places.h"

namespace umpre {
namespace {

class Reader {
public:
    Reader(const char* end, const NameFilter& macroNames, CallOutline& outline)
        : end_(end), macroNames_(macroNames), outline_(outline), makesOutline_(outline.begin()) {}

    /// Reads one argument, from its first byte to the "," or ")" that ends it. Returns null if it
    /// does not stand as it should.
    [[nodiscard]] const char* read(const char* at, ArgumentText& argument) {
        const char* const begin = at;
        std::size_t depth = 0;
        while (at != nullptr && at < end_) {
            if (!isDelimiter(*at)) {
                at = places_.next(at, end_);
            }
            if (at == end_) {
                return nullptr;
            }
            if (endsArgument(at, depth)) {
                argument.raw = withoutBlanksBehind(begin, at);
                return at;
            }
            at = passToken(at, depth, argument);
        }
        return nullptr;
    }

private:
    [[nodiscard]] static bool isDelimiter(char byte) noexcept {
        return byte == ',' || byte == '(' || byte == ')';
    }

    [[nodiscard]] static std::string_view viewOf(const char* begin, const char* end) noexcept {
        return {begin, static_cast<std::size_t>(end - begin)};
    }

    [[nodiscard]] static std::string_view withoutBlanksBehind(const char* begin,
                                                              const char* end) noexcept {
        while (end > begin && isBlankByte(end[-1])) {
            --end;
        }
        return viewOf(begin, end);
    }

    [[nodiscard]] const char* passToken(const char* at, std::size_t& depth,
                                        ArgumentText& argument) {
        const char byte = *at;
        if (isNameStart(byte)) {
            return passName(at, argument);
        }
        if (isDelimiter(byte)) {
            return passDelimiter(at, depth, argument);
        }
        if (isDigit(byte)) {
            return places_.numberEndAt(at);
        }
        return isBlankByte(byte) ? passBlanks(at, depth) : unusualTokenEnd(at, end_);
    }

    [[nodiscard]] const char* passName(const char* at, ArgumentText& argument) const {
        const char* const behind = places_.nameEndAt(at);
        argument.mayHaveMacros =
            argument.mayHaveMacros || macroNames_.mayHoldAmongBytes(viewOf(at, behind));
        return behind;
    }

    [[nodiscard]] const char* passDelimiter(const char* at, std::size_t& depth,
                                            ArgumentText& argument) {
        const char* const close = *at == '(' && !makesOutline_ ? outline_.closing(at) : nullptr;
        if (close != nullptr) {
            argument.mayHaveMacros = true;
            return close + 1;
        }
        if (*at == '(') {
            ++depth;
        } else if (*at == ')') {
            --depth;
        }
        if (makesOutline_) {
            outline_.note(at);
        }
        return at + 1;
    }

    // Returns where blanks end, or null if they are neither one space nor at the argument's end.
    [[nodiscard]] const char* passBlanks(const char* at, std::size_t depth) const {
        const char* const behind = skipBlankBytes(at, end_);
        const bool isSpace = *at == ' ' && behind == at + 1;
        return isSpace || (behind < end_ && endsArgument(behind, depth)) ? behind : nullptr;
    }

    [[nodiscard]] static bool endsArgument(const char* at, std::size_t depth) noexcept {
        return depth == 0 && (*at == ',' || *at == ')');
    }

    const char* end_;
    const NameFilter& macroNames_;
    CallOutline& outline_;
    bool makesOutline_;
    TextPlaces<PlacesFor::Arguments> places_;
};

}  // namespace

void CallOutline::note(const char* at) {
    if (*at == '(') {
        open_.push_back(parentheses_.size());
        parentheses_.push_back({at, nullptr});
    } else if (*at == ')') {
        parentheses_[open_.back()].close = at;
        open_.pop_back();
    }
}

const char* CallOutline::closing(const char* open) const {
    const auto standsBefore = [](const Parenthesis& one, const char* at) {
        return std::less<>()(one.open, at);
    };
    const auto it = std::lower_bound(parentheses_.begin(), parentheses_.end(), open, standsBefore);
    return it != parentheses_.end() && it->open == open ? it->close : nullptr;
}

const char* takeArgumentTexts(const char* open, const char* end, std::size_t count,
                              const NameFilter& macroNames, CallOutline& outline,
                              std::vector<ArgumentText>& arguments) {
    Reader reader(end, macroNames, outline);
    const char* at = skipBlankBytes(open + 1, end);
    std::size_t taken = 0;
    while (at < end && *at != ')' && taken < count) {
        at = reader.read(at, arguments.emplace_back());
        ++taken;
        if (at == nullptr) {
            return nullptr;
        }
        if (*at == ',') {
            at = skipBlankBytes(at + 1, end);
        }
    }
    return at < end && *at == ')' && taken == count ? at + 1 : nullptr;
}

}  // namespace umpre
