// SPDX-License-Identifier: MIT
#include "lex/text_outline.h"

#include <utility>

#include "lex/token_join.h"

namespace umpre {
namespace {

using enum TokenKind;

// Tells whether the token at `index`, and where it meets the one before, leave a text plain.
[[nodiscard]] bool staysPlain(const LexedText& text, std::size_t index) {
    const Token token = text.token(index);
    if (isBlankOrNewline(token.kind)) {
        return token.text == " " && (index == 0 || text.kind(index - 1) != WHITESPACE);
    }
    return !isLoneQuote(token) && (index == 0 || !mayJoin(text.token(index - 1), token));
}

[[nodiscard]] TextOutline outlineOf(const LexedText& text) {
    TextOutline outline;
    outline.isPlain = !text.hasEffects();
    outline.closing.resize(text.size());
    std::vector<std::size_t> open;
    for (std::size_t index = 0; index < text.size() && outline.isPlain; ++index) {
        outline.isPlain = staysPlain(text, index);
        if (text.kind(index) == LEFT_PARENTHESIS) {
            open.push_back(index);
        } else if (text.kind(index) == RIGHT_PARENTHESIS && !open.empty()) {
            outline.closing[open.back()] = index;
            open.pop_back();
        }
    }
    return outline;
}

}  // namespace

const TextOutline& LexedText::outline() const {
    if (outline_ == nullptr) {
        outline_ = std::make_shared<const TextOutline>(outlineOf(*this));
    }
    return *outline_;
}

}  // namespace umpre
