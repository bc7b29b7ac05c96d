// SPDX-License-Identifier: MIT
//
// The evaluator of conditions against another one that follows the rules in the plainest way. An
// input is the condition itself or, if its first byte is odd, a byte for each of its words.
#include "expr/evaluator.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <set>
#include <string>
#include <string_view>

#include "check.h"
#include "condition_rules.h"
#include "lex/output_writer.h"
#include "lex/reporter.h"
#include "lex/scanner_stack.h"
#include "lex/text_lexer.h"

namespace umpre::fuzz {
namespace {

constexpr std::size_t kLongestText = 1500;  // the other evaluator recurses

constexpr auto kWords = std::to_array<std::string_view>(
    {"0",          "1",          "2",       "3",          "1u",         "0x80000000",
     "0x7fffffff", "4294967295", "31",      "32",         "33",         "'a'",
     "'\\xff'",    "'\\377'",    "'abcde'", "4294967296", "+",          "-",
     "*",          "/",          "%",       "<<",         ">>",         "<",
     ">",          "<=",         ">=",      "==",         "!=",         "&",
     "|",          "^",          "&&",      "||",         "!",          "~",
     "?",          ":",          "(",       ")",          "(",          ")",
     " ",          "A",          "B",       "defined A",  "defined(B)", "defined",
     "line",       "\"s\"",      ",",       "\\\n",       "/* c */",    "=",
     "07l",        "2147483648", "-1",      "?1:",        "-8",         "(-2147483647 - 1)",
     "if",         "''",         "0x1fUL",  "\n"});

[[nodiscard]] std::string sentence(std::string_view choices) {
    std::string text;
    for (const char choice : choices) {
        text.append(kWords[static_cast<unsigned char>(choice) % kWords.size()]).append(" ");
    }
    return text;
}

// Keeps what is reported, without the notes of what comments do.
class Messages final : public Reporter {
public:
    void reportError(std::string_view message) override { text_.append(message).append("\n"); }

    void reportWarning(std::string_view message) override { reportError(message); }

    void noteUnterminatedComment(std::int32_t /*line*/) override {}

    [[nodiscard]] std::size_t reportCount() const override { return text_.size(); }

    [[nodiscard]] const std::string& text() const noexcept { return text_; }

private:
    std::string text_;
};

class NoSink final : public ByteSink {
public:
    [[nodiscard]] bool write(std::string_view /*bytes*/) override { return true; }
};

class NoEvents final : public FileEvents {
public:
    void fileEntered() override {}

    void fileEnds() override {}

    void fileResumed() override {}
};

[[nodiscard]] RuledCondition evaluated(std::string_view text, const RunOptions& options,
                                       const std::set<std::string, std::less<>>& names) {
    NoSink sink;
    OutputWriter output;
    output.redirect(sink);
    NoEvents events;
    Messages messages;
    TextLexer lexer(options);
    ScannerStack sources(events, output, messages, options);
    sources.pushFileText("main", "\n");
    sources.isolate(TextSlice::whole(lexer.lexed(text)), {});
    MacroTable macros;
    for (const std::string& name : names) {
        macros.defineMacro(name, "");
    }
    RuledCondition result;
    try {
        const ExprValue value =
            Evaluator<ScannerStack>(sources, macros, messages).evaluate(result.isCorrect);
        result.value = value.value;
        result.isSigned = value.isSigned;
    } catch (const ArithmeticFault&) {
        result.isFault = true;
    }
    result.messages = messages.text();
    for (Token token = sources.next(); token.kind != TokenKind::END_OF_INPUT;
         token = sources.next()) {
        result.left += token.text;
    }
    return result;
}

[[nodiscard]] std::string textOf(const RuledCondition& condition) {
    std::string text = condition.messages;
    if (condition.isFault) {
        return text.append("division fault\n");
    }
    text.append(std::to_string(condition.value)).append(condition.isSigned ? "\n" : "u\n");
    text.append(condition.isCorrect ? "" : "not ").append("correct, left: ");
    return text.append(condition.left);
}

}  // namespace
}  // namespace umpre::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace umpre::fuzz;
    static const std::set<std::string, std::less<>> kMacros{"A", "AA", "line"};
    if (size == 0) {
        return 0;
    }
    const std::string_view rest(reinterpret_cast<const char*>(data) + 1, size - 1);
    const std::string text = data[0] % 2 == 0 ? std::string(rest) : sentence(rest);
    if (text.size() <= kLongestText) {
        const std::string expected = textOf(conditionOf(text, kMacros));
        for (const bool plainRoad : {false, true}) {
            expectSame(printable(text), textOf(evaluated(text, {.plainRoad = plainRoad}, kMacros)),
                       expected);
        }
    }
    return 0;
}
