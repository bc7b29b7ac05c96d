// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_FILE_IDENTITY_H
#define UMPRE_LEX_FILE_IDENTITY_H

#include <cstdint>
#include <ctime>
#include <sys/stat.h>

namespace umpre {

/// What a file's bytes hang on: while its identity is the same, so are they, and whether it may be
/// opened. This holds once the file has been left alone for longer than a tick of the clock that
/// its times are taken from.
struct FileIdentity {
    std::uint64_t device = 0;
    std::uint64_t node = 0;
    std::int64_t size = 0;
    std::int64_t modified = 0;  ///< in nanoseconds
    std::int64_t changed = 0;   ///< in nanoseconds; its owner and mode count, too

    friend bool operator==(const FileIdentity&, const FileIdentity&) = default;

    /// Tells whether it is the same file, whatever has become of it.
    [[nodiscard]] bool isSameFile(const FileIdentity& other) const noexcept {
        return device == other.device && node == other.node;
    }
};

[[nodiscard]] constexpr std::int64_t nanoseconds(const std::timespec& time) noexcept {
    constexpr std::int64_t kInSecond = 1'000'000'000;
    return time.tv_sec * kInSecond + time.tv_nsec;
}

[[nodiscard]] inline FileIdentity identityOf(const struct stat& status) noexcept {
    return {status.st_dev, status.st_ino, status.st_size, nanoseconds(status.st_mtim),
            nanoseconds(status.st_ctim)};
}

}  // namespace umpre

#endif
