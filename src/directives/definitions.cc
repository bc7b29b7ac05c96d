// SPDX-License-Identifier: MIT
//
// A definition is kept as text, normalised: "#define A  1/* one */+  2  " gives "1 + 2", that is,
// one space where blanks stood between two tokens and none at the ends. A continuation separates
// nothing, so a backslash at the line end between "a" and "b" gives "ab".
#include "directives/definitions.h"

namespace umpre {

namespace {

using enum TokenKind;
using Outcome = DirectiveLine::Outcome;

// Reads from "(" to ")" and adds the names to `parameters`, with commas between them. Returns null,
// or an error with the offending token read.
template <typename Tokens>
[[nodiscard]] const char* readParameters(Tokens& tokens, std::string& parameters) {
    const auto nextInList = [&tokens] {
        tokens.skipBlanks();
        return tokens.next();
    };
    (void)tokens.next();
    Token token = nextInList();
    if (token.kind == RIGHT_PARENTHESIS) {
        return nullptr;
    }
    for (;;) {
        if (!isName(token.kind)) {
            return "An identifier is expected";
        }
        parameters.append(token.text);
        token = nextInList();
        if (token.kind == RIGHT_PARENTHESIS) {
            return nullptr;
        }
        if (token.kind != COMMA) {
            return "An ')' or ',' was expected";
        }
        parameters.push_back(',');
        token = nextInList();
    }
}

}  // namespace

void Definitions::defineDirective() {
    const std::optional<std::string> name = readMacroName();
    if (!name) {
        return;
    }
    const bool functionLike = sources_.peek() == LEFT_PARENTHESIS;
    parameters_.clear();
    if (functionLike) {
        const char* const error = readParameters(sources_, parameters_);
        if (error != nullptr) {
            reporter_.reportError(error);
            sources_.skipToEndOfLine();
            return;
        }
    }
    const std::string text = readReplacement();
    if (macros_.define(*name, {text, parameters_, functionLike})
        == MacroTable::Definition::Replaced) {
        reportIncompatible(*name);
    }
    sources_.skipBlanks();
    sources_.next();
}

void Definitions::undefDirective() {
    const std::optional<std::string> name = readMacroName();
    if (!name) {
        return;
    }
    macros_.undefine(*name);
    sources_.skipBlanks();
    sources_.next();
}

Outcome Definitions::defineDirective(DirectiveLine& line) {
    line.skipBlanks();
    const Token name = line.next();
    if (!isName(name.kind)) {
        return Outcome::Untold;
    }
    macros_.prefetch(name.text);
    const bool functionLike = line.peekByte() == '(';
    parameters_.clear();
    if (functionLike && readParameters(line, parameters_) != nullptr) {
        return Outcome::Untold;
    }
    line.skipBlanks();
    const std::optional<std::string_view> text = line.readText(text_);
    if (!text) {
        return Outcome::Untold;
    }
    const MacroTable::Definition definition =
        macros_.define(name.text, {*text, parameters_, functionLike});
    line.takeEnd();
    if (definition == MacroTable::Definition::Replaced) {
        reportIncompatible(name.text);
    }
    return Outcome::EndTaken;
}

Outcome Definitions::undefDirective(DirectiveLine& line) {
    line.skipBlanks();
    const Token name = line.next();
    line.skipBlanks();
    if (!isName(name.kind) || !line.isAtEnd()) {
        return Outcome::Untold;
    }
    macros_.undefine(name.text);
    line.takeEnd();
    return Outcome::EndTaken;
}

void Definitions::reportIncompatible(std::string_view name) {
    reporter_.reportWarning(
        std::string("Macro \"").append(name).append("\" has an incompatible redefinition"));
}

std::optional<std::string> Definitions::readMacroName() {
    sources_.skipBlanks();
    const Token token = sources_.next();
    if (!isName(token.kind)) {
        reporter_.reportError("Invalid macro name");
        return std::nullopt;
    }
    return std::string(token.text);
}

std::string Definitions::readReplacement() {
    std::string text;
    bool separatorPending = false;
    sources_.skipBlanks();
    while (!endsLine(sources_.peek())) {
        const Token token = sources_.next();
        if (token.kind == WHITESPACE) {
            separatorPending = true;
        } else if (token.kind != CONTINUATION) {
            if (separatorPending) {
                text.push_back(' ');
                separatorPending = false;
            }
            text.append(token.text);
        }
    }
    return text;
}

}  // namespace umpre
