// SPDX-License-Identifier: MIT
//
// A pass over a file counts if all of this is true of it:
//
//     its only action was a directive       so no other directive was carried out, and no text
//                                           read in which a macro could stand
//     its only decision was an #ifndef      so that was the action, and no #elif was tried
//     of a name that is defined             so from there on all was skipped, up to the #endif
//     it wrote line feeds alone             so there was no text before, and none behind
//     nothing was reported                  so no group was left open, no comment, no #else astray
//
// What was skipped depends on no definition. So as long as the name is defined and the file is the
// same, each pass does the same.
#include "directives/guard_watch.h"

#include <optional>
#include <utility>

namespace umpre {

void GuardWatch::fileEntered(std::shared_ptr<KnownFile> file) {
    passes_.push_back({std::move(file), output_.place(), reporter_.reportCount(),
                       conditionals_.decisions(), actions_});
}

std::shared_ptr<KnownFile> GuardWatch::fileEnds(bool asExpected) {
    Pass pass = std::move(passes_.back());
    passes_.pop_back();
    if (pass.file == nullptr || !asExpected || actions_ - pass.actions != 1
        || conditionals_.decisions() - pass.decisions != 1 || conditionals_.lastGuard() == nullptr
        || reporter_.reportCount() != pass.reports) {
        return std::move(pass.file);
    }
    const std::optional<std::size_t> lineFeeds = output_.lineFeedsSince(pass.begin);
    if (lineFeeds) {
        pass.file->guard = conditionals_.lastGuard();
        pass.file->guardedText = OutputWriter::markerOf({pass.file->name, 1});
        pass.file->guardedText.append(*lineFeeds, '\n');
    }
    return std::move(pass.file);
}

}  // namespace umpre
