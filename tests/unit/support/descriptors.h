// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_DESCRIPTORS_H
#define UMPRE_TESTS_UNIT_SUPPORT_DESCRIPTORS_H

#include <array>
#include <cstddef>
#include <stdexcept>
#include <string>
#include <string_view>
#include <sys/mman.h>
#include <unistd.h>

namespace umpre::testing {

/// A pipe, small texts of which a test writes and reads without another process.
class Pipe {
public:
    Pipe() {
        if (::pipe(ends_.data()) != 0) {
            throw std::runtime_error("no pipe");
        }
    }

    explicit Pipe(std::string_view text) : Pipe() {
        write(text);
        closeWriteEnd();
    }

    Pipe(const Pipe&) = delete;
    Pipe& operator=(const Pipe&) = delete;

    ~Pipe() {
        closeReadEnd();
        closeWriteEnd();
    }

    [[nodiscard]] int readEnd() const noexcept { return ends_[0]; }

    [[nodiscard]] int writeEnd() const noexcept { return ends_[1]; }

    void write(std::string_view text) const {
        if (::write(ends_[1], text.data(), text.size()) != static_cast<ssize_t>(text.size())) {
            throw std::runtime_error("a pipe did not take a text");
        }
    }

    /// Returns what waits in the pipe, at most a few kilobytes.
    [[nodiscard]] std::string read() const {
        std::array<char, 4096> buffer{};
        const ssize_t count = ::read(ends_[0], buffer.data(), buffer.size());
        return {buffer.data(), count < 0 ? 0 : static_cast<std::size_t>(count)};
    }

    void closeReadEnd() noexcept { close(ends_[0]); }

    void closeWriteEnd() noexcept { close(ends_[1]); }

private:
    static void close(int& end) noexcept {
        if (end >= 0) {
            ::close(end);
            end = -1;
        }
    }

    std::array<int, 2> ends_{-1, -1};
};

/// A file without a name that holds a text of any size, to be read from its beginning.
class MemoryFile {
public:
    explicit MemoryFile(std::string_view text) : descriptor_(::memfd_create("text", MFD_CLOEXEC)) {
        while (!text.empty()) {
            const ssize_t count = ::write(descriptor_, text.data(), text.size());
            if (count <= 0) {
                throw std::runtime_error("a file in memory did not take a text");
            }
            text.remove_prefix(static_cast<std::size_t>(count));
        }
        ::lseek(descriptor_, 0, SEEK_SET);
    }

    MemoryFile(const MemoryFile&) = delete;
    MemoryFile& operator=(const MemoryFile&) = delete;

    ~MemoryFile() { ::close(descriptor_); }

    [[nodiscard]] int descriptor() const noexcept { return descriptor_; }

private:
    int descriptor_;
};

/// Puts one descriptor in another's place while this object lives.
class Replaced {
public:
    Replaced(int descriptor, int replacement) : descriptor_(descriptor), saved_(::dup(descriptor)) {
        ::dup2(replacement, descriptor);
    }

    Replaced(const Replaced&) = delete;
    Replaced& operator=(const Replaced&) = delete;

    ~Replaced() {
        ::dup2(saved_, descriptor_);
        ::close(saved_);
    }

private:
    int descriptor_;
    int saved_;
};

}  // namespace umpre::testing

#endif
