// SPDX-License-Identifier: MIT
#include "directives/included_files.h"

#include <string>

namespace umpre {

void IncludedFiles::open(std::string_view name, IncludeForm form, Search* search) {
    if (search == nullptr) {
        enter(name, form);
    } else if (!passOver(*search)) {
        enter(*search);
    }
}

void IncludedFiles::enter(std::string_view name, IncludeForm form) {
    switch (finder_.enter(name, form)) {
    case FileFinder::Result::Nowhere:
        reporter_.reportError(std::string("Cannot open file: ").append(name));
        break;
    case FileFinder::Result::Entered: guards_.fileEntered(finder_.entered()); break;
    case FileFinder::Result::Known:
        Search& search = *finder_.find(name, form);
        if (!passOver(search)) {
            enter(search);
        }
        break;
    }
}

void IncludedFiles::enter(Search& search) {
    if (!enterKept(search)) {
        enter(search.name, search.form);
    }
}

bool IncludedFiles::enterKept(Search& search) {
    if (!sources_.canOpenOneMore() || finder_.fileOf(search) == nullptr
        || search.file->bytes == nullptr) {
        return false;
    }
    const std::shared_ptr<KnownFile> file = search.file;
    sources_.pushKeptFile(file->name, file->bytes, file->identity);
    guards_.fileEntered(file);
    return true;
}

void IncludedFiles::fileEnds() {
    const CppFileScanner& current = sources_.currentFile();
    const std::shared_ptr<KnownFile> file = guards_.fileEnds(current.isReadWhole());
    if (file != nullptr && file->bytes == nullptr && !file->isGuarded()) {
        keeper_.keep(file, current.wholeText());
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

bool IncludedFiles::passOver(Search& search, Passage& passage) {
    const std::size_t moment = finder_.moment();
    if (passage.guard == nullptr || passage.moment != moment) {
        if (!passOver(search)) {
            return false;
        }
        passage = {search.moment, search.file->guard, Snippet(search.file->guardedText)};
        return true;
    }
    CppFileScanner& file = sources_.currentFile();
    const Snippet& markerEnd = file.markerEnd();
    if (!passage.guard->isDefined || !sources_.canOpenOneMore() || passage.text.isEmpty()
        || markerEnd.isEmpty()) {
        return passOver(search);
    }
    output_.writeSnippet(passage.text);
    output_.writeLineMarker(file.position().line, markerEnd);
    return true;
}

}  // namespace umpre
