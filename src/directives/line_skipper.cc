// SPDX-License-Identifier: MIT
//
// Of skipped lines nothing comes out but a line feed for each line end, those in comments included.
// So they need not come out where they stood; it is enough to know how many there were, and which
// were none: a continuation, and the line end of an "#if" or "#elif" within the skipped lines,
// which goes with its line. What a line begins with is remembered over comments and continuations:
// "/**/ #endif" is a directive.
#include "directives/line_skipper.h"

#include <optional>
#include <string_view>

#include "lex/line_start.h"
#include "lex/literal.h"
#include "lex/spelling.h"
#include "lex/text_map.h"

namespace umpre {

using enum TokenKind;
using Stop = TextReader::Stop;

// One pass over the bytes ahead.
class LineSkipper::Pass {
public:
    Pass(LineSkipper& skipper, CppFileScanner& file, Stop from)
        : output_(skipper.output_),
          groups_(skipper.groups_),
          file_(file),
          map_(file.textMap()),
          text_(file.bytesAhead()),
          at_(text_.data()),
          end_(at_ + text_.size()),
          lineStart_(at_, from == Stop::LineStart) {}

    [[nodiscard]] Stop skip();

    [[nodiscard]] bool isUsedUp() const noexcept { return at_ == end_; }

private:
    // Where skipping stops; nothing if it goes on.
    using Outcome = std::optional<Stop>;

    [[nodiscard]] Outcome passSpecial();
    [[nodiscard]] Outcome passLiteral();
    [[nodiscard]] Outcome passSlash();
    [[nodiscard]] Outcome passBackslash();
    [[nodiscard]] Outcome passCarriageReturn();
    [[nodiscard]] Outcome passHash();
    [[nodiscard]] bool passDirective(TokenKind word, const char* behind);
    [[nodiscard]] bool passLineOf(const char* behind);

    [[nodiscard]] Stop stopHere() const noexcept {
        return lineStart_.before(at_) != nullptr ? Stop::LineStart : Stop::InLine;
    }

    [[nodiscard]] std::size_t lineFeedsBefore(const char* place) {
        return map_.lineFeedsBefore(place, end_);
    }

