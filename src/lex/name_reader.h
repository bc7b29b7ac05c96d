// SPDX-License-Identifier: MIT
#ifndef UMPRE_LEX_NAME_READER_H
#define UMPRE_LEX_NAME_READER_H

#include <span>
#include <string_view>

namespace umpre {

/// The port for names in a file's text that may be macros.
class NameReader {
public:
    /// What a name, with the arguments behind it, comes out as.
    struct Outcome {
        std::string_view text;
        const char* end;  ///< of what was read; null if it must be read token by token
    };

    virtual ~NameReader() = default;
    /// Tells whether reading names is quicker if they were given notice of.
    [[nodiscard]] virtual bool gainsByNotice() const noexcept = 0;
    /// Says that these names will be read soon.
    virtual void notice(std::span<const std::string_view> names) = 0;
    /// Reads a name in a text that goes on behind it up to `end`; a view of these bytes as text
    /// means the name itself. The text is valid until the next call.
    [[nodiscard]] virtual Outcome readName(std::string_view name, const char* end) = 0;
};

}  // namespace umpre

#endif
