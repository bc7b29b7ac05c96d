// SPDX-License-Identifier: MIT
//
// Reads in windows. The window of "ab\ncd\nef" with room for eight bytes is
//
//     a b \n c d \n e f 0 0        lineLimit() behind the second line feed
//
// and once the two lines are used up, "ef" moves to the front and reading goes on behind it. A line
// that is longer than the window makes the window grow, by doubling, so that every byte is moved a
// constant number of times.
#include "lex/input_buffer.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <new>
#include <sys/stat.h>
#include <unistd.h>

#include "lex/scanner_failure.h"

namespace umpre {
namespace {

// The generated scanner wants two zero bytes; readers of several bytes at a time may look further.
constexpr std::size_t kPadding = 64;

}  // namespace

void InputBuffer::Free::operator()(char* memory) const noexcept {
    std::free(memory);  // NOLINT(cppcoreguidelines-no-malloc): grown with realloc
}

bool InputBuffer::openFile(const std::string& name) {
    if (name.find('\0') != std::string::npos) {
        return false;
    }
    const int descriptor = ::open(name.c_str(), O_RDONLY | O_CLOEXEC);
    if (descriptor < 0) {
        return false;
    }

    struct stat status {};

    if (::fstat(descriptor, &status) != 0 || S_ISDIR(status.st_mode)) {
        ::close(descriptor);
        return false;
    }
    openBorrowed(descriptor);
    owned_ = true;
    if (S_ISREG(status.st_mode)) {
        // A size of 0 may just not be told. What such a file holds is read before anything can be
        // added to it.
        sizeKnown_ = status.st_size > 0;
        readAtOnce_ = !sizeKnown_;
        unread_ = static_cast<std::uint64_t>(status.st_size);
    }
    return true;
}

void InputBuffer::openBorrowed(int descriptor) {
    close();
    descriptor_ = descriptor;
    ended_ = false;
}

void InputBuffer::openText(std::string_view text) {
    close();
    reserve(text.size());
    filled_ = text.copy(begin(), text.size());
    terminate();
}

void InputBuffer::close() {
    if (owned_) {
        ::close(descriptor_);
    }
    if (capacity_ > 2 * windowSize_) {
        data_.reset();
        capacity_ = 0;
    }
    reset();
}

void InputBuffer::reset() {
    filled_ = 0;
    lineLimit_ = 0;
    descriptor_ = -1;
    owned_ = false;
    ended_ = true;
    readAtOnce_ = false;
    sizeKnown_ = false;
    unread_ = 0;
}

bool InputBuffer::refill(char*& position, Need need) {
    if (data_ != nullptr && position != begin()) {
        const auto kept = static_cast<std::size_t>(end() - position);
        std::memmove(begin(), position, kept);
        filled_ = kept;
    }
    bool enough = false;
    while (!enough && !ended_) {
        const std::size_t before = filled_;
        const std::size_t count = readOnce();
        const void* const lineEnd = ::memrchr(begin() + before, '\n', count);
        if (readAtOnce_) {
            continue;
        }
        if (lineEnd != nullptr) {
            lineLimit_ = static_cast<std::size_t>(static_cast<const char*>(lineEnd) - begin()) + 1;
            enough = true;
        } else if (need == Need::Bytes && count > 0) {
            lineLimit_ = 0;
            enough = true;
        }
    }
    terminate();
    position = begin();
    return filled_ > 0;
}

std::size_t InputBuffer::readOnce() {
    std::size_t wanted = windowSize_;
    if (sizeKnown_) {
        wanted = static_cast<std::size_t>(std::min<std::uint64_t>(unread_, windowSize_));
    }
    if (filled_ + wanted > capacity_) {
        // Room for the window; after that, twice as much each time.
        wanted = std::max(wanted, filled_);
        reserve(filled_ + wanted);
    }
    std::size_t room = capacity_ - filled_;
    if (sizeKnown_) {
        room = static_cast<std::size_t>(std::min<std::uint64_t>(unread_, room));
    }
    ssize_t count = 0;
    do {
        count = room == 0 ? 0 : ::read(descriptor_, end(), room);
    } while (count < 0 && errno == EINTR);
    if (count < 0) {
        throw ScannerFailure{"input in flex scanner failed"};
    }
    filled_ += static_cast<std::size_t>(count);
    if (sizeKnown_) {
        unread_ -= static_cast<std::uint64_t>(count);
    }
    ended_ = count == 0 || (sizeKnown_ && unread_ == 0);
    return static_cast<std::size_t>(count);
}

void InputBuffer::terminate() {
    if (ended_) {
        lineLimit_ = filled_;
    }
    if (data_ == nullptr) {
        reserve(0);
    }
    std::memset(end(), 0, 2);
}

void InputBuffer::reserve(std::size_t capacity) {
    if (data_ != nullptr && capacity <= capacity_) {
        return;
    }
    // NOLINTNEXTLINE(cppcoreguidelines-no-malloc): realloc moves large windows without a copy
    void* const memory = std::realloc(data_.get(), capacity + kPadding);
    if (memory == nullptr) {
        throw std::bad_alloc();
    }
    (void)data_.release();
    data_.reset(static_cast<char*>(memory));
    capacity_ = capacity;
}

}  // namespace umpre
