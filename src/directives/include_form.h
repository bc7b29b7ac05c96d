// SPDX-License-Identifier: MIT
#ifndef UMPRE_DIRECTIVES_INCLUDE_FORM_H
#define UMPRE_DIRECTIVES_INCLUDE_FORM_H

namespace umpre {

/// The form of a name in `#include`: a quoted one is tried as it is before the directories.
enum class IncludeForm { Brackets, Quotes };

}  // namespace umpre

#endif
