// SPDX-License-Identifier: MIT
#include "lex/cpp_token_scanner.h"

#include <utility>

namespace umpre {

void CppTokenScanner::read(Pieces& pieces) {
    std::swap(pieces_, pieces);
    shared_.reset();
    start(pieces_.tokens());
}

void CppTokenScanner::read(std::shared_ptr<const LexedText> text, NoExpandSet noExpand) {
    shared_ = std::move(text);
    sharedSet_ = noExpand;
    start(*shared_);
}

void CppTokenScanner::start(const LexedText& text) {
    text_ = &text;
    index_ = 0;
    run_ = 0;
    peekedEnd_ = false;
    restart();
}

NoExpandSet CppTokenScanner::noExpandSet() const {
    if (shared_ != nullptr) {
        return sharedSet_;
    }
    return pieces_.runs().empty() ? NoExpandSet() : pieces_.runs()[run_].noExpand;
}

Token CppTokenScanner::scan() {
    if (index_ == text_->size()) {
        peekedEnd_ = true;
        return {};
    }
    if (shared_ == nullptr) {
        while (pieces_.runs()[run_].end <= index_) {
            ++run_;
        }
    }
    if (text_->hasEffects()) {
        text_->carryOutEffects(index_, commentSink_);
    }
    const Token token{text_->kind(index_), text_->text(index_)};
    ++index_;
    return token;
}

}  // namespace umpre
