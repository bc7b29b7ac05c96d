// SPDX-License-Identifier: MIT
#ifndef UMPRE_LINES_REWRITING_H
#define UMPRE_LINES_REWRITING_H

#include <string_view>

#include "lex/output_writer.h"
#include "lines/marker_finder.h"

namespace umpre {

/// Writes the text without its markers.
class StrippedText final : public MarkedText {
public:
    explicit StrippedText(OutputWriter& output) noexcept : output_(output) {}

    void text(std::string_view bytes) override { output_.write(bytes); }

    void marker(const Marker& /*marker*/) override {}

private:
    OutputWriter& output_;
};

/// Writes the text with its markers as GNU tools read them: # 12 "dir\\a.src".
class GnuText final : public MarkedText {
public:
    explicit GnuText(OutputWriter& output) noexcept : output_(output) {}

    void text(std::string_view bytes) override { output_.write(bytes); }

    /// Puts a backslash before each quote in the name, as such readers want it.
    void marker(const Marker& marker) override;

private:
    OutputWriter& output_;
};

}  // namespace umpre

#endif
