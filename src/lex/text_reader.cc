// SPDX-License-Identifier: MIT
//
// Most of a file is text that comes out as it went in. Of it the scanner would make tokens only for
// the main loop to write them one after the other. This reader copies what stands between two marks
// in one piece:
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
#include "lex/text_reader.h"

#include <algorithm>
#include <cstddef>
#include <optional>
#include <utility>

#include "lex/byte_block.h"
#include "lex/spelling.h"
#include "lex/text_pass.h"
#include "lex/text_scan.h"

namespace umpre {
namespace {

[[nodiscard]] const char* blanksEnd(const char* at, const char* end) noexcept {
    using Block = BasicByteBlock<BaseVector, 16>;
    for (; at < end; at += Block::kSize) {
        const auto others = ~Block(at).any(' ', '\t', '\v', '\f') & bitsBelow(Block::kSize);
        if (others != 0) {
            return std::min(at + firstBit(others), end);
        }
    }
    return end;
}

}  // namespace

// One pass over the bytes ahead.
class TextReader::Pass {
public:
    Pass(TextReader& reader, CppFileScanner& file, Stop from)
        : reader_(reader),
          output_(reader.output_),
          file_(file),
          pass_(file, from == Stop::LineStart, reader.macroNames_),
          run_(pass_.begin()) {}

    [[nodiscard]] Stop copy(Stop from);

    [[nodiscard]] bool isUsedUp() const noexcept { return pass_.begin() == pass_.end(); }

private:
    // Where copying stops; nothing if it goes on.
    using Outcome = std::optional<Stop>;

    // What a line begins with.
    struct Beginning {
        const char* first = nullptr;  // behind blanks and comments; null: for the scanner to read
        std::size_t commentLines = 0;
        bool hasComments = false;
    };

    [[nodiscard]] Outcome passMark(TextMark mark);
    [[nodiscard]] Outcome passName();
    [[nodiscard]] Outcome passComment();
    [[nodiscard]] Outcome passContinuation();
    [[nodiscard]] Outcome passCarriageReturn();

    [[nodiscard]] Outcome beginLine(const char* start);
    [[nodiscard]] Outcome beginLine(const char* start, const char* behindBlanks);
    [[nodiscard]] bool passLineComments(const char*& start, const char*& behindBlanks);
    [[nodiscard]] bool needsNoLook(const char* start, const char* behindBlanks);
    [[nodiscard]] Beginning beginningOf(const char* behindBlanks);
    void beginText(const char* start, const Beginning& beginning);
    void writeBlanks(const char* start, const char* first);
    [[nodiscard]] const char* endBlankLine(const char* start, const Beginning& beginning);
    [[nodiscard]] const char* endLine(const char* lineEnd);
    void passCommentLines(std::size_t count);

    [[nodiscard]] Stop stop(const char* place, Stop stop);
    void writeUpTo(const char* place);

    void commit(const char* place) { output_.countLines(pass_.commit(place)); }

    void setInStep(bool isInStep) noexcept;

