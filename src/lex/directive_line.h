// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_DIRECTIVE_LINE_H
#define UMPRE_LEX_DIRECTIVE_LINE_H

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

#include "lex/cpp_file_scanner.h"
#include "lex/token.h"

namespace umpre {

/// The next line of a file read as bytes, if it is a directive. The file goes on only with
/// `takeEnd`; whoever meets something that cannot be told from the bytes drops the line before
/// that, and the scanner reads it.
class DirectiveLine {
public:
    /// Reads "#" and the word behind it. The file must be at the start of a line, with no token
    /// looked ahead at.
    explicit DirectiveLine(CppFileScanner& file);

    /// What became of a line.
    enum class Outcome {
        Untold,    ///< nothing, it is for the scanner
        EndLeft,   ///< it was carried out; its end comes next, and is text
        EndTaken,  ///< it was carried out, with its end
    };

    /// Returns the kind of the directive's word, a name; END_OF_INPUT if the line has none, or is
    /// not whole in memory, or has a continuation before the "#", which is then not on the line
    /// that the file stands on.
    [[nodiscard]] TokenKind word() const noexcept { return word_; }

    /// Returns the byte that comes next.
    [[nodiscard]] char peekByte() const noexcept { return *at_; }

    /// Tells whether the line's end comes next.
    [[nodiscard]] bool isAtEnd() const noexcept { return *at_ == '\n'; }

    /// Passes over blanks, comments and continuations. A comment or a continuation that does not
    /// end in this line, or in memory, is not passed; it comes next as a token of the kind OTHER.
    /// Tells whether there were any.
    bool skipBlanks() {
        const char* const begin = at_;
        while (*at_ == ' ') {
            ++at_;
        }
        if (*at_ < ' ' || *at_ == '/' || *at_ == '\\') {  // other blanks, perhaps
            at_ = blanksEnd(at_).end;
        }
        return at_ != begin;
    }

    /// Tells whether no continuation was passed so far: the file's line is that of the bytes read.
    [[nodiscard]] bool isOneLine() const noexcept { return lines_ == 0; }

    /// Reads the token that comes next, as `tokenAt` tells it. The line's end, OTHER, is not
    /// passed: what is behind it may not be there.
    [[nodiscard]] Token next();

    /// Reads the rest of the line up to its end and returns it with one space for each run of
    /// blanks, and nothing for continuations alone. The text is valid until `memory` and the file
    /// are used again. Returns nothing if the text cannot be told from the bytes.
    [[nodiscard]] std::optional<std::string_view> readText(std::string& memory);

    /// Returns the bytes ahead up to the next line feed; none if they are more than about `most`.
    [[nodiscard]] std::string_view bytesToLineFeed(std::size_t most) const noexcept;

    /// Passes over so many bytes, up to the beginning of a token; no line end is among them.
    void passBytes(std::size_t count) noexcept { at_ += count; }

    /// Passes over the rest of the line up to its end. Returns false if that cannot be told from
    /// the bytes.
    [[nodiscard]] bool skipRest();

    /// Passes over the line's end, which comes next: the file goes on behind it.
    void takeEnd();

private:
    struct Blanks {
        const char* end;
        bool separate;  // there were others than continuations
    };

    [[nodiscard]] Blanks blanksEnd(const char* at);
    [[nodiscard]] const char* runEnd(const char* at);

    CppFileScanner& file_;
    const char* begin_;
    const char* limit_;  // behind the last line end in memory
    const char* at_;
    std::size_t lines_ = 0;
    TokenKind word_ = TokenKind::END_OF_INPUT;
};

}  // namespace umpre

#endif
