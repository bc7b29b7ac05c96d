// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_PREPROCESSOR_H
#define UMPRE_DRIVER_PREPROCESSOR_H

#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "directives/conditionals.h"
#include "directives/definitions.h"
#include "directives/included_files.h"
#include "directives/inclusion.h"
#include "directives/line_control.h"
#include "directives/line_skipper.h"
#include "driver/diagnostics.h"
#include "driver/event_teller.h"
#include "lex/byte_sink.h"
#include "lex/directive_line.h"
#include "lex/name_reader.h"
#include "lex/output_writer.h"
#include "lex/run_options.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"
#include "lex/text_reader.h"
#include "macros/macro_expander.h"
#include "macros/macro_table.h"
#include "umpre/event.h"

namespace umpre {

/// How a run ended. All that was written before the end has gone to the output.
enum class RunResult {
    Clean,
    Errors,           ///< at least one error was reported
    ScannerFailure,   ///< the input could not be read on; the message was written
    ArithmeticFault,  ///< a condition divides as no machine can
};

/// One run: reads the source from its first token to the end of the input and writes the result.
class Preprocessor final : private FileEvents, private NameReader {
public:
    /// Problems go to the sink, or nowhere if it is empty. The predefined macros take their date
    /// and time from now.
    explicit Preprocessor(DiagnosticSink diagnostics, const RunOptions& options = {});

    /// Enters an object-like macro unless the name is defined.
    void defineMacro(std::string_view name, std::string_view text) {
        macros_.defineMacro(name, text);
    }

    /// Adds a directory to search for included files, after those added before.
    void addIncludeDirectory(std::string_view directory) { files_.addDirectory(directory); }

    /// Asks before an included file is looked for on the disk.
    void setResolver(IncludeResolver resolver) { files_.setResolver(std::move(resolver)); }

    /// Tells what the run does, if somebody is given; of macros only if the options say so.
    void setObserver(const Observer& observer);

    /// Sets where the output goes; must be called before a source is opened.
    void setOutput(ByteSink& output) { output_.redirect(output); }

    /// Opens the source, standard input if the name is empty, and writes its first line marker. In
    /// messages and markers it has the message name, unless that is empty. Returns false after
    /// reporting that it cannot be opened.
    [[nodiscard]] bool openSource(const std::string& sourceName, const std::string& messageName);
    /// Reads what somebody else brings as the source.
    void openBytes(const std::string& sourceName, ByteSource& source);
    /// Reads a text as the source.
    void openText(const std::string& sourceName, std::string_view text);

    /// Reads the open source; to be called once.
    [[nodiscard]] RunResult run();

    /// Tells whether some of the output could not be written.
    [[nodiscard]] bool outputFailed() const noexcept { return output_.failed(); }

private:
    void fileEntered() override;
    void fileEnds() override;
    void fileResumed() override;
    [[nodiscard]] bool gainsByNotice() const noexcept override;
    void notice(std::span<const std::string_view> names) override;
    [[nodiscard]] Outcome readName(std::string_view name, const char* end) override;

    void tellSource(const std::string& name);
    [[nodiscard]] RunResult readAll();
    [[nodiscard]] bool readBytes();
    [[nodiscard]] bool readDirective(CppFileScanner& file);
    [[nodiscard]] DirectiveLine::Outcome carryOut(DirectiveLine& line);
    [[nodiscard]] DirectiveLine::Outcome carryOutInclude(DirectiveLine& line);
    [[nodiscard]] DirectiveLine::Outcome carryOutConditional(DirectiveLine& line);
    [[nodiscard]] CppFileScanner* byteSource();
    void line();
    void directiveLine();
    void activeDirective(TokenKind word);
    void textLine(std::string_view blanks, Token first);
    void restOfTextLine();
    void writeToken(const Token& token);
    void endSkippedLine();

    RunOptions options_;
    std::optional<EventTeller> events_;
    OutputWriter output_;
    TextLexer lexer_;  // its texts are held by sources and macros
    ScannerStack sources_;
    Diagnostics diagnostics_;
    MacroTable macros_;
    MacroExpander expander_;
    Conditionals conditionals_;
    Definitions definitions_;
    IncludedFiles files_;
    Inclusion inclusion_;
    LineControl lineControl_;
    TextReader textReader_;
    LineSkipper lineSkipper_;
};

}  // namespace umpre

#endif
