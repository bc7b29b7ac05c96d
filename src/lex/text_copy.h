// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_COPY_H
#define UMPRE_LEX_TEXT_COPY_H

#include <array>
#include <cstddef>
#include <optional>
#include <string_view>

#include "lex/cpp_file_scanner.h"
#include "lex/line_beginning.h"
#include "lex/name_filter.h"
#include "lex/name_reader.h"
#include "lex/output_writer.h"
#include "lex/text_pass.h"
#include "lex/text_scan.h"

namespace umpre {

/// One pass over the bytes of a file that lie ahead: copies what the scanner would only have
/// copied.
class TextCopy {
public:
    /// Where copying stops.
    enum class Stop {
        LineStart,  ///< before a line's first token, its blanks included, or at the end
        InLine,     ///< within a line that has been begun
        Name,       ///< behind a name that may be a macro, which was not copied
    };

    /// Begins at a line's start or within a line.
    TextCopy(OutputWriter& output, const NameFilter& macroNames, NameReader& nameReader,
             CppFileScanner& file, Stop from)
        : output_(output),
          nameReader_(nameReader),
          file_(file),
          pass_(file, from == Stop::LineStart, macroNames),
          run_(pass_.begin()),
          gainsByNotice_(nameReader.gainsByNotice()) {}

    /// Copies from where it begins, up to the end of the bytes, a name that may be a macro, a
    /// directive, or anything else out of the ordinary.
    [[nodiscard]] Stop copy(Stop from);

    /// Returns the name behind which copying stopped.
    [[nodiscard]] std::string_view name() const noexcept { return name_; }

    /// Tells whether all bytes ahead were copied.
    [[nodiscard]] bool isUsedUp() const noexcept { return pass_.begin() == pass_.end(); }

private:
    static constexpr std::size_t kNamesTogether = 8;

    // Where copying stops; nothing if it goes on.
    using Outcome = std::optional<Stop>;

    [[nodiscard]] Outcome passMark(TextMark mark);
    [[nodiscard]] Outcome passName();
    [[nodiscard]] Outcome takeName();
    [[nodiscard]] Outcome readNames();
    [[nodiscard]] const char* readName(std::string_view name);
    [[nodiscard]] Outcome passComment();
    [[nodiscard]] Outcome passContinuation();
    [[nodiscard]] Outcome passCarriageReturn();

    [[nodiscard]] Outcome beginLine(const char* start);
    [[nodiscard]] Outcome beginLine(const char* start, const char* behindBlanks);
    [[nodiscard]] bool passLineComments(const char*& start, const char*& behindBlanks);
    [[nodiscard]] bool needsNoLook(const char* start, const char* behindBlanks);
    void beginText(const char* start, const LineBeginning& beginning);
    void writeBlanks(const char* start, const char* first);
    [[nodiscard]] const char* endBlankLine(const char* start, const LineBeginning& beginning);
    [[nodiscard]] const char* endLine(const char* lineEnd);
    void passCommentLines(std::size_t count);

    // Returns the name that the scan stopped at.
    [[nodiscard]] std::string_view scannedName() noexcept {
        const char* const at = pass_.at();
        return {at, static_cast<std::size_t>(pass_.scan().nameEnd() - at)};
    }

    [[nodiscard]] static const char* endOf(std::string_view name) noexcept {
        return name.data() + name.size();
    }

    [[nodiscard]] Stop stop(const char* place, Stop stop);
    void writeUpTo(const char* place);

    void commit(const char* place) { output_.countLines(pass_.commit(place)); }

    void setInStep(bool isInStep) noexcept;

    OutputWriter& output_;
    NameReader& nameReader_;
    CppFileScanner& file_;
    TextPass pass_;
    std::size_t lineFeeds_ = 0;  // to be written before the run
    const char* run_;            // what else is not written yet begins here
    bool inStep_ = true;
    std::array<std::string_view, kNamesTogether> names_;  // taken and not read yet
    std::size_t nameCount_ = 0;
    bool gainsByNotice_;
    std::string_view name_;
    bool namesFollow_ = false;  // where reading the last one ended, with what is known of them
};

}  // namespace umpre

#endif