    TextReader& reader_;
    OutputWriter& output_;
    CppFileScanner& file_;
    TextPass pass_;
    std::size_t lineFeeds_ = 0;  // to be written before the run
    const char* run_;            // what else is not written yet begins here
    bool inStep_ = true;
};

TextReader::Stop TextReader::Pass::copy(Stop from) {
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

TextReader::Pass::Outcome TextReader::Pass::passMark(TextMark mark) {
    const char* const at = pass_.at();
    switch (mark) {
    case TextMark::Name: return passName();
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

TextReader::Pass::Outcome TextReader::Pass::passName() {
    std::string_view name;
    do {
        const char* const at = pass_.at();
        const char* const end = pass_.scan().nameEnd();
        name = {at, static_cast<std::size_t>(end - at)};
        if (name == "defined") {
            pass_.scan().resume(end, false);  // no macro, even if there is one of this name
            return std::nullopt;
        }
        const NameReader::Outcome outcome = reader_.nameReader_.readName(name, pass_.end());
        if (outcome.end == nullptr) {
            writeUpTo(at);
            commit(end);
            reader_.name_ = name;
            return Stop::Name;
        }
        if (outcome.text.data() != at) {
            writeUpTo(at);
            output_.write(outcome.text);
            run_ = outcome.end;
        }
        pass_.scan().resume(outcome.end, false);
    } while (pass_.scan().passToSame(name));
    return std::nullopt;
}

TextReader::Pass::Outcome TextReader::Pass::passComment() {
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
TextReader::Pass::Outcome TextReader::Pass::passContinuation() {
    if (const char* const start = pass_.scan().lineStart(pass_.at()); start != nullptr) {
        return stop(start, Stop::LineStart);
    }
    pass_.passContinuation(false);
    setInStep(false);
    return std::nullopt;
}

TextReader::Pass::Outcome TextReader::Pass::passCarriageReturn() {
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

TextReader::Pass::Outcome TextReader::Pass::beginLine(const char* start) {
    return beginLine(start, blanksEnd(start, pass_.end()));
}

// Begins lines until one has text, or is one that needs no look at its beginning.
TextReader::Pass::Outcome TextReader::Pass::beginLine(const char* start, const char* behindBlanks) {
    for (;;) {
        if (passLineComments(start, behindBlanks) && needsNoLook(start, behindBlanks)) {
            return std::nullopt;
        }
        const Beginning beginning = beginningOf(behindBlanks);
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
bool TextReader::Pass::passLineComments(const char*& start, const char*& behindBlanks) {
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
bool TextReader::Pass::needsNoLook(const char* start, const char* behindBlanks) {
    const bool needsNone = inStep_ && !beginsComment(behindBlanks, pass_.end());
    if (needsNone) {
        pass_.scan().resume(start, true);
    }
    return needsNone;
}

// Looks at what a line begins with behind its first blanks. Nothing is done yet about the comments
// there.
TextReader::Pass::Beginning TextReader::Pass::beginningOf(const char* behindBlanks) {
    const char* const end = pass_.end();
    Beginning beginning;
    const char* next = behindBlanks;
    while (beginsComment(next, end)) {
        const TextMap::Comment comment = pass_.commentAt(next);
        if (comment.end == nullptr) {
            return {};
        }
        beginning.hasComments = true;
        beginning.commentLines += comment.lineFeeds;
        next = *comment.end == '\n' ? comment.end : blanksEnd(comment.end, end);
    }
    const bool isContinuation = next < end && *next == '\\' && isLineEndByte(next[1]);
    beginning.first = isContinuation ? nullptr : next;
    return beginning;
}

void TextReader::Pass::beginText(const char* start, const Beginning& beginning) {
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
void TextReader::Pass::writeBlanks(const char* start, const char* first) {
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
const char* TextReader::Pass::endBlankLine(const char* start, const Beginning& beginning) {
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
const char* TextReader::Pass::endLine(const char* lineEnd) {
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

void TextReader::Pass::passCommentLines(std::size_t count) {
    if (count > 0) {
        output_.writeLineFeeds(count);
        pass_.countLines(count);
        setInStep(false);
    }
}

TextReader::Stop TextReader::Pass::stop(const char* place, Stop stop) {
    writeUpTo(place);
    commit(place);
    return stop;
}

void TextReader::Pass::writeUpTo(const char* place) {
    output_.writeLineFeeds(std::exchange(lineFeeds_, 0));
    if (place > run_) {
        output_.write({run_, static_cast<std::size_t>(place - run_)});
        run_ = place;
    }
}

void TextReader::Pass::setInStep(bool isInStep) noexcept {
    inStep_ = isInStep;
    pass_.scan().markLineFeeds(!isInStep);
}

TextReader::Stop TextReader::copyText(CppFileScanner& file, Stop from) {
    if (from == Stop::LineStart && file.isAtHash()) {
        return from;
    }
    Stop stop = from;
    bool goesOn = true;
    while (goesOn && !output_.failed()) {
        Pass pass(*this, file, stop);
        if (pass.isUsedUp()) {
            return stop;  // there are no bytes ahead
        }
        stop = pass.copy(stop);
        goesOn = stop != Stop::Name && pass.isUsedUp();
    }
    return stop;
}

}  // namespace umpre
