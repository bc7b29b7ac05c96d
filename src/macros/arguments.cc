// SPDX-License-Identifier: MIT
//
// Reads "(a, (b, c) d)" as the arguments "a" and "(b, c) d". Only commas and a ")" outside inner
// parentheses separate. An argument is begun by its first token, so a ")" right after "(" or after
// a comma adds none: the last argument can not be empty, any other can.
#include "macros/arguments.h"

namespace umpre {

using enum TokenKind;

Argument& ArgumentList::add(const SharedText& text) {
    if (size_ == arguments_.size()) {
        arguments_.emplace_back();
    }
    Argument& argument = arguments_[size_++];
    argument.raw = {text, 0, 0};
    argument.mustBeLexed = false;
    argument.state = Argument::Expansion::Unknown;
    return argument;
}

void ArgumentList::release() {
    for (std::size_t index = 0; index < size_; ++index) {
        arguments_[index].raw = {};
        arguments_[index].expansion.restart();
    }
    clear();
}

bool ArgumentCollector::collect(std::size_t parameterCount, ArgumentList& arguments) {
    arguments.clear();
    (void)sources_.next();
    TokenKind end = COMMA;
    const SharedText text = texts_.take();
    while (end == COMMA && arguments.size() <= parameterCount) {
        (void)sources_.passBlanksAndNewlines();
        const Token token = sources_.next();
        end = token.kind;
        if (end == RIGHT_PARENTHESIS) {
            break;
        }
        Argument& argument = arguments.add(text);
        argument.raw.first = argument.raw.last = text->size();
        if (end != COMMA) {
            end = readArgument(token, argument);
        }
        argument.noExpand = sources_.noExpandSet();
        // Keeps two arguments apart where the text is looked at as a whole.
        text.edit().append(WHITESPACE, " ");
    }
    if (end == END_OF_INPUT) {
        reporter_.reportError("The macro invocation is improperly terminated");
    } else if (arguments.size() < parameterCount) {
        reporter_.reportError("There are not enough arguments in a macro invocation");
    } else if (arguments.size() > parameterCount) {
        reporter_.reportError("A macro invocation has too many arguments");
    } else {
        return true;
    }
    return false;
}

// Reads the argument that `first` begins, to the token that ends it; returns that token's kind.
TokenKind ArgumentCollector::readArgument(const Token& first, Argument& argument) {
    std::size_t depth = first.kind == LEFT_PARENTHESIS ? 1 : 0;
    append(argument, first);
    for (;;) {
        const bool separated = sources_.passBlanksAndNewlines();
        const Token token = sources_.next();
        if (token.kind == END_OF_INPUT
            || (depth == 0 && (token.kind == COMMA || token.kind == RIGHT_PARENTHESIS))) {
            return token.kind;
        }
        if (token.kind == LEFT_PARENTHESIS) {
            ++depth;
        } else if (token.kind == RIGHT_PARENTHESIS) {
            --depth;
        }
        if (separated) {
            append(argument, {WHITESPACE, " "});
        }
        append(argument, token);
    }
}

void ArgumentCollector::append(Argument& argument, const Token& token) {
    LexedText& text = argument.raw.text.edit();
    const bool isKnown = !isName(token.kind) || token.name != nullptr;
    text.append(token.kind, token.text, isKnown ? token.name : &macros_.noteOf(token.text));
    argument.mustBeLexed = argument.mustBeLexed || !text.isClean(text.size() - 1);
    argument.raw.last = text.size();
}

}  // namespace umpre
