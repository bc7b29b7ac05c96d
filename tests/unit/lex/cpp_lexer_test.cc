// SPDX-License-Identifier: MIT
#include "lex/cpp_lexer.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <optional>
#include <ostream>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "lex/scanner_failure.h"
#include "support/descriptors.h"
#include "support/lexeme.h"
#include "support/recording_comment_sink.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using testing::Lexeme;
using testing::Lexemes;
using testing::RecordingCommentSink;
using enum TokenKind;

// A way for a text to reach the scanner.
struct Road {
    bool plain;
    std::size_t windowSize;  // 0: the text stands in memory, without windows
};

constexpr auto kRoads = std::to_array<Road>({
    {false, 0},
    {true, 0},
    {false, 1},
    {true, 1},
    {false, 2},
    {true, 2},
    {false, 3},
    {true, 3},
    {false, 64 * 1024},
    {true, 64 * 1024},
});

// What scanning a text to its end led to.
struct Scan {
    Lexemes tokens;
    std::string effects;
    std::int32_t lastLine = 0;

    friend bool operator==(const Scan&, const Scan&) = default;

    friend void PrintTo(const Scan& scan, std::ostream* out) {
        *out << ::testing::PrintToString(scan.tokens) << ", effects "
             << ::testing::PrintToString(scan.effects) << ", at line " << scan.lastLine;
    }
};

[[nodiscard]] Scan readToEnd(CppLexer& lexer, const RecordingCommentSink& comments) {
    Scan scan;
    for (Token token = lexer.lex(); token.kind != END_OF_INPUT; token = lexer.lex()) {
        scan.tokens.push_back(testing::lexemeOf(token));
    }
    scan.effects = comments.effects();
    scan.lastLine = lexer.line();
    return scan;
}

[[nodiscard]] Scan scanOn(const Road& road, std::string_view text) {
    RecordingCommentSink comments;
    CppLexer lexer(comments, {road.plain, road.windowSize});
    if (road.windowSize == 0) {
        std::string memory = std::string(text) + std::string(2, '\0');
        lexer.scan(memory.data(), memory.data() + text.size());
        return readToEnd(lexer, comments);
    }
    const testing::MemoryFile file(text);
    InputBuffer input({road.plain, road.windowSize});
    input.openBorrowed(file.descriptor());
    lexer.read(input);
    return readToEnd(lexer, comments);
}

void expectScan(std::string_view text, const Scan& expected) {
    for (const Road& road : kRoads) {
        EXPECT_EQ(scanOn(road, text), expected)
            << ::testing::PrintToString(text) << ", plain road: " << road.plain << ", window "
            << road.windowSize;
    }
}

void expectTokens(std::string_view text, const Lexemes& expected) {
    for (const Road& road : kRoads) {
        EXPECT_EQ(scanOn(road, text).tokens, expected)
            << ::testing::PrintToString(text) << ", plain road: " << road.plain << ", window "
            << road.windowSize;
    }
}

struct OneToken {
    std::string_view text;
    TokenKind kind;
};

void expectOneTokenEach(const std::vector<OneToken>& table) {
    for (const OneToken& row : table) {
        expectTokens(row.text, {{row.kind, std::string(row.text)}});
    }
}

struct Tokens {
    std::string_view text;
    Lexemes tokens;
};

void expectTokensEach(const std::vector<Tokens>& table) {
    for (const Tokens& row : table) {
        expectTokens(row.text, row.tokens);
    }
}

TEST(CppLexer, APunctuatorOfOneCharacterHasItsCode) {
    for (const char byte : "!#%&()*+,-/:<>?^|~"sv) {
        expectTokens({&byte, 1}, {{static_cast<TokenKind>(byte), std::string(1, byte)}});
    }
}

TEST(CppLexer, APunctuatorOfTwoCharactersHasItsKind) {
    expectOneTokenEach({
        {"##", PASTE},
        {"||", OROR},
        {"&&", ANDAND},
        {"==", EQ},
        {"!=", NE},
        {"<=", LE},
        {">=", GE},
        {"<<", LSHIFT},
        {">>", RSHIFT},
    });
}

