// SPDX-License-Identifier: MIT
//
// umpre-deps: preprocesses as umpre does, and writes which files were read, as a rule for Make.
#include <optional>
#include <string>
#include <string_view>
#include <unistd.h>
#include <unordered_set>
#include <utility>
#include <vector>

#include "deps/command_line.h"
#include "deps/rule.h"
#include "driver/command_line.h"
#include "driver/diagnostics.h"
#include "driver/output_file.h"
#include "driver/preprocessor.h"
#include "driver/program.h"
#include "driver/version.h"

namespace {

// Adds a name to a list unless it was added before.
class Names {
public:
    void add(std::string_view name) {
        if (seen_.emplace(name).second) {
            list_.emplace_back(name);
        }
    }

    [[nodiscard]] const std::vector<std::string>& list() const noexcept { return list_; }

private:
    std::vector<std::string> list_;
    std::unordered_set<std::string> seen_;
};

// Writes a text to a file, to standard output if the name is empty or a hyphen. Returns the exit
// status.
int write(const std::string& name, std::string_view text, umpre::ByteSink& errors) {
    umpre::OutputFile file("umpre-deps");
    if (!name.empty() && name != "-" && !file.open(name)) {
        (void)errors.write(file.openFailureMessage(name));
        return 1;
    }
    (void)file.write(text);
    if (!file.close()) {
        (void)errors.write(file.failureMessage());
        return 1;
    }
    return 0;
}

// As gcc names what a compiler would make of the source.
std::string objectOf(const std::string& source) {
    return umpre::withSuffix(source.substr(source.rfind('/') + 1), ".o");
}

int writeRule(const umpre::DepsOptions& options, umpre::Rule rule, umpre::ByteSink& errors) {
    rule.targets = options.targets;
    if (rule.targets.empty()) {
        const std::string& source = rule.files.front();
        rule.targets.push_back(source.empty() ? "-" : umpre::escapedTarget(objectOf(source)));
    }
    return write(options.ruleName, umpre::textOf(rule), errors);
}

int preprocess(const umpre::DepsOptions& options, umpre::ByteSink& errors) {
    umpre::OutputFile output("umpre-deps");
    if (const std::string nowhere = "/dev/null";
        options.outputName.empty() && !output.open(nowhere)) {
        (void)errors.write(output.openFailureMessage(nowhere));
        return 1;
    }
    Names files;
    Names absent;
    umpre::Preprocessor preprocessor(umpre::linesTo(errors));
    preprocessor.setObserver([&](const umpre::Event& event) {
        if (event.kind == umpre::Event::Kind::FileEntered) {
            files.add(event.name);
        } else if (event.kind == umpre::Event::Kind::FileMissed && options.absent) {
            absent.add(event.name);
        }
    });
    std::vector<const char*> words;
    for (const std::string& word : options.words) {
        words.push_back(word.c_str());
    }
    const int count = static_cast<int>(words.size());
    if (!umpre::parseCommandLine(preprocessor, {output, errors, "umpre-deps"}, count,
                                 words.data())) {
        return 1;
    }
    const umpre::RunResult result = preprocessor.run();
    if (!output.close()) {
        (void)errors.write(output.failureMessage());
        return 1;
    }
    if (result != umpre::RunResult::Clean) {
        return result == umpre::RunResult::Errors ? 1 : 2;
    }
    return writeRule(options, {{}, files.list(), absent.list(), options.phonyFiles}, errors);
}

int run(int argc, char** argv) {
    umpre::DescriptorSink errors(STDERR_FILENO);
    const std::optional<umpre::DepsOptions> options = umpre::readDepsOptions(argc, argv, errors);
    if (!options) {
        return 1;
    }
    switch (options->task) {
    case umpre::DepsOptions::Task::Help: return write("", umpre::depsUsage(), errors);
    case umpre::DepsOptions::Task::Version:
        return write("", umpre::versionTextOf("umpre-deps"), errors);
    case umpre::DepsOptions::Task::Rule: break;
    }
    return preprocess(*options, errors);
}

}  // namespace

int main(int argc, char** argv) {
    return umpre::runProgram(run, argc, argv);
}
