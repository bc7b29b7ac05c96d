// SPDX-License-Identifier: MIT
#include "macros/expansion_memo.h"

namespace umpre {
namespace {

// What takes more is worked out at each use.
constexpr std::size_t kMostKept = std::size_t{32} << 20U;

}  // namespace

std::optional<std::string_view> ExpansionMemo::workedOut(const MacroName& name) {
    text_.clear();
    const bool isTold = expander_.expandObject(name, text_);
    if (version_ != macros_.version()) {
        version_ = macros_.version();
        bytes_.release();
        size_ = 0;
    }
    if (isTold && size_ + text_.view().size() > kMostKept) {
        return text_.view();
    }
    Expansion& expansion = name.expansion;
    expansion = {version_, isTold ? kept(text_.view()) : std::string_view()};
    return isTold ? std::optional(expansion.text) : std::nullopt;
}

std::string_view ExpansionMemo::kept(std::string_view text) {
    char* const bytes = static_cast<char*>(bytes_.allocate(text.size() + 1, 1));
    size_ += text.size() + 1;
    return {bytes, text.copy(bytes, text.size())};
}

}  // namespace umpre
