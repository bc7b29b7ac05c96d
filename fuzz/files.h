// SPDX-License-Identifier: MIT
#ifndef UMPRE_FUZZ_FILES_H
#define UMPRE_FUZZ_FILES_H

#include <string>
#include <string_view>

#include "umpre/event.h"

namespace umpre::fuzz {

/// The files of a run, all of them in memory. Of the included ones, two are found by the names "a"
/// and "b", and one in the folder "d" by the name "c".
struct Files {
    std::string main;
    std::string a;
    std::string b;
    std::string c;

    /// Separates the files of an input; the source is the last.
    static constexpr char kSeparator = '\x1C';

    /// Takes an input apart. Files that it does not have are empty.
    [[nodiscard]] static Files from(std::string_view input);

    /// Returns what is to be read for a name.
    [[nodiscard]] IncludeAnswer find(std::string_view name) const;
};

}  // namespace umpre::fuzz

#endif
