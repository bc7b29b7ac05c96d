// SPDX-License-Identifier: MIT
//
// A file that is included a thousand times would be searched for, opened and looked at a thousand
// times. What a search found is therefore kept: the file, and how many places were tried before in
// vain. Files may change while the program runs, but nobody can say when the program looks, unless
// it can be made to wait, as by a pipe that it reads from or writes to, or by whoever answers its
// messages. So time is divided into moments: a wait or a message begins a new one, and so does
// every tenth of a second. In each moment each search that is needed is checked once, by `stat` at
// the same places.
//
// Files are told apart by identity, that is by their times, too. A file that was changed just now
// could change again at the same time, and one that the program itself writes to changes without a
// wait; neither is kept.
#include "directives/file_finder.h"

#include <cerrno>
#include <ctime>
#include <sys/stat.h>

namespace umpre {
namespace {

constexpr std::int64_t kMomentLength = 100'000'000;

[[nodiscard]] std::int64_t timeBy(clockid_t clock) noexcept {
    std::timespec now{};
    (void)::clock_gettime(clock, &now);
    return nanoseconds(now);
}

}  // namespace

Search* FileFinder::find(std::string_view name, IncludeForm form) {
    ByName<Search>& searches = searches_[static_cast<std::size_t>(form)];
    const auto found = searches.find(name);
    return found == searches.end() ? nullptr : &found->second;
}

void FileFinder::lookAtClock() {
    clock_ = static_cast<std::size_t>(timeBy(CLOCK_MONOTONIC_COARSE) / kMomentLength);
}

FileFinder::Result FileFinder::enter(std::string_view name, IncludeForm form) {
    entered_ = nullptr;
    searchTime_ = timeBy(CLOCK_REALTIME_COARSE);
    if (searchMoment_ != moment()) {
        searchMoment_ = moment();
        momentTime_ = searchTime_;
    }
    // Who serves files or is told of them wants to know of each attempt.
    if (options_.plainRoad || resolver_ || observer_) {
        return enter(name, form, nullptr);
    }
    // That there is no such file must not be said of what was so a moment ago.
    std::size_t omitted = 0;
    const Result result = enter(name, form, &omitted);
    return result == Result::Nowhere && omitted > 0 ? enter(name, form, nullptr) : result;
}

// Attempts that are known to fail are omitted and counted, unless `omitted` is null.
FileFinder::Result FileFinder::enter(std::string_view name, IncludeForm form,
                                     std::size_t* omitted) {
    for (std::size_t number = 0;; ++number) {
        const std::string* const path = candidate(name, form, number);
        if (path == nullptr) {
            return Result::Nowhere;
        }
        if (omitted != nullptr && names_.lacks(*path, searchMoment_)) {
            ++*omitted;
            continue;
        }
        if (std::shared_ptr<KnownFile> file = knownAt(*path); file != nullptr) {
            keepSearch(name, form, std::move(file), number);
            return Result::Known;
        }
        if (enterPath(*path)) {
            noteEntered(*path);
            keepSearch(name, form, entered_, number);
            return Result::Entered;
        }
        if (omitted != nullptr) {
            names_.noteMiss(*path, searchMoment_, searchTime_);
        }
    }
}

// Returns the file if it is one that was found by another name and need not be opened now.
std::shared_ptr<KnownFile> FileFinder::knownAt(const std::string& path) const {
    if (!pathsEntered_.mayHold(path) || !sources_.canOpenOneMore()) {
        return nullptr;
    }
    const auto found = files_.find(path);
    if (found == files_.end() || !found->second->isAtHand()) {
        return nullptr;
    }

    struct stat status {};

    const bool isSame =
        ::stat(path.c_str(), &status) == 0 && identityOf(status) == found->second->identity;
    return isSame ? found->second : nullptr;
}

void FileFinder::noteEntered(const std::string& path) {
    const FileIdentity& identity = sources_.currentFile().identity();
    noteChange(identity);
    entered_ = remember(path, identity);
}

void FileFinder::keepSearch(std::string_view name, IncludeForm form,
                            std::shared_ptr<KnownFile> file, std::size_t attempts) {
    if (file != nullptr) {
        ByName<Search>& searches = searches_[static_cast<std::size_t>(form)];
        auto& [key, search] = *searches.try_emplace(std::string(name)).first;
        search = {key, form, std::move(file), attempts, moment()};
    }
}

// What was looked at in this moment may be older than a file that was changed since.
void FileFinder::noteChange(const FileIdentity& identity) {
    const std::int64_t lastChange = std::max(identity.modified, identity.changed);
    changes_ += momentTime_ - lastChange < options_.settlingTime ? 1U : 0U;
}

bool FileFinder::enterPath(const std::string& path) {
    if (!observer_) {
        return open(path);
    }
    const SourcePosition includer = sources_.position();
    const bool isOpen = open(path);
    observer_({isOpen ? Event::Kind::FileEntered : Event::Kind::FileMissed, path, includer.fileName,
               includer.line});
    return isOpen;
}

bool FileFinder::open(const std::string& path) {
    if (!resolver_) {
        return sources_.pushFile(path);
    }
    const IncludeAnswer answer = resolver_(path);
    if (answer.kind == IncludeAnswer::Kind::Text) {
        sources_.pushFileText(path, answer.text);
        return true;
    }
    return answer.kind == IncludeAnswer::Kind::Disk && sources_.pushFile(path);
}

bool FileFinder::isStill(Search& search) {
    if (search.file == nullptr || !leadsToSameFile(search)) {
        search.file = nullptr;
        return false;
    }
    search.moment = moment();
    return true;
}

bool FileFinder::leadsToSameFile(const Search& search) {
    struct stat status {};

    for (std::size_t number = 0; number < search.attempts; ++number) {
        const std::string* const path = candidate(search.name, search.form, number);
        if (::stat(path->c_str(), &status) == 0 || (errno != ENOENT && errno != ENOTDIR)) {
            return false;
        }
    }
    return ::stat(search.file->name.c_str(), &status) == 0
           && identityOf(status) == search.file->identity;
}

// Returns the place to try after so many others, or null.
const std::string* FileFinder::candidate(std::string_view name, IncludeForm form,
                                         std::size_t number) {
    if (form == IncludeForm::Quotes) {
        if (number == 0) {
            path_.assign(name);
            return &path_;
        }
        --number;
    }
    if (number == directories_.size()) {
        return nullptr;
    }
    path_.assign(directories_[number]).append("/").append(name);
    return &path_;
}

// Tells whether a change of the file will show in its identity.
bool FileFinder::isLasting(const FileIdentity& identity) const {
    const std::int64_t lastChange = std::max(identity.modified, identity.changed);
    return identity.size > 0 && searchTime_ - lastChange >= options_.settlingTime
           && !(output_.target() && output_.target()->isSameFile(identity));
}

// Most files are included once, so the first time only leaves a mark.
std::shared_ptr<KnownFile> FileFinder::remember(const std::string& path,
                                                const FileIdentity& identity) {
    if (options_.plainRoad || resolver_ || observer_ || !isLasting(identity)) {
        return nullptr;
    }
    if (!pathsEntered_.mayHold(path)) {
        pathsEntered_.add(path);
        return nullptr;
    }
    std::shared_ptr<KnownFile>& file = files_[path];
    if (file == nullptr || file->identity != identity) {
        changes_ += file == nullptr ? 0U : 1U;
        file = std::make_shared<KnownFile>(KnownFile{path, identity, nullptr, {}});
    }
    return file;
}

}  // namespace umpre
