// SPDX-License-Identifier: MIT
#include "macros/operand_join.h"

#include "macros/stringize.h"

namespace umpre {

bool OperandJoin::join(const MacroBody& body, const BodyStep& step, const ArgumentText* arguments,
                       std::size_t most, TextBuffer& to) {
    const std::size_t before = to.size();
    for (std::size_t index = step.first; index < step.last; ++index) {
        const BodyOperand operand = body.operands[index];
        if (operand.kind == BodyOperand::Kind::Token) {
            to.append(body.tokens->text(operand.index));
            continue;
        }
        const ArgumentText& argument = arguments[operand.index];
        if (to.size() - before + argument.raw.size() > most) {
            return false;
        }
        if (operand.kind == BodyOperand::Kind::RawArgument) {
            to.append(argument.raw);
        } else {
            addLiteral(argument, to);
        }
    }
    return true;
}

void OperandJoin::addLiteral(const ArgumentText& argument, TextBuffer& to) {
    if (argument.mayHaveQuotes) {
        literal_.clear();
        stringize(argument.raw, literal_);
        to.appendAlone(literal_);
    } else {
        to.append('"');
        to.append(argument.raw);
        to.append('"');
    }
}

}  // namespace umpre
