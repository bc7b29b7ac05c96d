// SPDX-License-Identifier: MIT
#ifndef UMPRE_LINES_LINE_MAP_H
#define UMPRE_LINES_LINE_MAP_H

#include <cstdint>
#include <string>
#include <string_view>

#include "lex/output_writer.h"
#include "lines/marker_finder.h"

namespace umpre {

/// Writes, as JSON, which lines of a text come from which lines of which file.
class LineMap final : public MarkedText {
public:
    /// Which lines are counted.
    enum class Count { All, WithoutMarkers };

    /// Writes the beginning.
    LineMap(OutputWriter& output, Count count);

    void text(std::string_view bytes) override;
    void marker(const Marker& marker) override;
    /// Writes the end.
    void finish();

private:
    OutputWriter& output_;
    Count count_;
    std::uint64_t lineEnds_ = 0;
    bool endsLine_ = true;
    std::string pending_;  // of the segment for the marker read last, while no text has followed
    bool isFirst_ = true;
};

}  // namespace umpre

#endif
