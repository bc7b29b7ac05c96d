// SPDX-License-Identifier: MIT
#include "directives/include_lines.h"

#include "lex/spelling.h"

namespace umpre {
namespace {

using enum TokenKind;

// Tells whether a byte stands for itself in a quoted name.
[[nodiscard]] bool isPlain(char byte) noexcept {
    return byte != '\\' && byte != '\n' && byte != '\r' && byte != '\0';
}

}  // namespace

std::optional<IncludeOperand> IncludeLines::read(DirectiveLine& line) const {
    line.skipBlanks();
    const Token open = line.next();
    if (open.kind != LESS && open.text != "\"") {
        return std::nullopt;
    }
    IncludeOperand operand;
    operand.form = open.kind == LESS ? IncludeForm::Brackets : IncludeForm::Quotes;
    const std::string_view close = open.kind == LESS ? ">" : "\"";
    Token token = line.next();
    const char* const begin = token.text.data();
    while (token.text != close) {
        if (!isPartOfName(token, operand)) {
            return std::nullopt;
        }
        token = line.next();
    }
    operand.name = {begin, static_cast<std::size_t>(token.text.data() - begin)};
    line.skipBlanks();
    if (operand.name.empty() || !line.isAtEnd()) {
        return std::nullopt;
    }
    operand.isLasting = operand.isLasting && line.isOneLine();
    return operand;
}

// Quotes hold text. Between brackets stand tokens that are expanded; of those that are no names the
// ones are taken that are common in file names.
bool IncludeLines::isPartOfName(const Token& token, IncludeOperand& operand) const {
    const char first = token.text.front();
    if (operand.form == IncludeForm::Quotes) {
        return isPlain(first);
    }
    if (isName(token.kind)) {
        if (!macros_.filter().mayHold(token.text)) {
            return true;
        }
        operand.isLasting = false;
        return macros_.find(token.text) == nullptr;
    }
    return token.kind == SLASH || isDigit(first) || first == '.' || first == '-' || first == '+';
}

// With no macro name that was not there before, no name of the line can have become one.
void IncludeLines::keep(std::string_view text, const IncludeOperand& operand, Search* search) {
    if (search != nullptr && operand.isLasting) {
        known_.keep(text, *search, macros_.filter().size());
    }
}

}  // namespace umpre
