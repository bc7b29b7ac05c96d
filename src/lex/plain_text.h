// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_PLAIN_TEXT_H
#define UMPRE_LEX_PLAIN_TEXT_H

namespace umpre {

/// Returns the end of the number, literal or other byte that begins at `at`, before `end`; null if
/// that is more than text: a comment, a line end, a quote that is not closed, a zero byte.
[[nodiscard]] const char* unusualTokenEnd(const char* at, const char* end) noexcept;

}  // namespace umpre

#endif
