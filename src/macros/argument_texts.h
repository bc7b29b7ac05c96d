// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_ARGUMENT_TEXTS_H
#define UMPRE_MACROS_ARGUMENT_TEXTS_H

#include <cstddef>
#include <span>
#include <string_view>
#include <utility>
#include <vector>

#include "lex/name_filter.h"

namespace umpre {

/// One argument of a call as bytes.
struct ArgumentText {
    /// As written, with one space between two tokens and none at the ends.
    std::string_view raw;
    /// All that it comes out as; null until it is worked out.
    std::string_view expansion;
    bool mayHaveMacros = false;  ///< in `raw`
    bool mayHaveQuotes = false;  ///< or backslashes, in `raw`
    bool hasMacros = false;      ///< names of macros were left in the expansion
};

/// Where the parentheses in the arguments of a call close, so that a call in them is passed over
/// without reading it again: else calls in calls would cost the square of their depth.
class CallOutline {
public:
    void clear() noexcept {
        parentheses_.clear();
        open_.clear();
        isBegun_ = false;
    }

    /// Returns true once.
    [[nodiscard]] bool begin() noexcept { return !std::exchange(isBegun_, true); }

    /// Notes what stands behind all that was noted before, if it is a "(" or ")".
    void note(const char* at);

    /// Returns the ")" of a "(", or null if that is not known.
    [[nodiscard]] const char* closing(const char* open) const;

private:
    struct Parenthesis {
        const char* open;
        const char* close;
    };

    std::vector<Parenthesis> parentheses_;
    std::vector<std::size_t> open_;
    bool isBegun_ = false;
};

/// Takes the arguments of a call as views of its bytes, from each of which 32 can be read. Returns
/// the end of the call whose "(" is at `open`, or null if that is not told by the bytes before
/// `end`: the call goes on behind them or over a line end, it has not so many arguments, or one of
/// them does not stand as it should.
/// The first call makes the `outline`, for those in its arguments; it must be cleared before their
/// bytes are other ones.
[[nodiscard]] const char* takeArgumentTexts(const char* open, const char* end,
                                            const NameFilter& macroNames, CallOutline& outline,
                                            std::span<ArgumentText> arguments);

}  // namespace umpre

#endif
