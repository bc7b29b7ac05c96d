// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_COMMENT_H
#define UMPRE_LEX_COMMENT_H

#include <cstddef>

namespace umpre {

/// How far a block comment was read.
struct CommentScan {
    enum class Stop {
        Closed,          ///< behind the comment
        CarriageReturn,  ///< at a carriage return, which ends a line, alone or with a line feed
        Cut,             ///< where reading is to go on when there are more bytes
    };

    Stop stop;
    const char* at;
    std::size_t lineFeeds;  ///< passed
};

/// Reads a block comment from a place within it, where no "*" stands before it that could close it.
/// Reads up to `end`.
[[nodiscard]] CommentScan scanBlockComment(const char* begin, const char* end) noexcept;

/// Returns where the line ends that `at` stands in: its line feed or carriage return, or `end`.
[[nodiscard]] const char* findLineEnd(const char* at, const char* end) noexcept;

}  // namespace umpre

#endif
