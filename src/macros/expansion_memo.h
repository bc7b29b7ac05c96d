// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_EXPANSION_MEMO_H
#define UMPRE_MACROS_EXPANSION_MEMO_H

#include <cstddef>
#include <cstdint>
#include <memory_resource>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "macros/macro_table.h"

namespace umpre {

/// What object-like macros come out as where a file's text uses them, with all macros of their
/// texts expanded. It is worked out from bytes and kept until a name that was looked at for it is
/// defined or undefined.
class ExpansionMemo {
public:
    explicit ExpansionMemo(MacroTable& macros) noexcept : macros_(macros) {}

    /// Returns what an object-like macro comes out as; nothing if it must be read token by token.
    /// Valid until the next call.
    [[nodiscard]] std::optional<std::string_view> textOf(const MacroName& name) {
        const Macro::Expansion& expansion = name.macro.expansion;
        if (expansion.version != macros_.version()) {
            return workedOut(name);
        }
        return expansion.text.data() == nullptr ? std::nullopt : std::optional(expansion.text);
    }

private:
    // A text that is read in the place of its macro's name.
    struct Replacement {
        const MacroName* macro;
        const char* at;
        const char* end;
    };

    [[nodiscard]] std::optional<std::string_view> workedOut(const MacroName& name);
    [[nodiscard]] bool expand(const MacroName& name);
    [[nodiscard]] bool readOn(Replacement& text);
    [[nodiscard]] const MacroName* macroOf(std::string_view name);
    [[nodiscard]] bool begin(const MacroName& name);
    [[nodiscard]] std::string_view kept(std::string_view text);

    MacroTable& macros_;
    std::pmr::monotonic_buffer_resource bytes_;
    std::size_t size_ = 0;       // of the texts kept
    std::uint64_t version_ = 0;  // of the table, for which they were worked out
    std::size_t begun_ = 0;      // texts that went into the one that is worked out
    std::string text_;
    std::vector<Replacement> replacements_;  // the innermost one is the last
};

}  // namespace umpre

#endif
