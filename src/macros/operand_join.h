// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_OPERAND_JOIN_H
#define UMPRE_MACROS_OPERAND_JOIN_H

#include <cstddef>
#include <string>

#include "macros/argument_texts.h"
#include "macros/macro_body.h"
#include "macros/text_buffer.h"

namespace umpre {

/// Joins the operands of `##`, and makes the string literals of `#`, as bytes.
class OperandJoin {
public:
    /// Tells whether a step is known to yield one string literal.
    [[nodiscard]] static bool isLiteral(const MacroBody& body, const BodyStep& step,
                                        const ArgumentText* arguments) noexcept {
        const BodyOperand& first = body.operands[step.first];
        return first.kind == BodyOperand::Kind::Stringized && step.last == step.first + 1
               && !arguments[first.index].mayHaveQuotes;
    }

    /// Adds what a step joins of the body of a call with these arguments. Returns false if that is
    /// not all, because with an argument it was more than `most` bytes.
    [[nodiscard]] bool join(const MacroBody& body, const BodyStep& step,
                            const ArgumentText* arguments, std::size_t most, TextBuffer& to);

private:
    void addLiteral(const ArgumentText& argument, TextBuffer& to);

    std::string literal_;
};

}  // namespace umpre

#endif
