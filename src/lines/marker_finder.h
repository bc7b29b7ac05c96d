// SPDX-License-Identifier: MIT
#ifndef UMPRE_LINES_MARKER_FINDER_H
#define UMPRE_LINES_MARKER_FINDER_H

#include <cstddef>
#include <string>
#include <string_view>

#include "lines/marker.h"

namespace umpre {

/// What a text with line markers consists of, in its order.
class MarkedText {
public:
    virtual ~MarkedText() = default;
    /// Some text, never empty. It may begin and end anywhere, but after a marker it begins a line.
    virtual void text(std::string_view bytes) = 0;
    /// A marker with its line end. Its views are dead after the call.
    virtual void marker(const Marker& marker) = 0;
};

/// Tells the markers of a text from its lines, in one pass. Keeps nothing of the text but a line
/// that begins like a marker.
class MarkerFinder {
public:
    explicit MarkerFinder(MarkedText& receiver) noexcept : receiver_(receiver) {}

    /// Takes the next bytes.
    void feed(std::string_view bytes);
    /// Says that no bytes will follow.
    void finish();

private:
    [[nodiscard]] std::size_t pass(std::string_view bytes);
    [[nodiscard]] std::size_t hold(std::string_view bytes);
    [[nodiscard]] std::size_t candidateIn(std::string_view bytes) const;
    void release();
    void handOn(std::string_view bytes);

    MarkedText& receiver_;
    std::string held_;  // the beginning of a line that may be a marker
    bool isHolding_ = false;
    // The two bytes before those that come next.
    char last_ = '\n';
    char lastButOne_ = '\n';
};

}  // namespace umpre

#endif
