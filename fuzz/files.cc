// SPDX-License-Identifier: MIT
#include "files.h"

namespace umpre::fuzz {

Files Files::from(std::string_view input) {
    Files files;
    for (std::string* const file : {&files.a, &files.b, &files.c}) {
        const std::size_t end = input.find(kSeparator);
        if (end == std::string_view::npos) {
            break;
        }
        *file = input.substr(0, end);
        input.remove_prefix(end + 1);
    }
    files.main = input;
    return files;
}

IncludeAnswer Files::find(std::string_view name) const {
    using enum IncludeAnswer::Kind;
    if (name == "a") {
        return {Text, a};
    }
    if (name == "b") {
        return {Text, b};
    }
    if (name == "d/c") {
        return {Text, c};
    }
    return {Absent, {}};
}

}  // namespace umpre::fuzz
