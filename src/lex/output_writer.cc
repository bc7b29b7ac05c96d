// SPDX-License-Identifier: MIT
#include "lex/output_writer.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstring>

namespace umpre {
namespace {

// The most that a marker takes without its name.
constexpr std::size_t kMarkerSize = 24;

[[nodiscard]] char* put(char* at, std::string_view text) noexcept {
    return at + text.copy(at, text.size());
}

// Writes a marker up to its line into memory that is large enough. Returns its end.
[[nodiscard]] char* putMarkerBegin(char* at, std::int32_t line) noexcept {
    at = put(at, "#line ");
    return std::to_chars(at, at + kMarkerSize, line).ptr;
}

// Writes the rest of a marker.
[[nodiscard]] char* putMarkerEnd(char* at, std::string_view name) noexcept {
    at = put(at, " \"");
    for (std::size_t end = name.find('\\'); end != std::string_view::npos; end = name.find('\\')) {
        at = put(at, name.substr(0, end + 1));
        *at++ = '\\';
        name.remove_prefix(end + 1);
    }
    at = put(at, name);
    return put(at, "\"\n");
}

[[nodiscard]] char* putMarker(char* at, const SourcePosition& position) noexcept {
    return putMarkerEnd(putMarkerBegin(at, position.line), position.fileName);
}

}  // namespace

OutputWriter::OutputWriter() {
    (void)block_.extend(kBlockSize);
}

void OutputWriter::redirect(ByteSink& sink) {
    sink_ = &sink;
    target_ = sink.target();
}

void OutputWriter::writeManyLineFeeds(std::size_t count) {
    while (count > 0) {
        if (used_ == kBlockSize) {
            flush();
        }
        const std::size_t now = std::min(count, kBlockSize - used_);
        std::memset(block_.data() + used_, '\n', now);
        used_ += now;
        count -= now;
    }
}

void OutputWriter::writeLineMarker(const SourcePosition& position) {
    outputLine_ = position.line;
    // Every byte of the name may be doubled.
    const std::size_t size = kMarkerSize + 2 * position.fileName.size();
    if (size > kBlockSize - used_) {
        write(markerOf(position));
        return;
    }
    char* const begin = block_.data() + used_;
    used_ += static_cast<std::size_t>(putMarker(begin, position) - begin);
}

void OutputWriter::writeLineMarker(std::int32_t line, const Snippet& markerEnd) {
    outputLine_ = line;
    if (kMarkerSize + Snippet::kRoom > kBlockSize - used_) {
        std::array<char, kMarkerSize + Snippet::kRoom> marker{};
        const char* const end = put(putMarkerBegin(marker.data(), line), markerEnd.text());
        write({marker.data(), static_cast<std::size_t>(end - marker.data())});
        return;
    }
    char* const begin = block_.data() + used_;
    char* const end = putMarkerBegin(begin, line);
    markerEnd.copyTo(end);
    used_ += static_cast<std::size_t>(end - begin) + markerEnd.size();
}

std::string OutputWriter::markerOf(const SourcePosition& position) {
    std::string marker(kMarkerSize + 2 * position.fileName.size(), '\0');
    marker.resize(static_cast<std::size_t>(putMarker(marker.data(), position) - marker.data()));
    return marker;
}

std::string OutputWriter::markerEndOf(std::string_view fileName) {
    std::string markerEnd(kMarkerSize + 2 * fileName.size(), '\0');
    char* const end = putMarkerEnd(markerEnd.data(), fileName);
    markerEnd.resize(static_cast<std::size_t>(end - markerEnd.data()));
    return markerEnd;
}

void OutputWriter::flush() {
    handOver({block_.data(), used_});
    used_ = 0;
}

void OutputWriter::writeLarge(std::string_view text) {
    flush();
    if (text.size() >= kBlockSize) {
        handOver(text);
        return;
    }
    write(text);
}

std::optional<std::size_t> OutputWriter::lineFeedsSince(Place place) const {
    if (place.block != blocks_) {
        return std::nullopt;
    }
    const std::string_view written(block_.data() + place.at, used_ - place.at);
    if (written.find_first_not_of('\n') != std::string_view::npos) {
        return std::nullopt;
    }
    return written.size();
}

void OutputWriter::handOver(std::string_view text) {
    ++blocks_;
    if (!failed_ && !text.empty()) {
        failed_ = sink_ == nullptr || !sink_->write(text);
    }
}

}  // namespace umpre
