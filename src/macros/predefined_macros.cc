// SPDX-License-Identifier: MIT
#include "macros/predefined_macros.h"

#include <array>
#include <cstring>
#include <ctime>
#include <string>
#include <string_view>

namespace umpre {
namespace {

constexpr std::string_view kFile = "__FILE__";
constexpr std::string_view kLine = "__LINE__";

[[nodiscard]] std::string twoDigits(int number, char filling) {
    std::string text = std::to_string(number);
    if (text.size() < 2) {
        text.insert(0, 1, filling);
    }
    return text;
}

}  // namespace

void definePredefinedMacros(MacroTable& macros) {
    static constexpr std::array<const char*, 12> kMonths{"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                                         "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
    macros.defineMacro(kFile, "");
    macros.defineMacro(kLine, "");
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    ::localtime_r(&now, &local);
    const std::string date = std::string(kMonths.at(static_cast<std::size_t>(local.tm_mon))) + " "
                             + twoDigits(local.tm_mday, ' ') + " "
                             + std::to_string(1900 + local.tm_year);
    const std::string time = twoDigits(local.tm_hour, '0') + ":" + twoDigits(local.tm_min, '0')
                             + ":" + twoDigits(local.tm_sec, '0');
    macros.defineMacro("__DATE__", date);
    macros.defineMacro("__TIME__", time);
}

bool isRefreshed(const MacroName& name) noexcept {
    // Of a size that is known, bytes are compared all at once.
    const auto is = [&name](std::string_view other) {
        return std::memcmp(name.text.data(), other.data(), kFile.size()) == 0;
    };
    return mayBeRefreshed(name) && (is(kFile) || is(kLine));
}

void refreshPredefined(MacroTable& macros, MacroName& name, const SourcePosition& position) {
    std::string text;
    if (name.text == kFile) {
        text.append("\"").append(position.fileName).append("\"");
    } else if (name.text == kLine) {
        text = std::to_string(position.line);
    } else {
        return;
    }
    // The definition may be one of the source's own; only its text is replaced.
    if (text != name.macro.text()) {
        const std::string parameters(name.macro.parameters());
        macros.replace(name, {text, parameters, name.macro.functionLike()});
    }
}

}  // namespace umpre
