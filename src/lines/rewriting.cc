// SPDX-License-Identifier: MIT
#include "lines/rewriting.h"

#include <cstddef>

namespace umpre {

void GnuText::marker(const Marker& marker) {
    output_.write("# ");
    output_.write(marker.number);
    output_.write(" \"");
    std::string_view name = marker.doubledName;
    for (std::size_t at = name.find('"'); at != std::string_view::npos; at = name.find('"')) {
        output_.write(name.substr(0, at));
        output_.write("\\\"");
        name.remove_prefix(at + 1);
    }
    output_.write(name);
    output_.write("\"\n");
}

}  // namespace umpre
