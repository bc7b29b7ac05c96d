// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_COMMENT_SINK_H
#define UMPRE_LEX_COMMENT_SINK_H

#include <cstddef>
#include <cstdint>

namespace umpre {

/// What reading a comment does beside yielding a blank: its line ends go to the output at once, and
/// one that is never closed is noted.
class CommentSink {
public:
    virtual ~CommentSink() = default;
    /// Line ends were read; those of a long comment come in parts. Returns false if it is of no use
    /// to read on.
    virtual bool commentLineEnds(std::size_t count) = 0;
    virtual void unterminatedComment(std::int32_t line) = 0;
};

}  // namespace umpre

#endif
