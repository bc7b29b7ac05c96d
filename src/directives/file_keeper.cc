// SPDX-License-Identifier: MIT
#include "directives/file_keeper.h"

namespace umpre {

void FileKeeper::keep(const std::shared_ptr<KnownFile>& file, std::string_view bytes) {
    if (bytes.empty() || bytes.size() > kMostBytes / 8) {
        return;
    }
    while (size_ + bytes.size() > kMostBytes) {
        size_ -= files_.front()->bytes->size();
        files_.front()->bytes.reset();
        files_.pop_front();
    }
    file->bytes = std::make_shared<FileBytes>(bytes);
    files_.push_back(file);
    size_ += bytes.size();
}

}  // namespace umpre
