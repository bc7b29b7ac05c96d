// SPDX-License-Identifier: MIT
#include "lines/marker.h"

#include <algorithm>

namespace umpre {
namespace {

constexpr std::string_view kDigits = "0123456789";

// Takes a number as it is written for an integer: no leading zeros, a sign only before others than
// 0.
std::string_view numberAt(std::string_view text) {
    const std::size_t sign = text.substr(0, 1) == "-" ? 1 : 0;
    const std::size_t end = std::min(text.find_first_not_of(kDigits, sign), text.size());
    const std::string_view digits = text.substr(sign, end - sign);
    const bool isWritten = !digits.empty() && (digits.front() != '0' || text.substr(0, end) == "0");
    return isWritten ? text.substr(0, end) : std::string_view{};
}

// Tells whether every run of backslashes is as long as doubling makes it.
bool isDoubled(std::string_view name) {
    for (std::size_t at = name.find('\\'); at != std::string_view::npos; at = name.find('\\')) {
        if (name.substr(at + 1, 1) != "\\") {
            return false;
        }
        name.remove_prefix(at + 2);
    }
    return true;
}

}  // namespace

std::optional<Marker> parseMarker(std::string_view line) {
    if (!line.empty() && line.back() == '\n') {
        line.remove_suffix(1);
    }
    if (line.substr(0, kMarkerStart.size()) != kMarkerStart) {
        return std::nullopt;
    }
    line.remove_prefix(kMarkerStart.size());
    const std::string_view number = numberAt(line);
    line.remove_prefix(number.size());
    if (number.empty() || line.size() < 3 || line.substr(0, 2) != " \"" || line.back() != '"') {
        return std::nullopt;
    }
    const std::string_view name = line.substr(2, line.size() - 3);
    if (!isDoubled(name)) {
        return std::nullopt;
    }
    return Marker{number, name};
}

std::string fileNameOf(const Marker& marker) {
    std::string name;
    for (std::size_t at = 0; at < marker.doubledName.size(); ++at) {
        if (marker.doubledName[at] == '\\') {
            ++at;
        }
        name.push_back(marker.doubledName[at]);
    }
    return name;
}

}  // namespace umpre
