// SPDX-License-Identifier: MIT
#include "driver/command_line.h"

#include <optional>
#include <vector>

#include "driver/option_parser.h"
#include "driver/version.h"

namespace umpre {
namespace {

constexpr std::string_view kUsage =
    "Usage: umpre [options] [source_file]\n\n"
    "  -I<dir>        : add a directory for searching include files.\n"
    "  -D<name>       : define preprocessor symbol.\n"
    "  -o <name>      : output file. If not specified, writes to standard out.\n"
    "  -s <name>      : source name. Overrides source file name in messages."
    " Useful when reading from standard in.\n"
    "  -v, --version  : show version number.\n"
    "  -h, --help     : show this help text.\n\n"
    "The order you specify options and source file does not matter.\n"
    "If no source file is specified, umpre reads from standard in.\n\n";

constexpr OptionParser::Format kIgnored{"argument(s) '", "' is(are) ignored\n"};

const std::vector<OptionSpec>& optionTable() {
    static const std::vector<OptionSpec> kTable{
        {"I ", 1, "missing path name for '-I' option number "},
        {"D_", 1, "missing macro for '-D' option number "},
        {"o", 1, "missing output file name for '-o' option"},
        {"s", 1, "no source name provided to '-s' option"},
        {"v", OptionSpec::kTerminal, {}},
        {"-version", OptionSpec::kTerminal, {}},
        {"h", OptionSpec::kTerminal, {}},
        {"-help", OptionSpec::kTerminal, {}},
    };
    return kTable;
}

[[nodiscard]] std::string prefixOf(const Console& console) {
    return std::string(console.program).append(": ");
}

// Prints the help or the version, if asked for.
bool printTexts(const OptionParser& options, ByteSink& output) {
    if (options.has("h") || options.has("-help")) {
        options.reportIgnored(kIgnored);
        (void)output.write(kUsage);
        return true;
    }
    if (options.has("v") || options.has("-version")) {
        options.reportIgnored(kIgnored);
        (void)output.write(versionTextOf("umpre"));
        return true;
    }
    return false;
}

// Without "=" the text is "1".
void defineOption(Preprocessor& preprocessor, std::string_view definition) {
    const std::size_t equals = definition.find('=');
    if (equals == std::string_view::npos) {
        preprocessor.defineMacro(definition, "1");
    } else {
        preprocessor.defineMacro(definition.substr(0, equals), definition.substr(equals + 1));
    }
}

// Both return false after telling that an argument is missing.
bool takeDefinitions(const OptionParser& options, Preprocessor& preprocessor) {
    if (!options.hasPrefix("D_")) {
        return true;
    }
    const std::vector<std::string_view> definitions = options.values("D_");
    for (const std::string_view definition : definitions) {
        defineOption(preprocessor, definition);
    }
    return !definitions.empty();
}

bool takeDirectories(const OptionParser& options, Preprocessor& preprocessor) {
    if (!options.hasPrefix("I ")) {
        return true;
    }
    const std::vector<std::string_view> directories = options.values("I ");
    for (const std::string_view directory : directories) {
        preprocessor.addIncludeDirectory(directory);
    }
    return !directories.empty();
}

bool takeOutputFile(const OptionParser& options, const Console& console) {
    if (!options.has("o")) {
        return true;
    }
    const std::optional<std::string_view> word = options.get("o");
    if (!word) {
        return false;
    }
    const std::string name(*word);
    if (!console.output.open(name)) {
        (void)console.errors.write(console.output.openFailureMessage(name));
        return false;
    }
    return true;
}

bool takeSource(const OptionParser& options, Preprocessor& preprocessor, const Console& console) {
    std::string messageName;
    if (options.has("s")) {
        const std::optional<std::string_view> word = options.get("s");
        if (!word) {
            return false;
        }
        messageName = *word;
    }
    if (options.freeCount() > 1) {
        (void)console.errors.write(prefixOf(console)
                                   + "cannot provide more than one source file\n");
        return false;
    }
    preprocessor.setOutput(console.output);
    return preprocessor.openSource(std::string(options.free(1).value_or("")), messageName);
}

}  // namespace

bool parseCommandLine(Preprocessor& preprocessor, const Console& console, int argc,
                      const char* const* argv) {
    const std::string prefix = prefixOf(console);
    const OptionParser options(argc, argv, optionTable(), prefix, true, console.errors);
    if (options.reportUnknown({"unknown option '", "' ('-h' for help)\n"})
        || options.reportMisplaced({"'", "' argument is misplaced ('-h' for help)\n"})) {
        return false;
    }
    options.reportDuplicates(
        {"'-", "' option appears more than once\n\tonly the last one will be considered\n"});
    return !printTexts(options, console.output) && takeDefinitions(options, preprocessor)
           && takeDirectories(options, preprocessor) && takeOutputFile(options, console)
           && takeSource(options, preprocessor, console);
}

}  // namespace umpre
