// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_RECORDING_REPORTER_H
#define UMPRE_TESTS_UNIT_SUPPORT_RECORDING_REPORTER_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "lex/reporter.h"

namespace umpre::testing {

/// Keeps what is reported: errors as they are, warnings with "Warning: " before them, and
/// unterminated comments as the line and a text.
class RecordingReporter final : public Reporter {
public:
    void reportError(std::string_view message) override { add(std::string(message)); }

    void reportWarning(std::string_view message) override {
        add("Warning: " + std::string(message));
    }

    void noteUnterminatedComment(std::int32_t line) override {
        add(std::to_string(line) + ": unterminated comment");
    }

    [[nodiscard]] std::size_t reportCount() const override { return reports_.size(); }

    [[nodiscard]] const std::vector<std::string>& reports() const noexcept { return reports_; }

    /// Returns the only report. A test that expects one compares it with a text; none gives an
    /// empty text, several are joined by line feeds.
    [[nodiscard]] std::string report() const {
        std::string all;
        for (const std::string& report : reports_) {
            all.append(all.empty() ? "" : "\n").append(report);
        }
        return all;
    }

private:
    void add(std::string report) { reports_.push_back(std::move(report)); }

    std::vector<std::string> reports_;
};

}  // namespace umpre::testing

#endif
