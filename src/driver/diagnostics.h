// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_DIAGNOSTICS_H
#define UMPRE_DRIVER_DIAGNOSTICS_H

#include <cstddef>
#include <cstdint>
#include <string_view>

#include "lex/byte_sink.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"

namespace umpre {

/// The form of a message: file, line, weight, text, period; and whether there was an error. Each
/// message is written at once; that the sink fails is ignored.
class Diagnostics final : public Reporter {
public:
    Diagnostics(ByteSink& sink, const ScannerStack& sources) noexcept
        : sink_(sink), sources_(sources) {}

    void reportError(std::string_view message) override;
    void reportWarning(std::string_view message) override;
    /// Reports a problem that ends the run. Before a file is open it has no position.
    void reportFatal(std::string_view message);
    void noteUnterminatedComment(std::int32_t line) override;
    /// Writes the scanner's own message, which has no position.
    void noteScannerFailure(std::string_view message);

    [[nodiscard]] std::size_t reportCount() const override { return reportCount_; }

    [[nodiscard]] bool errorFlag() const noexcept { return errorFlag_; }

private:
    void report(std::string_view weight, std::string_view message);

    ByteSink& sink_;
    const ScannerStack& sources_;
    std::size_t reportCount_ = 0;
    bool errorFlag_ = false;
};

}  // namespace umpre

#endif
