// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_FILE_KEEPER_H
#define UMPRE_DIRECTIVES_FILE_KEEPER_H

#include <cstddef>
#include <deque>
#include <memory>
#include <string_view>

#include "directives/file_finder.h"

namespace umpre {

/// Keeps the bytes of files that are read again and again, up to a size of all of them.
class FileKeeper {
public:
    static constexpr std::size_t kMostBytes = std::size_t{4} << 20U;

    /// Keeps all bytes of a file; those that were kept first make room. Does nothing for an empty
    /// text, or for more than an eighth of all that can be kept.
    void keep(const std::shared_ptr<KnownFile>& file, std::string_view bytes);

private:
    std::deque<std::shared_ptr<KnownFile>> files_;
    std::size_t size_ = 0;  // of their bytes
};

}  // namespace umpre

#endif
