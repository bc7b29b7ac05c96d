// SPDX-License-Identifier: MIT
#include "driver/preprocessor.h"

#include <new>
#include <utility>

#include "expr/expr_value.h"
#include "lex/scanner_failure.h"
#include "macros/predefined_macros.h"

namespace umpre {

using enum TokenKind;
using Stop = TextReader::Stop;

Preprocessor::Preprocessor(DiagnosticSink diagnostics, const RunOptions& options)
    : options_(options),
      lexer_(options),
      sources_(*this, output_, diagnostics_, options),
      diagnostics_(std::move(diagnostics), sources_),
      expander_(sources_, macros_, diagnostics_, lexer_),
      conditionals_(sources_, macros_, expander_, lexer_, diagnostics_),
      definitions_(sources_, macros_, diagnostics_),
      files_(sources_, output_, conditionals_, diagnostics_, options),
      inclusion_(sources_, expander_, lexer_, macros_, files_, diagnostics_),
      lineControl_(sources_, expander_, lexer_, output_, diagnostics_),
      textReader_(output_, macros_.filter(), *this),
      lineSkipper_(output_, conditionals_.groups()) {
    definePredefinedMacros(macros_);
}

void Preprocessor::setObserver(const Observer& observer) {
    if (!observer) {
        return;
    }
    events_.emplace(observer, sources_);
    files_.setObserver([this](const Event& event) { events_->includedFile(event); });
    if (options_.tellsMacros) {
        macros_.setEvents(*events_);
        expander_.setEvents(*events_);
    }
}

bool Preprocessor::openSource(const std::string& sourceName, const std::string& messageName) {
    if (!sources_.pushFile(sourceName, messageName)) {
        diagnostics_.reportFatal("cannot open " + sourceName);
        return false;
    }
    tellSource(sourceName);
    return true;
}

void Preprocessor::openBytes(const std::string& sourceName, ByteSource& source) {
    sources_.pushFileSource(sourceName, source);
    tellSource(sourceName);
}

void Preprocessor::openText(const std::string& sourceName, std::string_view text) {
    sources_.pushFileText(sourceName, text);
    tellSource(sourceName);
}

void Preprocessor::tellSource(const std::string& name) {
    if (events_) {
        events_->sourceEntered(name);
    }
}

RunResult Preprocessor::run() {
    RunResult result = RunResult::Clean;
    try {
        result = readAll();
    } catch (const ScannerFailure& failure) {
        diagnostics_.noteScannerFailure(failure.message);
        result = RunResult::ScannerFailure;
    } catch (const std::bad_alloc&) {
        diagnostics_.noteScannerFailure(kNoMemory);
        result = RunResult::ScannerFailure;
    } catch (const ArithmeticFault&) {
        result = RunResult::ArithmeticFault;
    }
    output_.flush();
    return result;
}

RunResult Preprocessor::readAll() {
    for (;;) {
        while (readBytes()) {
        }
        if (output_.failed()) {
            return RunResult::Errors;
        }
        if (sources_.peek() == END_OF_INPUT) {
            break;
        }
        line();
    }
    conditionals_.closeFileGroups();
    if (events_) {
        events_->fileLeft();
    }
    return diagnostics_.errorFlag() ? RunResult::Errors : RunResult::Clean;
}

// Reads lines as bytes, finishes the line that this stops in, if any, and leaves a file that has
// ended. Returns false, at the start of a line, when that line wants tokens.
bool Preprocessor::readBytes() {
    CppFileScanner* const file = byteSource();
    if (file == nullptr || output_.failed()) {
        return false;
    }
    if (conditionals_.skipping()) {
        if (lineSkipper_.skip(*file, Stop::LineStart) == Stop::LineStart) {
            return readDirective(*file);
        }
        endSkippedLine();
    } else {
        const Stop stop = textReader_.copyText(*file, Stop::LineStart);
        if (stop == Stop::LineStart) {
            return inclusion_.includeLines(*file) || readDirective(*file);
        }
        if (stop == Stop::Name) {
            writeToken(textReader_.name());
        }
        restOfTextLine();
    }
    return true;
}

// Reads the next line if it is a directive that its bytes tell. Returns false, with nothing read,
// if not.
bool Preprocessor::readDirective(CppFileScanner& file) {
    DirectiveLine line(file);
    const DirectiveLine::Outcome outcome = carryOut(line);
    if (outcome == DirectiveLine::Outcome::EndLeft) {
        line.takeEnd();
        output_.endLine();
    }
    return outcome != DirectiveLine::Outcome::Untold || sources_.leaveEndedFile();
}

DirectiveLine::Outcome Preprocessor::carryOut(DirectiveLine& line) {
    const TokenKind word = line.word();
    const bool isConditional = word >= KW_IF && word <= KW_ENDIF;
    if (isConditional) {
        return carryOutConditional(line);
    }
    if (conditionals_.skipping()) {
        return isName(word) && line.skipRest() ? DirectiveLine::Outcome::EndLeft
                                               : DirectiveLine::Outcome::Untold;
    }
    switch (word) {
    case KW_INCLUDE: return carryOutInclude(line);
    case KW_DEFINE: files_.noteAction(); return definitions_.defineDirective(line);
    case KW_UNDEF: files_.noteAction(); return definitions_.undefDirective(line);
    default: return DirectiveLine::Outcome::Untold;
    }
}

DirectiveLine::Outcome Preprocessor::carryOutInclude(DirectiveLine& line) {
    const EventTeller::Directive told(events_);
    return inclusion_.includeDirective(line);
}

DirectiveLine::Outcome Preprocessor::carryOutConditional(DirectiveLine& line) {
    const bool isActive = !conditionals_.skipping();
    const DirectiveLine::Outcome outcome = conditionals_.carryOut(line);
    if (isActive && outcome != DirectiveLine::Outcome::Untold) {
        files_.noteAction();
    }
    return outcome;
}

// Returns the file that can be read as bytes now, or null.
CppFileScanner* Preprocessor::byteSource() {
    return options_.plainRoad ? nullptr : sources_.fileReadNow();
}

void Preprocessor::line() {
    const std::string blanks = sources_.skipBlanks();
    const Token first = sources_.next();
    if (first.kind == HASH) {
        directiveLine();
    } else if (first.kind == NEWLINE) {
        output_.endLine();
    } else if (conditionals_.skipping()) {
        endSkippedLine();
    } else {
        textLine(blanks, first);
    }
}

// A word that stands for no conditional directive is looked at in active text only.
void Preprocessor::directiveLine() {
    const EventTeller::Directive told(events_);
    if (!conditionals_.skipping()) {
        files_.noteAction();
    }
    sources_.skipBlanks();
    const TokenKind word = sources_.next().kind;
    if (conditionals_.carryOut(word)) {
        return;
    }
    if (conditionals_.skipping()) {
        endSkippedLine();
    } else {
        activeDirective(word);
    }
}

void Preprocessor::activeDirective(TokenKind word) {
    switch (word) {
    case NEWLINE: break;
    case KW_INCLUDE: inclusion_.includeDirective(); break;
    case KW_DEFINE: definitions_.defineDirective(); break;
    case KW_UNDEF: definitions_.undefDirective(); break;
    case KW_LINE: lineControl_.lineDirective(); break;
    case KW_ERROR: lineControl_.errorDirective(); break;
    case KW_PRAGMA: lineControl_.pragmaDirective(); break;
    default:
        diagnostics_.reportError(
            "the indicated directive is not a recognized preprocessing directive");
        sources_.skipToEndOfLine();
    }
}

void Preprocessor::textLine(std::string_view blanks, Token first) {
    files_.noteAction();
    output_.syncTo(sources_.position());
    output_.write(blanks);
    if (first.kind != END_OF_INPUT) {
        writeToken(first);
        restOfTextLine();
    }
}

void Preprocessor::restOfTextLine() {
    files_.noteAction();
    while (!output_.failed()) {
        CppFileScanner* const file = byteSource();
        const Stop stop =
            file == nullptr ? Stop::InLine : textReader_.copyText(*file, Stop::InLine);
        if (stop == Stop::LineStart) {
            return;
        }
        if (stop == Stop::Name) {
            writeToken(textReader_.name());
            continue;
        }
        const std::string_view text = expander_.takeText();
        if (!text.empty()) {
            output_.write(text);
            continue;
        }
        const Token token = sources_.next();
        if (token.kind == END_OF_INPUT) {
            return;
        }
        if (token.kind == NEWLINE) {
            output_.endLine();
            return;
        }
        writeToken(token);
    }
}

void Preprocessor::writeToken(const Token& token) {
    output_.write(isName(token.kind) ? expander_.expandName(token) : token.text);
}

// Reads at least one token. Where the line goes on behind the end of a file, what follows it need
// not be skipped.
void Preprocessor::endSkippedLine() {
    while (!output_.failed()) {
        CppFileScanner* const file = conditionals_.skipping() ? byteSource() : nullptr;
        if (file != nullptr && lineSkipper_.skip(*file, Stop::InLine) == Stop::LineStart) {
            return;
        }
        if (endsLine(sources_.next().kind)) {
            output_.endLine();
            return;
        }
    }
}

void Preprocessor::fileEntered() {
    conditionals_.enterFileGroups();
    output_.writeLineMarker(sources_.position());
}

void Preprocessor::fileEnds() {
    conditionals_.closeFileGroups();
    files_.fileEnds();
}

void Preprocessor::fileResumed() {
    if (events_) {
        events_->fileLeft();
    }
    output_.writeLineMarker(sources_.position());
}

bool Preprocessor::gainsByNotice() const noexcept {
    return macros_.size() > options_.manyMacros;
}

void Preprocessor::notice(std::span<const std::string_view> names) {
    expander_.notice(names);
}

NameReader::Outcome Preprocessor::readName(std::string_view name, const char* end) {
    files_.noteAction();
    return expander_.readName(name, end);
}

}  // namespace umpre
