// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_SCANNER_STACK_H
#define UMPRE_LEX_SCANNER_STACK_H

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "lex/comment_sink.h"
#include "lex/cpp_file_scanner.h"
#include "lex/cpp_scanner.h"
#include "lex/cpp_token_scanner.h"
#include "lex/output_writer.h"
#include "lex/pieces.h"
#include "lex/reporter.h"
#include "lex/run_options.h"
#include "lex/source_position.h"
#include "lex/token.h"

namespace umpre {

/// What happens to files on the stack. The file that ends is still the current one when it ends.
class FileEvents {
public:
    virtual ~FileEvents() = default;
    virtual void fileEntered() = 0;
    virtual void fileEnds() = 0;
    virtual void fileResumed() = 0;
};

/// What is read now, and what waits below it. Every consumer reads through `peek` and `next`, which
/// drop an exhausted source and go on in the one below.
class ScannerStack final : private CommentSink {
public:
    /// The references must outlive the stack; none is used before the first source is pushed.
    ScannerStack(FileEvents& events, OutputWriter& output, Reporter& reporter,
                 const RunOptions& options);
    ScannerStack(const ScannerStack&) = delete;
    ScannerStack& operator=(const ScannerStack&) = delete;
    ~ScannerStack() override;

    /// Returns the kind of the next token; END_OF_INPUT when all is read, or the isolated source
    /// is.
    [[nodiscard]] TokenKind peek() {
        const TokenKind kind = currentSource_->peek();
        return kind != TokenKind::END_OF_INPUT || atFloor() ? kind : peekBelow();
    }

    /// Consumes the next token. Its text is valid until the next `peek` or `next`.
    Token next() {
        const Token token = currentSource_->next();
        return token.kind != TokenKind::END_OF_INPUT || atFloor() ? token : nextBelow();
    }

    /// Returns the names that must not be expanded in the token last read or peeked.
    [[nodiscard]] NoExpandSet noExpandSet() const { return currentSource_->noExpandSet(); }

    /// Consumes blanks and returns their texts, joined.
    std::string skipBlanks() { return skipWhile(isBlank); }

    /// Consumes blanks and line ends and returns their texts, joined.
    std::string skipBlanksAndNewlines() { return skipWhile(isBlankOrNewline); }

    /// Consumes blanks and line ends. Tells whether there were any: the NEWLINE that a file
    /// supplies at its end has no text, but it counts.
    bool passBlanksAndNewlines() {
        bool any = false;
        while (isBlankOrNewline(peek())) {
            (void)currentSource_->next();
            any = true;
        }
        return any;
    }

    /// Consumes tokens up to and including a NEWLINE, at least one.
    void skipToEndOfLine();

    /// Opens a file, or standard input if the name is empty, and reads it from now on. Returns
    /// false, with nothing changed, if it cannot be opened. `messageName`, if not empty, replaces
    /// the name in messages and markers.
    [[nodiscard]] bool pushFile(const std::string& fileName, std::string_view messageName = {});
    /// Does the same for a file whose bytes were kept. One more must be able to be opened.
    void pushKeptFile(const std::string& fileName, std::shared_ptr<FileBytes> bytes,
                      const FileIdentity& identity);
    /// Reads what somebody else brings as if it were a file.
    void pushFileSource(const std::string& fileName, ByteSource& source);
    /// Reads a text as if it were a file.
    void pushFileText(const std::string& fileName, std::string_view text);
    /// Reads pieces, taking them over; `pieces` must be restarted before it is used again.
    void pushPieces(Pieces&& pieces);
    /// Reads one piece.
    void pushSlice(TextSlice slice, NoExpandSet noExpand);

    /// Reads one piece on its own: until `endIsolation`, reading ends where it ends.
    void isolate(TextSlice slice, NoExpandSet noExpand);
    void endIsolation();

    /// Returns the file that is being read, also while a macro's replacement is read.
    [[nodiscard]] CppFileScanner& currentFile() noexcept { return *files_.back(); }

    [[nodiscard]] bool hasFile() const noexcept { return !files_.empty(); }

