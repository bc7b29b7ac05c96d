// SPDX-License-Identifier: MIT
//
// Loaded into the running program by LD_PRELOAD. Looks the version functions up by name, as any
// library in the same process can, and prints what they return, a line for each:
//
//     UmGetVersionString=1.0.0 win32 (Mar 14 2026) "Amber Crossroads"
#include <cstdio>
#include <dlfcn.h>

namespace {

using TextFunction = const char*();

void printTextOf(const char* name) {
    auto* const function = reinterpret_cast<TextFunction*>(dlsym(RTLD_DEFAULT, name));
    if (function == nullptr) {
        std::printf("%s is not found\n", name);
        return;
    }
    const char* const text = function();
    std::printf("%s=%s\n", name, text);
    if (function() != text) {
        std::printf("%s returns another text the second time\n", name);
    }
}

__attribute__((constructor)) void printTexts() {
    printTextOf("UmGetVersionString");
    printTextOf("UmGetLibNameAndVersionString");
    printTextOf("UmGetCopyrightString");
    (void)std::fflush(stdout);
}

}  // namespace
