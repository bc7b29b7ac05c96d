// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_DIRECTORY_NAMES_H
#define UMPRE_DIRECTIVES_DIRECTORY_NAMES_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "lex/file_identity.h"
#include "lex/name_filter.h"

namespace umpre {

/// Which names directories do not hold: a directory in which many files are looked for in vain is
/// read once.
class DirectoryNames {
public:
    /// A directory is kept only if it was not changed for so many nanoseconds.
    explicit DirectoryNames(std::int64_t settlingTime) noexcept : settlingTime_(settlingTime) {}

    /// Tells whether there is surely no file of this path, as of this moment.
    [[nodiscard]] bool lacks(std::string_view path, std::size_t moment);

    /// A file of this path was looked for in vain at this moment. `now`: in nanoseconds.
    void noteMiss(std::string_view path, std::size_t moment, std::int64_t now);

private:
    struct Directory {
        std::size_t misses = 0;
        std::size_t worth = 0;  // that many misses make reading it worth while; 0: not known yet
        FileIdentity identity;
        std::size_t moment = 0;            // when it was as it was read
        std::vector<std::uint64_t> names;  // a bit for each hash; empty: not read
    };

    struct Hash {
        using is_transparent = void;

        [[nodiscard]] std::size_t operator()(std::string_view name) const noexcept {
            return hashOfName(name);
        }
    };

    void read(const std::string& name, Directory& directory, std::int64_t now) const;

    std::int64_t settlingTime_;
    std::unordered_map<std::string, Directory, Hash, std::equal_to<>> directories_;
};

}  // namespace umpre

#endif
