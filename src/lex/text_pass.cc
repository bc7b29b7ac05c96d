// SPDX-License-Identifier: MIT
#include "lex/text_pass.h"

#include "lex/spelling.h"

namespace umpre {

TextPass::TextPass(CppFileScanner& file, bool atLineStart, const NameFilter& names)
    : TextPass(file, file.bytesAhead(), atLineStart, names) {}

void TextPass::passContinuation(bool atLineStart) noexcept {
    const char* const lineEnd = scan_.at() + 1;
    continued_ = lineEnd[0] == '\r' && lineEnd[1] == '\n' ? lineEnd + 2 : lineEnd + 1;
    scan_.resume(continued_, atLineStart);
    ++lines_;
}

std::size_t TextPass::commit(const char* place) {
    const std::size_t lineFeeds = scan_.takeLineFeeds();
    if (place != begin_) {
        const bool endsLine = isLineEndByte(place[-1]) && place != continued_;
        file_.advance(static_cast<std::size_t>(place - begin_), lineFeeds + lines_, endsLine);
        begin_ = place;
        lines_ = 0;
    }
    return lineFeeds;
}

}  // namespace umpre
