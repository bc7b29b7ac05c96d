// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_ARGUMENT_SLICES_H
#define UMPRE_MACROS_ARGUMENT_SLICES_H

#include <cstddef>

#include "lex/cpp_token_scanner.h"
#include "macros/arguments.h"

namespace umpre {

/// Takes the arguments of an invocation out of the list that is read, without reading them token by
/// token: its "(" is the list's next token, and the arguments become slices of the list's text.
/// Returns false, with nothing consumed, if they must be read as tokens: they do not end in the
/// list, they are too many or too few, or their blanks are not single spaces.
[[nodiscard]] bool takeArgumentSlices(CppTokenScanner& list, std::size_t parameterCount,
                                      ArgumentList& arguments);

}  // namespace umpre

#endif
