// SPDX-License-Identifier: MIT
#include "lex/byte_sink.h"

#include <cerrno>
#include <unistd.h>

namespace umpre {

bool DescriptorSink::write(std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t written = ::write(descriptor_, bytes.data(), bytes.size());
        if (written >= 0) {
            bytes.remove_prefix(static_cast<std::size_t>(written));
        } else if (errno != EINTR) {
            return false;
        }
    }
    return true;
}

std::optional<FileIdentity> DescriptorSink::target() const {
    struct stat status {};

    if (::fstat(descriptor_, &status) != 0) {
        return std::nullopt;
    }
    const bool isDevice = S_ISCHR(status.st_mode) && ::isatty(descriptor_) == 0;
    if (!S_ISREG(status.st_mode) && !isDevice) {
        return std::nullopt;
    }
    return identityOf(status);
}

}  // namespace umpre
