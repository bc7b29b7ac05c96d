// SPDX-License-Identifier: MIT
//
// Most of a file is text that comes out as it went in. Of it the scanner would make tokens only for
// the main loop to write them one after the other. What is here copies what stands between two
// marks in one piece:
//
//     value = table[N] + 0x1f;   /* N a macro */
//     --------------^                                 up to N, which is left to the expander
//                    ------------^                    up to the comment, which is one blank
//                                               ---   and on with the lines below
//
// A run ends where something else than its bytes must be written; `run_` is where it began. As long
// as the output is in step with the file, lines need no look at their beginnings. If a comment or a
// continuation brought it out of step, lines are begun one by one until one has text, and its
// marker.
#include "lex/text_copy.h"

#include <span>
#include <utility>

#include "lex/spelling.h"

namespace umpre {

TextCopy::Stop TextCopy::copy(Stop from) {
    setInStep(output_.isAt(file_.position()));
    Outcome outcome;
    if (from == Stop::LineStart && !inStep_) {
        outcome = beginLine(pass_.begin());
    }
    while (!outcome) {
        outcome = passMark(pass_.scan().next());
    }
    return *outcome;
}

TextCopy::Outcome TextCopy::passMark(TextMark mark) {
    if (mark == TextMark::Name) {
        return namesFollow_ ? takeName() : passName();
    }
    if (nameCount_ != 0) {
        const Outcome outcome = readNames();
        if (outcome || !namesFollow_) {
            return outcome;
        }
    }
    const char* const at = pass_.at();
    switch (mark) {
    case TextMark::Name: return std::nullopt;
    case TextMark::Comment: return passComment();
    case TextMark::Continuation: return passContinuation();
    case TextMark::CarriageReturn: return passCarriageReturn();
    case TextMark::Literal: return stop(at, Stop::InLine);
    case TextMark::LineFeed: return beginLine(endLine(at));
    case TextMark::BlankLine:
        writeUpTo(pass_.scan().lineStart(at));
        run_ = at;
        pass_.scan().resume(at, false);
        return std::nullopt;
    case TextMark::Hash:
        writeUpTo(pass_.scan().lineStart(at));
        commit(at);
        return Stop::LineStart;
    case TextMark::End: break;
    }
    // Blanks at the beginning of a line are not written before it shows what follows them.
    const char* const start = pass_.scan().lineStart(at);
    return start != nullptr ? stop(start, Stop::LineStart) : stop(at, Stop::InLine);
}

TextCopy::Outcome TextCopy::passName() {
    std::string_view name;
    do {
        name = scannedName();
        const char* const next = readName(name);
        if (next == nullptr) {
            return Stop::Name;
        }
        namesFollow_ = gainsByNotice_ && next == endOf(name);
        pass_.scan().resume(next, false);
    } while (pass_.scan().passToSame(name));
    return std::nullopt;
}

// Takes a name and goes on behind it, so that those that follow are asked for together with it.
// That they follow is not known for one that a "(" follows.
TextCopy::Outcome TextCopy::takeName() {
    const std::string_view name = scannedName();
    names_[nameCount_] = name;
    ++nameCount_;
    pass_.scan().resume(endOf(name), false);
    return *endOf(name) == '(' || nameCount_ == kNamesTogether ? readNames() : std::nullopt;
}

// Reads the names taken. Behind one that takes more than itself, scanning begins anew.
TextCopy::Outcome TextCopy::readNames() {
    const auto names = std::span(names_).first(std::exchange(nameCount_, 0));
    nameReader_.notice(names);
    for (const std::string_view name : names) {
        const char* const next = readName(name);
        if (next == nullptr) {
            return Stop::Name;
        }
        if (next != endOf(name)) {
            namesFollow_ = false;
            pass_.scan().resume(next, false);
            return std::nullopt;
        }
    }
    return std::nullopt;
}

// Writes what a name comes out as and returns the end of what was read; null if that is not told.
[[gnu::always_inline]] inline const char* TextCopy::readName(std::string_view name) {
    const char* const at = name.data();
    if (name == "defined") {
        return endOf(name);  // no macro, even if there is one of this name
    }
    const NameReader::Outcome outcome = nameReader_.readName(name, pass_.end());
    if (outcome.end == nullptr) {
        writeUpTo(at);
        commit(endOf(name));
        name_ = name;
    } else if (outcome.text.data() != at) {
        writeUpTo(at);
        output_.write(outcome.text);
        run_ = outcome.end;
    }
    return outcome.end;
}

TextCopy::Outcome TextCopy::passComment() {
    const char* const at = pass_.at();
    if (const char* const start = pass_.scan().lineStart(at); start != nullptr) {
        return beginLine(start, at);
    }
    const TextMap::Comment comment = pass_.commentAt(at);
    if (comment.end == nullptr) {
        return stop(at, Stop::InLine);
    }
    writeUpTo(at);
    passCommentLines(comment.lineFeeds);
    output_.write(" ");
    run_ = comment.end;
    pass_.scan().resume(comment.end, false);
    return std::nullopt;
}

// A continuation is copied, but counts as a line of the file alone. At the beginning of a line it
// is a blank, which may not come out.
TextCopy::Outcome TextCopy::passContinuation() {
    if (const char* const start = pass_.scan().lineStart(pass_.at()); start != nullptr) {
        return stop(start, Stop::LineStart);
    }
    pass_.passContinuation(false);
    setInStep(false);
    return std::nullopt;
}

TextCopy::Outcome TextCopy::passCarriageReturn() {
    const char* const at = pass_.at();
    const char* const start = pass_.scan().lineStart(at);
    if (start != nullptr) {
        writeUpTo(start);
        run_ = at;
    }
    const char* const behind = endLine(at);
    if (!inStep_) {
        return beginLine(behind);
    }
    pass_.scan().resume(behind, true);
    return std::nullopt;
}

TextCopy::Outcome TextCopy::beginLine(const char* start) {
    return beginLine(start, blanksEnd(start, pass_.end()));
}

// Begins lines until one has text, or is one that needs no look at its beginning.
TextCopy::Outcome TextCopy::beginLine(const char* start, const char* behindBlanks) {
    for (;;) {
        if (passLineComments(start, behindBlanks) && needsNoLook(start, behindBlanks)) {
            return std::nullopt;
        }
        const LineBeginning beginning = lineBeginning(behindBlanks, pass_);
        const char* const first = beginning.first;
        if (first == nullptr || first == pass_.end()) {
            return stop(start, Stop::LineStart);
        }
        if (*first == '#' && first[1] != '#') {
            writeUpTo(start);
            passCommentLines(beginning.commentLines);
            commit(first);
            return Stop::LineStart;
        }
        if (!isLineEndByte(*first)) {
            beginText(start, beginning);
            return std::nullopt;
        }
        start = endBlankLine(start, beginning);
        behindBlanks = blanksEnd(start, pass_.end());
        if (needsNoLook(start, behindBlanks)) {
            return std::nullopt;
        }
    }
}

// Passes over lines with a line comment and nothing else, which come out as their line feeds.
// Returns false if there are none.
bool TextCopy::passLineComments(const char*& start, const char*& behindBlanks) {
    std::size_t count = 0;
    while (beginsLineComment(behindBlanks, pass_.end())) {
        const char* const lineEnd = pass_.commentAt(behindBlanks).end;
        if (lineEnd == nullptr || *lineEnd != '\n') {
            break;
        }
        if (run_ != start) {
            writeUpTo(start);
        }
        ++count;
        ++lineFeeds_;
        run_ = start = lineEnd + 1;
        behindBlanks = blanksEnd(start, pass_.end());
    }
    output_.countLines(count);
    pass_.countLines(count);
    return count != 0;
}

// Tells whether scanning may go on with the line that begins at `start`; it then does.
bool TextCopy::needsNoLook(const char* start, const char* behindBlanks) {
    const bool needsNone = inStep_ && !beginsComment(behindBlanks, pass_.end());
    if (needsNone) {
        pass_.scan().resume(start, true);
    }
    return needsNone;
}

void TextCopy::beginText(const char* start, const LineBeginning& beginning) {
    writeUpTo(start);
    passCommentLines(beginning.commentLines);
    if (!inStep_) {
        commit(beginning.first);
        output_.syncTo(file_.position());
        setInStep(true);
    }
    if (beginning.hasComments) {
        writeBlanks(start, beginning.first);
        run_ = beginning.first;
    }
    pass_.scan().resume(beginning.first, false);
}

// Writes the blanks from a line's start to its first token, where comments are among them.
void TextCopy::writeBlanks(const char* start, const char* first) {
    const char* at = start;
    for (;;) {
        const char* const next = blanksEnd(at, first);
        output_.write({at, static_cast<std::size_t>(next - at)});
        if (next == first) {
            return;
        }
        output_.write(" ");
        at = pass_.commentAt(next).end;
    }
}

// Returns where the next line begins.
const char* TextCopy::endBlankLine(const char* start, const LineBeginning& beginning) {
    if (beginning.first != start) {
        if (run_ != start) {
            writeUpTo(start);
        }
        run_ = beginning.first;
    }
    passCommentLines(beginning.commentLines);
    if (*run_ == '\n' && run_ == beginning.first) {
        ++lineFeeds_;
        ++run_;
    }
    return endLine(beginning.first);
}

// Passes over a line end, which comes out as one line feed. Returns where the next line begins.
const char* TextCopy::endLine(const char* lineEnd) {
    output_.countLines(1);
    pass_.countLines(1);
    // NOLINTNEXTLINE(clang-analyzer-core.NullDereference): no mark is nowhere
    if (*lineEnd == '\n') {
        return lineEnd + 1;
    }
    writeUpTo(lineEnd);
    if (lineEnd[1] == '\n') {
        run_ = lineEnd + 1;
        return lineEnd + 2;
    }
    pass_.countCarriageReturn();
    output_.write("\n");
    run_ = lineEnd + 1;
    return run_;
}

void TextCopy::passCommentLines(std::size_t count) {
    if (count > 0) {
        output_.writeLineFeeds(count);
        pass_.countLines(count);
        setInStep(false);
    }
}

TextCopy::Stop TextCopy::stop(const char* place, Stop stop) {
    writeUpTo(place);
    commit(place);
    return stop;
}

void TextCopy::writeUpTo(const char* place) {
    output_.writeLineFeeds(std::exchange(lineFeeds_, 0));
    if (place > run_) {
        output_.write({run_, static_cast<std::size_t>(place - run_)});
        run_ = place;
    }
}

void TextCopy::setInStep(bool isInStep) noexcept {
    inStep_ = isInStep;
    pass_.scan().markLineFeeds(!isInStep);
}

}  // namespace umpre
