// SPDX-License-Identifier: MIT
//
// Sources lie on one stack; the last is read. A macro's replacement goes on top of the file that
// used the macro, an included file on top of its includer. With `f(1)` in the file and f's
// replacement "g" pushed, the stack is
//
//     file  "g"          and after "g" is read:    file          with "(1)" still to come
//
// An operand that must not run on into what lies below is read alone: `floor_` is raised to its own
// place, so that nothing below is popped into, and lowered again afterwards.
#include "lex/scanner_stack.h"

#include <algorithm>
#include <cassert>
#include <utility>

namespace umpre {
namespace {

// Sources kept for use again; more of them are open at a time only in deep nesting.
constexpr std::size_t kSpares = 64;

// Files that are open inside so many others are read in narrow windows: there may be as many as
// there can be descriptors.
constexpr std::size_t kWideFiles = 32;
constexpr std::size_t kNarrowWindow = 2048;

}  // namespace

ScannerStack::ScannerStack(FileEvents& events, OutputWriter& output, Reporter& reporter,
                           const RunOptions& options)
    : events_(events), output_(output), reporter_(reporter), options_(options) {}

ScannerStack::~ScannerStack() = default;

TokenKind ScannerStack::peekBelow() {
    TokenKind kind = TokenKind::END_OF_INPUT;
    while (kind == TokenKind::END_OF_INPUT && !atFloor()) {
        pop();
        kind = currentSource_->peek();
    }
    return kind;
}

Token ScannerStack::nextBelow() {
    Token token;
    while (token.kind == TokenKind::END_OF_INPUT && !atFloor()) {
        pop();
        token = currentSource_->next();
    }
    return token;
}

bool ScannerStack::leaveEndedFile() {
    CppFileScanner* const file = fileReadNow();
    if (file == nullptr || atFloor() || !file->isAtEnd()) {
        return false;
    }
    pop();
    return true;
}

void ScannerStack::pop() {
    const bool isFile = currentSource_->isFile();
    if (isFile) {
        events_.fileEnds();
    }
    dropCurrent();
    if (isFile) {
        events_.fileResumed();
    }
}

void ScannerStack::dropCurrent() {
    const bool isFile = sources_.back().isFile;
    sources_.pop_back();
    assert(!sources_.empty());
    currentSource_ = sources_.back().scanner;
    if (isFile) {
        CppFileScanner& file = *files_.back();
        waits_ += file.takeWaits();
        filesWithoutDescriptors_ -= file.lacksDescriptor() ? 1U : 0U;
        file.close();
        if (spareFiles_.size() < kSpares) {
            spareFiles_.push_back(std::move(files_.back()));
        }
        files_.pop_back();
    } else {
        --listsUsed_;
        lists_[listsUsed_]->release();
        if (listsUsed_ >= kSpares) {
            lists_.pop_back();
        }
    }
}

std::string ScannerStack::skipWhile(bool (*wanted)(TokenKind)) {
    std::string skipped;
    while (wanted(peek())) {
        skipped.append(next().text);
    }
    return skipped;
}

void ScannerStack::skipToEndOfLine() {
    while (!endsLine(next().kind)) {
    }
}

bool ScannerStack::pushFile(const std::string& fileName, std::string_view messageName) {
    if (!canOpenOneMore()) {
        holdDescriptors();
    }
    std::unique_ptr<CppFileScanner> file = newFile();
    file->setWindowSize(files_.size() < kWideFiles ? options_.windowSize
                                                   : std::min(options_.windowSize, kNarrowWindow));
    if (!file->open(fileName)) {
        spareFiles_.push_back(std::move(file));
        return false;
    }
    if (!messageName.empty()) {
        file->setFileName(messageName);
    }
    enter(std::move(file));
    mostFiles_ = std::max(mostFiles_, files_.size());
    return true;
}

void ScannerStack::pushKeptFile(const std::string& fileName, std::shared_ptr<FileBytes> bytes,
                                const FileIdentity& identity) {
    assert(canOpenOneMore());
    std::unique_ptr<CppFileScanner> file = newFile();
    file->openKept(fileName, std::move(bytes), identity);
    ++filesWithoutDescriptors_;
    enter(std::move(file));
}

// More files are to be open at a time than ever. Whether there is a descriptor for one more must
// not hang on how some of them are read.
void ScannerStack::holdDescriptors() {
    for (auto file = files_.rbegin(); filesWithoutDescriptors_ > 0; ++file) {
        if ((*file)->lacksDescriptor()) {
            (*file)->holdDescriptor();
            --filesWithoutDescriptors_;
        }
    }
}

std::unique_ptr<CppFileScanner> ScannerStack::newFile() {
    if (spareFiles_.empty()) {
        return std::make_unique<CppFileScanner>(commentSink(), options_);
    }
    std::unique_ptr<CppFileScanner> file = std::move(spareFiles_.back());
    spareFiles_.pop_back();
    return file;
}

void ScannerStack::pushFileText(const std::string& fileName, std::string_view text) {
    auto file = std::make_unique<CppFileScanner>(commentSink(), options_);
    file->openText(fileName, text);
    enter(std::move(file));
}

void ScannerStack::pushFileSource(const std::string& fileName, ByteSource& source) {
    auto file = std::make_unique<CppFileScanner>(commentSink(), options_);
    file->openSource(fileName, source);
    enter(std::move(file));
}

void ScannerStack::enter(std::unique_ptr<CppFileScanner> file) {
    files_.push_back(std::move(file));
    currentSource_ = files_.back().get();
    sources_.push_back({currentSource_, true});
    events_.fileEntered();
}

CppTokenScanner& ScannerStack::pushList() {
    // A list that is read to its end has nothing more to say; without this, a macro that ends in
    // the name of another would leave a source behind for each.
    dropReadLists();
    if (listsUsed_ == lists_.size()) {
        lists_.push_back(std::make_unique<CppTokenScanner>(commentSink()));
    }
    CppTokenScanner& list = *lists_[listsUsed_];
    ++listsUsed_;
    sources_.push_back({&list, false});
    currentSource_ = &list;
    return list;
}

void ScannerStack::pushPieces(Pieces&& pieces) {
    pushList().read(std::move(pieces));
}

void ScannerStack::pushSlice(TextSlice slice, NoExpandSet noExpand) {
    pushList().read(std::move(slice), noExpand);
}

void ScannerStack::isolate(TextSlice slice, NoExpandSet noExpand) {
    savedFloors_.push_back(floor_);
    pushSlice(std::move(slice), noExpand);
    floor_ = sources_.size();
}

void ScannerStack::endIsolation() {
    assert(atFloor());
    floor_ = savedFloors_.back();
    savedFloors_.pop_back();
    dropCurrent();
}

bool ScannerStack::commentLineEnds(std::size_t count) {
    ++commentEffects_;
    output_.writeLineFeeds(count);
    return !output_.failed();
}

void ScannerStack::unterminatedComment(std::int32_t line) {
    ++commentEffects_;
    reporter_.noteUnterminatedComment(line);
}

}  // namespace umpre
