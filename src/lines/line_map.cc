// SPDX-License-Identifier: MIT
//
// A segment says where the lines of the text come from, up to the next segment:
//
//     {"output": 4, "file": "a.src", "line": 7}     line 4 is line 7 of a.src, line 5 is line 8
//
// A marker that no text follows before the next one says nothing and has no segment.
#include "lines/line_map.h"

#include <algorithm>

#include "lines/json_string.h"

namespace umpre {

LineMap::LineMap(OutputWriter& output, Count count) : output_(output), count_(count) {
    output_.write("{\"segments\": [");
}

void LineMap::text(std::string_view bytes) {
    if (!pending_.empty()) {
        output_.write(isFirst_ ? "\n" : ",\n");
        output_.write("{\"output\": " + std::to_string(lineEnds_ + 1) + pending_);
        isFirst_ = false;
        pending_.clear();
    }
    lineEnds_ += static_cast<std::uint64_t>(std::count(bytes.begin(), bytes.end(), '\n'));
    endsLine_ = bytes.back() == '\n';
}

void LineMap::marker(const Marker& marker) {
    pending_.assign(", \"file\": ").append(jsonString(fileNameOf(marker)));
    pending_.append(", \"line\": ").append(marker.number).append("}");
    lineEnds_ += count_ == Count::All ? 1 : 0;
}

void LineMap::finish() {
    const std::uint64_t lines = lineEnds_ + (endsLine_ ? 0 : 1);
    output_.write(isFirst_ ? "]" : "\n]");
    output_.write(", \"lines\": " + std::to_string(lines) + "}\n");
}

}  // namespace umpre
