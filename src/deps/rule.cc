// SPDX-License-Identifier: MIT
//
// A blank, a colon or a number sign in a name gets a backslash, and the backslashes before it are
// doubled; a dollar sign is doubled; every other backslash stays. Make and Ninja read that alike. A
// percent sign matters to Make alone, in targets.
//
// The function `wildcard` of Make takes a pattern, in which a backslash stands before what would be
// special, and gives back names in which nothing is escaped. In a function's arguments a number
// sign is no comment.
#include "deps/rule.h"

#include <cstddef>

namespace umpre {
namespace {

constexpr std::string_view kBlanks = " \t";
constexpr std::string_view kBlanksAndColon = " \t:";

std::string escaped(std::string_view name, std::string_view special) {
    std::string text;
    std::size_t backslashes = 0;  // just before
    for (const char byte : name) {
        if (special.find(byte) != std::string_view::npos) {
            text.append(backslashes + 1, '\\');
        } else if (byte == '$') {
            text.push_back('$');
        }
        backslashes = byte == '\\' ? backslashes + 1 : 0;
        text.push_back(byte);
    }
    return text;
}

// Returns what Make makes the name of a file, or nothing if there is no such file.
std::string ifThere(std::string_view name) {
    std::string pattern;
    for (const char byte : name) {
        pattern.append(std::string_view("\\*?[#").find(byte) == std::string_view::npos ? 0 : 1,
                       '\\');
        pattern.push_back(byte);
    }
    const std::string text = "$(wildcard " + escaped(pattern, kBlanks) + ")";
    return name.find_first_of(" \t:\\*?[") == std::string_view::npos
               ? text
               : "$(if " + text + "," + escaped(name, kBlanksAndColon) + ")";
}

}  // namespace

std::string escapedFile(std::string_view name) {
    return escaped(name, " \t:#");
}

std::string escapedTarget(std::string_view name) {
    return escaped(name, " \t:#%");
}

std::string textOf(const Rule& rule) {
    std::string targets;
    for (const std::string& target : rule.targets) {
        targets.append(targets.empty() ? "" : " ").append(target);
    }
    std::string text = targets + ":";
    for (const std::string& file : rule.files) {
        if (!file.empty()) {
            text.append(" \\\n  ").append(escapedFile(file));
        }
    }
    text.append("\n");
    for (const std::string& file : rule.absent) {
        text.append(targets).append(": ").append(ifThere(file)).append("\n");
    }
    for (std::size_t at = 1; rule.phonyFiles && at < rule.files.size(); ++at) {
        text.append(escapedTarget(rule.files[at])).append(":\n");
    }
    return text;
}

}  // namespace umpre
