// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_INPUT_BUFFER_H
#define UMPRE_LEX_INPUT_BUFFER_H

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <utility>

#include "lex/byte_source.h"
#include "lex/file_bytes.h"
#include "lex/file_identity.h"
#include "lex/run_options.h"

namespace umpre {

/// The bytes of a file, of standard input, of somebody else or of a text, in windows. A window can
/// be scanned up to `limit()`, where a token begins: behind the last line end, or within a line
/// that is longer than the window. Of the tokens in front of it only comments and literals may
/// reach across; bytes behind it may already be there. Two zero bytes follow the end, as the
/// generated scanner wants them, and readers of several bytes at a time may read 64 bytes behind it
/// and 8 before the beginning.
class InputBuffer {
public:
    /// What a refill has to bring.
    enum class Need {
        Tokens,  ///< something to scan
        Bytes,   ///< something
        Double,  ///< as much again as is kept
    };

    /// On the plain road limits stand at line ends only.
    explicit InputBuffer(const RunOptions& options) noexcept
        : windowSize_(options.windowSize), splitsLines_(!options.plainRoad) {}

    InputBuffer(const InputBuffer&) = delete;
    InputBuffer& operator=(const InputBuffer&) = delete;

    ~InputBuffer() { close(); }

    /// Sets how many bytes are held at a time, about, in what is opened next. It is now closed.
    void setWindowSize(std::size_t size);

    /// Opens a file and keeps it open until `close`. Returns false if there is none, if it cannot
    /// be read, or if it is a directory. A regular file ends where it ended at this moment.
    [[nodiscard]] bool openFile(const std::string& name);
    /// Reads a descriptor that somebody else closes.
    void openBorrowed(int descriptor);
    /// Reads what somebody else brings.
    void openSource(ByteSource& source);
    /// Reads a copy of a text.
    void openText(std::string_view text);
    /// Reads the bytes of a regular file that were kept, without opening it.
    void openKept(std::shared_ptr<FileBytes> bytes, const FileIdentity& identity);

    /// Takes a descriptor for a file that was kept, as if it were open.
    void holdDescriptor();

    /// Tells whether a file is read that was kept and has no descriptor.
    [[nodiscard]] bool lacksDescriptor() const noexcept {
        return kept_ != nullptr && descriptor_ < 0;
    }

    void close();

    [[nodiscard]] char* begin() noexcept { return begin_; }

    [[nodiscard]] char* end() noexcept { return begin_ + filled_; }

    /// Returns the end of what can be scanned; at the end of the input, the end of the bytes.
    [[nodiscard]] char* limit() noexcept { return begin_ + limit_; }

    /// Tells whether nothing follows the bytes in memory.
    [[nodiscard]] bool isEnded() const noexcept { return ended_; }

    /// Drops what stands before `position`, moves the rest to the front and reads on until what is
    /// needed has come or the input ends. Sets `position` to where its byte is now. Returns false
    /// if nothing is left there. Throws ScannerFailure if reading fails.
    [[nodiscard]] bool refill(char*& position, Need need);

    /// Returns what a regular file was when it was opened; all zeros for anything else.
    [[nodiscard]] const FileIdentity& identity() const noexcept { return identity_; }

    /// Tells whether a regular file was read to its end and was as long as its size said.
    [[nodiscard]] bool isReadWhole() const noexcept { return sizeKnown_ && unread_ == 0; }

    /// Returns all bytes of a regular file that is open, if it was read whole and they are all in
    /// memory; otherwise nothing.
    [[nodiscard]] std::string_view wholeText() const noexcept;

    /// Returns how often bytes were waited for since this was last asked.
    [[nodiscard]] std::size_t takeWaits() noexcept { return std::exchange(waits_, 0); }

private:
    void reset();
    void dropLargeMemory();
    void reserve(std::size_t capacity);
    [[nodiscard]] bool hasCome(Need need, std::size_t kept, std::size_t& searched);
    [[nodiscard]] bool findLimit(std::size_t& searched);
    void readOnce();
    [[nodiscard]] std::size_t readBytes(std::size_t room);
    void terminate();

    struct Free {
        void operator()(char* memory) const noexcept;
    };

    std::size_t windowSize_;
    bool splitsLines_;
    std::unique_ptr<char, Free> data_;
    std::shared_ptr<FileBytes> kept_;  // read instead of the memory
    char* begin_ = nullptr;            // of the bytes, within the memory
    std::size_t capacity_ = 0;         // without the bytes around it
    std::size_t filled_ = 0;
    std::size_t limit_ = 0;
    int descriptor_ = -1;
    ByteSource* source_ = nullptr;  // read instead of the descriptor
    bool owned_ = false;
    bool ended_ = true;
    bool readAtOnce_ = false;  // in the first refill
    bool sizeKnown_ = false;
    std::uint64_t unread_ = 0;  // of a regular file
    FileIdentity identity_;
    bool mayWait_ = false;  // for somebody else to write
    std::size_t waits_ = 0;
};

}  // namespace umpre

#endif
