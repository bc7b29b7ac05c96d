// SPDX-License-Identifier: MIT
#include "umpre/preprocessing.h"

#include <istream>
#include <new>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "driver/preprocessor.h"
#include "lex/byte_sink.h"
#include "lex/byte_source.h"
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

// Brings what a reader brings.
class ReaderBytes final : public ByteSource {
public:
    explicit ReaderBytes(const SourceReader& reader) noexcept : reader_(reader) {}

    [[nodiscard]] std::optional<std::size_t> read(char* to, std::size_t size) override {
        return reader_ ? reader_(to, size) : 0;
    }

private:
    const SourceReader& reader_;
};

// Reads from a stream, which may be one that throws; its state tells the same.
std::optional<std::size_t> readFrom(std::istream& stream, char* to, std::size_t size) {
    try {
        stream.read(to, static_cast<std::streamsize>(size));
    } catch (...) {
        // The state tells.
    }
    if (stream.bad() || (stream.fail() && !stream.eof())) {
        return std::nullopt;
    }
    return static_cast<std::size_t>(stream.gcount());
}

struct Definition {
    std::string name;
    std::string text;
};

}  // namespace

// Within a class that is seen from outside it would be seen, too.
struct __attribute__((visibility("hidden"))) Preprocessing::Settings {
    enum class Kind { File, Text, Reader };

    // Lets go of the source before.
    void setSource(Kind newKind, std::string_view name) {
        kind = newKind;
        sourceName = name;
        sourceText.clear();
        sourceReader = nullptr;
    }

    [[nodiscard]] bool open(Preprocessor& engine, ByteSource& reader) const;
    [[nodiscard]] Outcome run() const;

    Kind kind = Kind::Text;
    std::string sourceName;
    std::string sourceText;
    SourceReader sourceReader;
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
    settings_->setSource(Settings::Kind::File, fileName);
}

void Preprocessing::setSourceText(std::string_view name, std::string_view text) {
    settings_->setSource(Settings::Kind::Text, name);
    settings_->sourceText = text;
}

void Preprocessing::setSourceReader(std::string_view name, SourceReader reader) {
    settings_->setSource(Settings::Kind::Reader, name);
    settings_->sourceReader = std::move(reader);
}

void Preprocessing::setSourceStream(std::string_view name, std::istream& stream) {
    setSourceReader(name,
                    [&stream](char* to, std::size_t size) { return readFrom(stream, to, size); });
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

bool Preprocessing::Settings::open(Preprocessor& engine, ByteSource& reader) const {
    const std::string& name = messageName.empty() ? sourceName : messageName;
    switch (kind) {
    case Kind::File: return engine.openSource(sourceName, messageName);
    case Kind::Text: engine.openText(name, sourceText); return true;
    case Kind::Reader: engine.openBytes(name, reader); return true;
    }
    return false;
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
    ReaderBytes reader(sourceReader);
    if (!open(engine, reader)) {
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
