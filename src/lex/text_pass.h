// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_PASS_H
#define UMPRE_LEX_TEXT_PASS_H

#include <cstddef>
#include <string_view>

#include "lex/cpp_file_scanner.h"
#include "lex/name_filter.h"
#include "lex/text_map.h"
#include "lex/text_scan.h"

namespace umpre {

/// One pass over the bytes of a file that lie ahead: the scan of them, and what the file must be
/// told about it.
class TextPass {
public:
    /// `names` are those that may be macros. If there are no bytes ahead, there is nothing to pass.
    TextPass(CppFileScanner& file, bool atLineStart, const NameFilter& names);

    [[nodiscard]] TextScan& scan() noexcept { return scan_; }

    /// Returns the place of the scan's mark.
    [[nodiscard]] const char* at() const noexcept { return scan_.at(); }

    [[nodiscard]] const char* end() const noexcept { return scan_.end(); }

    /// Returns where the file stands.
    [[nodiscard]] const char* begin() const noexcept { return begin_; }

    /// Counts lines that are none of those that the scan passes over.
    void countLines(std::size_t count) noexcept { lines_ += count; }

    /// Says that one of these ended with a carriage return alone.
    void countCarriageReturn() noexcept { ++carriageReturns_; }

    /// Returns the comment that begins at `comment`, as TextMap does.
    [[nodiscard]] TextMap::Comment commentAt(const char* comment) {
        return file_.textMap().commentAt(comment, end());
    }

    /// Passes over the continuation that the scan stopped at.
    void passContinuation(bool atLineStart) noexcept;

    /// Tells the file that it was read up to `place`, where a token begins. Returns how many lines
    /// the scan passed over since the last time.
    std::size_t commit(const char* place);

private:
    TextPass(CppFileScanner& file, std::string_view text, bool atLineStart, const NameFilter& names)
        : file_(file),
          scan_(text, atLineStart, file.textMap(), file.literals(), names),
          begin_(text.data()),
          lineFeedsBefore_(text.empty() ? 0 : lineFeedsBefore(begin_)) {}

    [[nodiscard]] std::size_t lineFeedsBefore(const char* place) {
        return file_.textMap().lineFeedsBefore(place, end());
    }

    CppFileScanner& file_;
    TextScan scan_;
    const char* begin_;
    const char* continued_ = nullptr;  // behind the last continuation
    std::size_t lineFeedsBefore_;      // before begin_
    std::size_t lines_ = 0;            // that the scan did not pass over
    std::size_t carriageReturns_ = 0;  // line ends by themselves among these
};

}  // namespace umpre

#endif
