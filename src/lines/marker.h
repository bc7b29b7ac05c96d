// SPDX-License-Identifier: MIT
#ifndef UMPRE_LINES_MARKER_H
#define UMPRE_LINES_MARKER_H

#include <optional>
#include <string>
#include <string_view>

namespace umpre {

/// A line marker, `#line 12 "dir\\a.src"`, in views of the line that it was found in.
struct Marker {
    std::string_view number;       ///< in decimal, perhaps with a sign
    std::string_view doubledName;  ///< with every backslash doubled
};

/// What every line marker begins with.
inline constexpr std::string_view kMarkerStart = "#line ";

/// Returns what a line says if it has exactly the form in which markers are written. The line comes
/// with its line end, if it has one.
[[nodiscard]] std::optional<Marker> parseMarker(std::string_view line);

/// Returns the name of the file, each of its backslashes once.
[[nodiscard]] std::string fileNameOf(const Marker& marker);

}  // namespace umpre

#endif
