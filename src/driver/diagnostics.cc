// SPDX-License-Identifier: MIT
#include "driver/diagnostics.h"

#include <string>

namespace umpre {

void Diagnostics::reportError(std::string_view message) {
    report("", message);
    errorFlag_ = true;
}

void Diagnostics::reportWarning(std::string_view message) {
    report("Warning: ", message);
}

void Diagnostics::reportFatal(std::string_view message) {
    report("FATAL ERROR: ", message);
    errorFlag_ = true;
}

void Diagnostics::report(std::string_view weight, std::string_view message) {
    std::string line;
    if (sources_.hasFile()) {
        const SourcePosition position = sources_.position();
        line.append(position.fileName).append(":");
        line.append(std::to_string(position.line)).append(": ");
    }
    line.append(weight).append(message).append(".\n");
    (void)sink_.write(line);
    ++reportCount_;
}

void Diagnostics::noteUnterminatedComment(std::int32_t line) {
    (void)sink_.write(std::to_string(line) + ": unterminated comment.\n");
    ++reportCount_;
}

void Diagnostics::noteScannerFailure(std::string_view message) {
    // Not joined first: there may be no memory for that.
    (void)(sink_.write(message) && sink_.write("\n"));
}

}  // namespace umpre
