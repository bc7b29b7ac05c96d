// SPDX-License-Identifier: MIT
//
// Of skipped lines nothing comes out but a line feed for each line end, those in comments included.
// So they need not come out where they stood; only those of the lines are counted. What a line
// begins with is remembered over comments and continuations: "/**/ #endif" is a directive.
#include "lex/line_skipper.h"

#include <optional>

#include "lex/comment.h"
#include "lex/text_pass.h"

namespace umpre {

using Stop = TextReader::Stop;

// One pass over the bytes ahead.
class LineSkipper::Pass {
public:
    Pass(OutputWriter& output, CppFileScanner& file, Stop from)
        : output_(output), pass_(file, from == Stop::LineStart, nullptr) {}

    [[nodiscard]] Stop skip() {
        std::optional<Stop> stop;
        while (!stop) {
            stop = passMark(pass_.scan().next());
        }
        output_.endLines(pass_.commit(pass_.at()));
        return *stop;
    }

    [[nodiscard]] bool isUsedUp() const noexcept { return pass_.begin() == pass_.end(); }

private:
    // Returns where skipping stops, or nothing if it goes on.
    [[nodiscard]] std::optional<Stop> passMark(TextMark mark) {
        const bool isFirst = pass_.scan().lineStart(pass_.at()) != nullptr;
        const Stop stop = isFirst ? Stop::LineStart : Stop::InLine;
        switch (mark) {
        case TextMark::Comment:
            if (!passComment(isFirst)) {
                return stop;
            }
            break;
        case TextMark::Continuation: pass_.passContinuation(isFirst); break;
        case TextMark::CarriageReturn: passCarriageReturn(); break;
        case TextMark::Literal: return Stop::InLine;
        default: return stop;
        }
        return std::nullopt;
    }

    [[nodiscard]] bool passComment(bool isFirst) {
        const CommentScan comment = scanComment(pass_.at(), pass_.end());
        if (comment.stop != CommentScan::Stop::Closed) {
            return false;
        }
        output_.writeLineFeeds(comment.lineFeeds);
        pass_.countLines(comment.lineFeeds);
        pass_.scan().resume(comment.at, isFirst);
        return true;
    }

    void passCarriageReturn() {
        const char* const behind = pass_.at() + 1;
        const bool isPair = *behind == '\n';
        if (!isPair) {
            output_.endLine();
            pass_.countLines(1);
        }
        pass_.scan().resume(behind, !isPair);
    }

    OutputWriter& output_;
    TextPass pass_;
};

Stop LineSkipper::skip(CppFileScanner& file, Stop from) {
    Stop stop = from;
    bool goesOn = true;
    while (goesOn && !output_.failed()) {
        Pass pass(output_, file, stop);
        if (pass.isUsedUp()) {
            return stop;  // there are no bytes ahead
        }
        stop = pass.skip();
        goesOn = pass.isUsedUp();
    }
    return stop;
}

}  // namespace umpre
