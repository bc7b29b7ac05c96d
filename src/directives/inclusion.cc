// SPDX-License-Identifier: MIT
#include "directives/inclusion.h"

#include "directives/operand.h"

namespace umpre {

using enum TokenKind;

void Inclusion::includeDirective() {
    const std::optional<Operand> operand = readOperand();
    if (operand) {
        sources_.next();  // the line end, so that the file starts on a line of its own
        files_.lookAtClock();
        files_.open(operand->name, operand->form, files_.find(operand->name, operand->form));
    }
}

DirectiveLine::Outcome Inclusion::includeDirective(DirectiveLine& line) {
    const std::string_view text = sources_.currentFile().wholeLines();
    const std::optional<IncludeOperand> include = lines_.read(line);
    if (!include) {
        return DirectiveLine::Outcome::Untold;
    }
    line.takeEnd();
    files_.noteAction();
    files_.lookAtClock();
    Search* const search = files_.find(include->name, include->form);
    lines_.keep(text, *include, search);
    files_.open(include->name, include->form, search);
    return DirectiveLine::Outcome::EndTaken;
}

bool Inclusion::includeLines(CppFileScanner& file) {
    std::string_view text = file.wholeLines();
    KnownLines::Line* line = lines_.find(text);
    if (line == nullptr) {
        return false;
    }
    files_.lookAtClock();
    while (line != nullptr) {
        file.advance(line->text.size(), 1, true);
        files_.noteAction();
        if (!files_.passOver(*line->search, line->passage)) {
            files_.enter(*line->search);
            break;
        }
        text.remove_prefix(line->text.size());
        line = lines_.find(text);
    }
    return true;
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
        return Operand{std::string(first.text.substr(1, first.text.size() - 2)),
                       IncludeForm::Quotes};
    }
    if (first.kind != LESS) {
        return std::nullopt;
    }
    Operand operand{{}, IncludeForm::Brackets};
    for (Token token = sources_.next(); token.kind != GREATER; token = sources_.next()) {
        if (endsLine(token.kind)) {
            return std::nullopt;
        }
        operand.name.append(token.text);
    }
    return operand;
}

}  // namespace umpre
