// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_MACRO_H
#define UMPRE_MACROS_MACRO_H

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <type_traits>

#include "lex/no_expand_set.h"
#include "lex/shared_text.h"

namespace umpre {

struct MacroBody;

/// A definition made ready for uses, of an object-like macro and of a function-like one; nothing
/// until that is worth keeping.
struct MacroUse {
    SharedText tokens;
    std::shared_ptr<const MacroBody> body;
};

/// What a definition says, as views of somebody else's bytes.
struct MacroText {
    /// The replacement: the tokens' texts with one space where blanks stood between two.
    std::string_view text;
    /// The names in the order written, with commas between them: "a,b". Empty too for a list
    /// without names.
    std::string_view parameters;
    /// A "(" followed the name at once.
    bool functionLike = false;
};

/// One definition. Its bytes are the table's and stay until its name is defined anew; its body is
/// worked out at its first use.
class Macro {
public:
    /// A zero byte follows it, and from each of its bytes 32 can be read.
    [[nodiscard]] std::string_view text() const noexcept {
        return {bytes_ + parametersSize_, textSize_};
    }

    /// The names of the parameters, as in MacroText.
    [[nodiscard]] std::string_view parameters() const noexcept { return {bytes_, parametersSize_}; }

    [[nodiscard]] std::size_t parameterCount() const noexcept { return parameterCount_; }

    [[nodiscard]] bool functionLike() const noexcept { return functionLike_; }

    /// Tells whether this is not the first definition of its name.
    [[nodiscard]] bool isAnother() const noexcept { return isAnother_; }

    [[nodiscard]] bool wasUsed() const noexcept { return wasUsed_; }

    void noteUse() const noexcept { wasUsed_ = true; }

    /// Returns what `MacroTable::useOf` made, or null.
    [[nodiscard]] const MacroUse* use() const noexcept { return use_; }

private:
    friend class MacroTable;

    // Large inputs have many definitions, so the members are as small as they can be.

    mutable MacroUse* use_ = nullptr;  // the table's
    // The parameters, behind them the text and a zero byte.
    char* bytes_ = nullptr;
    std::size_t textSize_ = 0;
    std::uint32_t capacity_ = 0;
    std::uint32_t parametersSize_ = 0;
    std::uint32_t parameterCount_ = 0;
    bool functionLike_ = false;
    bool wasDefined_ = false;  // now or earlier
    bool isAnother_ = false;
    mutable bool wasUsed_ = false;
};

/// What an object-like macro comes out as in text, as of a version of the table; without bytes if
/// that has to be read token by token.
struct Expansion {
    std::uint64_t version = 0;
    std::string_view text;
};

/// A name that was defined at least once, and its last definition. Its bytes follow it: large
/// inputs use names that lie far apart, so what a use in text looks at stands together.
struct MacroName : Name {
    mutable Expansion expansion;
    Macro macro;
};

static_assert(std::is_trivially_destructible_v<MacroName>);

}  // namespace umpre

#endif
