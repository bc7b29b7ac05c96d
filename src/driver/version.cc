// SPDX-License-Identifier: MIT
#include "driver/version.h"

#include <array>
#include <cstdio>

#include "umpre/version.h"

namespace {

using VersionText = std::array<char, 256>;

// Fills a text of at most 255 characters; `productName` stands before it as it is.
void format(VersionText& text, const char* productName) {
    std::snprintf(text.data(), text.size(), "%s%d.%d.%d %s (%s) \"%s\"", productName,
                  UMPRE_VERSION_MAJOR, UMPRE_VERSION_MINOR, UMPRE_VERSION_PATCH, "win32", __DATE__,
                  "Amber Crossroads");
}

}  // namespace

const char* UmGetVersionString() {
    static VersionText text{};
    static bool isFilled = false;
    if (!isFilled) {
        format(text, "");
        isFilled = true;
    }
    return text.data();
}

const char* UmGetLibNameAndVersionString() {
    static VersionText text{};
    static bool isFilled = false;
    if (!isFilled) {
        format(text, "Umbrite ");
        isFilled = true;
    }
    return text.data();
}

const char* UmGetCopyrightString() {
    return "Copyright (c) 2026 The umpre developers.";
}

std::string umpre::versionTextOf(std::string_view program) {
    return std::string(program) + " version " + UmGetVersionString() + "\n" + UmGetCopyrightString()
           + "\n";
}
