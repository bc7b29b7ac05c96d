// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_REPORTER_H
#define UMPRE_LEX_REPORTER_H

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace umpre {

/// The port through which problems in the input leave the lower folders. Messages come without
/// their final period; the position is that of the file being read at the moment of the call.
class Reporter {
public:
    virtual ~Reporter() = default;
    virtual void reportError(std::string_view message) = 0;
    virtual void reportWarning(std::string_view message) = 0;
    /// A comment met the end of the input at `line`, counted by the lexer that read it.
    virtual void noteUnterminatedComment(std::int32_t line) = 0;
    /// Returns how many problems have been reported so far, of whatever weight.
    [[nodiscard]] virtual std::size_t reportCount() const = 0;
};

}  // namespace umpre

#endif
