// SPDX-License-Identifier: MIT
#include "deps/command_line.h"

#include <cstddef>
#include <string_view>

#include "deps/rule.h"

namespace umpre {
namespace {

constexpr std::string_view kPrefix = "umpre-deps: ";

// Takes the options that umpre does not have, and leaves the others to it.
class Reader {
public:
    explicit Reader(DepsOptions& options) noexcept : options_(options) {}

    // Takes one word, and the next if it is its argument. Returns how many; 0 if that is missing.
    [[nodiscard]] int take(const char* const* words, int count) {
        const std::string_view word = words[0];
        if (takeFlag(word)) {
            return 1;
        }
        if (hasArgument(word)) {
            if (word.size() > kGlued) {
                takeArgument(word.substr(0, kGlued), words[0] + kGlued);
                return 1;
            }
            if (count > 1) {
                takeArgument(word, words[1]);
            }
            return count > 1 ? 2 : 0;
        }
        const int taken = word == "-s" && count > 1 ? 2 : 1;
        options_.words.insert(options_.words.end(), words, words + taken);
        return taken;
    }

    // As gcc does: with -M the file of -o gets the rule, with -MD the rule goes beside it.
    void finish() {
        std::string& output = options_.outputName;
        if (ruleOnly_) {
            options_.ruleName = options_.ruleName.empty() ? output : options_.ruleName;
            output.clear();
        } else if (besideText_ && options_.ruleName.empty() && !output.empty()) {
            options_.ruleName = withSuffix(output, ".d");
        }
        if (!output.empty()) {
            options_.words.emplace_back("-o");
            options_.words.push_back(output);
            if (options_.targets.empty()) {
                options_.targets.push_back(escapedTarget(output));
            }
        }
    }

private:
    bool takeFlag(std::string_view word) {
        if (word == "-M" || word == "-MM") {
            return ruleOnly_ = true;
        }
        if (word == "-MD" || word == "-MMD") {
            return besideText_ = true;
        }
        if (word == "-MP") {
            return options_.phonyFiles = true;
        }
        if (word == "--absent") {
            return options_.absent = true;
        }
        return takeText(word);
    }

    bool takeText(std::string_view word) {
        const bool isHelp = word == "-h" || word == "--help";
        if (isHelp || word == "-v" || word == "--version") {
            options_.task = isHelp ? DepsOptions::Task::Help : DepsOptions::Task::Version;
            return true;
        }
        return false;
    }

    // Tells whether a word is an option with an argument, which may be glued to it, but not to -o.
    [[nodiscard]] static bool hasArgument(std::string_view word) {
        const std::string_view option = word.substr(0, kGlued);
        return word == "-o" || option == "-MF" || option == "-MT" || option == "-MQ";
    }

    void takeArgument(std::string_view option, const char* argument) {
        if (option == "-MF") {
            options_.ruleName = argument;
        } else if (option == "-o") {
            options_.outputName = argument;
        } else {
            options_.targets.push_back(option == "-MQ" ? escapedTarget(argument) : argument);
        }
    }

    static constexpr std::size_t kGlued = 3;  // where a glued argument begins

    DepsOptions& options_;
    bool ruleOnly_ = false;
    bool besideText_ = false;
};

}  // namespace

std::optional<DepsOptions> readDepsOptions(int argc, const char* const* argv, ByteSink& errors) {
    std::optional<DepsOptions> options(std::in_place);
    Reader reader(*options);
    options->words.emplace_back(argc > 0 ? argv[0] : "umpre-deps");
    for (int at = 1; at < argc;) {
        const int taken = reader.take(argv + at, argc - at);
        if (taken == 0) {
            const std::string option = argv[at];
            (void)errors.write(std::string(kPrefix) + "missing argument of '" + option + "'\n");
            return std::nullopt;
        }
        at += taken;
    }
    reader.finish();
    return options;
}

std::string withSuffix(const std::string& name, const std::string& suffix) {
    const std::size_t slash = name.rfind('/');
    const std::size_t start = slash == std::string::npos ? 0 : slash + 1;
    const std::size_t dot = name.rfind('.');
    return name.substr(0, dot == std::string::npos || dot <= start ? name.size() : dot) + suffix;
}

std::string depsUsage() {
    return "Usage: umpre-deps [options] [source_file]\n\n"
           "  -I<dir>        : add a directory for searching include files.\n"
           "  -D<name>       : define preprocessor symbol.\n"
           "  -o <name>      : write the preprocessed text there, too.\n"
           "  -s <name>      : source name in messages.\n"
           "  -M, -MM        : only the rule; -o names its file.\n"
           "  -MD, -MMD      : with -o, write the rule beside the text, with the suffix .d.\n"
           "  -MF <name>     : write the rule there instead of standard out, \"-\".\n"
           "  -MT <target>   : the rule's target, as it is. May be given many times.\n"
           "  -MQ <target>   : the same, with what is special to make escaped.\n"
           "  -MP            : add an empty rule for each included file.\n"
           "  --absent       : add what was looked for and is not there.\n"
           "  -v, --version  : show version number.\n"
           "  -h, --help     : show this help text.\n\n"
           "If no source file is specified, umpre-deps reads from standard in.\n";
}

}  // namespace umpre
