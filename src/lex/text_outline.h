// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_TEXT_OUTLINE_H
#define UMPRE_LEX_TEXT_OUTLINE_H

#include <cstddef>
#include <vector>

#include "lex/lexed_text.h"

namespace umpre {

/// What is known of a text as a whole.
struct TextOutline {
    /// All its tokens stay themselves: any part of it, joined and lexed again, gives the same.
    bool isPlain = false;
    /// Of each "(" the place of its ")"; of those without one, and of other tokens, 0.
    std::vector<std::size_t> closing;
};

}  // namespace umpre

#endif
