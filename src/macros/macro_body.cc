// SPDX-License-Identifier: MIT
//
// A body is read once, token by token. An operand, that is a token, a parameter or "#" with its
// parameter, is held back until the next token shows whether a "##" follows: then its text is
// joined with the next operand's, otherwise it stands alone. For F(x, y) with the body "[x] y ## _
// # x":
//
//     Tokens "["   Argument x   Tokens "] "   Joined {y, "_"}   Tokens " "   Joined {"x"}
//
// where the last one is the string literal of x.
#include "macros/macro_body.h"

#include <algorithm>
#include <array>
#include <optional>
#include <string_view>
#include <unordered_map>
#include <utility>

namespace umpre {
namespace {

using enum TokenKind;

// Of most bodies the steps and the operands.
constexpr std::size_t kUsualSteps = 8;

// The bytes of a definition whose body is kept beyond it.
constexpr std::size_t kMostKept = 512;

// The names of a macro's parameters. Of two with one name, the last counts.
class ParameterNames {
public:
    explicit ParameterNames(const Macro& macro) {
        std::string_view names = macro.parameters();
        const std::size_t count = macro.parameterCount();
        for (std::size_t index = 0; index < count; ++index) {
            const std::size_t size = std::min(names.find(','), names.size());
            add(names.substr(0, size), index);
            names.remove_prefix(std::min(size + 1, names.size()));
        }
    }

    // Returns the number of the parameter of this name.
    [[nodiscard]] std::optional<std::size_t> find(std::string_view name) const {
        if (const auto it = others_.find(name); it != others_.end()) {
            return it->second;
        }
        for (std::size_t index = fewSize_; index > 0; --index) {
            if (few_[index - 1] == name) {
                return index - 1;
            }
        }
        return std::nullopt;
    }

private:
    void add(std::string_view name, std::size_t index) {
        if (index < few_.size()) {
            few_[index] = name;
            fewSize_ = index + 1;
        } else {
            others_[name] = index;
        }
    }

    // A few names are found soonest by looking at each.
    std::array<std::string_view, 8> few_;
    std::size_t fewSize_ = 0;
    std::unordered_map<std::string_view, std::size_t> others_;
};

class BodyBuilder {
public:
    BodyBuilder(const Macro& macro, const LexedText& text, MacroBody& body)
        : text_(text), body_(body), tokens_(body.tokens.edit()), parameters_(macro) {
        body.steps.reserve(kUsualSteps);
        body.operands.reserve(kUsualSteps);
    }

    void build() {
        while (at_ < text_.size() && !failed_) {
            readToken();
        }
        if (failed_) {
            return;
        }
        if (pasting_) {
            fail(BodyStep::Kind::PasteLast);
        } else {
            writeHeld();
        }
    }

private:
    // The last operand read. Alone, its only operand may be a parameter to be expanded.
    struct Held {
        std::size_t firstOperand;
        bool isJoined;  // by "##", or a string literal
    };

    void readToken() {
        noteEffects();
        const TokenKind kind = text_.kind(at_);
        if (isBlankOrNewline(kind)) {
            blank_ = true;
            ++at_;
        } else if (kind == PASTE) {
            readPaste();
        } else {
            readOperand(kind);
        }
    }

    void readPaste() {
        if (isFirst_) {
            fail(BodyStep::Kind::PasteFirst);
            return;
        }
        pasting_ = true;
        blank_ = false;
        ++at_;
    }

    void readOperand(TokenKind kind) {
        if (!pasting_) {
            writeHeld();
            if (blank_ && !isFirst_) {
                tokens_.append(WHITESPACE, " ");
                writeLastToken();
            }
        }
        const std::size_t firstOperand = body_.operands.size();
        const std::optional<BodyOperand> operand = operandAt(kind);
        if (!operand) {
            fail(BodyStep::Kind::Misplaced);
            return;
        }
        body_.operands.push_back(*operand);
        if (pasting_) {
            held_->isJoined = true;
        } else {
            held_ = {firstOperand, operand->kind == BodyOperand::Kind::Stringized};
        }
        pasting_ = false;
        isFirst_ = false;
        blank_ = false;
        ++at_;
    }

    // Leaves `at_` on the operand's last token. Returns nothing for a "#" without a parameter.
    std::optional<BodyOperand> operandAt(TokenKind kind) {
        if (kind == HASH) {
            do {
                ++at_;
                if (at_ == text_.size()) {
                    return std::nullopt;
                }
                noteEffects();
            } while (isBlankOrNewline(text_.kind(at_)));
            const std::optional<std::size_t> parameter = parameterAt(at_);
            if (!parameter) {
                return std::nullopt;
            }
            return BodyOperand{BodyOperand::Kind::Stringized, *parameter};
        }
        if (const std::optional<std::size_t> parameter = parameterAt(at_)) {
            return BodyOperand{BodyOperand::Kind::RawArgument, *parameter};
        }
        tokens_.append(kind, text_.text(at_), text_.name(at_));
        return BodyOperand{BodyOperand::Kind::Token, tokens_.size() - 1};
    }

