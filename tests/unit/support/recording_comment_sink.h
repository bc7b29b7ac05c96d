// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_RECORDING_COMMENT_SINK_H
#define UMPRE_TESTS_UNIT_SUPPORT_RECORDING_COMMENT_SINK_H

#include <cstddef>
#include <cstdint>
#include <string>

#include "lex/comment_sink.h"

namespace umpre::testing {

/// Keeps the effects of comments: a line feed for each line end, and "[N]" for a comment that is
/// not closed by line N.
class RecordingCommentSink final : public CommentSink {
public:
    bool commentLineEnds(std::size_t count) override {
        effects_.append(count, '\n');
        return true;
    }

    void unterminatedComment(std::int32_t line) override {
        effects_.append("[").append(std::to_string(line)).append("]");
    }

    [[nodiscard]] const std::string& effects() const noexcept { return effects_; }

private:
    std::string effects_;
};

}  // namespace umpre::testing

#endif
