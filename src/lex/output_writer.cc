// SPDX-License-Identifier: MIT
#include "lex/output_writer.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstring>

namespace umpre {

OutputWriter::OutputWriter() : block_(kBlockSize) {}

void OutputWriter::redirect(ByteSink& sink) {
    sink_ = &sink;
}

void OutputWriter::writeLineFeeds(std::size_t count) {
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
    std::array<char, 16> number{};
    const char* const end = std::to_chars(number.begin(), number.end(), position.line).ptr;
    write("#line ");
    write({number.data(), static_cast<std::size_t>(end - number.data())});
    write(" \"");
    std::string_view name = position.fileName;
    for (std::size_t at = name.find('\\'); at != std::string_view::npos; at = name.find('\\')) {
        write(name.substr(0, at + 1));
        write("\\");
        name.remove_prefix(at + 1);
    }
    write(name);
    write("\"\n");
    outputLine_ = position.line;
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

void OutputWriter::handOver(std::string_view text) {
    if (!failed_ && !text.empty()) {
        failed_ = sink_ == nullptr || !sink_->write(text);
    }
}

}  // namespace umpre
