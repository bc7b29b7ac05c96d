// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_OUTPUT_WRITER_H
#define UMPRE_LEX_OUTPUT_WRITER_H

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <optional>
#include <string>
#include <string_view>

#include "lex/byte_sink.h"
#include "lex/growing_array.h"
#include "lex/snippet.h"
#include "lex/source_position.h"

namespace umpre {

/// The only way out for text: collects it in blocks, counts the line feeds of its lines, and writes
/// the markers that keep the output in step with the input. After the first failure nothing more
/// is written.
class OutputWriter {
public:
    OutputWriter();

    /// Sends what is written from now on to a borrowed sink.
    void redirect(ByteSink& sink);

    /// Writes text as it is. Line feeds in it are not counted.
    [[gnu::always_inline]] void write(std::string_view text) {
        if (text.size() > kBlockSize - used_) {
            writeLarge(text);
            return;
        }
        used_ += text.copy(block_.data() + used_, text.size());
    }

    /// Writes a snippet as it is.
    void writeSnippet(const Snippet& snippet) {
        if (Snippet::kRoom > kBlockSize - used_) {
            write(snippet.text());
            return;
        }
        snippet.copyTo(block_.data() + used_);
        used_ += snippet.size();
    }

    /// Writes the line feed that stands for a line end of the input, and counts it.
    void endLine() { endLines(1); }

    /// Writes `count` counted line feeds.
    void endLines(std::size_t count) {
        writeLineFeeds(count);
        countLines(count);
    }

    /// Counts line feeds that were part of a text written.
    void countLines(std::size_t count) { outputLine_ = addLines(outputLine_, count); }

    /// Writes line feeds that are not counted: the line ends inside a comment.
    void writeLineFeeds(std::size_t count) {
        // All of the room that a few may take is filled: how many they are cannot be predicted.
        if (count > kFewLineFeeds || kFewLineFeeds > kBlockSize - used_) {
            writeManyLineFeeds(count);
            return;
        }
        std::memset(block_.data() + used_, '\n', kFewLineFeeds);
        used_ += count;
    }

    /// Tells whether the next output line stands for the input line at `position`.
    [[nodiscard]] bool isAt(const SourcePosition& position) const noexcept {
        return outputLine_ == position.line;
    }

    /// Writes a line marker if the output is not at the input's line.
    void syncTo(const SourcePosition& position) {
        if (!isAt(position)) {
            writeLineMarker(position);
        }
    }

    /// Writes `#line N "name"` with every backslash of the name doubled, and counts from there.
    void writeLineMarker(const SourcePosition& position);

    /// Does the same for the file whose markers end like this.
    void writeLineMarker(std::int32_t line, const Snippet& markerEnd);

    /// Returns the marker of a position.
    [[nodiscard]] static std::string markerOf(const SourcePosition& position);

    /// Returns what stands in the markers of a file behind the line.
    [[nodiscard]] static std::string markerEndOf(std::string_view fileName);

    /// Hands everything written to the sink.
    void flush();

    /// A place in the output.
    struct Place {
        std::size_t block;
        std::size_t at;
    };

    [[nodiscard]] Place place() const noexcept { return {blocks_, used_}; }

    /// Returns how many line feeds were written since this place was taken; nothing if something
    /// else was, or if some of it has been handed over.
    [[nodiscard]] std::optional<std::size_t> lineFeedsSince(Place place) const;

    /// Returns what the sink writes to, as it says.
    [[nodiscard]] const std::optional<FileIdentity>& target() const noexcept { return target_; }

    /// Returns how often somebody else may have kept the sink waiting.
    [[nodiscard]] std::size_t waits() const noexcept { return target_ ? 0 : blocks_; }

    /// Tells whether something could not be written.
    [[nodiscard]] bool failed() const noexcept { return failed_; }

private:
    static constexpr std::size_t kBlockSize = std::size_t{64} * 1024;
    static constexpr std::size_t kFewLineFeeds = 32;

    void writeManyLineFeeds(std::size_t count);
    void writeLarge(std::string_view text);
    void handOver(std::string_view text);

    GrowingArray<char> block_;  // not set to zero: it is written before it is read
    std::size_t used_ = 0;
    std::size_t blocks_ = 0;  // handed over
    std::optional<FileIdentity> target_;
    ByteSink* sink_ = nullptr;
    std::int32_t outputLine_ = 0;
    bool failed_ = false;
};

}  // namespace umpre

#endif
