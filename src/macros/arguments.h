// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_ARGUMENTS_H
#define UMPRE_MACROS_ARGUMENTS_H

#include <cstddef>
#include <vector>

#include "lex/no_expand_set.h"
#include "lex/pieces.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/shared_text.h"
#include "macros/macro_table.h"

namespace umpre {

/// One argument of an invocation.
struct Argument {
    /// As written, with one space for each run of blanks and line ends, and none at its ends.
    TextSlice raw;
    /// Lexing the joined text may give other tokens than those that it was joined from.
    bool mustBeLexed = false;
    /// The names not to expand where the argument ended.
    NoExpandSet noExpand;
    /// The expansion, while it is known.
    Pieces expansion;
    enum class Expansion { Unknown, ForOneUse, Known, SameAsRaw } state = Expansion::Unknown;
};

/// The arguments of one invocation, in the order written. What `clear` leaves is used again.
class ArgumentList {
public:
    void clear() noexcept { size_ = 0; }

    /// Adds an empty argument of a text.
    Argument& add(const SharedText& text);

    /// Lets go of all texts.
    void release();

    [[nodiscard]] std::size_t size() const noexcept { return size_; }

    [[nodiscard]] Argument& operator[](std::size_t index) noexcept { return arguments_[index]; }

private:
    std::vector<Argument> arguments_;
    std::size_t size_ = 0;
};

/// Reads the arguments of invocations.
class ArgumentCollector {
public:
    ArgumentCollector(ScannerStack& sources, MacroTable& macros, Reporter& reporter,
                      TextPool& texts) noexcept
        : sources_(sources), macros_(macros), reporter_(reporter), texts_(texts) {}

    /// Reads an invocation from its "(", which is the next token, up to its ")" into `arguments`.
    /// Returns false after reporting an error; what was read then is lost, the rest stays to be
    /// read.
    [[nodiscard]] bool collect(std::size_t parameterCount, ArgumentList& arguments);

private:
    TokenKind readArgument(const Token& first, Argument& argument);
    void append(Argument& argument, const Token& token);

    ScannerStack& sources_;
    MacroTable& macros_;
    Reporter& reporter_;
    TextPool& texts_;
};

}  // namespace umpre

#endif
