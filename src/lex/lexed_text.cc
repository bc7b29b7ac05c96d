// SPDX-License-Identifier: MIT
#include "lex/lexed_text.h"

#include <algorithm>
#include <cassert>
#include <cstring>

#include "lex/token_join.h"

namespace umpre {

void LexedText::clear() {
    text_.clear();
    tokens_.clear();
    effects_.clear();
    lexedAsOne_ = 0;
    outline_.reset();
}

void LexedText::append(TokenKind kind, std::string_view text, Name* name) {
    text.copy(text_.extend(text.size()), text.size());
    Entry entry(kind, text_.size(), name);
    entry.set(Entry::kNotable,
              isName(kind) || kind == TokenKind::NEWLINE || kind == TokenKind::KW_DEFINED);
    *tokens_.extend(1) = entry;
    markUnclean(tokens_.size() - 1);
}

void LexedText::append(const LexedText& other, std::size_t first, std::size_t last) {
    assert(!other.hasEffects());
    if (first == last) {
        return;
    }
    const std::size_t shift = text_.size() - other.beginOf(first);  // may wrap
    const std::string_view text = other.joined(first, last);
    copyText(text.data(), text.size());
    const std::size_t meeting = tokens_.size();
    Entry* const added = tokens_.extend(last - first);
    const Entry* const from = other.tokens_.data() + first;
    for (std::size_t index = 0; index < last - first; ++index) {
        added[index] = from[index].shifted(shift);
    }
    markUnclean(meeting);
}

// Copies from a text's own bytes, behind which there is some slack, as there is here.
void LexedText::copyText(const char* from, std::size_t size) {
    char* const to = text_.extend(size);
    if (size > GrowingArray<char>::kSlack) {
        std::memcpy(to, from, size);
    } else if (size > 0) {
        std::memcpy(to, from, GrowingArray<char>::kSlack);
    }
}

// Most tokens are known to be clean by the bytes on the two sides of where they begin.
void LexedText::markUnclean(std::size_t index) {
    const std::size_t begin = beginOf(index);
    const unsigned before =
        begin == 0 ? JoinGroup::kAlone : joinGroupsOf(text_[begin - 1]) | JoinGroup::kAlone;
    const unsigned after = begin == text_.size() ? JoinGroup::kAlone : joinGroupsOf(text_[begin]);
    const bool isUnclean = (before & after) != 0 && isFoundUnclean(index);
    tokens_[index].set(Entry::kUnclean, isUnclean);
}

bool LexedText::isFoundUnclean(std::size_t index) const {
    const Token token = this->token(index);
    if (isBlankOrNewline(token.kind)) {
        return token.text != " " || (index > 0 && isBlankOrNewline(kind(index - 1)));
    }
    return isLoneQuote(token) || (index > 0 && mayJoin(this->token(index - 1), token));
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
            (void)sink.commentLineEnds(it->lineEnds);
        }
        if (it->unterminated) {
            sink.unterminatedComment(it->line);
        }
    }
}

}  // namespace umpre