    [[nodiscard]] SourcePosition position() const { return files_.back()->position(); }

    /// Returns the file if the next token comes straight from it, otherwise null.
    [[nodiscard]] CppFileScanner* fileReadNow() {
        dropReadLists();
        return sources_.back().isFile ? files_.back().get() : nullptr;
    }

    /// Returns the list if the next token comes from one and may be taken as a part of it,
    /// otherwise null.
    [[nodiscard]] CppTokenScanner* listReadNow() noexcept {
        return listsUsed_ > 0 && !options_.plainRoad && !sources_.back().isFile
                   ? lists_[listsUsed_ - 1].get()
                   : nullptr;
    }

    /// Tells whether every token must be read by itself.
    [[nodiscard]] bool plainRoad() const noexcept { return options_.plainRoad; }

    /// Tells whether each macro must be expanded by itself.
    [[nodiscard]] bool tellsMacros() const noexcept { return options_.tellsMacros; }

    /// Tells whether the token read last came straight from a file.
    [[nodiscard]] bool readsFile() const noexcept { return sources_.back().isFile; }

    /// Leaves the current file, as reading on would, if it is an included one and read to its end.
    /// Returns whether it was. The token behind is not looked at.
    bool leaveEndedFile();

    /// Returns how often bytes were waited for so far. While a program waits, others may change
    /// files.
    [[nodiscard]] std::size_t waits() noexcept {
        waits_ += files_.back()->takeWaits();
        return waits_;
    }

    /// Tells whether so many files have been open at a time that one more can be opened now.
    [[nodiscard]] bool canOpenOneMore() const noexcept { return files_.size() < mostFiles_; }

    /// Does what reading a token of a text does beside yielding it.
    void carryOutEffects(const LexedText& text, std::size_t index) {
        text.carryOutEffects(index, *this);
    }

    /// Returns how many comments met so far had an effect beside their blank.
    [[nodiscard]] std::size_t commentEffects() const noexcept { return commentEffects_; }

private:
    bool commentLineEnds(std::size_t count) override;
    void unterminatedComment(std::int32_t line) override;

    [[nodiscard]] CommentSink& commentSink() noexcept { return *this; }

    [[nodiscard]] bool atFloor() const noexcept { return sources_.size() == floor_; }

    [[nodiscard]] TokenKind peekBelow();
    [[nodiscard]] Token nextBelow();
    [[nodiscard]] std::string skipWhile(bool (*wanted)(TokenKind));
    [[nodiscard]] std::unique_ptr<CppFileScanner> newFile();
    void enter(std::unique_ptr<CppFileScanner> file);
    void holdDescriptors();
    [[nodiscard]] CppTokenScanner& pushList();
    void pop();
    void dropCurrent();

    void dropReadLists() {
        while (!sources_.back().isFile && !atFloor() && lists_[listsUsed_ - 1]->isExhausted()) {
            dropCurrent();
        }
    }

    FileEvents& events_;
    OutputWriter& output_;
    Reporter& reporter_;
    RunOptions options_;

    struct Source {
        CppScanner* scanner;
        bool isFile;
    };

    CppScanner* currentSource_ = nullptr;
    std::vector<Source> sources_;  // the current one is the last
    // Those of the sources that are files and, up to `listsUsed_`, those that are lists, in the
    // same order; the lists behind them are to be used again.
    std::vector<std::unique_ptr<CppFileScanner>> files_;
    std::vector<std::unique_ptr<CppTokenScanner>> lists_;
    std::size_t listsUsed_ = 0;
    std::vector<std::unique_ptr<CppFileScanner>> spareFiles_;
    // Reading stays at or above this many sources: the main file, or the source read on its own.
    std::size_t floor_ = 1;
    std::vector<std::size_t> savedFloors_;
    std::size_t commentEffects_ = 0;
    std::size_t waits_ = 0;
    std::size_t mostFiles_ = 0;  // open at a time
    std::size_t filesWithoutDescriptors_ = 0;
};

}  // namespace umpre

#endif
