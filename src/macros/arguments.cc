// SPDX-License-Identifier: MIT
//
// Reads "(a, (b, c) d)" as the arguments "a" and "(b, c) d". Only commas and a ")" outside inner
// parentheses separate. An argument is begun by its first token, so a ")" right after "(" or after
// a comma adds none: the last argument can not be empty, any other can.
#include "macros/arguments.h"

namespace umpre {
namespace {

using enum TokenKind;

// Reads the argument that `first` begins, to the token that ends it; returns that token's kind.
TokenKind readArgument(ScannerStack& sources, Token first, Argument& argument) {
    std::size_t depth = first.kind == LEFT_PARENTHESIS ? 1 : 0;
    argument.text = first.text;
    std::string skipped;
    for (;;) {
        const bool separated = sources.skipBlanksAndNewlines(skipped);
        const Token token = sources.next();
        if (token.kind == END_OF_INPUT
            || (depth == 0 && (token.kind == COMMA || token.kind == RIGHT_PARENTHESIS))) {
            argument.noExpand = sources.noExpandSet();
            return token.kind;
        }
        if (token.kind == LEFT_PARENTHESIS) {
            ++depth;
        } else if (token.kind == RIGHT_PARENTHESIS) {
            --depth;
        }
        if (separated) {
            argument.text.push_back(' ');
        }
        argument.text.append(token.text);
    }
}

}  // namespace

Argument& ArgumentList::add() {
    if (size_ == arguments_.size()) {
        arguments_.emplace_back();
    }
    Argument& argument = arguments_[size_++];
    argument.text.clear();
    argument.state = Argument::Expansion::Unknown;
    return argument;
}

bool collectArguments(ScannerStack& sources, Reporter& reporter, std::size_t parameterCount,
                      ArgumentList& arguments) {
    arguments.clear();
    (void)sources.next();
    TokenKind end = COMMA;
    while (end == COMMA && arguments.size() <= parameterCount) {
        std::string skipped;
        (void)sources.skipBlanksAndNewlines(skipped);
        const Token token = sources.next();
        end = token.kind;
        if (end == RIGHT_PARENTHESIS) {
            break;
        }
        Argument& argument = arguments.add();
        if (end == COMMA) {
            argument.noExpand = sources.noExpandSet();
        } else {
            end = readArgument(sources, token, argument);
        }
    }
    if (end == END_OF_INPUT) {
        reporter.reportError("The macro invocation is improperly terminated");
    } else if (arguments.size() < parameterCount) {
        reporter.reportError("There are not enough arguments in a macro invocation");
    } else if (arguments.size() > parameterCount) {
        reporter.reportError("A macro invocation has too many arguments");
    } else {
        return true;
    }
    return false;
}

}  // namespace umpre
