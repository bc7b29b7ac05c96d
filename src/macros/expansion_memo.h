// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_EXPANSION_MEMO_H
#define UMPRE_MACROS_EXPANSION_MEMO_H

#include <cstddef>
#include <cstdint>
#include <memory_resource>
#include <optional>
#include <string_view>

#include "macros/macro_table.h"
#include "macros/text_buffer.h"
#include "macros/text_expander.h"

namespace umpre {

/// What object-like macros come out as where a file's text uses them, kept until a name that this
/// hangs on is defined or undefined.
class ExpansionMemo {
public:
    ExpansionMemo(const MacroTable& macros, TextExpander& expander)
        : macros_(macros), expander_(expander) {}

    /// Returns what an object-like macro comes out as; nothing if the expander does not tell. Valid
    /// until the next call.
    [[nodiscard]] std::optional<std::string_view> textOf(const MacroName& name) {
        const Expansion& expansion = name.expansion;
        if (expansion.version != macros_.version()) {
            return workedOut(name);
        }
        return expansion.text.data() == nullptr ? std::nullopt : std::optional(expansion.text);
    }

private:
    [[nodiscard]] std::optional<std::string_view> workedOut(const MacroName& name);
    [[nodiscard]] std::string_view kept(std::string_view text);

    const MacroTable& macros_;
    TextExpander& expander_;
    std::pmr::monotonic_buffer_resource bytes_;
    std::size_t size_ = 0;       // of the texts kept
    std::uint64_t version_ = 0;  // of the table, for which they were worked out
    TextBuffer text_;
};

}  // namespace umpre

#endif
