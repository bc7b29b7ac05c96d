// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_FILE_FINDER_H
#define UMPRE_DIRECTIVES_FILE_FINDER_H

#include <array>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

#include "directives/directory_names.h"
#include "directives/include_form.h"
#include "lex/file_bytes.h"
#include "lex/file_identity.h"
#include "lex/name_filter.h"
#include "lex/no_expand_set.h"
#include "lex/output_writer.h"
#include "lex/reporter.h"
#include "lex/run_options.h"
#include "lex/scanner_stack.h"
#include "umpre/event.h"

namespace umpre {

/// What is known of a file that was included more than once. It holds for one identity.
struct KnownFile {
    std::string name;  ///< as it is opened
    FileIdentity identity;
    /// While this name is defined, reading the file writes line feeds and does nothing else; null
    /// if no such name is known.
    const Name* guard = nullptr;
    std::string guardedText;  ///< what comes out then, the file's first marker included
    std::shared_ptr<FileBytes> bytes = nullptr;  ///< all of them, if they were kept

    /// Tells whether reading it now would write that text and do nothing else.
    [[nodiscard]] bool isGuarded() const noexcept { return guard != nullptr && guard->isDefined; }

    /// Tells whether it can be included without being opened.
    [[nodiscard]] bool isAtHand() const noexcept { return isGuarded() || bytes != nullptr; }
};

/// A search that led to a known file, and what it hangs on.
struct Search {
    std::string_view name;
    IncludeForm form = IncludeForm::Brackets;
    std::shared_ptr<KnownFile> file;  ///< null: what was found does not hold any more
    std::size_t attempts = 0;         ///< at other places, in vain
    std::size_t moment = 0;           ///< when that was so
};

/// Where included files are looked for, and which were found where. What was found is taken for
/// granted only as long as nobody can tell: after a time, or after the program has waited for
/// somebody, all that the search hung on is looked at again.
class FileFinder {
public:
    FileFinder(ScannerStack& sources, const OutputWriter& output, const Reporter& reporter,
               const RunOptions& options)
        : sources_(sources),
          output_(output),
          reporter_(reporter),
          options_(options),
          names_(options.settlingTime) {}

    /// Adds a directory to search, after those added before.
    void addDirectory(std::string_view directory) { directories_.emplace_back(directory); }

    /// Asks before a file is looked for on the disk; nobody, if empty.
    void setResolver(IncludeResolver resolver) { resolver_ = std::move(resolver); }

    /// Tells which files are entered and which are missed; nobody, if empty.
    void setObserver(Observer observer) { observer_ = std::move(observer); }

    /// Returns an earlier search for this name, otherwise null. It lives as long as the finder.
    [[nodiscard]] Search* find(std::string_view name, IncludeForm form);

    /// Says that time may have passed.
    void lookAtClock();

    /// Returns what stands for now: it is another value when files may have changed.
    [[nodiscard]] std::size_t moment() const {
        // All of these only grow, so the sum is the same only if each of them is.
        return clock_ + changes_ + sources_.waits() + output_.waits() + reporter_.reportCount();
    }

    /// Returns the file that a search leads to if it is a known one, otherwise null.
    [[nodiscard]] const KnownFile* fileOf(Search& search) {
        return search.moment == moment() || isStill(search) ? search.file.get() : nullptr;
    }

    /// What became of looking for a file.
    enum class Result {
        Nowhere,  ///< there is none
        Entered,
        Known,  ///< it is there, but need not be opened; `find` now leads to it
    };

    /// Looks for a file and enters it if it has to be read.
    [[nodiscard]] Result enter(std::string_view name, IncludeForm form);

    /// Returns what is known of the file that was entered last; null for one that may change at any
    /// time, or that is new.
    [[nodiscard]] const std::shared_ptr<KnownFile>& entered() const noexcept { return entered_; }

private:
    struct Hash {
        using is_transparent = void;

        [[nodiscard]] std::size_t operator()(std::string_view name) const noexcept {
            return hashOfName(name);
        }
    };

    template <typename Value>
    using ByName = std::unordered_map<std::string, Value, Hash, std::equal_to<>>;

    [[nodiscard]] Result enter(std::string_view name, IncludeForm form, std::size_t* omitted);
    [[nodiscard]] std::shared_ptr<KnownFile> knownAt(const std::string& path) const;
    void keepSearch(std::string_view name, IncludeForm form, std::shared_ptr<KnownFile> file,
                    std::size_t attempts);
    [[nodiscard]] bool enterPath(const std::string& path);
    void noteEntered(const std::string& path);
    void noteChange(const FileIdentity& identity);
    [[nodiscard]] bool open(const std::string& path);
    [[nodiscard]] bool isStill(Search& search);
    [[nodiscard]] bool leadsToSameFile(const Search& search);
    [[nodiscard]] const std::string* candidate(std::string_view name, IncludeForm form,
                                               std::size_t number);
    [[nodiscard]] bool isLasting(const FileIdentity& identity) const;
    [[nodiscard]] std::shared_ptr<KnownFile> remember(const std::string& path,
                                                      const FileIdentity& identity);

    ScannerStack& sources_;
    const OutputWriter& output_;
    const Reporter& reporter_;
    RunOptions options_;
    IncludeResolver resolver_;
    Observer observer_;
    std::vector<std::string> directories_;
    std::string path_;
    NameFilter pathsEntered_;
    ByName<std::shared_ptr<KnownFile>> files_;  // by their paths
    std::array<ByName<Search>, 2> searches_;    // by the form of the name
    std::size_t clock_ = 0;
    std::size_t changes_ = 0;  // of files, that were met
    std::int64_t searchTime_ = 0;
    std::size_t searchMoment_ = 0;
    std::int64_t momentTime_ = 0;  // when it began
    DirectoryNames names_;
    std::shared_ptr<KnownFile> entered_;
};

}  // namespace umpre

#endif
