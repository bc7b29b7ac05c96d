// SPDX-License-Identifier: MIT
#include "lines/command_line.h"

#include <string_view>
#include <vector>

#include "driver/option_parser.h"

namespace umpre {
namespace {

constexpr std::string_view kPrefix = "umpre-lines: ";

const std::vector<OptionSpec>& optionTable() {
    static const std::vector<OptionSpec> kTable{
        {"-gnu", 0, {}},
        {"-strip", 0, {}},
        {"-map", 0, {}},
        {"o", 1, "missing output file name for '-o' option"},
        {"v", OptionSpec::kTerminal, {}},
        {"-version", OptionSpec::kTerminal, {}},
        {"h", OptionSpec::kTerminal, {}},
        {"-help", OptionSpec::kTerminal, {}},
    };
    return kTable;
}

// Returns nothing if the options ask for nothing, or for too much.
std::optional<LinesOptions::Task> taskOf(const OptionParser& parser) {
    using enum LinesOptions::Task;
    const bool strip = parser.has("-strip");
    const bool map = parser.has("-map");
    if (parser.has("-gnu")) {
        return strip || map ? std::nullopt : std::optional(Gnu);
    }
    if (map) {
        return strip ? MapStripped : Map;
    }
    return strip ? std::optional(Strip) : std::nullopt;
}

}  // namespace

std::optional<LinesOptions> readLinesOptions(int argc, const char* const* argv, ByteSink& errors) {
    const OptionParser parser(argc, argv, optionTable(), kPrefix, true, errors);
    const auto complain = [&errors](std::string_view what) {
        (void)errors.write(std::string(kPrefix).append(what).append("\n"));
        return std::nullopt;
    };
    if (parser.reportUnknown({"unknown option '", "' ('-h' for help)\n"})) {
        return std::nullopt;
    }
    if (parser.has("h") || parser.has("-help")) {
        return LinesOptions{LinesOptions::Task::Help, {}, {}};
    }
    if (parser.has("v") || parser.has("-version")) {
        return LinesOptions{LinesOptions::Task::Version, {}, {}};
    }
    const std::optional<LinesOptions::Task> task = taskOf(parser);
    if (!task) {
        return complain("--gnu, --strip, --map or --strip --map is needed ('-h' for help)");
    }
    if (parser.freeCount() > 1) {
        return complain("cannot read more than one file");
    }
    LinesOptions options{*task, std::string(parser.free(1).value_or("")), {}};
    if (parser.has("o")) {
        const std::optional<std::string_view> name = parser.get("o");
        if (!name) {
            return std::nullopt;
        }
        options.outputName = *name;
    }
    return options;
}

std::string linesUsage() {
    return "Usage: umpre-lines --gnu|--strip|--map|--strip --map [-o <name>] [file]\n\n"
           "  --gnu          : turn #line 12 \"file\" into # 12 \"file\".\n"
           "  --strip        : take the line markers out.\n"
           "  --map          : print as JSON where each line comes from; with --strip, each line\n"
           "                   that --strip leaves.\n"
           "  -o <name>      : output file. If not specified, writes to standard out.\n"
           "  -v, --version  : show version number.\n"
           "  -h, --help     : show this help text.\n\n"
           "If no file is specified, umpre-lines reads from standard in.\n";
}

}  // namespace umpre
