// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_LINE_BEGINNING_H
#define UMPRE_LEX_LINE_BEGINNING_H

#include <cstddef>

#include "lex/text_pass.h"

namespace umpre {

/// What a line begins with.
struct LineBeginning {
    const char* first = nullptr;   ///< behind blanks and comments; null: for the scanner to read
    std::size_t commentLines = 0;  ///< line ends in comments
    bool hasComments = false;
};

/// Returns where the blanks that begin at `at` end.
[[nodiscard]] const char* blanksEnd(const char* at, const char* end) noexcept;

/// Looks at what a line begins with behind its first blanks. Nothing is done yet about the comments
/// there.
[[nodiscard]] LineBeginning lineBeginning(const char* behindBlanks, TextPass& pass);

}  // namespace umpre

#endif
