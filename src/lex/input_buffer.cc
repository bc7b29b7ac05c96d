// SPDX-License-Identifier: MIT
//
// Reads in windows. The window of "ab\ncd\nef" with room for eight bytes is
//
//     a b \n c d \n e f 0 0        limit() behind the second line feed
//
// and once the two lines are used up, "ef" moves to the front and reading goes on behind it. Where
// no line ends in a full window, the limit stands between two bytes that no token holds together.
// A token that is longer than the window makes the window grow, by doubling, so that every byte is
// moved a constant number of times.
#include "lex/input_buffer.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <new>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

#include "lex/scanner_failure.h"
#include "lex/spelling.h"

namespace umpre {
namespace {

// Tells whether a token ends between two neighbours wherever they stand, comments and literals
// aside.
[[nodiscard]] bool isSplit(char before, char behind) noexcept {
    constexpr std::string_view kBeginsTwo = "#|&=!<>/\\";
    if (before == '\r') {
        return behind != '\n';
    }
    return kBeginsTwo.find(before) == std::string_view::npos
           && !(isWordByte(before) && isWordByte(behind));
}

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
    mayWait_ = !S_ISREG(status.st_mode);
    waits_ += mayWait_ ? 1 : 0;
    if (!mayWait_) {
        // A size of 0 may just not be told. What such a file holds is read before anything can be
        // added to it.
        identity_ = identityOf(status);
        sizeKnown_ = status.st_size > 0;
        readAtOnce_ = !sizeKnown_;
        unread_ = static_cast<std::uint64_t>(status.st_size);
    }
    return true;
}

void InputBuffer::openBorrowed(int descriptor) {
    close();
    descriptor_ = descriptor;
    mayWait_ = true;
    ended_ = false;
}

void InputBuffer::openSource(ByteSource& source) {
    openBorrowed(-1);
    source_ = &source;
}

void InputBuffer::openText(std::string_view text) {
    close();
    reserve(text.size());
    filled_ = text.copy(begin(), text.size());
    terminate();
}

void InputBuffer::openKept(std::shared_ptr<FileBytes> bytes, const FileIdentity& identity) {
    close();
    kept_ = std::move(bytes);
    begin_ = kept_->begin();
    filled_ = kept_->size();
    limit_ = filled_;
    sizeKnown_ = true;
    identity_ = identity;
}

void InputBuffer::holdDescriptor() {
    descriptor_ = ::open("/", O_PATH | O_CLOEXEC);
    owned_ = descriptor_ >= 0;
}

std::string_view InputBuffer::wholeText() const noexcept {
    const auto size = static_cast<std::size_t>(identity_.size);
    const char* const end = begin_ + filled_;
    if (kept_ != nullptr || !isReadWhole()
        || static_cast<std::size_t>(end - data_.get()) != kBytesBefore + size) {
        return {};
    }
    return {end - size, size};
}

void InputBuffer::close() {
    if (owned_) {
        ::close(descriptor_);
    }
    dropLargeMemory();
    reset();
}

void InputBuffer::setWindowSize(std::size_t size) {
    windowSize_ = size;
    close();
}

void InputBuffer::dropLargeMemory() {
    if (capacity_ > 2 * windowSize_) {
        data_.reset();
        capacity_ = 0;
    }
}

void InputBuffer::reset() {
    kept_.reset();
    begin_ = data_ == nullptr ? nullptr : data_.get() + kBytesBefore;
    filled_ = 0;
    limit_ = 0;
    descriptor_ = -1;
    source_ = nullptr;
    owned_ = false;
    ended_ = true;
    readAtOnce_ = false;
    sizeKnown_ = false;
    unread_ = 0;
    identity_ = {};
}

bool InputBuffer::refill(char*& position, Need need) {
    const auto kept = static_cast<std::size_t>(end() - position);
    if (ended_) {
        begin_ = position;  // nothing comes behind, and who was here first finds all as it was
    } else if (position != begin_) {
        std::memmove(begin_, position, kept);
    }
    filled_ = kept;
    limit_ = 0;
    std::size_t searched = 0;
    // A comment or a literal that reached across the limit may have left something to scan.
    bool enough = need == Need::Tokens && findLimit(searched);
    while (!enough && !ended_) {
        readOnce();
        enough = !readAtOnce_ && hasCome(need, kept, searched);
    }
    terminate();
    position = begin_;
    return filled_ > 0;
}

bool InputBuffer::hasCome(Need need, std::size_t kept, std::size_t& searched) {
    switch (need) {
    case Need::Tokens: return findLimit(searched);
    case Need::Bytes: return filled_ > kept;
    case Need::Double: return filled_ >= 2 * kept && filled_ > kept;
    }
    return true;
}

// Looks for a limit behind the first `searched` bytes, which have none. Returns false if there is
// none, or only one within a line that may yet end in this window.
bool InputBuffer::findLimit(std::size_t& searched) {
    if (searched == filled_) {
        return false;
    }
    const void* const lineEnd = ::memrchr(begin_ + searched, '\n', filled_ - searched);
    if (lineEnd != nullptr) {
        limit_ = static_cast<std::size_t>(static_cast<const char*>(lineEnd) - begin_) + 1;
        return true;
    }
    if (splitsLines_ && filled_ >= windowSize_) {
        const std::size_t first = searched < windowSize_ ? 1 : searched;
        for (std::size_t at = filled_ - 1; at >= first; --at) {
            if (isSplit(begin_[at - 1], begin_[at])) {
                limit_ = at;
                return true;
            }
        }
    }
    searched = filled_;
    return false;
}

void InputBuffer::readOnce() {
    std::size_t wanted = windowSize_;
    if (sizeKnown_) {
        wanted = static_cast<std::size_t>(std::min<std::uint64_t>(unread_, windowSize_));
    }
    if (filled_ + wanted > capacity_) {
        // Room for the window and the line that it begins in; after that, twice as much each time.
        reserve(filled_ == 0 && wanted < windowSize_
                    ? wanted
                    : filled_ + std::max(wanted + wanted / 4, filled_));
    }
    std::size_t room = std::min(capacity_ - filled_, std::max(windowSize_, filled_));
    if (sizeKnown_) {
        room = static_cast<std::size_t>(std::min<std::uint64_t>(unread_, room));
    }
    const std::size_t count = room == 0 ? 0 : readBytes(room);
    filled_ += count;
    waits_ += mayWait_ ? 1 : 0;
    if (sizeKnown_) {
        unread_ -= count;
    }
    ended_ = count == 0 || (sizeKnown_ && unread_ == 0);
}

// Returns how many bytes have come; 0 at the end.
std::size_t InputBuffer::readBytes(std::size_t room) {
    std::optional<std::size_t> count;
    if (source_ != nullptr) {
        count = source_->read(end(), room);
    } else {
        ssize_t read = 0;
        do {
            read = ::read(descriptor_, end(), room);
        } while (read < 0 && errno == EINTR);
        if (read >= 0) {
            count = static_cast<std::size_t>(read);
        }
    }
    if (!count || *count > room) {
        throw ScannerFailure{"input in flex scanner failed"};
    }
    return *count;
}

void InputBuffer::terminate() {
    if (ended_) {
        limit_ = filled_;
    }
    if (begin_ == nullptr) {
        reserve(0);
    }
    std::memset(end(), 0, 2);
}

void InputBuffer::reserve(std::size_t capacity) {
    if (data_ != nullptr && capacity <= capacity_) {
        return;
    }
    // NOLINTNEXTLINE(cppcoreguidelines-no-malloc): realloc moves large windows without a copy
    void* const memory = std::realloc(data_.get(), kBytesBefore + capacity + kBytesBehind);
    if (memory == nullptr) {
        throw std::bad_alloc();
    }
    (void)data_.release();
    data_.reset(static_cast<char*>(memory));
    begin_ = data_.get() + kBytesBefore;
    std::memset(data_.get(), 0, kBytesBefore);
    capacity_ = capacity;
}

}  // namespace umpre
