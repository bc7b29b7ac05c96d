// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_STRINGIZE_H
#define UMPRE_MACROS_STRINGIZE_H

#include <string>
#include <string_view>

namespace umpre {

/// Adds the string literal that `#` makes of an argument's text to `result`.
void stringize(std::string_view rawText, std::string& result);

}  // namespace umpre

#endif
