// SPDX-License-Identifier: MIT
#include "lex/text_pass.h"

#include <utility>

#include "lex/spelling.h"

namespace umpre {

TextPass::TextPass(CppFileScanner& file, bool atLineStart, const NameFilter& names)
    : TextPass(file, file.bytesAhead(), atLineStart, names) {}

void TextPass::passContinuation(bool atLineStart) noexcept {
    const char* const lineEnd = scan_.at() + 1;
    continued_ = lineEnd[0] == '\r' && lineEnd[1] == '\n' ? lineEnd + 2 : lineEnd + 1;
    carriageReturns_ += continued_[-1] == '\r' ? 1 : 0;
    scan_.resume(continued_, atLineStart);
    ++lines_;
}

std::size_t TextPass::commit(const char* place) {
    if (place == begin_) {
        return 0;
    }
    const std::size_t lineFeeds = lineFeedsBefore(place);
    const std::size_t lines = lineFeeds - lineFeedsBefore_ + carriageReturns_;
    const bool endsLine = isLineEndByte(place[-1]) && place != continued_;
    file_.advance(static_cast<std::size_t>(place - begin_), lines, endsLine);
    begin_ = place;
    lineFeedsBefore_ = lineFeeds;
    carriageReturns_ = 0;
    return lines - std::exchange(lines_, 0);
}

}  // namespace umpre
