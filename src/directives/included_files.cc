// SPDX-License-Identifier: MIT
#include "directives/included_files.h"

#include <string>

namespace umpre {

void IncludedFiles::open(std::string_view name, IncludeForm form, Search* search) {
    if (search == nullptr || !passOver(*search)) {
        enter(name, form);
    }
}

void IncludedFiles::enter(std::string_view name, IncludeForm form) {
    if (finder_.enter(name, form)) {
        guards_.fileEntered(finder_.entered());
    } else {
        reporter_.reportError(std::string("Cannot open file: ").append(name));
    }
}

bool IncludedFiles::passOver(Search& search) {
    if (!sources_.canOpenOneMore()) {
        return false;
    }
    const KnownFile* const file = finder_.fileOf(search);
    if (file == nullptr || !file->isGuarded()) {
        return false;
    }
    output_.write(file->guardedText);
    output_.writeLineMarker(sources_.position());
    return true;
}

}  // namespace umpre
