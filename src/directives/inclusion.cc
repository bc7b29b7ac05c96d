// SPDX-License-Identifier: MIT
#include "directives/inclusion.h"

#include "directives/operand.h"

namespace umpre {

using enum TokenKind;

void Inclusion::includeDirective() {
    const std::optional<Operand> operand = readOperand();
    if (operand) {
        sources_.next();  // the line end, so that the file starts on a line of its own
        openInclude(operand->name, operand->quoted);
    }
}

bool Inclusion::openInclude(const std::string& name, bool quoted) {
    if (quoted && enter(name)) {
        return true;
    }
    std::string path;
    for (const std::string& directory : includeDirectories_) {
        path.assign(directory).append("/").append(name);
        if (enter(path)) {
            return true;
        }
    }
    reporter_.reportError("Cannot open file: " + name);
    return false;
}

bool Inclusion::enter(const std::string& path) {
    if (!observer_) {
        return open(path);
    }
    const SourcePosition includer = sources_.position();
    const bool isOpen = open(path);
    observer_({isOpen ? Event::Kind::FileEntered : Event::Kind::FileMissed, path, includer.fileName,
               includer.line});
    return isOpen;
}

bool Inclusion::open(const std::string& path) {
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

std::optional<Inclusion::Operand> Inclusion::readOperand() {
    const std::string text = gatherLine(sources_);
    const ExpandedOperand source(sources_, expander_, lexer_, text, LineKind::Operand);
    std::optional<Operand> operand = readName();
    if (!operand || operand->name.empty()) {
        reporter_.reportError(operand ? "An expected file name is missing"
                                      : "Filename expected after #include directive");
        sources_.skipToEndOfLine();
        return std::nullopt;
    }
    sources_.skipBlanks();
    if (sources_.peek() != END_OF_INPUT) {
        reporter_.reportError(kInvalidCharacters);
    }
    return operand;
}

// Reads "name" or <name>; returns nothing if neither stands there.
std::optional<Inclusion::Operand> Inclusion::readName() {
    sources_.skipBlanks();
    const Token first = sources_.next();
    if (first.kind == STRING_LITERAL) {
        return Operand{std::string(first.text.substr(1, first.text.size() - 2)), true};
    }
    if (first.kind != LESS) {
        return std::nullopt;
    }
    Operand operand{{}, false};
    for (Token token = sources_.next(); token.kind != GREATER; token = sources_.next()) {
        if (endsLine(token.kind)) {
            return std::nullopt;
        }
        operand.name.append(token.text);
    }
    return operand;
}

}  // namespace umpre
