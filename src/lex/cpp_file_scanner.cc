// SPDX-License-Identifier: MIT
#include "lex/cpp_file_scanner.h"

#include <unistd.h>
#include <utility>

namespace umpre {

CppFileScanner::CppFileScanner(CommentSink& commentSink, const RunOptions& options)
    : input_(options), lexer_(commentSink, options) {}

bool CppFileScanner::open(const std::string& fileName) {
    if (fileName.empty()) {
        setFileName("stdin");
        input_.openBorrowed(STDIN_FILENO);
    } else if (input_.openFile(fileName)) {
        setFileName(fileName);
    } else {
        return false;
    }
    start();
    return true;
}

void CppFileScanner::openSource(const std::string& fileName, ByteSource& source) {
    setFileName(fileName);
    input_.openSource(source);
    start();
}

void CppFileScanner::openText(const std::string& fileName, std::string_view text) {
    setFileName(fileName);
    input_.openText(text);
    start();
}

void CppFileScanner::openKept(const std::string& fileName, std::shared_ptr<FileBytes> bytes,
                              const FileIdentity& identity) {
    setFileName(fileName);
    input_.openKept(std::move(bytes), identity);
    start();
}

void CppFileScanner::close() {
    input_.close();
}

void CppFileScanner::start() {
    lexer_.read(input_);
    lastWasNewline_ = true;
    restart();
}

void CppFileScanner::advance(std::size_t bytes, std::size_t lines, bool endsWithLineEnd) {
    lexer_.advance(bytes, lines);
    lastWasNewline_ = endsWithLineEnd;
}

Token CppFileScanner::scan() {
    const Token token = lexer_.lex();
    if (token.kind == TokenKind::END_OF_INPUT && !lastWasNewline_) {
        lastWasNewline_ = true;
        return {TokenKind::NEWLINE, {}};
    }
    lastWasNewline_ = token.kind == TokenKind::NEWLINE || token.kind == TokenKind::END_OF_INPUT;
    return token;
}

}  // namespace umpre
