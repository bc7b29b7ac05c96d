// SPDX-License-Identifier: MIT
#ifndef UMPRE_LINES_JSON_STRING_H
#define UMPRE_LINES_JSON_STRING_H

#include <string>
#include <string_view>

namespace umpre {

/// Returns bytes as a JSON string, quotes included. What is UTF-8 stays as it is; any other byte xx
/// becomes the escape \udcxx, which no text means and from which the byte can be had back.
[[nodiscard]] std::string jsonString(std::string_view bytes);

}  // namespace umpre

#endif
