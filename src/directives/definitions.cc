// SPDX-License-Identifier: MIT
//
// A definition is kept as text, normalised: "#define A  1/* one */+  2  " gives "1 + 2", that is,
// one space where blanks stood between two tokens and none at the ends. A continuation separates
// nothing, so a backslash at the line end between "a" and "b" gives "ab".
#include "directives/definitions.h"

namespace umpre {

using enum TokenKind;

void Definitions::defineDirective() {
    const std::optional<std::string> name = readMacroName();
    if (!name) {
        return;
    }
    const bool functionLike = sources_.peek() == LEFT_PARENTHESIS;
    std::optional<std::string> parameters = std::string();
    if (functionLike) {
        parameters = readParameters();
        if (!parameters) {
            sources_.skipToEndOfLine();
            return;
        }
    }
    const std::string text = readReplacement();
    if (macros_.define(*name, {text, *parameters, functionLike})
        == MacroTable::Definition::Replaced) {
        reporter_.reportWarning("Macro \"" + *name + "\" has an incompatible redefinition");
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

std::optional<std::string> Definitions::readMacroName() {
    sources_.skipBlanks();
    const Token token = sources_.next();
    if (!isName(token.kind)) {
        reporter_.reportError("Invalid macro name");
        return std::nullopt;
    }
    return std::string(token.text);
}

// Reads from "(" to ")" and returns the names, with commas between them. Returns nothing after
// reporting an error, the offending token read.
std::optional<std::string> Definitions::readParameters() {
    std::string parameters;
    const auto nextInList = [this] {
        sources_.skipBlanks();
        return sources_.next();
    };
    sources_.next();
    Token token = nextInList();
    if (token.kind == RIGHT_PARENTHESIS) {
        return parameters;
    }
    for (;;) {
        if (!isName(token.kind)) {
            reporter_.reportError("An identifier is expected");
            return std::nullopt;
        }
        parameters.append(token.text);
        token = nextInList();
        if (token.kind == RIGHT_PARENTHESIS) {
            return parameters;
        }
        if (token.kind != COMMA) {
            reporter_.reportError("An ')' or ',' was expected");
            return std::nullopt;
        }
        parameters.push_back(',');
        token = nextInList();
    }
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
