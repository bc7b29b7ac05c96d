// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_ARGUMENT_TEXTS_H
#define UMPRE_MACROS_ARGUMENT_TEXTS_H

#include <cstddef>
#include <string_view>
#include <vector>

#include "lex/name_filter.h"

namespace umpre {

/// One argument of a call as bytes.
struct ArgumentText {
    /// As written, with one space between two tokens and none at the ends.
    std::string_view raw;
    /// All that it comes out as, once it is worked out.
    std::string_view expansion{};
    bool isExpanded = false;
    bool mayHaveMacros = false;  ///< in `raw`
    bool hasMacros = false;      ///< names of macros were left in the expansion
};

/// Adds the arguments of a call as views of its bytes, behind which eight more can be read. Returns
/// the end of the call whose "(" is at `open`, or null if that is not told by the bytes before
/// `end`: the call goes on behind them or over a line end, its arguments are not `count`, or one of
/// them does not stand as it should.
[[nodiscard]] const char* takeArgumentTexts(const char* open, const char* end, std::size_t count,
                                            const NameFilter& macroNames,
                                            std::vector<ArgumentText>& arguments);

}  // namespace umpre

#endif
