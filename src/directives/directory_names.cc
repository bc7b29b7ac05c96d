// SPDX-License-Identifier: MIT
//
// With several directories to search, most attempts to open a file fail, and each costs about half
// as much as opening one. Reading a directory costs as much as failing in it half as many times as
// it has entries. So this is done when it has failed that often, about. What a directory holds is
// kept as one bit for each hash: a name that has no bit is not there.
//
// This holds for file systems whose directories show all that can be opened in them, under the
// names that it can be opened by, and whose directories' times tell each change.
#include "directives/directory_names.h"

#include <algorithm>
#include <bit>
#include <cerrno>
#include <dirent.h>
#include <fcntl.h>
#include <linux/fs.h>
#include <linux/magic.h>
#include <memory>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <sys/statfs.h>

namespace umpre {
namespace {

constexpr std::size_t kFirstMisses = 8;    // make it worth while to ask how large a directory is
constexpr std::size_t kBytesOfMiss = 512;  // of a directory's size, for each miss that it takes
constexpr std::size_t kMostWorth = 100'000;
constexpr std::size_t kBitsForEach = 16;
constexpr unsigned kBitsOfWord = 64;

// The part of a path before its last slash, and what is behind it.
struct Parts {
    std::string_view directory;
    std::string_view name;
};

[[nodiscard]] Parts partsOf(std::string_view path) noexcept {
    const std::size_t slash = path.rfind('/');
    if (slash == std::string_view::npos || slash == 0) {
        return {};
    }
    return {path.substr(0, slash), path.substr(slash + 1)};
}

// A stream of a directory's entries, closed at the end.
struct Close {
    void operator()(DIR* stream) const noexcept { (void)::closedir(stream); }
};

using Stream = std::unique_ptr<DIR, Close>;

[[nodiscard]] bool showsAllNames(int descriptor) noexcept {
    struct statfs system {};

    if (::fstatfs(descriptor, &system) != 0) {
        return false;
    }
    switch (static_cast<std::uint32_t>(system.f_type)) {
    case EXT4_SUPER_MAGIC:
    case BTRFS_SUPER_MAGIC:
    case TMPFS_MAGIC:
    case OVERLAYFS_SUPER_MAGIC: break;
    default: return false;
    }
    int flags = 0;
    return ::ioctl(descriptor, FS_IOC_GETFLAGS, &flags) != 0 || (flags & FS_CASEFOLD_FL) == 0;
}

[[nodiscard]] std::vector<std::uint64_t> bitsOf(const std::vector<std::uint32_t>& hashes) {
    const std::size_t count = std::bit_ceil(hashes.size() * kBitsForEach + kBitsOfWord);
    std::vector<std::uint64_t> bits(count / kBitsOfWord);
    for (const std::uint32_t hash : hashes) {
        const std::size_t bit = hash & (count - 1);
        bits[bit / kBitsOfWord] |= std::uint64_t{1} << bit % kBitsOfWord;
    }
    return bits;
}

[[nodiscard]] bool mayHold(const std::vector<std::uint64_t>& bits, std::string_view name) noexcept {
    const std::size_t bit = hashOfName(name) & (bits.size() * kBitsOfWord - 1);
    return (bits[bit / kBitsOfWord] >> bit % kBitsOfWord & 1U) != 0;
}

}  // namespace

bool DirectoryNames::lacks(std::string_view path, std::size_t moment) {
    const Parts parts = partsOf(path);
    const auto found = directories_.find(parts.directory);
    if (found == directories_.end() || found->second.names.empty()) {
        return false;
    }
    Directory& directory = found->second;
    if (directory.moment != moment) {
        struct stat status {};

        if (::stat(found->first.c_str(), &status) != 0
            || identityOf(status) != directory.identity) {
            directory = {};
            return false;
        }
        directory.moment = moment;
    }
    return !mayHold(directory.names, parts.name);
}

void DirectoryNames::noteMiss(std::string_view path, std::size_t moment, std::int64_t now) {
    const Parts parts = partsOf(path);
    if (parts.name.empty()) {
        return;
    }
    auto found = directories_.find(parts.directory);
    if (found == directories_.end()) {
        found = directories_.try_emplace(std::string(parts.directory)).first;
    }
    Directory& directory = found->second;
    ++directory.misses;
    if (directory.misses < std::max(kFirstMisses, directory.worth) || !directory.names.empty()) {
        return;
    }
    if (directory.worth == 0) {
        struct stat status {};

        const bool isThere = ::stat(found->first.c_str(), &status) == 0 && status.st_size >= 0;
        directory.worth =
            kFirstMisses
            + (isThere ? static_cast<std::size_t>(status.st_size) / kBytesOfMiss : kMostWorth);
        return;
    }
    read(found->first, directory, now);
    directory.moment = moment;
    directory.worth *= 2;  // should it turn out not to have been read, or to change
}

// Reads a directory if what it holds can be kept.
void DirectoryNames::read(const std::string& name, Directory& directory, std::int64_t now) const {
    const Stream stream(::opendir(name.c_str()));

    struct stat status {};

    if (stream == nullptr || ::fstat(::dirfd(stream.get()), &status) != 0
        || !showsAllNames(::dirfd(stream.get()))) {
        return;
    }
    directory.identity = identityOf(status);
    if (now - std::max(directory.identity.modified, directory.identity.changed) < settlingTime_) {
        return;
    }
    std::vector<std::uint32_t> hashes;
    errno = 0;
    for (const dirent* entry = ::readdir(stream.get()); entry != nullptr;
         entry = ::readdir(stream.get())) {
        hashes.push_back(hashOfName(entry->d_name));
    }
    if (errno == 0) {
        directory.names = bitsOf(hashes);
    }
}

}  // namespace umpre
