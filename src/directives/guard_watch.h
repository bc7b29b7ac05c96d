// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_GUARD_WATCH_H
#define UMPRE_DIRECTIVES_GUARD_WATCH_H

#include <cstddef>
#include <memory>
#include <vector>

#include "directives/conditionals.h"
#include "directives/file_finder.h"
#include "lex/output_writer.h"
#include "lex/reporter.h"

namespace umpre {

/// Watches how included files are read and finds those that did nothing but write line feeds
/// because a name was defined: an `#ifndef` of it came first, its `#endif` last.
class GuardWatch {
public:
    GuardWatch(const Conditionals& conditionals, const OutputWriter& output,
               const Reporter& reporter) noexcept
        : conditionals_(conditionals), output_(output), reporter_(reporter) {}

    /// A directive was met in active text, or text whose names may be macros.
    void noteAction() noexcept { ++actions_; }

    /// A file was entered and its marker written. What is found is kept in `file`, unless that is
    /// null.
    void fileEntered(std::shared_ptr<KnownFile> file);
    /// The file entered last has ended, and its groups are closed. `asExpected`: it was as long as
    /// its size said. Returns what was given for the file.
    std::shared_ptr<KnownFile> fileEnds(bool asExpected);

private:
    struct Pass {
        std::shared_ptr<KnownFile> file;
        OutputWriter::Place begin;
        std::size_t reports;
        std::size_t decisions;
        std::size_t actions;
    };

    const Conditionals& conditionals_;
    const OutputWriter& output_;
    const Reporter& reporter_;
    std::size_t actions_ = 0;
    std::vector<Pass> passes_;  // over the files that are open
};

}  // namespace umpre

#endif
