// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_MACRO_EXPANDER_H
#define UMPRE_MACROS_MACRO_EXPANDER_H

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "lex/name_reader.h"
#include "lex/no_expand_set.h"
#include "lex/pieces.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/shared_text.h"
#include "lex/text_lexer.h"
#include "macros/arguments.h"
#include "macros/expansion_memo.h"
#include "macros/macro_body.h"
#include "macros/macro_events.h"
#include "macros/macro_table.h"
#include "macros/substitution.h"
#include "macros/text_buffer.h"
#include "macros/text_expander.h"

namespace umpre {

/// What a directive line that is expanded is for.
enum class LineKind {
    Operand,
    Condition,  ///< `defined` and its operand are kept as written
};

/// Expands one name, or one directive line. A replacement is not returned but pushed as a source,
/// so whoever reads on reads it, and brings its names back here.
class MacroExpander {
public:
    MacroExpander(ScannerStack& sources, MacroTable& macros, Reporter& reporter, TextLexer& lexer)
        : sources_(sources),
          macros_(macros),
          reporter_(reporter),
          lexer_(lexer),
          bodies_(lexer, macros, sources.tellsMacros()),
          texts_(macros, bodies_),
          memo_(macros, texts_),
          collector_(sources, macros, reporter, lexer.texts()),
          substitution_(sources, macros, reporter, lexer, sets_) {}

    /// Tells of each macro that is replaced by tokens.
    void setEvents(MacroEvents& events) noexcept { events_ = &events; }

    /// Reads a name in a file's text, as bytes.
    [[nodiscard]] NameReader::Outcome readName(std::string_view name, const char* end);

    /// Says which names will be read next.
    void notice(std::span<const std::string_view> names);

    /// Takes a name that was just read and returns what is to be written for it: the name itself,
    /// perhaps with blanks before it, a replacement that holds no macros, or nothing when a
    /// replacement was pushed. Valid until the next call and the next token read.
    [[nodiscard]] std::string_view expandName(const Token& token);

    /// Consumes tokens of the current source, if it is a replacement, that are text as they stand,
    /// and returns their texts, joined. Valid until the next token is read.
    [[nodiscard]] std::string_view takeText();

    /// Returns the rest of a directive line with all its macros expanded.
    [[nodiscard]] std::string expandLine(std::string_view text, LineKind kind);

private:
    // What looking at a name led to.
    enum class Outcome {
        Name,       // the name is just a name, with no argument list read
        Uncalled,   // a function-like macro without "(": `skipped_` comes before the name
        Text,       // a replacement that need not be read again: `text_`
        Pushed,     // a replacement was pushed
        Begun,      // an invocation was added to `invocations_`
        Abandoned,  // an invocation with the wrong arguments: the name is left
    };

    [[nodiscard]] const MacroName* macroToRead(std::string_view name);
    [[nodiscard]] MacroName* entryOf(const Token& token);
    [[nodiscard]] Outcome lookAt(MacroName* name);
    void refresh(MacroName& name);
    [[nodiscard]] Outcome replace(const MacroName& name);
    [[nodiscard]] Outcome replaceAndTell(const MacroName& name);
    [[nodiscard]] Outcome replaceObject(const MacroName& name);
    [[nodiscard]] bool isText(const LexedText& text) const;
    [[nodiscard]] Outcome beginInvocation(const MacroName& name);
    [[nodiscard]] bool collect(const Macro& macro, ArgumentList& arguments);
    [[nodiscard]] std::unique_ptr<Invocation> newInvocation();
    void keepInvocation(std::unique_ptr<Invocation> invocation);
    void finishInvocations();
    void pushReplacement();
    void beginArgument(Invocation& invocation, Argument& argument);
    void endArgument(Invocation& invocation);
    [[nodiscard]] bool readList(Pieces& result);
    [[nodiscard]] bool readListName(const Token& token, Pieces& result);
    void takeList(Pieces& result);
    void keepDefined(const Token& word, Pieces& result);
    [[nodiscard]] std::size_t effects() const;

    ScannerStack& sources_;
    MacroTable& macros_;
    Reporter& reporter_;
    TextLexer& lexer_;
    NoExpandSets sets_;
    BodyMaker bodies_;
    TextExpander texts_;
    ExpansionMemo memo_;
    ArgumentCollector collector_;
    Substitution substitution_;
    MacroEvents* events_ = nullptr;
    LineKind lineKind_ = LineKind::Operand;
    std::vector<std::unique_ptr<Invocation>> invocations_;  // the innermost one is the last
    std::vector<std::unique_ptr<Invocation>> spare_;        // finished, to be used again
    // Bodies whose definitions changed while they were in use, until no invocation is left.
    std::vector<std::shared_ptr<const MacroBody>> retired_;
    std::string skipped_;
    std::string written_;
    TextBuffer call_;
    const MacroName* lastRead_ = nullptr;
    std::vector<MacroTable::Sought> noticed_;
    std::size_t nextNoticed_ = 0;
    SharedText text_;
};

}  // namespace umpre

#endif
