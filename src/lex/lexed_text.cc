// SPDX-License-Identifier: MIT
#include "lex/lexed_text.h"

#include <algorithm>
#include <cassert>

namespace umpre {

void LexedText::clear() {
    text_.clear();
    tokens_.clear();
    effects_.clear();
}

void LexedText::append(const LexedText& other, std::size_t first, std::size_t last) {
    assert(!other.hasEffects());
    if (first == last) {
        return;
    }
    const std::size_t begin = other.beginOf(first);
    const std::size_t shift = text_.size() - begin;  // may wrap; adding it wraps back
    text_.append(other.text_, begin, other.tokens_[last - 1].end() - begin);
    for (std::size_t index = first; index < last; ++index) {
        const Entry& entry = other.tokens_[index];
        tokens_.emplace_back(entry.kind(), entry.end() + shift);
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
