// SPDX-License-Identifier: MIT
#include "directives/line_control.h"

#include <cctype>
#include <cstdint>
#include <limits>
#include <string>

#include "directives/operand.h"

namespace umpre {
namespace {

using enum TokenKind;

constexpr std::string_view kInvalidFormat = R"(Invalid format for "#line" directive)";

// Converts as a decimal conversion to a 64-bit integer that keeps to its largest value, of which
// the low 32 bits are taken.
[[nodiscard]] std::int32_t lineNumber(std::string_view digits) noexcept {
    constexpr std::uint64_t kMost = std::numeric_limits<std::int64_t>::max();
    std::uint64_t number = 0;
    for (const char digit : digits) {
        const auto value = static_cast<std::uint64_t>(digit - '0');
        number = number > (kMost - value) / 10 ? kMost : number * 10 + value;
    }
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(number));
}

}  // namespace

// Unlike other directives this one reads its line end before its operand is looked at: the new
// number is that of the line that follows.
void LineControl::lineDirective() {
    const std::string text = gatherUncontinuedLine(sources_);
    sources_.next();
    const ExpandedOperand operand(sources_, expander_, lexer_, text, LineKind::Operand);
    sources_.skipBlanks();
    const Token token = sources_.next();
    if (token.kind != INT_DEC) {
        reporter_.reportError(token.text == "0" ? "Invalid line number" : kInvalidFormat);
    } else if (std::isdigit(static_cast<unsigned char>(token.text.back())) == 0) {
        rejectRest(kInvalidFormat);
    } else {
        changeLine(token.text);
    }
}

void LineControl::changeLine(std::string_view number) {
    CppFileScanner& file = sources_.currentFile();
    file.setLine(lineNumber(number));
    sources_.skipBlanks();
    const Token token = sources_.next();
    if (token.kind == STRING_LITERAL) {
        file.setFileName(token.text.substr(1, token.text.size() - 2));
    } else if (token.kind != END_OF_INPUT) {
        rejectRest(kInvalidFormat);
    }
    output_.writeLineMarker(file.position());
    sources_.skipBlanks();
    if (sources_.peek() != END_OF_INPUT) {
        rejectRest(kInvalidCharacters);
    }
}

// Reports a problem and reads the operand to its end, for what comments in it may do.
void LineControl::rejectRest(std::string_view message) {
    reporter_.reportError(message);
    while (sources_.next().kind != END_OF_INPUT) {
    }
}

void LineControl::pragmaDirective() {
    output_.write("#pragma ");
    while (!endsLine(sources_.peek())) {
        const Token token = sources_.next();
        if (token.kind != CONTINUATION) {
            output_.write(token.text);
        }
    }
    output_.endLine();
}

void LineControl::errorDirective() {
    reporter_.reportError("#error directive: " + gatherUncontinuedLine(sources_));
}

}  // namespace umpre
