// SPDX-License-Identifier: MIT
//
// With
//
//     #define PORT_Msk (0x3UL << PORT_Pos)
//     #define PORT_Pos 4
//     #define PORT PORT_Msk
//
// each PORT of a text comes out as "(0x3UL << 4)". On the token road that is three texts lexed, or
// at least pushed, read and looked through. But it is a matter of bytes alone: in text, tokens of
// two sources never become one, so what comes out is the texts one in the other, with no look at
// what meets where one begins or ends.
//
// The token road is left to do what depends on more than definitions (`__FILE__`, `__LINE__`, the
// argument list of a function-like macro), or does more than yield text (comments, line ends).
#include "macros/expansion_memo.h"

#include <algorithm>

#include "lex/literal.h"
#include "lex/spelling.h"
#include "macros/predefined_macros.h"

namespace umpre {
namespace {

// What is larger is left to the token road, which takes no memory for it.
constexpr std::size_t kLongest = 4096;
constexpr std::size_t kMostReplacements = 256;
// Deeper nesting is left to it too; it has a quicker way to know the names around a text.
constexpr std::size_t kDeepest = 16;
constexpr std::size_t kMostKept = std::size_t{32} << 20U;

// Returns the end of a token that is no name, or null if it is more than text.
[[nodiscard]] const char* tokenEnd(const char* at, const char* end) noexcept {
    switch (*at) {
    case '\n':
    case '\r':
    case '\0': return nullptr;
    case '\\': return isLineEndByte(at[1]) ? nullptr : at + 1;
    case '/': return at[1] == '/' || at[1] == '*' ? nullptr : at + 1;
    case '"':
    case '\'': {
        const LiteralScan literal = scanLiteral(at, end);
        return literal.result == LiteralScan::Result::Closed ? literal.end : nullptr;
    }
    default: break;
    }
    return isDigit(*at) ? at + numberAt(at).text.size() : at + 1;
}

}  // namespace

std::optional<std::string_view> ExpansionMemo::workedOut(const MacroName& name) {
    macros_.watch(name.text);
    const bool isTold = expand(name);
    if (isTold && size_ + text_.size() > kMostKept) {
        return text_;
    }
    if (version_ != macros_.version()) {
        version_ = macros_.version();
        bytes_.release();
        size_ = 0;
    }
    Macro::Expansion& expansion = name.macro.expansion;
    expansion = {version_, isTold ? kept(text_) : std::string_view()};
    return isTold ? std::optional(expansion.text) : std::nullopt;
}

// Works `text_` out. Returns false if that is not a matter of bytes.
bool ExpansionMemo::expand(const MacroName& name) {
    text_.clear();
    replacements_.clear();
    begun_ = 0;
    bool isTold = begin(name);
    while (isTold && !replacements_.empty()) {
        if (replacements_.back().at == replacements_.back().end) {
            replacements_.pop_back();
        } else {
            isTold = readOn(replacements_.back());
        }
    }
    return isTold;
}

// Reads up to a name that is replaced, or to the end. Returns false if bytes do not tell.
bool ExpansionMemo::readOn(Replacement& text) {
    const char* const run = text.at;
    const MacroName* replaced = nullptr;
    const char* end = run;
    while (end != nullptr && end < text.end && replaced == nullptr) {
        text.at = end;
        if (isNameStart(*end)) {
            end = nameEnd(end);
            replaced = macroOf({text.at, static_cast<std::size_t>(end - text.at)});
        } else {
            end = tokenEnd(end, text.end);
        }
    }
    if (end == nullptr) {
        return false;
    }
    text_.append(run, replaced == nullptr ? end : text.at);
    text.at = end;
    return text_.size() <= kLongest && (replaced == nullptr || begin(*replaced));
}

// Returns the macro that a name of the innermost text stands for, or null if the name stays.
const MacroName* ExpansionMemo::macroOf(std::string_view name) {
    if (name == "defined") {
        return nullptr;
    }
    macros_.watch(name);
    const MacroName* const macro = macros_.filter().mayHold(name) ? macros_.find(name) : nullptr;
    const auto isOf = [macro](const Replacement& text) { return text.macro == macro; };
    return std::any_of(replacements_.begin(), replacements_.end(), isOf) ? nullptr : macro;
}

// Begins to read a macro's text in the place of its name. Returns false if bytes do not tell.
bool ExpansionMemo::begin(const MacroName& name) {
    if (name.macro.functionLike() || isRefreshed(name) || replacements_.size() == kDeepest
        || ++begun_ == kMostReplacements) {
        return false;
    }
    const std::string_view text = name.macro.text();
    replacements_.push_back({&name, text.data(), text.data() + text.size()});
    return true;
}

std::string_view ExpansionMemo::kept(std::string_view text) {
    char* const bytes = static_cast<char*>(bytes_.allocate(text.size() + 1, 1));
    size_ += text.size() + 1;
    return {bytes, text.copy(bytes, text.size())};
}

}  // namespace umpre
