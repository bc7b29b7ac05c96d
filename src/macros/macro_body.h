// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_MACRO_BODY_H
#define UMPRE_MACROS_MACRO_BODY_H

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "lex/lexed_text.h"
#include "lex/shared_text.h"
#include "lex/text_lexer.h"
#include "macros/macro.h"
#include "macros/macro_table.h"

namespace umpre {

/// One step of building a replacement.
struct BodyStep {
    enum class Kind {
        Tokens,      ///< tokens `first` to `last` of the body, as they are
        Effects,     ///< what reading token `first` of the source does
        Argument,    ///< the expanded argument number `first`
        Joined,      ///< the operands `first` to `last`, joined into one text
        Misplaced,   ///< error: "#" without a parameter; ends the replacement
        PasteFirst,  ///< error: "##" begins the body; ends the replacement
        PasteLast,   ///< error: "##" ends the body; ends the replacement
    };
    Kind kind = Kind::Tokens;
    std::size_t first = 0;
    std::size_t last = 0;  // not included
    // For tokens, their texts, joined, and the names among them, of those of the body.
    std::string_view text{};
    std::size_t firstName = 0;
    std::size_t lastName = 0;
};

/// One text of those that a step joins.
struct BodyOperand {
    enum class Kind {
        Token,        ///< token `index` of the body
        RawArgument,  ///< the text of argument `index`, unexpanded
        Stringized,   ///< the string literal of argument `index`
    };
    Kind kind = Kind::Token;
    std::size_t index = 0;
};

/// A replacement text made ready for use: lexed, and, for a function-like macro, with what `#`,
/// `##` and the parameters ask for worked out.
struct MacroBody {
    SharedText tokens;
    // For function-like macros only:
    SharedText source;  // the text as lexed, if reading it has effects
    std::vector<BodyStep> steps;
    std::vector<BodyOperand> operands;  // of the steps that join
    std::vector<const Name*> names;     // of the tokens that stay as they are
    /// Replacing is a matter of the bytes of this body and the arguments alone.
    bool isPlain = false;
    // Whether `names` holds one of a macro, as of so many changes of the table.
    mutable bool hasMacros = false;
    mutable std::uint64_t changes = 0;
};

/// Makes bodies.
class BodyMaker {
public:
    /// Where each macro must be expanded by itself, no body is plain.
    BodyMaker(TextLexer& lexer, MacroTable& macros, bool tellsMacros = false) noexcept
        : lexer_(lexer), macros_(macros), tellsMacros_(tellsMacros) {}

    /// Tells whether each macro must be expanded by itself.
    [[nodiscard]] bool tellsMacros() const noexcept { return tellsMacros_; }

    /// Returns the tokens of an object-like macro. They are kept from the second use on: of many
    /// macros that name each other each is often used once.
    [[nodiscard]] SharedText tokensOf(const Macro& macro);

    /// Returns the body of a function-like macro, made at the first use.
    [[nodiscard]] const MacroBody& bodyOf(const Macro& macro) {
        MacroUse& use = macros_.useOf(macro);
        if (use.body == nullptr) {
            use.body = macro.isAnother() ? keptBody(macro) : newBody(macro);
        }
        return *use.body;
    }

private:
    // The body of a definition, by what the definition says.
    struct KeptBody {
        std::string parameters;
        std::string text;
        std::shared_ptr<const MacroBody> body;
    };

    [[nodiscard]] std::shared_ptr<const MacroBody> newBody(const Macro& macro);
    [[nodiscard]] std::shared_ptr<const MacroBody> keptBody(const Macro& macro);

    TextLexer& lexer_;
    MacroTable& macros_;
    bool tellsMacros_;
    // A name that is defined anew is often given one of few definitions in turn.
    std::array<KeptBody, 64> kept_;
};

}  // namespace umpre

#endif
