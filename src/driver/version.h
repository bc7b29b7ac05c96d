// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_VERSION_H
#define UMPRE_DRIVER_VERSION_H

#include <string>
#include <string_view>

// Exported by name from the executable. Each returns a text that stays valid for the life of the
// process; the first call of each must not race with another.
extern "C" {

/// Returns the version, the build date and the code name.
__attribute__((visibility("default"))) const char* UmGetVersionString();
/// Returns the same with the product's name before it.
__attribute__((visibility("default"))) const char* UmGetLibNameAndVersionString();
/// Returns the copyright line.
__attribute__((visibility("default"))) const char* UmGetCopyrightString();
}

namespace umpre {

/// Returns what a program of the project says when it is asked for its version.
[[nodiscard]] std::string versionTextOf(std::string_view program);

}  // namespace umpre

#endif
