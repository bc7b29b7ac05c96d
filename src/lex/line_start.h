// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_LINE_START_H
#define UMPRE_LEX_LINE_START_H

#include "lex/spelling.h"

namespace umpre {

/// Tells what stands first on its line, for a reader of bytes that began somewhere and passed over
/// what is no blank by its bytes alone: a comment, a continuation.
class LineStart {
public:
    /// Begins at `place`, where a token begins, the first of its line if `atLineStart`.
    LineStart(const char* place, bool atLineStart) noexcept
        : begin_(place), isStart_(atLineStart) {}

    /// Returns where the blanks before `place` begin if nothing else stands before it on its line,
    /// otherwise null.
    [[nodiscard]] const char* before(const char* place) const noexcept {
        const char* at = place;
        while (at != begin_ && isBlankByte(at[-1])) {
            --at;
        }
        const bool isStart = at == begin_ ? isStart_ : at[-1] == '\n';
        return isStart ? at : nullptr;
    }

private:
    const char* begin_;
    bool isStart_;
};

}  // namespace umpre

#endif
