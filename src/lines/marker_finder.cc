// SPDX-License-Identifier: MIT
//
// A marker stands on a line of its own and has exactly one form, and no line of text is written in
// that form unless its macros make it so; then whoever reads the text takes it for a marker, too.
// Only a line that a backslash makes part of the line before is none:
//
//     first\|#line 5 "f"\|last|        with a bar for each line end
//
// is one line of text. It may be a literal, a pragma or anything else that goes on over a line end,
// so nothing needs to be known about these.
#include "lines/marker_finder.h"

#include <algorithm>
#include <optional>

namespace umpre {

void MarkerFinder::feed(std::string_view bytes) {
    while (!bytes.empty()) {
        bytes.remove_prefix(isHolding_ ? hold(bytes) : pass(bytes));
    }
}

void MarkerFinder::finish() {
    if (isHolding_) {
        release();
    }
}

// Hands on what stands before a line that may be a marker.
std::size_t MarkerFinder::pass(std::string_view bytes) {
    const std::size_t size = candidateIn(bytes);
    isHolding_ = size < bytes.size();
    if (size > 0) {
        handOn(bytes.substr(0, size));
    }
    return size;
}

// Holds back up to the line's end, or until it cannot be a marker.
std::size_t MarkerFinder::hold(std::string_view bytes) {
    const std::size_t size = std::min(bytes.find('\n'), bytes.size() - 1) + 1;
    held_.append(bytes.substr(0, size));
    const std::size_t known = std::min(held_.size(), kMarkerStart.size());
    const bool canBeMarker = held_.compare(0, known, kMarkerStart, 0, known) == 0;
    if (!canBeMarker || held_.back() == '\n') {
        release();
    }
    return size;
}

std::size_t MarkerFinder::candidateIn(std::string_view bytes) const {
    for (std::size_t at = bytes.find('#'); at != std::string_view::npos;
         at = bytes.find('#', at + 1)) {
        const char before = at > 0 ? bytes[at - 1] : last_;
        if (before == '\n') {
            const char beforeThat = at > 1 ? bytes[at - 2] : at > 0 ? last_ : lastButOne_;
            if (beforeThat != '\\') {
                return at;
            }
        }
    }
    return bytes.size();
}

void MarkerFinder::release() {
    isHolding_ = false;
    const std::optional<Marker> marker = parseMarker(held_);
    if (marker) {
        receiver_.marker(*marker);
        last_ = '\n';
        lastButOne_ = '"';
    } else {
        handOn(held_);
    }
    held_.clear();
}

void MarkerFinder::handOn(std::string_view bytes) {
    receiver_.text(bytes);
    lastButOne_ = bytes.size() > 1 ? bytes[bytes.size() - 2] : last_;
    last_ = bytes.back();
}

}  // namespace umpre
