// SPDX-License-Identifier: MIT
#include "directives/conditional_stack.h"

#include <cassert>

namespace umpre {

void ConditionalStack::open() {
    enclosing_.push_back(innermost_);
    ++conditionalDepth_;
    if (innermost_.skipping) {
        innermost_.state = GroupState::Dead;
    }
}

void ConditionalStack::decide(bool taken) {
    innermost_.skipping = !taken;
    innermost_.state = taken ? GroupState::Taking : GroupState::Seeking;
}

void ConditionalStack::takeElse() {
    assert(innermost_.state != GroupState::AfterElse);
    // In a dead group everything stays skipped.
    if (innermost_.state != GroupState::Dead) {
        innermost_.skipping = innermost_.state == GroupState::Taking;
    }
    innermost_.state = GroupState::AfterElse;
}

void ConditionalStack::close() {
    assert(conditionalDepth_ > 0);
    innermost_ = enclosing_.back();
    enclosing_.pop_back();
    --conditionalDepth_;
}

void ConditionalStack::enterFile() {
    savedDepths_.push_back(conditionalDepth_);
    conditionalDepth_ = 0;
}

std::size_t ConditionalStack::leaveFile() {
    assert(!savedDepths_.empty());
    const std::size_t open = conditionalDepth_;
    while (conditionalDepth_ > 0) {
        close();
    }
    conditionalDepth_ = savedDepths_.back();
    savedDepths_.pop_back();
    return open;
}

}  // namespace umpre