TEST(CppLexer, EveryDirectiveWordHasItsKind) {
    expectOneTokenEach({
        {"if", KW_IF},
        {"ifdef", KW_IFDEF},
        {"ifndef", KW_IFNDEF},
        {"else", KW_ELSE},
        {"elif", KW_ELIF},
        {"endif", KW_ENDIF},
        {"include", KW_INCLUDE},
        {"define", KW_DEFINE},
        {"undef", KW_UNDEF},
        {"line", KW_LINE},
        {"error", KW_ERROR},
        {"pragma", KW_PRAGMA},
        {"ident", KW_IDENT},
        {"defined", KW_DEFINED},
    });
}

TEST(CppLexer, WordsThatResembleDirectiveWordsAreIdentifiers) {
    expectOneTokenEach({
        {"ifdefx", IDENTIFIER},
        {"IF", IDENTIFIER},
        {"Define", IDENTIFIER},
        {"include_next", IDENTIFIER},
        {"warning", IDENTIFIER},
        {"_if", IDENTIFIER},
        {"if0", IDENTIFIER},
        {"el", IDENTIFIER},
        {"define_", IDENTIFIER},
        {"undefined", IDENTIFIER},
    });
}

TEST(CppLexer, AnIdentifierBeginsWithALetterOrAnUnderscore) {
    expectOneTokenEach({
        {"a", IDENTIFIER},
        {"Z", IDENTIFIER},
        {"_", IDENTIFIER},
        {"_9", IDENTIFIER},
        {"azAZ09_", IDENTIFIER},
        {"a_rather_long_identifier_with_1_digit", IDENTIFIER},
    });
}

TEST(CppLexer, ANumberHasTheKindOfItsBaseAndSuffix) {
    expectOneTokenEach({
        {"1", INT_DEC},       {"9876543210", INT_DEC}, {"10l", INT_DEC},
        {"10L", INT_DEC},     {"0", INT_OCT},          {"0l", INT_OCT},
        {"07L", INT_OCT},     {"01234567", INT_OCT},   {"0x0", INT_HEX},
        {"0XfF", INT_HEX},    {"0x1FL", INT_HEX},      {"0x0123456789abcdefABCDEF", INT_HEX},
        {"1u", UINT_DEC},     {"1U", UINT_DEC},        {"10UL", UINT_DEC},
        {"10lu", UINT_DEC},   {"10Lu", UINT_DEC},      {"10uL", UINT_DEC},
        {"0u", UINT_OCT},     {"07ul", UINT_OCT},      {"07LU", UINT_OCT},
        {"0x1FuL", UINT_HEX}, {"0X1lu", UINT_HEX},     {"0xFu", UINT_HEX},
    });
}

TEST(CppLexer, ANumberEndsWhereItsRuleEnds) {
    expectTokensEach({
        {"123abc", {{INT_DEC, "123"}, {IDENTIFIER, "abc"}}},
        {"08", {{INT_OCT, "0"}, {INT_DEC, "8"}}},
        {"0178", {{INT_OCT, "017"}, {INT_DEC, "8"}}},
        {"0x", {{INT_OCT, "0"}, {IDENTIFIER, "x"}}},
        {"0xg", {{INT_OCT, "0"}, {IDENTIFIER, "xg"}}},
        {"0x1g", {{INT_HEX, "0x1"}, {IDENTIFIER, "g"}}},
        {"10LL", {{INT_DEC, "10L"}, {IDENTIFIER, "L"}}},
        {"10ULL", {{UINT_DEC, "10UL"}, {IDENTIFIER, "L"}}},
        {"10LUL", {{UINT_DEC, "10LU"}, {IDENTIFIER, "L"}}},
        {"1uu", {{UINT_DEC, "1u"}, {IDENTIFIER, "u"}}},
        {"1.5e3", {{INT_DEC, "1"}, {OTHER, "."}, {INT_DEC, "5"}, {IDENTIFIER, "e3"}}},
        {"1if", {{INT_DEC, "1"}, {KW_IF, "if"}}},
        {"00x1", {{INT_OCT, "00"}, {IDENTIFIER, "x1"}}},
    });
}

