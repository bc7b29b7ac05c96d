// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_CONDITIONAL_STACK_H
#define UMPRE_DIRECTIVES_CONDITIONAL_STACK_H

#include <cstddef>
#include <vector>

namespace umpre {

/// How far a conditional group has come.
enum class GroupState {
    Dead,       ///< opened in skipped text; no branch can become active
    Taking,     ///< a branch was taken, this one or an earlier one
    Seeking,    ///< no branch was taken yet; the current one is skipped
    AfterElse,  ///< its `#else` has been seen
};

/// The open conditional groups of the open files, and nothing else: it reports nothing and reads
/// nothing. A group belongs to the file that opened it.
class ConditionalStack {
public:
    /// Returns how many groups are open in the current file.
    [[nodiscard]] std::size_t conditionalDepth() const noexcept { return conditionalDepth_; }

    /// Returns the state of the innermost group.
    [[nodiscard]] GroupState groupState() const noexcept { return innermost_.state; }

    /// Tells whether lines are being skipped.
    [[nodiscard]] bool skipping() const noexcept { return innermost_.skipping; }

    /// Tells whether the innermost group of the current file lies in skipped text: none of its
    /// branches becomes active, and behind its end skipping goes on.
    [[nodiscard]] bool isDead() const noexcept {
        return conditionalDepth_ > 0 && enclosing_.back().skipping;
    }

    /// Opens a group: a dead one in skipped text, otherwise one whose condition `decide` gives.
    void open();
    /// Says whether the branch that begins is taken.
    void decide(bool taken);

    /// A branch that follows a taken one is skipped.
    void passOver() { innermost_.skipping = true; }

    /// The `#else` of a group that had none.
    void takeElse();
    /// Closes the innermost group of the current file; one must be open.
    void close();

    /// Begins a file, which has no open groups.
    void enterFile();
    /// Ends the file: closes its groups and returns to those of its includer. Returns how many
    /// groups were open.
    std::size_t leaveFile();

private:
    struct Group {
        GroupState state = GroupState::Dead;
        bool skipping = false;
    };

    std::size_t conditionalDepth_ = 0;
    Group innermost_;
    std::vector<Group> enclosing_;          // what was in force outside each open group
    std::vector<std::size_t> savedDepths_;  // of the files that wait
};

}  // namespace umpre

#endif
