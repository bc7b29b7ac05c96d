// SPDX-License-Identifier: MIT
#include "lex/cpp_token_scanner.h"

#include <algorithm>
#include <utility>

namespace umpre {

void CppTokenScanner::read(Pieces&& pieces) {
    pieces.moveTo(text_, runs_);
    noExpand_ = {};
    index_ = 0;
    end_ = text_->size();
    start();
}

void CppTokenScanner::read(TextSlice slice, NoExpandSet noExpand) {
    text_ = std::move(slice.text);
    runs_.clear();
    noExpand_ = noExpand;
    index_ = slice.first;
    end_ = slice.last;
    start();
}

void CppTokenScanner::start() {
    run_ = 0;
    runEnd_ = end_;
    if (!runs_.empty()) {
        runEnd_ = runs_.front().end;
        noExpand_ = runs_.front().noExpand;
    }
    peekedEnd_ = false;
    restart();
}

// Makes the run of the token before `index_` the current one.
void CppTokenScanner::findRun() {
    while (runEnd_ < index_) {
        ++run_;
        runEnd_ = runs_[run_].end;
        noExpand_ = runs_[run_].noExpand;
    }
}

Token CppTokenScanner::scan() {
    if (index_ == end_) {
        peekedEnd_ = true;
        return {};
    }
    const Token token = text_->token(index_);
    ++index_;
    findRun();
    if (text_->hasEffects()) {
        text_->carryOutEffects(index_ - 1, commentSink_);
    }
    return token;
}

NoExpandSet CppTokenScanner::noExpandSetAt(std::size_t index) const {
    if (index < runEnd_) {
        return noExpand_;
    }
    const auto endsBefore = [](std::size_t token, const Pieces::Run& run) {
        return token < run.end;
    };
    return std::upper_bound(runs_.begin(), runs_.end(), index, endsBefore)->noExpand;
}

void CppTokenScanner::moveTo(std::size_t index) {
    index_ = index;
    findRun();
    restart();
}

std::size_t CppTokenScanner::takePlain(const NameFilter& macroNames, TokenKind stop) {
    const LexedText& text = *text_;
    const std::size_t first = position();
    if (first == end_ || text.hasEffects()) {
        return first;
    }
    index_ = first + 1;
    findRun();
    const std::size_t last = std::min(end_, runEnd_);
    std::size_t at = text.nextNotable(first, last);
    while (at < last && text.kind(at) != stop && !mayBeMacro(text, at, macroNames)) {
        at = text.nextNotable(at + 1, last);
    }
    index_ = at;
    restart();
    return first;
}

}  // namespace umpre