TEST(CppLexer, EveryOtherCharacterIsAKindOfItsOwn) {
    expectOneTokenEach({
        {"=", OTHER},    {".", OTHER},    {";", OTHER},    {"[", OTHER},    {"]", OTHER},
        {"{", OTHER},    {"}", OTHER},    {"@", OTHER},    {"$", OTHER},    {"`", OTHER},
        {"\\", OTHER},   {"\"", OTHER},   {"'", OTHER},    {"\0"sv, OTHER}, {"\x01", OTHER},
        {"\x7F", OTHER}, {"\x80", OTHER}, {"\xE9", OTHER}, {"\xFF", OTHER},
    });
}

TEST(CppLexer, ABlankIsOneCharacter) {
    expectTokensEach({
        {" ", {{WHITESPACE, " "}}},
        {"\t", {{WHITESPACE, "\t"}}},
        {"\v", {{WHITESPACE, "\v"}}},
        {"\f", {{WHITESPACE, "\f"}}},
        {"  \t", {{WHITESPACE, " "}, {WHITESPACE, " "}, {WHITESPACE, "\t"}}},
    });
}

TEST(CppLexer, TheLongestMatchWins) {
    expectTokensEach({
        {"###", {{PASTE, "##"}, {HASH, "#"}}},
        {"|||", {{OROR, "||"}, {BAR, "|"}}},
        {"&&&", {{ANDAND, "&&"}, {AMPERSAND, "&"}}},
        {"!==", {{NE, "!="}, {OTHER, "="}}},
        {"===", {{EQ, "=="}, {OTHER, "="}}},
        {"<<=", {{LSHIFT, "<<"}, {OTHER, "="}}},
        {">>>", {{RSHIFT, ">>"}, {GREATER, ">"}}},
        {"<=>", {{LE, "<="}, {GREATER, ">"}}},
        {"a+=b", {{IDENTIFIER, "a"}, {PLUS, "+"}, {OTHER, "="}, {IDENTIFIER, "b"}}},
        {"->", {{MINUS, "-"}, {GREATER, ">"}}},
        {"++", {{PLUS, "+"}, {PLUS, "+"}}},
        {"...", {{OTHER, "."}, {OTHER, "."}, {OTHER, "."}}},
        {"definedx", {{IDENTIFIER, "definedx"}}},
    });
}

