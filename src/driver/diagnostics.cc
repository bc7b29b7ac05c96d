// SPDX-License-Identifier: MIT
#include "driver/diagnostics.h"

#include <string>
#include <utility>

namespace umpre {

Diagnostics::Diagnostics(DiagnosticSink sink, const ScannerStack& sources)
    : sink_(std::move(sink)), sources_(sources) {}

void Diagnostics::reportError(std::string_view message) {
    report(Severity::Error, message);
    errorFlag_ = true;
}

void Diagnostics::reportWarning(std::string_view message) {
    report(Severity::Warning, message);
}

void Diagnostics::reportFatal(std::string_view message) {
    report(Severity::Fatal, message);
    errorFlag_ = true;
}

void Diagnostics::report(Severity severity, std::string_view message) {
    const SourcePosition at = position();
    handOn({severity, at.fileName, at.line, message});
    ++reportCount_;
}

void Diagnostics::noteUnterminatedComment(std::int32_t line) {
    handOn({Severity::Note, position().fileName, line, "unterminated comment"});
    ++reportCount_;
}

void Diagnostics::noteScannerFailure(std::string_view message) {
    const SourcePosition at = position();
    handOn({Severity::Failure, at.fileName, at.line, message});
}

void Diagnostics::handOn(const Diagnostic& diagnostic) const {
    if (sink_) {
        sink_(diagnostic);
    }
}

SourcePosition Diagnostics::position() const {
    return sources_.hasFile() ? sources_.position() : SourcePosition{};
}

// The notice of a comment has no file, and the scanner's own message is alone on its line.
std::string messageOf(const Diagnostic& diagnostic) {
    std::string line;
    if (diagnostic.severity == Severity::Failure) {
        return line.append(diagnostic.text).append("\n");
    }
    if (diagnostic.severity == Severity::Note) {
        return line.append(std::to_string(diagnostic.line))
            .append(": ")
            .append(diagnostic.text)
            .append(".\n");
    }
    const bool isBeforeAnyFile = diagnostic.severity == Severity::Fatal && diagnostic.file.empty();
    if (!isBeforeAnyFile) {
        line.append(diagnostic.file).append(":");
        line.append(std::to_string(diagnostic.line)).append(": ");
    }
    if (diagnostic.severity != Severity::Error) {
        line.append(diagnostic.severity == Severity::Warning ? "Warning: " : "FATAL ERROR: ");
    }
    return line.append(diagnostic.text).append(".\n");
}

DiagnosticSink linesTo(ByteSink& sink) {
    return [&sink](const Diagnostic& diagnostic) {
        if (diagnostic.severity == Severity::Failure) {
            // Not joined first: there may be no memory for that.
            (void)(sink.write(diagnostic.text) && sink.write("\n"));
        } else {
            (void)sink.write(messageOf(diagnostic));
        }
    };
}

}  // namespace umpre
