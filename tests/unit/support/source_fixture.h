// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_SOURCE_FIXTURE_H
#define UMPRE_TESTS_UNIT_SUPPORT_SOURCE_FIXTURE_H

#include <string>
#include <string_view>
#include <utility>

#include "lex/output_writer.h"
#include "lex/run_options.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "support/lexeme.h"
#include "support/recording_reporter.h"
#include "support/recording_sink.h"

namespace umpre::testing {

/// Keeps what happens to files, in the words "+name", "-name" and "=name" for a file that was
/// entered, that ends and that goes on.
class RecordingFileEvents final : public FileEvents {
public:
    void watch(ScannerStack& sources) noexcept { sources_ = &sources; }

    void fileEntered() override { add('+'); }

    void fileEnds() override { add('-'); }

    void fileResumed() override { add('='); }

    [[nodiscard]] const std::string& events() const noexcept { return events_; }

private:
    void add(char mark) {
        events_.append(events_.empty() ? "" : " ");
        events_.push_back(mark);
        events_.append(sources_->position().fileName);
    }

    ScannerStack* sources_ = nullptr;
    std::string events_;
};

/// A stack that reads a text as the file "main", with what it reports, writes and announces.
struct SourceFixture {
    explicit SourceFixture(std::string_view text, const RunOptions& runOptions = {})
        : options(runOptions), lexer(options), sources(fileEvents, output, reporter, options) {
        fileEvents.watch(sources);
        output.redirect(sink);
        sources.pushFileText("main", text);
    }

    SourceFixture(const SourceFixture&) = delete;
    SourceFixture& operator=(const SourceFixture&) = delete;

    /// Returns pieces: one, with the tokens of a text.
    [[nodiscard]] Pieces piecesOf(std::string_view text, NoExpandSet noExpand = {}) {
        Pieces pieces;
        lexer.append(pieces.open(), text);
        pieces.close(noExpand);
        return pieces;
    }

    /// Reads a text on its own.
    void isolateText(std::string_view text) {
        sources.isolate(TextSlice::whole(lexer.lexed(text)), {});
    }

    void pushText(std::string_view text, NoExpandSet noExpand = {}) {
        Pieces pieces = piecesOf(text, noExpand);
        sources.pushPieces(std::move(pieces));
    }

    /// Returns what is left to be read, joined.
    [[nodiscard]] std::string rest() { return readText(sources); }

    /// Returns what was written so far.
    [[nodiscard]] const std::string& written() {
        output.flush();
        return sink.bytes();
    }

    RunOptions options;
    TextLexer lexer;
    RecordingSink sink;
    OutputWriter output;
    RecordingReporter reporter;
    RecordingFileEvents fileEvents;
    ScannerStack sources;
};

}  // namespace umpre::testing

#endif
