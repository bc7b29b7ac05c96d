// SPDX-License-Identifier: MIT
//
// The scanner, over windows of a file and over a text, against the rules followed one by one.
#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "check.h"
#include "lex/cpp_lexer.h"
#include "lex/input_buffer.h"
#include "support/descriptors.h"
#include "token_rules.h"

namespace umpre::fuzz {
namespace {

// Tokens as text, a line each: what reading them did, their kind, where the next line begins, and
// their own text. A zero byte ends the tokens.
class Record final : public CommentSink {
public:
    bool commentLineEnds(std::size_t count) override {
        text_.append(count, '\n');
        return true;
    }

    void unterminatedComment(std::int32_t line) override {
        text_.append("open on ").append(std::to_string(line)).append(", ");
    }

    void token(TokenKind kind, std::int32_t nextLine, std::string_view text) {
        text_.append(std::to_string(static_cast<int>(kind)))
            .append(" before ")
            .append(std::to_string(nextLine))
            .append(": ")
            .append(text)
            .append("\n");
    }

    [[nodiscard]] const std::string& text() const noexcept { return text_; }

private:
    std::string text_;
};

[[nodiscard]] std::string ruled(std::string_view text) {
    Record record;
    std::int32_t line = 1;
    for (const RuledToken& token : allTokens(text)) {
        line += static_cast<std::int32_t>(token.lineEnds);
        if (token.isComment) {
            (void)record.commentLineEnds(token.lineEnds);
        }
        if (token.isUnterminated) {
            record.unterminatedComment(line);
        }
        record.token(token.kind, line, token.text);
    }
    return record.text();
}

void readAll(CppLexer& lexer, Record& record) {
    for (Token token = lexer.lex(); token.kind != TokenKind::END_OF_INPUT; token = lexer.lex()) {
        record.token(token.kind, lexer.line(), token.text);
    }
}

[[nodiscard]] std::string readInWindows(std::string_view text, const RunOptions& options) {
    const testing::MemoryFile file(text);
    InputBuffer input(options);
    input.openBorrowed(file.descriptor());
    Record record;
    CppLexer lexer(record, options);
    lexer.read(input);
    readAll(lexer, record);
    return record.text();
}

[[nodiscard]] std::string scanned(std::string_view text, const RunOptions& options) {
    std::vector<char> memory(text.begin(), text.end());
    memory.insert(memory.end(), 2, '\0');
    Record record;
    CppLexer lexer(record, options);
    lexer.scan(memory.data(), memory.data() + text.size());
    readAll(lexer, record);
    return record.text();
}

void expectRulesFollowed(std::string_view text, std::size_t windowSize) {
    const std::string expected = ruled(text);
    for (const bool plainRoad : {false, true}) {
        const RunOptions options{.plainRoad = plainRoad, .windowSize = windowSize};
        expectSame("a file, in windows", readInWindows(text, options), expected);
        expectSame("a text", scanned(text, options), expected);
    }
}

}  // namespace
}  // namespace umpre::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static constexpr auto kWindowSizes = std::to_array<std::size_t>({1, 2, 3, 7, 16, 64, 65536});
    if (size > 0) {
        umpre::fuzz::expectRulesFollowed({reinterpret_cast<const char*>(data) + 1, size - 1},
                                         kWindowSizes[data[0] % kWindowSizes.size()]);
    }
    return 0;
}
