// SPDX-License-Identifier: MIT
//
// Preprocesses a stream that includes a file in memory. Prints what the run did, what was said
// about the source, how it ended, and what came out.
#include <cstdio>
#include <sstream>
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

// Null for what may come with newer versions.
const char* nameOf(umpre::Event::Kind kind) {
    switch (kind) {
    case umpre::Event::Kind::FileEntered: return "entered";
    case umpre::Event::Kind::FileMissed: return "missed";
    case umpre::Event::Kind::FileLeft: return "left";
    case umpre::Event::Kind::MacroDefined: return "defined";
    case umpre::Event::Kind::MacroUndefined: return "undefined";
    case umpre::Event::Kind::MacroExpanded: return "expanded";
    }
    return nullptr;
}

void printEvent(const umpre::Event& event) {
    const std::string name(event.name);
    const std::string file(event.file);
    if (const char* const what = nameOf(event.kind)) {
        std::printf("%s:%d: %s %s\n", file.c_str(), event.line, what, name.c_str());
    }
}

void printProblem(const umpre::Diagnostic& problem) {
    const std::string file(problem.file);
    const std::string text(problem.text);
    std::printf("file: %s\nline: %d\ntext: %s\n", file.c_str(), problem.line, text.c_str());
}

umpre::IncludeAnswer find(std::string_view name) {
    if (name == "inc/limits.inc") {
        return {umpre::IncludeAnswer::Kind::Text, "#define LIMIT (PORTS * 2)\n"};
    }
    return {umpre::IncludeAnswer::Kind::Absent, {}};
}

}  // namespace

int main() {
    std::istringstream source(
        "#include \"limits.inc\"\n"
        "#if LIMIT > 1\n"
        "ports = LIMIT;\n"
        "#undef LIMIT\n"
        "#endif\n"
        "#endif\n");
    std::string result;
    umpre::Preprocessing preprocessing;
    preprocessing.define("PORTS", "2");
    preprocessing.addIncludeDirectory("inc");
    preprocessing.setSourceStream("memory.src", source);
    preprocessing.setIncludeResolver(find);
    preprocessing.setObserver(printEvent, umpre::EventScope::FilesAndMacros);
    preprocessing.setDiagnostics(printProblem);
    preprocessing.setOutput([&result](std::string_view bytes) {
        result.append(bytes);
        return true;
    });
    const umpre::Outcome outcome = preprocessing.run();
    std::printf("outcome: %s\n\n%s", nameOf(outcome), result.c_str());
}
