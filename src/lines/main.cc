// SPDX-License-Identifier: MIT
//
// umpre-lines: what comes after umpre may want its line markers in another form, not at all, or as
// a map beside the text.
#include <array>
#include <cerrno>
#include <fcntl.h>
#include <optional>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

#include "driver/output_file.h"
#include "driver/program.h"
#include "driver/version.h"
#include "lex/byte_sink.h"
#include "lex/output_writer.h"
#include "lines/command_line.h"
#include "lines/line_map.h"
#include "lines/marker_finder.h"
#include "lines/rewriting.h"

namespace {

using Task = umpre::LinesOptions::Task;

// Hands all that can be read to the finder. Returns false if reading fails.
bool readAll(int descriptor, umpre::MarkerFinder& finder, const umpre::OutputWriter& output) {
    std::array<char, std::size_t{64} * 1024> block{};
    while (!output.failed()) {
        const ssize_t count = ::read(descriptor, block.data(), block.size());
        if (count == 0) {
            break;
        }
        if (count > 0) {
            finder.feed({block.data(), static_cast<std::size_t>(count)});
        } else if (errno != EINTR) {
            return false;
        }
    }
    finder.finish();
    return true;
}

bool filter(Task task, int descriptor, umpre::OutputWriter& output) {
    if (task == Task::Map || task == Task::MapStripped) {
        using Count = umpre::LineMap::Count;
        umpre::LineMap map(output, task == Task::Map ? Count::All : Count::WithoutMarkers);
        umpre::MarkerFinder finder(map);
        const bool isRead = readAll(descriptor, finder, output);
        map.finish();
        return isRead;
    }
    umpre::GnuText gnu(output);
    umpre::StrippedText stripped(output);
    umpre::MarkerFinder finder(task == Task::Gnu ? static_cast<umpre::MarkedText&>(gnu)
                                                 : static_cast<umpre::MarkedText&>(stripped));
    return readAll(descriptor, finder, output);
}

// To empty the file that is read would lose it.
bool isSameFile(int descriptor, const std::string& name) {
    struct stat source {};

    struct stat output {};

    return ::fstat(descriptor, &source) == 0 && ::stat(name.c_str(), &output) == 0
           && S_ISREG(source.st_mode) && source.st_dev == output.st_dev
           && source.st_ino == output.st_ino;
}

// These return what went wrong; nothing if nothing did.

std::string print(std::string_view text, umpre::OutputFile& file) {
    return file.write(text) && file.close() ? "" : file.failureMessage();
}

std::string convert(const umpre::LinesOptions& options, umpre::OutputFile& file) {
    const std::string& source = options.sourceName;
    const int descriptor =
        source.empty() ? STDIN_FILENO : ::open(source.c_str(), O_RDONLY | O_CLOEXEC);
    if (descriptor < 0) {
        return "umpre-lines: cannot open '" + source + "'\n";
    }
    const std::string& result = options.outputName;
    if (!result.empty()) {
        if (isSameFile(descriptor, result)) {
            return "umpre-lines: '" + result + "' would overwrite what it is made from\n";
        }
        if (!file.open(result)) {
            return file.openFailureMessage(result);
        }
    }
    umpre::OutputWriter output;
    output.redirect(file);
    const bool isRead = filter(options.task, descriptor, output);
    output.flush();
    if (!isRead) {
        return "umpre-lines: cannot read '" + (source.empty() ? "stdin" : source) + "'\n";
    }
    return file.close() ? "" : file.failureMessage();
}

std::string carryOut(const umpre::LinesOptions& options, umpre::OutputFile& file) {
    switch (options.task) {
    case Task::Help: return print(umpre::linesUsage(), file);
    case Task::Version: return print(umpre::versionTextOf("umpre-lines"), file);
    default: return convert(options, file);
    }
}

int run(int argc, char** argv) {
    umpre::DescriptorSink errors(STDERR_FILENO);
    umpre::OutputFile file("umpre-lines");
    const std::optional<umpre::LinesOptions> options = umpre::readLinesOptions(argc, argv, errors);
    if (!options) {
        return 1;
    }
    const std::string problem = carryOut(*options, file);
    (void)errors.write(problem);
    return problem.empty() ? 0 : 1;
}

}  // namespace

int main(int argc, char** argv) {
    return umpre::runProgram(run, argc, argv);
}
