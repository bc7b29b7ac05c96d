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

}  // namespace umpre