    [[nodiscard]] std::optional<std::size_t> parameterAt(std::size_t index) const {
        return isName(text_.kind(index)) ? parameters_.find(text_.text(index)) : std::nullopt;
    }

    void writeHeld() {
        if (!held_) {
            return;
        }
        if (held_->isJoined) {
            body_.steps.push_back(
                {BodyStep::Kind::Joined, held_->firstOperand, body_.operands.size()});
        } else {
            writeAlone(body_.operands.back());
            body_.operands.pop_back();
        }
        held_.reset();
    }

    // Puts an operand that is not joined into the replacement.
    void writeAlone(const BodyOperand& operand) {
        if (operand.kind == BodyOperand::Kind::Token) {
            writeLastToken();
        } else {
            body_.steps.push_back({BodyStep::Kind::Argument, operand.index, 0});
        }
    }

    // Puts the token last added to the body's own into the replacement.
    void writeLastToken() {
        const std::size_t last = tokens_.size();
        if (!body_.steps.empty() && body_.steps.back().kind == BodyStep::Kind::Tokens
            && body_.steps.back().last == last - 1) {
            body_.steps.back().last = last;
        } else {
            body_.steps.push_back({BodyStep::Kind::Tokens, last - 1, last});
        }
    }

    // The effects of a comment happen where the comment is read, not where its blank is written.
    void noteEffects() {
        if (text_.hasEffects() && effectsNoted_ <= at_) {
            body_.steps.push_back({BodyStep::Kind::Effects, at_, 0});
            effectsNoted_ = at_ + 1;
        }
    }

    void fail(BodyStep::Kind kind) {
        body_.steps.push_back({kind, 0, 0});
        failed_ = true;
    }

    const LexedText& text_;
    MacroBody& body_;
    LexedText& tokens_;
    ParameterNames parameters_;
    std::size_t at_ = 0;
    std::size_t effectsNoted_ = 0;
    std::optional<Held> held_;
    bool pasting_ = false;  // a "##" waits for its right operand; the left one is held
    bool blank_ = false;    // blanks were read since the last token
    bool isFirst_ = true;
    bool failed_ = false;
};

void noteTexts(MacroBody& body) {
    const LexedText& tokens = *body.tokens;
    for (BodyStep& step : body.steps) {
        if (step.kind == BodyStep::Kind::Tokens) {
            step.firstName = body.names.size();
            for (std::size_t index = step.first; index < step.last; ++index) {
                if (isName(tokens.kind(index))) {
                    body.names.push_back(tokens.name(index));
                }
            }
            step.lastName = body.names.size();
            step.text = tokens.joined(step.first, step.last);
        }
    }
}

// Tells whether a text as lexed has nothing but text to it, so that lexing parts of it yields its
// tokens.
[[nodiscard]] bool isPlainText(const LexedText& text) {
    bool isPlain = !text.hasEffects();
    for (std::size_t index = 0; index < text.size() && isPlain; ++index) {
        isPlain = text.isClean(index);
    }
    return isPlain;
}

}  // namespace

SharedText BodyMaker::tokensOf(const Macro& macro) {
    if (macro.use() != nullptr && macro.use()->tokens) {
        return macro.use()->tokens;
    }
    if (!macro.wasUsed()) {
        macro.noteUse();
        SharedText tokens = lexer_.lexed(macro.text());
        macros_.setNames(tokens.edit());
        return tokens;
    }
    SharedText& tokens = macros_.useOf(macro).tokens;
    tokens = SharedText::alone();
    lexer_.append(tokens.edit(), macro.text());
    macros_.enterNames(tokens.edit());
    return tokens;
}

std::shared_ptr<const MacroBody> BodyMaker::newBody(const Macro& macro) {
    auto body = std::make_shared<MacroBody>();
    body->tokens = SharedText::alone();
    const SharedText source = lexer_.lexed(macro.text());
    macros_.enterNames(source.edit());
    body->tokens.edit().reserve(source->size(), source->joined().size());
    BodyBuilder(macro, *source, *body).build();
    body->isPlain = !tellsMacros_ && isPlainText(*source);
    noteTexts(*body);
    if (source->hasEffects()) {
        body->source = source;
    }
    return body;
}

std::shared_ptr<const MacroBody> BodyMaker::keptBody(const Macro& macro) {
    if (macro.text().size() + macro.parameters().size() > kMostKept) {
        return newBody(macro);
    }
    KeptBody& kept = kept_[hashOfName(macro.text()) % kept_.size()];
    if (kept.body == nullptr || kept.text != macro.text()
        || kept.parameters != macro.parameters()) {
        kept = {std::string(macro.parameters()), std::string(macro.text()), newBody(macro)};
    }
    return kept.body;
}

}  // namespace umpre
