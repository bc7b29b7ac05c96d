// SPDX-License-Identifier: MIT
#ifndef UMPRE_PREPROCESSING_H
#define UMPRE_PREPROCESSING_H

#include <cstddef>
#include <functional>
#include <iosfwd>
#include <memory>
#include <optional>
#include <string_view>

#include "umpre/diagnostic.h"
#include "umpre/event.h"
#include "umpre/export.h"

/// All that the library has.
namespace umpre {

/// How a run ended. All that was made before its end has gone to the output.
enum class Outcome {
    Clean,            ///< no error
    Errors,           ///< at least one error was reported
    SourceNotOpened,  ///< there is no such source; reported
    OutputFailed,     ///< the output sink did not take all
    InputFailed,      ///< the input could not be read on; reported
    DivisionFault     ///< a condition divides by zero, or the smallest number by -1; not reported
};

/// Takes bytes of the result; returns false if it cannot take them, which ends the run. It must not
/// throw, and it must not use the Preprocessing that runs.
using OutputSink = std::function<bool(std::string_view bytes)>;

/// Brings bytes of the source: up to `size` of them, which is not 0, to `to`. Returns how many, 0
/// at the end, or nothing if reading fails. It may bring fewer than there is room for, but the run
/// waits for each call. It must not throw, and it must not use the Preprocessing that runs.
using SourceReader = std::function<std::optional<std::size_t>(char* to, std::size_t size)>;

/// What is to be preprocessed, how, and where the result goes.
///
/// An object can run any number of times. It keeps no state from run to run and shares none with
/// others: different objects can run in different threads at the same time.
///
/// It ends no process, raises no signal and prints nothing.
class UMPRE_API Preprocessing {
public:
    /// Makes one with an empty source, no definitions and no directories. What comes out is dropped
    /// until sinks are set.
    Preprocessing();
    /// Takes over the settings of another one, which can then only be destroyed or assigned to.
    Preprocessing(Preprocessing&& other) noexcept;
    /// Takes over the settings of another one, which can then only be destroyed or assigned to.
    Preprocessing& operator=(Preprocessing&& other) noexcept;
    ~Preprocessing();

    /// Reads the source from a file; an empty name is standard input.
    void setSourceFile(std::string_view fileName);
    /// Reads the source from a text, of which a copy is kept, under this name.
    void setSourceText(std::string_view name, std::string_view text);
    /// Reads the source, which has this name, from whoever brings it, in pieces of some 64 KiB,
    /// none of which is asked for before it is needed. The reader is kept until another source is
    /// set. A run asks it until it says that the end is reached, and not again; what it brings to a
    /// next run is up to it. If it fails, or says that it brought more than there was room for, the
    /// run ends with Outcome::InputFailed.
    void setSourceReader(std::string_view name, SourceReader reader);
    /// Reads the source, which has this name, from where a stream stands to its end, in the same
    /// way. The stream is borrowed: it must outlive all runs, and belongs to the run that goes on.
    /// To run again, clear and rewind it before. It fails with `bad()`, or with `fail()` before its
    /// end.
    void setSourceStream(std::string_view name, std::istream& stream);
    /// Names the source in messages, line markers and `__FILE__`, unless `name` is empty.
    void setMessageName(std::string_view name);

    /// Defines a macro without parameters, as the option -D does: the first definition of a name
    /// holds.
    void define(std::string_view name, std::string_view text = "1");
    /// Adds a directory to search for included files, after those added before.
    void addIncludeDirectory(std::string_view directory);

    /// Sets where the result goes. It comes in blocks.
    void setOutput(OutputSink sink);
    /// Sets where problems in the input go.
    void setDiagnostics(DiagnosticSink sink);

    /// Sets who serves included files that are not on the disk.
    void setIncludeResolver(IncludeResolver resolver);
    /// Sets who is told what the run does, and of what. Without one, nothing is told, and that
    /// costs nothing.
    void setObserver(Observer observer, EventScope scope = EventScope::Files);

    /// Preprocesses the source from its beginning to its end.
    [[nodiscard]] Outcome run() const;

    /// Returns the version of the library, as "1.0.0".
    [[nodiscard]] static const char* version() noexcept;

private:
    struct Settings;

    std::unique_ptr<Settings> settings_;
};

}  // namespace umpre

#endif
