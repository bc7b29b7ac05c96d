// SPDX-License-Identifier: MIT
#include "umpre/preprocessing.h"

#include <new>
#include <string>
#include <utility>
#include <vector>

#include "driver/preprocessor.h"
#include "lex/byte_sink.h"
#include "lex/scanner_failure.h"
#include "umpre/version.h"

namespace umpre {
namespace {

// Hands bytes to a sink that may be missing.
class SinkBytes final : public ByteSink {
public:
    explicit SinkBytes(const OutputSink& sink) noexcept : sink_(sink) {}

    [[nodiscard]] bool write(std::string_view bytes) override { return !sink_ || sink_(bytes); }

private:
    const OutputSink& sink_;
};

struct Definition {
    std::string name;
    std::string text;
};

}  // namespace

struct Preprocessing::Settings {
    enum class Kind { File, Text };

    [[nodiscard]] Outcome run() const;

    Kind kind = Kind::Text;
    std::string sourceName;
    std::string sourceText;
    std::string messageName;
    std::vector<Definition> definitions;
    std::vector<std::string> includeDirectories;
    OutputSink outputSink;
    DiagnosticSink diagnostics;
    IncludeResolver resolver;
    Observer observer;
    EventScope eventScope = EventScope::Files;
};

Preprocessing::Preprocessing() : settings_(std::make_unique<Settings>()) {}

Preprocessing::Preprocessing(Preprocessing&& other) noexcept = default;
Preprocessing& Preprocessing::operator=(Preprocessing&& other) noexcept = default;
Preprocessing::~Preprocessing() = default;

void Preprocessing::setSourceFile(std::string_view fileName) {
    settings_->kind = Settings::Kind::File;
    settings_->sourceName = fileName;
}

void Preprocessing::setSourceText(std::string_view name, std::string_view text) {
    settings_->kind = Settings::Kind::Text;
    settings_->sourceName = name;
    settings_->sourceText = text;
}

void Preprocessing::setMessageName(std::string_view name) {
    settings_->messageName = name;
}

void Preprocessing::define(std::string_view name, std::string_view text) {
    settings_->definitions.push_back({std::string(name), std::string(text)});
}

void Preprocessing::addIncludeDirectory(std::string_view directory) {
    settings_->includeDirectories.emplace_back(directory);
}

void Preprocessing::setOutput(OutputSink sink) {
    settings_->outputSink = std::move(sink);
}

void Preprocessing::setDiagnostics(DiagnosticSink sink) {
    settings_->diagnostics = std::move(sink);
}

void Preprocessing::setIncludeResolver(IncludeResolver resolver) {
    settings_->resolver = std::move(resolver);
}

void Preprocessing::setObserver(Observer observer, EventScope scope) {
    settings_->observer = std::move(observer);
    settings_->eventScope = scope;
}

Outcome Preprocessing::Settings::run() const {
    SinkBytes output(outputSink);
    RunOptions options;
    options.tellsMacros = observer && eventScope == EventScope::FilesAndMacros;
    Preprocessor engine(diagnostics, options);
    engine.setOutput(output);
    engine.setResolver(resolver);
    engine.setObserver(observer);
    for (const Definition& definition : definitions) {
        engine.defineMacro(definition.name, definition.text);
    }
    for (const std::string& directory : includeDirectories) {
        engine.addIncludeDirectory(directory);
    }
    if (kind == Settings::Kind::Text) {
        engine.openText(messageName.empty() ? sourceName : messageName, sourceText);
    } else if (!engine.openSource(sourceName, messageName)) {
        return Outcome::SourceNotOpened;
    }
    switch (engine.run()) {
    case RunResult::Clean: return engine.outputFailed() ? Outcome::OutputFailed : Outcome::Clean;
    case RunResult::Errors: return engine.outputFailed() ? Outcome::OutputFailed : Outcome::Errors;
    case RunResult::ScannerFailure: return Outcome::InputFailed;
    case RunResult::ArithmeticFault: return Outcome::DivisionFault;
    }
    return Outcome::InputFailed;
}

Outcome Preprocessing::run() const {
    try {
        return settings_->run();
    } catch (const std::bad_alloc&) {
        if (settings_->diagnostics) {
            settings_->diagnostics({Severity::Failure, {}, 0, kNoMemory});
        }
        return Outcome::InputFailed;
    }
}

const char* Preprocessing::version() noexcept {
    return UMPRE_VERSION;
}

}  // namespace umpre
