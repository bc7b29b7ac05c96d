// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_DIRECTIVE_FIXTURE_H
#define UMPRE_TESTS_UNIT_SUPPORT_DIRECTIVE_FIXTURE_H

#include <string>
#include <string_view>

#include "lex/token.h"
#include "support/macro_fixture.h"

namespace umpre::testing {

/// Sources and macros, with what a directive needs: its word is read before it is carried out.
struct DirectiveFixture : MacroFixture {
    using MacroFixture::MacroFixture;

    /// Reads "#", blanks and the directive word, whose kind it returns.
    [[nodiscard]] TokenKind readWord() {
        (void)sources.skipBlanks();
        const TokenKind hash = sources.next().kind;
        (void)sources.skipBlanks();
        return hash == TokenKind::HASH ? sources.next().kind : TokenKind::END_OF_INPUT;
    }

    [[nodiscard]] std::string definition(std::string_view name) {
        return definitionOf(macros, name);
    }
};

}  // namespace umpre::testing

#endif
