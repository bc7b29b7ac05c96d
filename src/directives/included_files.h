// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_INCLUDED_FILES_H
#define UMPRE_DIRECTIVES_INCLUDED_FILES_H

#include <cstddef>
#include <string_view>
#include <utility>

#include "directives/conditionals.h"
#include "directives/file_finder.h"
#include "directives/file_keeper.h"
#include "directives/guard_watch.h"
#include "lex/no_expand_set.h"
#include "lex/output_writer.h"
#include "lex/reporter.h"
#include "lex/run_options.h"
#include "lex/scanner_stack.h"
#include "lex/snippet.h"
#include "umpre/event.h"

namespace umpre {

/// What there is to do for a file that is passed over. It lies beside the line that names the file,
/// so that nothing else has to be looked at.
struct Passage {
    std::size_t moment = 0;       ///< of the search
    const Name* guard = nullptr;  ///< while it is defined, the file is passed over; null: unknown
    Snippet text;                 ///< what comes out
};

/// Enters included files, and passes over those that would come out empty.
class IncludedFiles {
public:
    IncludedFiles(ScannerStack& sources, OutputWriter& output, const Conditionals& conditionals,
                  Reporter& reporter, const RunOptions& options)
        : sources_(sources),
          output_(output),
          reporter_(reporter),
          finder_(sources, output, reporter, options),
          guards_(conditionals, output, reporter) {}

    /// Adds a directory to search, after those added before.
    void addDirectory(std::string_view directory) { finder_.addDirectory(directory); }

    /// Passes over a file or enters it. It may already be known where the search leads, see `find`.
    void open(std::string_view name, IncludeForm form, Search* search);

    /// Looks for a file and enters it: a quoted name as it is first, then any name in the
    /// directories. Reports a file that is nowhere.
    void enter(std::string_view name, IncludeForm form);
    /// Enters the file that a search leads to.
    void enter(Search& search);

    /// Does what entering the file that a search leads to and reading it would do, if it would come
    /// out empty. Otherwise, or if that is not known, returns false with nothing done.
    [[nodiscard]] bool passOver(Search& search);
    /// Does the same with the passage of this search, if that is known, and keeps it otherwise.
    [[nodiscard]] bool passOver(Search& search, Passage& passage);

    /// Asks before a file is looked for on the disk; nobody, if empty.
    void setResolver(IncludeResolver resolver) { finder_.setResolver(std::move(resolver)); }

    /// Tells which files are entered and which are missed; nobody, if empty.
    void setObserver(Observer observer) { finder_.setObserver(std::move(observer)); }

    /// Returns an earlier search for this name, otherwise null. It lives as long as this object.
    [[nodiscard]] Search* find(std::string_view name, IncludeForm form) {
        return finder_.find(name, form);
    }

    /// Says that time may have passed.
    void lookAtClock() { finder_.lookAtClock(); }

    /// A directive was met in active text, or text whose names may be macros.
    void noteAction() noexcept { guards_.noteAction(); }

    /// The current file, an included one, has ended, and its groups are closed.
    void fileEnds();

private:
    [[nodiscard]] bool enterKept(Search& search);

    ScannerStack& sources_;
    OutputWriter& output_;
    Reporter& reporter_;
    FileFinder finder_;
    GuardWatch guards_;
    FileKeeper keeper_;
};

}  // namespace umpre

#endif
