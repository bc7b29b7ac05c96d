// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_LEXER_H
#define UMPRE_LEX_TEXT_LEXER_H

#include <string>
#include <string_view>

#include "lex/comment_sink.h"
#include "lex/cpp_lexer.h"
#include "lex/lexed_text.h"
#include "lex/shared_text.h"

namespace umpre {

/// Lexes texts: macro bodies, arguments, directive operands. One scanner and one piece of memory
/// serve all of them.
class TextLexer final : private CommentSink {
public:
    explicit TextLexer(const RunOptions& options = {}) : lexer_(*this, options) {}

    /// Adds the tokens of `text` to `to`. What comments in it do is recorded there, not done.
    void append(LexedText& to, std::string_view text);

    /// Returns the tokens of `text`.
    [[nodiscard]] SharedText lexed(std::string_view text) {
        SharedText result = texts_.take();
        append(result.edit(), text);
        return result;
    }

    /// Returns the pool for texts that are made of others. It must outlive them.
    [[nodiscard]] TextPool& texts() noexcept { return texts_; }

private:
    bool commentLineEnds(std::size_t count) override;
    void unterminatedComment(std::int32_t line) override;

    TextPool texts_;
    std::string memory_;
    CppLexer lexer_;
    LexedText* to_ = nullptr;
};

}  // namespace umpre

#endif