    OutputWriter& output_;
    ConditionalStack& groups_;
    CppFileScanner& file_;
    TextMap& map_;
    std::string_view text_;
    const char* at_;
    const char* end_;
    LineStart lineStart_;
    const char* continued_ = nullptr;  // behind the last continuation
    std::size_t commentLines_ = 0;     // come out, but are not counted
    std::size_t swallowed_ = 0;        // do not come out
    std::size_t carriageReturns_ = 0;  // that are line ends without a line feed
};

Stop LineSkipper::Pass::skip() {
    const char* const begin = at_;
    const std::size_t before = lineFeedsBefore(begin);
    Outcome stop;
    while (!stop) {
        at_ = map_.findSpecial(at_, end_);
        stop = at_ == end_ ? stopHere() : passSpecial();
    }
    if (at_ != begin) {
        const std::size_t lines = lineFeedsBefore(at_) - before + carriageReturns_;
        output_.writeLineFeeds(commentLines_);
        output_.endLines(lines - commentLines_ - swallowed_);
        file_.advance(static_cast<std::size_t>(at_ - begin), lines,
                      isLineEndByte(at_[-1]) && at_ != continued_);
    }
    return *stop;
}

// Passes over what stands here. If it cannot, reading stops before it.
LineSkipper::Pass::Outcome LineSkipper::Pass::passSpecial() {
    switch (*at_) {
    case '"':
    case '\'': return passLiteral();
    case '/': return passSlash();
    case '\\': return passBackslash();
    case '\r': return passCarriageReturn();
    default: return passHash();
    }
}

LineSkipper::Pass::Outcome LineSkipper::Pass::passLiteral() {
    if (*at_ == '\'' && !file_.literals().isOpen(at_)) {
        if (const char* const characterEnd = map_.characterEnd(at_, end_);
            characterEnd != nullptr) {
            at_ = characterEnd;
            return std::nullopt;
        }
    }
    const LiteralScan literal = file_.literals().find(at_, end_, false);
    if (literal.result == LiteralScan::Result::Cut) {
        return Stop::InLine;
    }
    at_ = literal.result == LiteralScan::Result::Closed ? literal.end : at_ + 1;
    return std::nullopt;
}

LineSkipper::Pass::Outcome LineSkipper::Pass::passSlash() {
    if (!isCommentSign(at_[1])) {
        ++at_;
        return std::nullopt;
    }
    const TextMap::Comment comment = map_.commentAt(at_, end_);
    if (comment.end == nullptr) {
        return stopHere();
    }
    // Where the line ends, what it began with does not matter.
    if (*comment.end != '\n') {
        lineStart_ = {comment.end, lineStart_.before(at_) != nullptr};
    }
    commentLines_ += comment.lineFeeds;
    at_ = comment.end;
    return std::nullopt;
}

LineSkipper::Pass::Outcome LineSkipper::Pass::passBackslash() {
    if (!isLineEndByte(at_[1])) {
        ++at_;
        return std::nullopt;
    }
    const bool isFirst = lineStart_.before(at_) != nullptr;
    if (at_[1] == '\r' && at_[2] != '\n') {
        ++carriageReturns_;
        at_ += 2;
    } else {
        at_ += at_[1] == '\r' ? 3 : 2;
    }
    ++swallowed_;
    continued_ = at_;
    lineStart_ = {at_, isFirst};
    return std::nullopt;
}

LineSkipper::Pass::Outcome LineSkipper::Pass::passCarriageReturn() {
    ++at_;
    if (*at_ != '\n') {
        ++carriageReturns_;
        lineStart_ = {at_, true};
    }
    return std::nullopt;
}

LineSkipper::Pass::Outcome LineSkipper::Pass::passHash() {
    if (at_[1] == '#' || lineStart_.before(at_) == nullptr) {
        at_ += at_[1] == '#' ? 2 : 1;
        return std::nullopt;
    }
    const char* word = at_ + 1;
    while (isBlankByte(*word)) {
        ++word;
    }
    const char* const behind = nameEndAhead(word);
    const bool isName = isNameStart(*word);
    const TokenKind kind =
        isName ? kindOfName({word, static_cast<std::size_t>(behind - word)}) : END_OF_INPUT;
    return isName && behind < end_ && passDirective(kind, behind) ? Outcome{} : Stop::LineStart;
}

// Carries out a directive up to `behind` its word, or with its line. What follows "#else" and
// "#endif" is read as if a line began there: "#endif #endif" closes two groups. Returns false, with
// nothing done, if it might end the skipping or has to be reported.
bool LineSkipper::Pass::passDirective(TokenKind word, const char* behind) {
    switch (word) {
    case KW_IF:
    case KW_IFDEF:
    case KW_IFNDEF:
        if (!passLineOf(behind)) {
            return false;
        }
        groups_.open();
        return true;
    case KW_ELIF:
        return groups_.isDead() && groups_.groupState() == GroupState::Dead && passLineOf(behind);
    case KW_ELSE:
        if (!groups_.isDead() || groups_.groupState() == GroupState::AfterElse) {
            return false;
        }
        groups_.takeElse();
        lineStart_ = {behind, true};
        break;
    case KW_ENDIF:
        if (!groups_.isDead()) {
            return false;
        }
        groups_.close();
        lineStart_ = {behind, true};
        break;
    default: break;
    }
    at_ = behind;
    return true;
}

// Passes over a directive's line with its line end, if nothing special stands behind the word.
bool LineSkipper::Pass::passLineOf(const char* behind) {
    const char* lineEnd = map_.find(behind, end_, &TextMasks::special, &TextMasks::lineFeeds);
    if (lineEnd != end_ && *lineEnd == '\r') {
        ++lineEnd;
    }
    if (lineEnd == end_ || *lineEnd != '\n') {
        return false;
    }
    at_ = lineEnd + 1;
    ++swallowed_;
    return true;
}

Stop LineSkipper::skip(CppFileScanner& file, Stop from) {
    Stop stop = from;
    bool goesOn = true;
    while (goesOn && !output_.failed()) {
        Pass pass(*this, file, stop);
        if (pass.isUsedUp()) {
            return stop;  // there are no bytes ahead
        }
        stop = pass.skip();
        goesOn = pass.isUsedUp();
    }
    return stop;
}

}  // namespace umpre
