// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_MACRO_FIXTURE_H
#define UMPRE_TESTS_UNIT_SUPPORT_MACRO_FIXTURE_H

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "macros/macro_expander.h"
#include "macros/macro_table.h"
#include "support/source_fixture.h"

namespace umpre::testing {

/// A definition as a test writes it: `{"F", {"x", "y"}, "x + y"}`.
struct Definition {
    std::string name;
    std::vector<std::string> parameters;
    std::string text;
};

/// Returns a defined name's text, or a text that says that there is none.
[[nodiscard]] inline std::string definitionOf(MacroTable& macros, std::string_view name) {
    const MacroName* const found = macros.find(name);
    return std::string(found == nullptr ? "(not defined)" : found->macro.text());
}

/// Sources with macros.
struct MacroFixture : SourceFixture {
    explicit MacroFixture(std::string_view text, const RunOptions& runOptions = {})
        : SourceFixture(text, runOptions), expander(sources, macros, reporter, lexer) {}

    /// Enters an object-like macro.
    void define(std::string_view name, std::string_view text) {
        macros.define(name, {text, {}, false});
    }

    /// Enters a function-like macro.
    void define(const Definition& definition) {
        std::string parameters;
        for (const std::string& parameter : definition.parameters) {
            parameters.append(parameters.empty() ? "" : ",").append(parameter);
        }
        macros.define(definition.name, {definition.text, parameters, true});
    }

    void define(const std::vector<Definition>& definitions) {
        for (const Definition& definition : definitions) {
            define(definition);
        }
    }

    /// Reads everything as text: names go through the expander, the rest is taken as it is.
    [[nodiscard]] std::string expanded() {
        std::string result;
        for (Token token = sources.next(); token.kind != TokenKind::END_OF_INPUT;
             token = sources.next()) {
            result.append(isName(token.kind) ? expander.expandName(token) : token.text);
        }
        return result;
    }

    MacroTable macros;
    MacroExpander expander;
};

}  // namespace umpre::testing

#endif
