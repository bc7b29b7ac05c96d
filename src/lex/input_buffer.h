// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_INPUT_BUFFER_H
#define UMPRE_LEX_INPUT_BUFFER_H

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

namespace umpre {

/// The bytes of a file, of standard input or of a text, in windows. A window holds whole lines up
/// to `lineLimit()`, so no token but a block comment reaches from one window into the next; behind
/// it the beginning of the next line may stand. Two zero bytes follow the end, as the generated
/// scanner wants them.
class InputBuffer {
public:
    /// What a refill has to bring.
    enum class Need { Bytes, Line };

    explicit InputBuffer(std::size_t windowSize) noexcept : windowSize_(windowSize) {}

    InputBuffer(const InputBuffer&) = delete;
    InputBuffer& operator=(const InputBuffer&) = delete;

    ~InputBuffer() { close(); }

    /// Opens a file and keeps it open until `close`. Returns false if there is none, if it cannot
    /// be read, or if it is a directory. A regular file ends where it ended at this moment.
    [[nodiscard]] bool openFile(const std::string& name);
    /// Reads a descriptor that somebody else closes.
    void openBorrowed(int descriptor);
    /// Reads a copy of a text.
    void openText(std::string_view text);
    void close();

    [[nodiscard]] char* begin() noexcept { return data_.get(); }

    [[nodiscard]] char* end() noexcept { return data_.get() + filled_; }

    /// Returns the end of the last whole line; at the end of the input, the end of the bytes.
    [[nodiscard]] char* lineLimit() noexcept { return data_.get() + lineLimit_; }

    /// Drops what stands before `position`, moves the rest to the front and reads on until what is
    /// needed has come or the input ends. Sets `position` to where its byte is now. Returns false
    /// if nothing is left there. Throws ScannerFailure if reading fails.
    [[nodiscard]] bool refill(char*& position, Need need);

private:
    void reset();
    void reserve(std::size_t capacity);
    [[nodiscard]] std::size_t readOnce();
    void terminate();

    struct Free {
        void operator()(char* memory) const noexcept;
    };

    std::size_t windowSize_;
    std::unique_ptr<char, Free> data_;
    std::size_t capacity_ = 0;  // without the zero bytes behind
    std::size_t filled_ = 0;
    std::size_t lineLimit_ = 0;
    int descriptor_ = -1;
    bool owned_ = false;
    bool ended_ = true;
    bool readAtOnce_ = false;  // in the first refill
    bool sizeKnown_ = false;
    std::uint64_t unread_ = 0;  // of a regular file
};

}  // namespace umpre

#endif
