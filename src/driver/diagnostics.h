// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_DIAGNOSTICS_H
#define UMPRE_DRIVER_DIAGNOSTICS_H

#include <cstddef>
#include <cstdint>
#include <string_view>

#include "lex/byte_sink.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "umpre/diagnostic.h"

namespace umpre {

/// Gives problems their place and their weight and hands them on at once; and tells whether there
/// was an error.
class Diagnostics final : public Reporter {
public:
    /// An empty sink drops them.
    Diagnostics(DiagnosticSink sink, const ScannerStack& sources);

    void reportError(std::string_view message) override;
    void reportWarning(std::string_view message) override;
    /// Reports a problem that ends the run. Before a file is open it has no position.
    void reportFatal(std::string_view message);
    void noteUnterminatedComment(std::int32_t line) override;
    /// Hands on the scanner's own message.
    void noteScannerFailure(std::string_view message);

    [[nodiscard]] std::size_t reportCount() const override { return reportCount_; }

    [[nodiscard]] bool errorFlag() const noexcept { return errorFlag_; }

private:
    void report(Severity severity, std::string_view message);
    void handOn(const Diagnostic& diagnostic) const;
    [[nodiscard]] SourcePosition position() const;

    DiagnosticSink sink_;
    const ScannerStack& sources_;
    std::size_t reportCount_ = 0;
    bool errorFlag_ = false;
};

/// Returns a sink that writes each problem as a line to a borrowed one; that this fails is ignored.
[[nodiscard]] DiagnosticSink linesTo(ByteSink& sink);

}  // namespace umpre

#endif
