// SPDX-License-Identifier: MIT
//
// In F(F(F(x))) the argument of the outermost F is a slice of what is read, and while it is read
// the argument of the next F is a slice of the same text, and so on. To look for the end of each
// anew would cost the square of the depth, so an argument that is not short is looked through with
// the outline of its text, which knows where each parenthesis is closed.
#include "macros/argument_slices.h"

#include "lex/text_outline.h"

namespace umpre {
namespace {

using enum TokenKind;

// Up to so many tokens are looked at before the outline is asked for.
constexpr std::size_t kShort = 512;

class Slicer {
public:
    explicit Slicer(const CppTokenScanner& list)
        : list_(list), text_(*list.text()), at_(list.position() + 1) {}

    [[nodiscard]] bool take(std::size_t parameterCount, ArgumentList& arguments) {
        for (;;) {
            while (at_ < list_.end() && text_.kind(at_) == WHITESPACE) {
                ++at_;
            }
            if (at_ == list_.end() || isBlankOrNewline(text_.kind(at_))) {
                return false;
            }
            if (text_.kind(at_) == RIGHT_PARENTHESIS) {
                break;
            }
            if (arguments.size() == parameterCount) {
                return false;
            }
            Argument& argument = arguments.add(list_.text());
            if (!takeOne(argument)) {
                return false;
            }
            argument.noExpand = list_.noExpandSetAt(at_);
            if (text_.kind(at_) == RIGHT_PARENTHESIS) {
                break;
            }
            ++at_;
        }
        ++at_;
        return arguments.size() == parameterCount;
    }

    /// Behind the last token of the invocation.
    [[nodiscard]] std::size_t end() const noexcept { return at_; }

private:
    // Goes on to the "," or ")" that ends the argument. Returns false if there is none.
    [[nodiscard]] bool takeOne(Argument& argument) {
        argument.raw.first = at_;
        argument.raw.last = at_;
        outline_ = nullptr;
        depth_ = 0;
        for (; at_ < list_.end(); ++at_) {
            const TokenKind kind = text_.kind(at_);
            if (depth_ == 0 && (kind == COMMA || kind == RIGHT_PARENTHESIS)) {
                return true;
            }
            if (at_ == argument.raw.first + kShort && text_.outline().isPlain) {
                outline_ = &text_.outline();
            }
            if (outline_ == nullptr && !look(argument)) {
                return false;
            }
            passParenthesis(kind);
            if (kind != WHITESPACE) {
                argument.raw.last = at_ + 1;
            }
        }
        return false;
    }

    // Goes from a "(" to its ")" if that is known, or counts.
    void passParenthesis(TokenKind kind) {
        if (kind == RIGHT_PARENTHESIS) {
            --depth_;
        } else if (kind == LEFT_PARENTHESIS) {
            const std::size_t closing = outline_ == nullptr ? 0 : outline_->closing[at_];
            if (closing > 0 && closing < list_.end()) {
                at_ = closing;
            } else {
                ++depth_;
            }
        }
    }

    // Looks at one token of an argument. Returns false if it is a blank that must be changed.
    [[nodiscard]] bool look(Argument& argument) const {
        if (text_.staysItself(at_)) {
            return true;
        }
        argument.mustBeLexed = true;
        return !isBlankOrNewline(text_.kind(at_));
    }

    const CppTokenScanner& list_;
    const LexedText& text_;
    std::size_t at_;
    // Of the argument that is looked through:
    const TextOutline* outline_ = nullptr;  // once it is asked for, and if it can be trusted
    std::size_t depth_ = 0;                 // of parentheses open in it
};

}  // namespace

bool takeArgumentSlices(CppTokenScanner& list, std::size_t parameterCount,
                        ArgumentList& arguments) {
    if (list.text()->hasEffects()) {
        return false;
    }
    Slicer slicer(list);
    if (!slicer.take(parameterCount, arguments)) {
        return false;
    }
    list.moveTo(slicer.end());
    return true;
}

}  // namespace umpre
