// SPDX-License-Identifier: MIT
//
// Preprocesses a text in memory and prints what comes out, what was said about it, and how it
// ended.
#include <cstdio>
#include <string>
#include <string_view>
#include <umpre/preprocessing.h>

namespace {

const char* nameOf(umpre::Outcome outcome) {
    switch (outcome) {
    case umpre::Outcome::Clean: return "clean";
    case umpre::Outcome::Errors: return "errors";
    case umpre::Outcome::SourceNotOpened: return "the source cannot be opened";
    case umpre::Outcome::OutputFailed: return "the output failed";
    case umpre::Outcome::InputFailed: return "the input failed";
    case umpre::Outcome::DivisionFault: return "a condition divides by zero";
    }
    return "";
}

}  // namespace

int main() {
    std::string result;
    umpre::Preprocessing preprocessing;
    preprocessing.define("PORTS", "2");
    preprocessing.setSourceText("memory.src", "#if PORTS > 1\nports = PORTS;\n#endif\n#endif\n");
    preprocessing.setOutput([&result](std::string_view bytes) {
        result.append(bytes);
        return true;
    });
    preprocessing.setDiagnostics([](const umpre::Diagnostic& diagnostic) {
        const std::string file(diagnostic.file);
        const std::string text(diagnostic.text);
        std::printf("file: %s\nline: %d\ntext: %s\n", file.c_str(), diagnostic.line, text.c_str());
    });
    const umpre::Outcome outcome = preprocessing.run();
    std::printf("outcome: %s\n\n%s", nameOf(outcome), result.c_str());
}
