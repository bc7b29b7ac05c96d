// SPDX-License-Identifier: MIT
#include "driver/standard_descriptors.h"

#include <fcntl.h>
#include <unistd.h>

namespace umpre {

void openStandardDescriptors() {
    for (int descriptor = STDIN_FILENO; descriptor <= STDERR_FILENO; ++descriptor) {
        if (::fcntl(descriptor, F_GETFD) == -1) {
            (void)::open("/dev/null", descriptor == STDOUT_FILENO ? O_RDONLY : O_RDWR);
        }
    }
}

}  // namespace umpre