TEST(CppLexer, ALiteralIsOneTokenWithItsQuotes) {
    expectOneTokenEach({
        {R"("")", STRING_LITERAL},
        {R"("text")", STRING_LITERAL},
        {R"("a 'quoted' word")", STRING_LITERAL},
        {R"("\"")", STRING_LITERAL},
        {R"("\\")", STRING_LITERAL},
        {R"("\q\x\0")", STRING_LITERAL},
        {R"("/* no comment */ // no")", STRING_LITERAL},
        {"\"\r\"", STRING_LITERAL},
        {"\"a\0b\xFF\""sv, STRING_LITERAL},
        {"\"\\\0\""sv, STRING_LITERAL},
        {"'a'", CHAR_LITERAL},
        {"'ab'", CHAR_LITERAL},
        {R"('\'')", CHAR_LITERAL},
        {R"('\\')", CHAR_LITERAL},
        {R"('"')", CHAR_LITERAL},
        {"'a\rb'", CHAR_LITERAL},
        {"'\0'"sv, CHAR_LITERAL},
    });
}

TEST(CppLexer, AQuoteThatNothingClosesIsACharacter) {
    expectTokensEach({
        {"\"ab", {{OTHER, "\""}, {IDENTIFIER, "ab"}}},
        {"'ab", {{OTHER, "'"}, {IDENTIFIER, "ab"}}},
        {"''", {{OTHER, "'"}, {OTHER, "'"}}},
        {"'''", {{OTHER, "'"}, {OTHER, "'"}, {OTHER, "'"}}},
        {"''a'", {{OTHER, "'"}, {CHAR_LITERAL, "'a'"}}},
        {"\"a\n\"", {{OTHER, "\""}, {IDENTIFIER, "a"}, {NEWLINE, "\n"}, {OTHER, "\""}}},
        {R"("\")", {{OTHER, "\""}, {OTHER, "\\"}, {OTHER, "\""}}},
        {R"('\')", {{OTHER, "'"}, {OTHER, "\\"}, {OTHER, "'"}}},
        {R"("'a'\")", {{OTHER, "\""}, {CHAR_LITERAL, "'a'"}, {OTHER, "\\"}, {OTHER, "\""}}},
        {R"('"a"\')", {{OTHER, "'"}, {STRING_LITERAL, "\"a\""}, {OTHER, "\\"}, {OTHER, "'"}}},
    });
}

TEST(CppLexer, ABackslashAtALineEndLeavesTheQuoteBeforeItOpen) {
    expectTokensEach({
        {"\"a\\\nb\"",
         {{OTHER, "\""},
          {IDENTIFIER, "a"},
          {CONTINUATION, "\\\n"},
          {IDENTIFIER, "b"},
          {OTHER, "\""}}},
        {"\"a\\\rb\"",
         {{OTHER, "\""},
          {IDENTIFIER, "a"},
          {CONTINUATION, "\\\r"},
          {IDENTIFIER, "b"},
          {OTHER, "\""}}},
        {"\"a\\", {{OTHER, "\""}, {IDENTIFIER, "a"}, {OTHER, "\\"}}},
    });
}

TEST(CppLexer, ALiteralAfterAnUnclosedQuoteOfTheOtherKindIsFound) {
    expectTokensEach({
        {R"(don't say "no")",
         {{IDENTIFIER, "don"},
          {OTHER, "'"},
          {IDENTIFIER, "t"},
          {WHITESPACE, " "},
          {IDENTIFIER, "say"},
          {WHITESPACE, " "},
          {STRING_LITERAL, "\"no\""}}},
        {"'\n'a'", {{OTHER, "'"}, {NEWLINE, "\n"}, {CHAR_LITERAL, "'a'"}}},
    });
}

TEST(CppLexer, APrefixIsNoPartOfALiteral) {
    expectTokens("L\"a\"", {{IDENTIFIER, "L"}, {STRING_LITERAL, "\"a\""}});
    expectTokens("L'a'", {{IDENTIFIER, "L"}, {CHAR_LITERAL, "'a'"}});
}

TEST(CppLexer, ALineEndOfAnyFormIsOneLineFeed) {
    expectScan("x\ny", {{{IDENTIFIER, "x"}, {NEWLINE, "\n"}, {IDENTIFIER, "y"}}, "", 2});
    expectScan("x\ry", {{{IDENTIFIER, "x"}, {NEWLINE, "\n"}, {IDENTIFIER, "y"}}, "", 2});
    expectScan("x\r\ny", {{{IDENTIFIER, "x"}, {NEWLINE, "\n"}, {IDENTIFIER, "y"}}, "", 2});
    expectScan("\n\r\r\n", {{{NEWLINE, "\n"}, {NEWLINE, "\n"}, {NEWLINE, "\n"}}, "", 4});
}

TEST(CppLexer, AContinuationKeepsItsTextAndCountsALine) {
    expectScan("a\\\nb", {{{IDENTIFIER, "a"}, {CONTINUATION, "\\\n"}, {IDENTIFIER, "b"}}, "", 2});
    expectScan("\\\r\n", {{{CONTINUATION, "\\\r\n"}}, "", 2});
    expectScan("\\\rx", {{{CONTINUATION, "\\\r"}, {IDENTIFIER, "x"}}, "", 2});
    expectScan("\\\\\n", {{{OTHER, "\\"}, {CONTINUATION, "\\\n"}}, "", 2});
}

TEST(CppLexer, ABlankBehindABackslashMakesItNoContinuation) {
    expectScan("\\ \n", {{{OTHER, "\\"}, {WHITESPACE, " "}, {NEWLINE, "\n"}}, "", 2});
}

TEST(CppLexer, AContinuationSplitsWhatItStandsIn) {
    expectTokensEach({
        {"1\\\n2", {{INT_DEC, "1"}, {CONTINUATION, "\\\n"}, {INT_DEC, "2"}}},
        {"/\\\n* x",
         {{SLASH, "/"}, {CONTINUATION, "\\\n"}, {STAR, "*"}, {WHITESPACE, " "}, {IDENTIFIER, "x"}}},
        {"|\\\n|", {{BAR, "|"}, {CONTINUATION, "\\\n"}, {BAR, "|"}}},
    });
}

TEST(CppLexer, ABlockCommentIsOneBlank) {
    expectTokensEach({
        {"/**/", {{WHITESPACE, " "}}},
        {"/***/", {{WHITESPACE, " "}}},
        {"/* a */b", {{WHITESPACE, " "}, {IDENTIFIER, "b"}}},
        {"a/*/*/b", {{IDENTIFIER, "a"}, {WHITESPACE, " "}, {IDENTIFIER, "b"}}},
        {"/* ** / **/x", {{WHITESPACE, " "}, {IDENTIFIER, "x"}}},
        {"/* // */x", {{WHITESPACE, " "}, {IDENTIFIER, "x"}}},
        {"/* \" */\"a\"", {{WHITESPACE, " "}, {STRING_LITERAL, "\"a\""}}},
        {"/*\0*/x"sv, {{WHITESPACE, " "}, {IDENTIFIER, "x"}}},
        {"/* a *//* b */", {{WHITESPACE, " "}, {WHITESPACE, " "}}},
    });
}

TEST(CppLexer, TheLineEndsOfABlockCommentAreToldAndCounted) {
    expectScan("/*1\n2\n3*/x", {{{WHITESPACE, " "}, {IDENTIFIER, "x"}}, "\n\n", 3});
    expectScan("/*1\r2\r3*/", {{{WHITESPACE, " "}}, "\n\n", 3});
    expectScan("/*1\r\n2\r\n3*/", {{{WHITESPACE, " "}}, "\n\n", 3});
    expectScan("/*\n\r*/", {{{WHITESPACE, " "}}, "\n\n", 3});
    expectScan("/**\n*\n/*/", {{{WHITESPACE, " "}}, "\n\n", 3});
    expectScan("/* \\\n */", {{{WHITESPACE, " "}}, "\n", 2});
    expectScan("/* none */", {{{WHITESPACE, " "}}, "", 1});
}

TEST(CppLexer, AnUnclosedBlockCommentIsToldWithItsLastLine) {
    expectScan("/*", {{{WHITESPACE, " "}}, "[1]", 1});
    expectScan("a\n/* x", {{{IDENTIFIER, "a"}, {NEWLINE, "\n"}, {WHITESPACE, " "}}, "[2]", 2});
    expectScan("/*\n\n*", {{{WHITESPACE, " "}}, "\n\n[3]", 3});
    expectScan("/*\r", {{{WHITESPACE, " "}}, "\n[2]", 2});
    expectScan("/* *\n/", {{{WHITESPACE, " "}}, "\n[2]", 2});
    expectScan("/*/", {{{WHITESPACE, " "}}, "[1]", 1});
}

TEST(CppLexer, ALineCommentEndsBeforeTheLineEnd) {
    expectScan("// x\ny", {{{WHITESPACE, " "}, {NEWLINE, "\n"}, {IDENTIFIER, "y"}}, "", 2});
    expectScan("// x\ry", {{{WHITESPACE, " "}, {NEWLINE, "\n"}, {IDENTIFIER, "y"}}, "", 2});
    expectScan("// x\r\ny", {{{WHITESPACE, " "}, {NEWLINE, "\n"}, {IDENTIFIER, "y"}}, "", 2});
    expectScan("//\n", {{{WHITESPACE, " "}, {NEWLINE, "\n"}}, "", 2});
    expectScan("// /* x\ny", {{{WHITESPACE, " "}, {NEWLINE, "\n"}, {IDENTIFIER, "y"}}, "", 2});
}

TEST(CppLexer, ABackslashDoesNotContinueALineComment) {
    expectTokens("// x \\\ny", {{WHITESPACE, " "}, {NEWLINE, "\n"}, {IDENTIFIER, "y"}});
}

TEST(CppLexer, NothingFollowsALineCommentThatEndsTheInput) {
    expectScan("// x", {{{WHITESPACE, " "}}, "", 1});
    expectScan("//", {{{WHITESPACE, " "}}, "", 1});
}

TEST(CppLexer, ACarriageReturnThatEndsALineCommentAndTheInputIsNoLineEnd) {
    expectScan("// x\r", {{{WHITESPACE, " "}}, "", 1});
    expectScan("//\r", {{{WHITESPACE, " "}}, "", 1});
}

TEST(CppLexer, AnEmptyTextHasNoTokens) {
    expectScan("", {{}, "", 1});
}

TEST(CppLexer, LongTokensAreWhole) {
    const std::string name(40'000, 'n');
    const std::string number(40'000, '7');
    const std::string literal = "\"" + std::string(40'000, 's') + "\"";
    const std::string text = name + " " + number + "\n" + literal;
    expectTokens(text, {{IDENTIFIER, name},
                        {WHITESPACE, " "},
                        {INT_DEC, number},
                        {NEWLINE, "\n"},
                        {STRING_LITERAL, literal}});
}

TEST(CppLexer, ManyUnclosedQuotesOnALongLineAreReadInOnePass) {
    std::string text;
    Lexemes expected;
    for (int count = 0; count < 20'000; ++count) {
        text += R"(\")";
        expected.push_back({OTHER, "\\"});
        expected.push_back({OTHER, "\""});
    }
    EXPECT_EQ(scanOn({false, 0}, "\"" + text + "\n").tokens.size(), expected.size() + 2);
    expected.insert(expected.begin(), {OTHER, "\""});
    expected.push_back({NEWLINE, "\n"});
    EXPECT_EQ(scanOn({false, 0}, "\"" + text + "\n").tokens, expected);
}

// The tests below use one scanner step by step.
struct CppLexerSteps : ::testing::Test {
    void read(std::string_view text, std::size_t windowSize) {
        input.emplace(RunOptions{.windowSize = windowSize});
        input->openText(text);
        lexer.read(*input);
    }

    RecordingCommentSink comments;
    std::optional<InputBuffer> input;
    CppLexer lexer{comments};
};

TEST_F(CppLexerSteps, TheEndStaysTheEnd) {
    read("a", 8);
    EXPECT_EQ(lexer.lex().kind, IDENTIFIER);
    for (int count = 0; count < 3; ++count) {
        const Token token = lexer.lex();
        EXPECT_EQ(token.kind, END_OF_INPUT);
        EXPECT_EQ(token.text, "");
    }
}

TEST_F(CppLexerSteps, TheLineIsThatOfTheNextToken) {
    read("a\n/*\n*/b", 8);
    EXPECT_EQ(lexer.line(), 1);
    (void)lexer.lex();
    EXPECT_EQ(lexer.line(), 1);
    EXPECT_EQ(lexer.lex().kind, NEWLINE);
    EXPECT_EQ(lexer.line(), 2);
    EXPECT_EQ(lexer.lex().kind, WHITESPACE);
    EXPECT_EQ(lexer.line(), 3);
}

TEST_F(CppLexerSteps, TheLineCanBeSet) {
    read("a\nb", 8);
    lexer.setLine(100);
    (void)lexer.lex();
    (void)lexer.lex();
    EXPECT_EQ(lexer.line(), 101);
}

TEST_F(CppLexerSteps, TheLineCounterWrapsAround) {
    read("\n\\\n/*\n*/", 8);
    lexer.setLine(std::numeric_limits<std::int32_t>::max());
    (void)lexer.lex();
    EXPECT_EQ(lexer.line(), std::numeric_limits<std::int32_t>::min());
    (void)lexer.lex();
    (void)lexer.lex();
    EXPECT_EQ(lexer.line(), std::numeric_limits<std::int32_t>::min() + 2);
}

TEST_F(CppLexerSteps, EachInputIsReadFromLineOne) {
    read("a\nb\n", 8);
    (void)lexer.lex();
    (void)lexer.lex();
    read("c", 8);
    EXPECT_EQ(lexer.line(), 1);
    EXPECT_EQ(lexer.lex().text, "c");
    std::string memory("d\0\0", 3);
    lexer.scan(memory.data(), memory.data() + 1);
    EXPECT_EQ(lexer.line(), 1);
    EXPECT_EQ(lexer.lex().text, "d");
    EXPECT_EQ(lexer.lex().kind, END_OF_INPUT);
}

TEST_F(CppLexerSteps, AnOpenCommentOfOneInputDoesNotReachTheNext) {
    read("/* a", 8);
    (void)lexer.lex();
    read("b", 8);
    EXPECT_EQ(lexer.lex().text, "b");
}

TEST_F(CppLexerSteps, ATextInMemoryIsLeftAsItWas) {
    std::string memory("#define A \"b\" /* c */\n\0\0", 24);
    const std::string before = memory;
    lexer.scan(memory.data(), memory.data() + memory.size() - 2);
    while (lexer.lex().kind != END_OF_INPUT) {
        EXPECT_EQ(memory, before);
    }
}

TEST_F(CppLexerSteps, WholeLinesLieAheadBetweenTokens) {
    read("a b\nc\n", 64);
    EXPECT_EQ(lexer.lex().text, "a");
    EXPECT_EQ(lexer.wholeLines(), " b\nc\n");
    EXPECT_EQ(lexer.lex().kind, WHITESPACE);
}

TEST_F(CppLexerSteps, NoLinesLieAheadAtTheEnd) {
    read("a", 64);
    EXPECT_EQ(lexer.wholeLines(), "a");
    (void)lexer.lex();
    EXPECT_EQ(lexer.wholeLines(), "");
    EXPECT_EQ(lexer.lex().kind, END_OF_INPUT);
}

TEST_F(CppLexerSteps, BytesThatAreAdvancedOverAreNotScanned) {
    read("one\ntwo \"three\"\n", 64);
    (void)lexer.wholeLines();
    lexer.advance(8, 1);
    EXPECT_EQ(lexer.line(), 2);
    EXPECT_EQ(lexer.lex().text, "\"three\"");
    EXPECT_EQ(lexer.wholeLines(), "\n");
}

TEST_F(CppLexerSteps, LinesAndTokensMayTakeTurnsThroughAllWindows) {
    const testing::Pipe pipe("a 1\nbb 22\nccc 333\n");
    input.emplace(RunOptions{.windowSize = 8});
    input->openBorrowed(pipe.readEnd());
    lexer.read(*input);
    std::string names;
    for (std::string_view ahead = lexer.wholeLines(); !ahead.empty(); ahead = lexer.wholeLines()) {
        names += lexer.lex().text;
        ahead = lexer.wholeLines();
        lexer.advance(ahead.find('\n') + 1, 1);
    }
    EXPECT_EQ(names, "abbccc");
    EXPECT_EQ(lexer.line(), 4);
}

TEST_F(CppLexerSteps, ALineThatIsLongerThanTheWindowLiesAheadInParts) {
    const testing::Pipe pipe("aaa bbb ccc ddd\n");
    input.emplace(RunOptions{.windowSize = 6});
    input->openBorrowed(pipe.readEnd());
    lexer.read(*input);
    EXPECT_EQ(lexer.wholeLines(), "");
    std::string text;
    for (std::string_view ahead = lexer.bytesAhead(); !ahead.empty(); ahead = lexer.bytesAhead()) {
        EXPECT_TRUE(ahead.ends_with('\n') || lexer.wholeLines().empty());
        text += ahead;
        lexer.advance(ahead.size(), ahead.ends_with('\n') ? 1 : 0);
    }
    EXPECT_EQ(text, "aaa bbb ccc ddd\n");
}

TEST_F(CppLexerSteps, ALiteralMayReachAcrossTheBytesAhead) {
    const testing::Pipe pipe("a \"b c d e f g\" h");
    input.emplace(RunOptions{.windowSize = 4});
    input->openBorrowed(pipe.readEnd());
    lexer.read(*input);
    EXPECT_EQ(lexer.lex().text, "a");
    EXPECT_EQ(lexer.lex().text, " ");
    EXPECT_EQ(lexer.lex().text, "\"b c d e f g\"");
    EXPECT_EQ(lexer.lex().text, " ");
    EXPECT_EQ(lexer.bytesAhead(), "h");
}

TEST_F(CppLexerSteps, ALineCommentMayReachAcrossTheBytesAhead) {
    const testing::Pipe pipe("// b c d e f g\r\nh");
    input.emplace(RunOptions{.windowSize = 4});
    input->openBorrowed(pipe.readEnd());
    lexer.read(*input);
    EXPECT_EQ(lexer.lex().text, " ");
    EXPECT_EQ(lexer.lex().kind, NEWLINE);
    EXPECT_EQ(lexer.lex().text, "h");
}

TEST_F(CppLexerSteps, AnInputThatCannotBeReadThrows) {
    input.emplace(RunOptions{.windowSize = 8});
    input->openBorrowed(-1);
    lexer.read(*input);
    EXPECT_THROW((void)lexer.lex(), ScannerFailure);
}

}  // namespace
}  // namespace umpre
