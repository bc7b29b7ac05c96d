// SPDX-License-Identifier: MIT
#include "directives/include_lines.h"

#include <algorithm>
#include <utility>

#include "lex/spelling.h"

namespace umpre {
namespace {

using enum TokenKind;

// A line that can be known begins like this.
constexpr std::string_view kBegin = "#in";

// Tells whether a byte stands for itself in a quoted name.
[[nodiscard]] bool isPlain(char byte) noexcept {
    return byte != '\\' && byte != '\n' && byte != '\r' && byte != '\0';
}

}  // namespace

std::optional<IncludeOperand> IncludeLines::read(DirectiveLine& line) const {
    line.skipBlanks();
    const Token open = line.next();
    if (open.kind != LESS && open.text != "\"") {
        return std::nullopt;
    }
    IncludeOperand operand;
    operand.form = open.kind == LESS ? IncludeForm::Brackets : IncludeForm::Quotes;
    const std::string_view close = open.kind == LESS ? ">" : "\"";
    Token token = line.next();
    const char* const begin = token.text.data();
    while (token.text != close) {
        if (!isPartOfName(token, operand)) {
            return std::nullopt;
        }
        token = line.next();
    }
    operand.name = {begin, static_cast<std::size_t>(token.text.data() - begin)};
    line.skipBlanks();
    if (operand.name.empty() || !line.isAtEnd()) {
        return std::nullopt;
    }
    operand.isLasting = operand.isLasting && line.isOneLine();
    return operand;
}

// Quotes hold text. Between brackets stand tokens that are expanded; of those that are no names the
// ones are taken that are common in file names.
bool IncludeLines::isPartOfName(const Token& token, IncludeOperand& operand) const {
    const char first = token.text.front();
    if (operand.form == IncludeForm::Quotes) {
        return isPlain(first);
    }
    if (isName(token.kind)) {
        if (!macros_.filter().mayHold(token.text)) {
            return true;
        }
        operand.isLasting = false;
        return macros_.find(token.text) == nullptr;
    }
    return token.kind == SLASH || isDigit(first) || first == '.' || first == '-' || first == '+';
}

// With no macro name that was not there before, no name of the line can have become one.
void IncludeLines::keep(std::string_view text, const IncludeOperand& operand, Search* search) {
    const std::string_view line = text.substr(0, text.find('\n') + 1);
    if (search == nullptr || !operand.isLasting || line.substr(0, kBegin.size()) != kBegin) {
        return;
    }
    if (2 * used_ >= slots_.size()) {
        makeRoom();
    }
    Known& known = slotOf(line);
    if (known.bytes.empty()) {
        ++used_;
    }
    known = {std::string(line), search, macros_.filter().size()};
}

const IncludeLines::Known* IncludeLines::find(std::string_view text) {
    if (slots_.empty() || text.substr(0, kBegin.size()) != kBegin) {
        return nullptr;
    }
    const std::string_view line = text.substr(0, text.find('\n') + 1);
    const Known& known = slotOf(line);
    return known.search != nullptr && known.macroNames == macros_.filter().size() ? &known
                                                                                  : nullptr;
}

// Returns the slot of this line, or the free one for it.
IncludeLines::Known& IncludeLines::slotOf(std::string_view line) noexcept {
    const std::size_t mask = slots_.size() - 1;
    std::size_t slot = hashOfName(line) & mask;
    while (!slots_[slot].bytes.empty() && slots_[slot].bytes != line) {
        slot = (slot + 1) & mask;
    }
    return slots_[slot];
}

// Doubles the slots. When there are very many, it forgets the lines instead.
void IncludeLines::makeRoom() {
    std::vector<Known> before(std::clamp(2 * slots_.size(), kFewestSlots, kMostSlots));
    before.swap(slots_);
    if (before.size() == kMostSlots) {
        used_ = 0;
        return;
    }
    for (Known& known : before) {
        if (!known.bytes.empty()) {
            slotOf(known.bytes) = std::move(known);
        }
    }
}

}  // namespace umpre
