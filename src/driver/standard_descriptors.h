// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_STANDARD_DESCRIPTORS_H
#define UMPRE_DRIVER_STANDARD_DESCRIPTORS_H

namespace umpre {

/// Opens those of the three standard descriptors that are closed, which would otherwise be given to
/// the next files opened. Standard output gets one that cannot be written, so that what is lost is
/// noticed.
void openStandardDescriptors();

}  // namespace umpre

#endif
