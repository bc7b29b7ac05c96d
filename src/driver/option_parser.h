// SPDX-License-Identifier: MIT
#ifndef UMPRE_DRIVER_OPTION_PARSER_H
#define UMPRE_DRIVER_OPTION_PARSER_H

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "lex/byte_sink.h"

namespace umpre {

/// One row of an option table.
struct OptionSpec {
    /// Without the leading dash. If the second character is "_" or a blank, only the first one
    /// counts and the argument follows it in the same word or, with a blank, in the next one.
    std::string_view name;
    /// How many arguments follow; kTerminal: parsing ends, and every other word is ignored.
    int argumentCount;
    /// Told when the argument is missing, followed, for prefix options, by the option's number.
    std::string_view missingMessage;

    static constexpr int kTerminal = -1;

    [[nodiscard]] bool isPrefix() const noexcept {
        return name.size() > 1 && (name[1] == '_' || name[1] == ' ');
    }

    /// Tells whether a word means this option; `text` is the word without its dash.
    [[nodiscard]] bool matches(std::string_view text) const noexcept;
};

/// Splits an argument vector into options and free arguments. What is wrong with it is collected
/// and told when it is asked for. The vector, the table and the sink are borrowed.
class OptionParser {
public:
    /// A piece of a message before and after the word that it is about.
    struct Format {
        std::string_view before;
        std::string_view after;
    };

    OptionParser(int argc, const char* const* argv, const std::vector<OptionSpec>& options,
                 std::string_view prefix, bool optionsMayFollowArguments, ByteSink& errors);

    /// Tells each word that is no option. Returns whether there was one.
    [[nodiscard]] bool reportUnknown(const Format& format) const;
    /// Tells each free argument if an option followed one and must not. Returns whether so.
    [[nodiscard]] bool reportMisplaced(const Format& format) const;
    /// Tells each option, once for each time it came again. The last one counts.
    void reportDuplicates(const Format& format) const;
    /// Tells the words that a terminal option made parsing ignore.
    void reportIgnored(const Format& format) const;

    [[nodiscard]] bool has(std::string_view name) const;
    [[nodiscard]] bool hasPrefix(std::string_view name) const;
    /// Returns all arguments of a prefix option; none after telling that one is missing.
    [[nodiscard]] std::vector<std::string_view> values(std::string_view name) const;
    /// Returns an ordinary option's argument; nothing after telling that it is missing.
    [[nodiscard]] std::optional<std::string_view> get(std::string_view name) const;

    [[nodiscard]] std::size_t freeCount() const noexcept { return freeArguments_.size(); }

    /// Returns a free argument, counted from 1; nothing if there are fewer.
    [[nodiscard]] std::optional<std::string_view> free(std::size_t number) const;

private:
    using Word = std::string_view;

    struct Entry {
        Word name;                // as in the table
        std::vector<Word> words;  // its arguments
    };

    [[nodiscard]] const OptionSpec* lookUp(Word text) const;
    [[nodiscard]] bool isOption(Word word) const;
    void parse(const std::vector<Word>& words, bool optionsMayFollowArguments);
    void endParsing(const OptionSpec& option, const std::vector<Word>& words, std::size_t index);
    [[nodiscard]] std::size_t parseOrdinary(const OptionSpec& option,
                                            const std::vector<Word>& words, std::size_t index);
    [[nodiscard]] std::size_t parsePrefix(const OptionSpec& option, const std::vector<Word>& words,
                                          std::size_t index);
    void tell(const Format& format, std::string_view text) const;
    void tellMissing(std::string_view name, std::string_view number) const;
    [[nodiscard]] const Entry* entryOf(Word name) const;

    const std::vector<OptionSpec>& options_;
    std::string_view prefix_;
    ByteSink& errors_;
    std::vector<Entry> entries_;
    std::vector<Entry> prefixEntries_;
    std::vector<Word> freeArguments_;
    std::vector<Word> unknown_;
    std::vector<Word> duplicates_;
    std::string ignored_;
    bool isMisplaced_ = false;
};

}  // namespace umpre

#endif
