// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_CPP_FILE_SCANNER_H
#define UMPRE_LEX_CPP_FILE_SCANNER_H

#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "lex/cpp_lexer.h"
#include "lex/cpp_scanner.h"
#include "lex/input_buffer.h"
#include "lex/literal.h"
#include "lex/output_writer.h"
#include "lex/snippet.h"
#include "lex/source_position.h"
#include "lex/text_map.h"

namespace umpre {

/// The tokens of a file. If its last line has no line end, a NEWLINE with an empty text closes it.
class CppFileScanner final : public CppScanner {
public:
    explicit CppFileScanner(CommentSink& commentSink, const RunOptions& options = {});

    /// Sets how many bytes are held at a time, about, of what is opened next.
    void setWindowSize(std::size_t size) { input_.setWindowSize(size); }

    /// Opens a file, or standard input, called "stdin", if the name is empty. Returns false if it
    /// cannot be opened; the scanner must then not be read.
    [[nodiscard]] bool open(const std::string& fileName);
    /// Reads what somebody else brings as if it were the file of that name.
    void openSource(const std::string& fileName, ByteSource& source);
    /// Reads a text as if it were the file of that name.
    void openText(const std::string& fileName, std::string_view text);
    /// Reads the bytes of a regular file that were kept, without opening it.
    void openKept(const std::string& fileName, std::shared_ptr<FileBytes> bytes,
                  const FileIdentity& identity);
    /// Closes the file; the scanner can open another one.
    void close();

    /// The name in messages and line markers.
    [[nodiscard]] const std::string& fileName() const noexcept { return fileName_; }

    void setFileName(std::string_view name) {
        fileName_ = name;
        markerEnd_.reset();
    }

    /// Returns what stands in the file's markers behind the line; empty if that is too long.
    [[nodiscard]] const Snippet& markerEnd() {
        if (!markerEnd_) {
            markerEnd_.emplace(OutputWriter::markerEndOf(fileName_));
        }
        return *markerEnd_;
    }

    void setLine(std::int32_t line) noexcept { lexer_.setLine(line); }

    [[nodiscard]] SourcePosition position() const noexcept { return {fileName_, lexer_.line()}; }

    [[nodiscard]] NoExpandSet noExpandSet() const override { return {}; }

    [[nodiscard]] bool isFile() const noexcept override { return true; }

    /// For readers of bytes: what lies ahead in memory, up to a place where a token begins; empty
    /// at the end of the file, and while a token is looked ahead at.
    [[nodiscard]] std::string_view bytesAhead() {
        return hasPeek() ? std::string_view{} : lexer_.bytesAhead();
    }

    /// Tells whether "#" comes next, and is no "##".
    [[nodiscard]] bool isAtHash() {
        const std::string_view bytes = bytesAhead();
        return bytes.starts_with('#') && !bytes.starts_with("##");
    }

    /// Returns the whole lines among the bytes ahead; at the end of the file, all of them.
    [[nodiscard]] std::string_view wholeLines() {
        return hasPeek() ? std::string_view{} : lexer_.wholeLines();
    }

    /// Tells whether nothing but END_OF_INPUT is left to be read.
    [[nodiscard]] bool isAtEnd() { return !hasPeek() && lastWasNewline_ && bytesAhead().empty(); }

    /// Returns the size of the literal that begins at this place of `wholeLines()`, or 0.
    [[nodiscard]] std::size_t literalSize(const char* quote) { return lexer_.literalSize(quote); }

    /// Returns what a regular file was when it was opened; all zeros for anything else.
    [[nodiscard]] const FileIdentity& identity() const noexcept { return input_.identity(); }

    /// Tells whether a regular file was read to its end and was as long as its size said.
    [[nodiscard]] bool isReadWhole() const noexcept { return input_.isReadWhole(); }

    /// Returns all bytes of a regular file, if they were read and are all in memory; otherwise
    /// nothing.
    [[nodiscard]] std::string_view wholeText() const noexcept { return input_.wholeText(); }

    /// Tells whether the file was kept and has no descriptor.
    [[nodiscard]] bool lacksDescriptor() const noexcept { return input_.lacksDescriptor(); }

    /// Takes a descriptor for a file that was kept, as if it were open.
    void holdDescriptor() { input_.holdDescriptor(); }

    /// Returns how often bytes were waited for since this was last asked.
    [[nodiscard]] std::size_t takeWaits() noexcept { return input_.takeWaits(); }

    /// Returns the finder of literals among the bytes ahead.
    [[nodiscard]] LiteralFinder& literals() noexcept { return lexer_.literals(); }

    /// Returns the map of the bytes ahead.
    [[nodiscard]] TextMap& textMap() noexcept { return lexer_.textMap(); }

    /// Passes over bytes ahead, up to the beginning of a token, `lines` line ends among them.
    void advance(std::size_t bytes, std::size_t lines, bool endsWithLineEnd);

private:
    [[nodiscard]] Token scan() override;
    void start();

    InputBuffer input_;
    CppLexer lexer_;
    std::string fileName_;
    std::optional<Snippet> markerEnd_;
    bool lastWasNewline_ = true;
};

}  // namespace umpre

#endif
