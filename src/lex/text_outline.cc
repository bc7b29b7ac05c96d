// SPDX-License-Identifier: MIT
#include "lex/text_outline.h"

namespace umpre {
namespace {

using enum TokenKind;

[[nodiscard]] TextOutline outlineOf(const LexedText& text) {
    TextOutline outline;
    outline.isPlain = !text.hasEffects();
    outline.closing.resize(text.size());
    std::vector<std::size_t> open;
    for (std::size_t index = 0; index < text.size() && outline.isPlain; ++index) {
        outline.isPlain = text.staysItself(index);
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
