// SPDX-License-Identifier: MIT
#include "lex/lexed_text.h"

#include <algorithm>
#include <cassert>

namespace umpre {

void LexedText::clear() {
    text_.clear();
    tokens_.clear();
    effects_.clear();
    outline_.reset();
}

void LexedText::append(const LexedText& other, std::size_t first, std::size_t last) {
    assert(!other.hasEffects());
    if (first == last) {
        return;
    }
    const std::size_t shift = text_.size() - other.beginOf(first);  // may wrap
    text_.append(other.joined(first, last));
    const std::size_t before = tokens_.size();
    const auto from = [&other](std::size_t index) {
        return other.tokens_.begin() + static_cast<std::ptrdiff_t>(index);
    };
    tokens_.insert(tokens_.end(), from(first), from(last));
    for (std::size_t index = before; index < tokens_.size(); ++index) {
        tokens_[index].shift(shift);
    }
}

void LexedText::addCommentEffect(std::size_t lineEnds, bool unterminated, std::int32_t line) {
    effects_.push_back({tokens_.size(), lineEnds, unterminated, line});
}

void LexedText::carryOutEffects(std::size_t index, CommentSink& sink) const {
    const auto before = [](const Effect& effect, std::size_t token) {
        return effect.token < token;
    };
    for (auto it = std::lower_bound(effects_.begin(), effects_.end(), index, before);
         it != effects_.end() && it->token == index; ++it) {
        if (it->lineEnds > 0) {
            sink.commentLineEnds(it->lineEnds);
        }
        if (it->unterminated) {
            sink.unterminatedComment(it->line);
        }
    }
}

}  // namespace umpre
