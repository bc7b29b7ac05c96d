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
    Reader(const char* begin, const char* end, const NameFilter& macroNames, CallOutline& outline)
        : end_(end),
          macroNames_(macroNames),
          outline_(outline),
          makesOutline_(outline.begin()),
          places_(begin) {}

    /// Reads one argument, from its first byte to the "," or ")" that ends it. Returns null if it
    /// does not stand as it should.
    [[nodiscard]] const char* read(const char* begin, ArgumentText& argument) {
        argument = {};
        std::size_t depth = 0;
        for (;;) {
            const char* const at = places_.next(end_);
            if (at == end_) {
                return nullptr;
            }
            if (isNameStart(*at)) {
                passName(at, argument);
            } else if (endsArgument(at, depth)) {
                argument.raw = withoutBlanksBehind(begin, at);
                return at;
            } else if (!passToken(at, depth, argument)) {
                return nullptr;
            }
        }
    }

    /// Returns where the blanks before an argument end.
    [[nodiscard]] const char* passBlanks(const char* at) noexcept {
        if (isNoBlank(*at)) {
            return at;
        }
        const bool isSpace = *at == ' ' && isNoBlank(at[1]);
        const char* const behind = isSpace ? at + 1 : skipBlankBytes(at, end_);
        places_.resume(behind);
        return behind;
    }

private:
    // Tells quickly of most bytes that they are no blanks.
    [[nodiscard]] static bool isNoBlank(char byte) noexcept {
        return static_cast<unsigned char>(byte) > ' ';
    }

    [[nodiscard]] static std::string_view viewOf(const char* begin, const char* end) noexcept {
        return {begin, static_cast<std::size_t>(end - begin)};
    }

    [[nodiscard]] static std::string_view withoutBlanksBehind(const char* begin,
                                                              const char* end) noexcept {
        while (end > begin && !isNoBlank(end[-1]) && isBlankByte(end[-1])) {
            --end;
        }
        return viewOf(begin, end);
    }

    void passName(const char* at, ArgumentText& argument) {
        const char* const behind = places_.passName(at);
        argument.mayHaveMacros =
            argument.mayHaveMacros || macroNames_.mayHoldAmongBytes(viewOf(at, behind));
    }

    // Returns false if what begins there does not stand as it should.
    [[nodiscard]] bool passToken(const char* at, std::size_t& depth, ArgumentText& argument) {
        const char byte = *at;
        if (byte == ',' || byte == '(' || byte == ')') {
            passDelimiter(at, depth, argument);
            return true;
        }
        if (isDigit(byte)) {
            (void)places_.passNumber(at);
            return true;
        }
        if (isBlankByte(byte)) {
            return passBlanksWithin(at, depth);
        }
        argument.mayHaveQuotes =
            argument.mayHaveQuotes || byte == '"' || byte == '\'' || byte == '\\';
        const char* const behind = unusualTokenEnd(at, end_);
        if (behind != nullptr) {
            places_.resume(behind);
        }
        return behind != nullptr;
    }

    void passDelimiter(const char* at, std::size_t& depth, ArgumentText& argument) {
        const char* const close = *at == '(' && !makesOutline_ ? outline_.closing(at) : nullptr;
        if (close != nullptr) {
            argument.mayHaveMacros = true;
            argument.mayHaveQuotes = true;
            places_.resume(close + 1);
            return;
        }
        if (*at == '(') {
            ++depth;
        } else if (*at == ')') {
            --depth;
        }
        if (makesOutline_) {
            outline_.note(at);
        }
    }

    // Returns false if blanks are neither one space nor at the argument's end.
    [[nodiscard]] bool passBlanksWithin(const char* at, std::size_t depth) {
        const char* const behind = skipBlankBytes(at, end_);
        places_.resume(behind);
        const bool isSpace = *at == ' ' && behind == at + 1;
        return isSpace || (behind < end_ && endsArgument(behind, depth));
    }

    [[nodiscard]] static bool endsArgument(const char* at, std::size_t depth) noexcept {
        return (*at == ',' || *at == ')') && depth == 0;
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

const char* takeArgumentTexts(const char* open, const char* end, const NameFilter& macroNames,
                              CallOutline& outline, std::span<ArgumentText> arguments) {
    Reader reader(open + 1, end, macroNames, outline);
    const char* at = reader.passBlanks(open + 1);
    for (ArgumentText& argument : arguments) {
        at = at < end && *at != ')' ? reader.read(at, argument) : nullptr;
        if (at == nullptr) {
            return nullptr;
        }
        if (*at == ',') {
            at = reader.passBlanks(at + 1);
        }
    }
    return at < end && *at == ')' ? at + 1 : nullptr;
}

}  // namespace umpre
