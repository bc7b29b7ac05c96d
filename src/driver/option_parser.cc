// SPDX-License-Identifier: MIT
#include "driver/option_parser.h"

#include <algorithm>

namespace umpre {

bool OptionSpec::matches(std::string_view text) const noexcept {
    return isPrefix() ? text.substr(0, 1) == name.substr(0, 1) : text == name;
}

OptionParser::OptionParser(int argc, const char* const* argv,
                           const std::vector<OptionSpec>& options, std::string_view prefix,
                           bool optionsMayFollowArguments, ByteSink& errors)
    : options_(options), prefix_(prefix), errors_(errors) {
    parse({argv + std::min(argc, 1), argv + argc}, optionsMayFollowArguments);
}

const OptionSpec* OptionParser::lookUp(Word text) const {
    const auto it = std::find_if(options_.begin(), options_.end(),
                                 [&](const OptionSpec& option) { return option.matches(text); });
    return it == options_.end() ? nullptr : &*it;
}

bool OptionParser::isOption(Word word) const {
    return word.substr(0, 1) == "-" && lookUp(word.substr(1)) != nullptr;
}

void OptionParser::parse(const std::vector<Word>& words, bool optionsMayFollowArguments) {
    std::size_t index = 0;
    while (index < words.size()) {
        const Word word = words[index];
        if (word.substr(0, 1) != "-") {
            freeArguments_.push_back(word);
            ++index;
            continue;
        }
        if (!optionsMayFollowArguments && !freeArguments_.empty()) {
            isMisplaced_ = true;
            return;
        }
        const OptionSpec* const option = lookUp(word.substr(1));
        if (option == nullptr) {
            unknown_.push_back(word);
            ++index;
        } else if (option->argumentCount == OptionSpec::kTerminal) {
            endParsing(*option, words, index);
            return;
        } else if (option->isPrefix()) {
            index = parsePrefix(*option, words, index);
        } else {
            index = parseOrdinary(*option, words, index);
        }
    }
}

void OptionParser::endParsing(const OptionSpec& option, const std::vector<Word>& words,
                              std::size_t index) {
    entries_.push_back({option.name, {}});
    for (std::size_t other = 0; other < words.size(); ++other) {
        if (other != index) {
            ignored_.append(words[other]).append(" ");
        }
    }
}

std::size_t OptionParser::parseOrdinary(const OptionSpec& option, const std::vector<Word>& words,
                                        std::size_t index) {
    const auto earlier = std::find_if(entries_.begin(), entries_.end(), [&](const Entry& entry) {
        return entry.name == option.name;
    });
    if (earlier != entries_.end()) {
        duplicates_.push_back(option.name);
        entries_.erase(earlier);
    }
    Entry& entry = entries_.emplace_back(Entry{option.name, {}});
    ++index;
    for (int taken = 0; taken < option.argumentCount && index < words.size(); ++taken) {
        if (isOption(words[index])) {
            break;
        }
        entry.words.push_back(words[index++]);
    }
    return index;
}

// The next word may be an argument if it looks like no option, or like the first one of the table:
// "-I -Ix" takes "-Ix" for a directory, while "-I -Dx" has none.
std::size_t OptionParser::parsePrefix(const OptionSpec& option, const std::vector<Word>& words,
                                      std::size_t index) {
    const Word glued = words[index].substr(2);
    Entry& entry = prefixEntries_.emplace_back(Entry{option.name, {}});
    ++index;
    if (!glued.empty()) {
        entry.words.push_back(glued);
    } else if (option.name[1] == ' ' && index < words.size()) {
        const Word next = words[index];
        if (next.substr(0, 1) != "-" || options_.front().matches(next.substr(1))) {
            entry.words.push_back(next);
            ++index;
        }
    }
    return index;
}

void OptionParser::tell(const Format& format, std::string_view text) const {
    std::string message(prefix_);
    message.append(format.before).append(text).append(format.after);
    (void)errors_.write(message);
}

void OptionParser::tellMissing(std::string_view name, std::string_view number) const {
    const auto option = std::find_if(options_.begin(), options_.end(),
                                     [&](const OptionSpec& spec) { return spec.name == name; });
    tell({option->missingMessage, "\n"}, number);
}

bool OptionParser::reportUnknown(const Format& format) const {
    for (const Word word : unknown_) {
        tell(format, word);
    }
    return !unknown_.empty();
}

bool OptionParser::reportMisplaced(const Format& format) const {
    if (isMisplaced_) {
        for (const Word word : freeArguments_) {
            tell(format, word);
        }
    }
    return isMisplaced_;
}

void OptionParser::reportDuplicates(const Format& format) const {
    for (const Word name : duplicates_) {
        tell(format, name);
    }
}

void OptionParser::reportIgnored(const Format& format) const {
    if (!ignored_.empty()) {
        tell(format, ignored_);
    }
}

const OptionParser::Entry* OptionParser::entryOf(Word name) const {
    const auto it = std::find_if(entries_.begin(), entries_.end(),
                                 [&](const Entry& entry) { return entry.name == name; });
    return it == entries_.end() ? nullptr : &*it;
}

bool OptionParser::has(std::string_view name) const {
    return entryOf(name) != nullptr;
}

bool OptionParser::hasPrefix(std::string_view name) const {
    return std::any_of(prefixEntries_.begin(), prefixEntries_.end(),
                       [&](const Entry& entry) { return entry.name == name; });
}

std::vector<std::string_view> OptionParser::values(std::string_view name) const {
    std::vector<Word> collected;
    for (const Entry& entry : prefixEntries_) {
        if (entry.name != name) {
            continue;
        }
        if (entry.words.empty()) {
            tellMissing(name, std::to_string(collected.size() + 1));
            return {};
        }
        collected.push_back(entry.words.front());
    }
    return collected;
}

std::optional<std::string_view> OptionParser::get(std::string_view name) const {
    const Entry* const entry = entryOf(name);
    if (entry == nullptr || entry->words.empty()) {
        tellMissing(name, "");
        return std::nullopt;
    }
    return entry->words.front();
}

std::optional<std::string_view> OptionParser::free(std::size_t number) const {
    if (number == 0 || number > freeArguments_.size()) {
        return std::nullopt;
    }
    return freeArguments_[number - 1];
}

}  // namespace umpre
