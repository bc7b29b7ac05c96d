// SPDX-License-Identifier: MIT
//
// A run may copy and skip text as bytes or read all of it as tokens, and it may hold much or little
// of its input at a time. Whichever road it takes, the same must come out, and the same be told.
#include <array>
#include <cstddef>
#include <cstdint>
#include <ostream>
#include <random>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "driver/preprocessor.h"
#include "support/event_list.h"
#include "support/recording_sink.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

using std::string_literals::operator""s;

constexpr auto kWindowSizes = std::to_array<std::size_t>({1, 2, 3, 7, 64, 64 * 1024});

constexpr std::string_view kMacros =
    "#define N 3\n"
    "#define EMPTY\n"
    "#define F(x) [x]\n"
    "#define G() g\n"
    "#define S(x) #x\n"
    "#define J(a, b) a##b\n"
    "#define H(a, b) a + b\n";

// What a run gives.
struct Outcome {
    std::string output;
    std::string errors;
    RunResult result;

    friend bool operator==(const Outcome&, const Outcome&) = default;

    friend void PrintTo(const Outcome& outcome, std::ostream* out) {
        *out << "output " << ::testing::PrintToString(outcome.output) << ", errors "
             << ::testing::PrintToString(outcome.errors) << ", result "
             << static_cast<int>(outcome.result);
    }
};

struct Run {
    explicit Run(const RunOptions& options) : preprocessor(linesTo(errors), options) {
        preprocessor.setOutput(output);
    }

    [[nodiscard]] Outcome outcome() {
        const RunResult result = preprocessor.run();
        return {output.bytes(), errors.bytes(), result};
    }

    testing::RecordingSink output;
    testing::RecordingSink errors;
    Preprocessor preprocessor;
};

// The plain road with all of the text at hand is the one that the others are held against.
[[nodiscard]] Outcome plainOutcome(std::string_view text) {
    Run run({.plainRoad = true});
    run.preprocessor.openText("main", text);
    return run.outcome();
}

[[nodiscard]] Outcome fileOutcome(const std::string& fileName, const RunOptions& options) {
    Run run(options);
    if (!run.preprocessor.openSource(fileName, "main")) {
        return {"", "not opened", RunResult::Errors};
    }
    return run.outcome();
}

[[nodiscard]] Outcome textOutcome(std::string_view text, const RunOptions& options) {
    Run run(options);
    run.preprocessor.openText("main", text);
    return run.outcome();
}

// What a run gives, and what it tells an observer.
using ObservedOutcome = std::pair<Outcome, std::string>;

[[nodiscard]] ObservedOutcome observedOutcome(std::string_view text, const RunOptions& options) {
    testing::EventList events;
    Run run(options);
    run.preprocessor.setObserver(events.observer());
    run.preprocessor.openText("main", text);
    const Outcome outcome = run.outcome();
    return {outcome, events.text()};
}

void expectSameEvents(std::string_view text, const Outcome& expected) {
    for (const bool tellsMacros : {true, false}) {
        const ObservedOutcome plain =
            observedOutcome(text, {.plainRoad = true, .tellsMacros = tellsMacros});
        EXPECT_EQ(plain.first, expected) << ::testing::PrintToString(text) << ", observed";
        for (const std::size_t windowSize : {kWindowSizes.front(), kWindowSizes.back()}) {
            const ObservedOutcome observed =
                observedOutcome(text, {.windowSize = windowSize,
                                       .settlingTime = RunOptions::kAlwaysSettled,
                                       .tellsMacros = tellsMacros});
            EXPECT_EQ(observed, plain) << ::testing::PrintToString(text) << ", macros told "
                                       << tellsMacros << ", window " << windowSize;
        }
    }
}

void expectSameOnAllRoads(std::string_view text) {
    const testing::TemporaryDirectory directory;
    const std::string fileName = directory.write("main", text);
    const Outcome expected = plainOutcome(text);
    expectSameEvents(text, expected);
    for (const bool plainRoad : {true, false}) {
        for (const std::size_t windowSize : kWindowSizes) {
            RunOptions options{plainRoad, windowSize, RunOptions::kAlwaysSettled};
            options.manyMacros = 0;
            EXPECT_EQ(fileOutcome(fileName, options), expected)
                << ::testing::PrintToString(text) << ", plain road " << plainRoad << ", window "
                << windowSize;
            options.manyMacros = RunOptions{}.manyMacros;
            EXPECT_EQ(textOutcome(text, options), expected)
                << ::testing::PrintToString(text) << " as a text, plain road " << plainRoad
                << ", window " << windowSize;
        }
    }
}

// Each text as it is, after the macros, in a branch that is skipped, and without its last byte.
void expectSameOnAllRoads(const std::vector<std::string>& texts) {
    for (const std::string& text : texts) {
        const std::string defined = std::string(kMacros).append(text);
        expectSameOnAllRoads(text);
        expectSameOnAllRoads(defined);
        expectSameOnAllRoads(std::string("#if 0\n").append(text).append("\n#else\nN\n#endif\nend"));
        expectSameOnAllRoads(std::string_view(defined).substr(0, defined.size() - 1));
    }
}

// A file that is included again and again, with the macro G defined and not, from files and from
// another included file.
void expectSameOnAllRoadsIncludedAgain(std::string_view text) {
    const testing::TemporaryDirectory directory;
    const std::string include = "#include \"" + directory.write("a.h", text) + "\"\n";
    const std::string outer = "#include \"" + directory.write("b.h", include + include) + "\"\n";
    const std::string twice = include + include;
    expectSameOnAllRoads(std::string(kMacros)
                             .append(twice)
                             .append("N __LINE__\n")
                             .append(twice + outer + "G\n")
                             .append("#undef G\n#define U\n")
                             .append(twice + twice + "#undef U\n" + outer)
                             .append("#define G\n#undef EMPTY\n" + outer + twice)
                             .append("#if 0\n" + include + "#endif\n  " + include + "N"));
}

TEST(Roads, WriteWhatIsExpected) {
    const Outcome outcome = textOutcome("#define N 3\nN \"N\" /* N */ n\n", {});
    EXPECT_EQ(outcome.output, "#line 1 \"main\"\n#line 2 \"main\"\n3 \"N\"   n\n");
    EXPECT_EQ(outcome.errors, "");
    EXPECT_EQ(outcome.result, RunResult::Clean);
    expectSameOnAllRoads("#define N 3\nN \"N\" /* N */ n\n");
}

TEST(Roads, AgreeOnNothing) {
    expectSameOnAllRoads("");
    expectSameOnAllRoads("\n");
    expectSameOnAllRoads(" ");
    expectSameOnAllRoads("\n\n\n \n\t\nx");
}

TEST(Roads, AgreeOnQuotes) {
    expectSameOnAllRoads({
        "a \"N\" 'N' N\n",
        "a \" N\nN\n",
        "a ' N\nN\n",
        "it's N\nit's N isn't N\n",
        "\"N 'N\" N' N\n",
        "'N \"N' N\" N\n",
        "\"\" '' N\n",
        "\"N\\\"N\\\"\" N\n",
        "\"N\\\\\" N \"\\\\\\\" N\n N\" N\n",
        "\\\" N \\\"N\\\" N\n",
        "\\\"\\\"\\\"N\\\\\"N\"\n",
        "'\\'' N '\\\\' N '\\\n",
        "\"N /* N\" N */ N\n",
        "\"N // N\" N\n",
        "L\"N\" u8\"N\" N\"N\" N'N'\n",
        "\"N\\\nN\" N\n",
        "'N\\\nN' N\n",
        "\"N\n\"N\n\"N\"N\n",
        "\"N",
        "N\"",
        "\"\\",
    });
}

TEST(Roads, AgreeOnCarriageReturns) {
    expectSameOnAllRoads({
        "N\r\nN\r\n",
        "N\rN\rN",
        "\"a\rN\" N\n",
        "\"a\r\nN\" N\r\n",
        "'\r' N\n",
        "\r\r\n\n\rN",
        "a \\\r\nN\r\n",
        "a \\\rN\n",
        "/* a\r\nb\rc */ N\r\n",
        "// a\rN\n",
        "// a\r\nN\r\n",
        "#define M 1\r\nM\r\n#undef M\r\nM\r\n",
        "\r#define M 1\r\nM\r\n",
        "#if 1\r\nN\r\n#else\r\n\"N\r\n#endif\r\n",
    });
}

TEST(Roads, AgreeOnContinuations) {
    expectSameOnAllRoads({
        "a \\\nN\\\n\\\n N\nN\n",
        "\\\nN\n",
        "\\\n#define M 1\nM\n",
        "#def\\\nine M 1\nM\n",
        "#define M 1 \\\n + \\\n2\nM\n",
        "#\\\nN\n",
        "a \\ \nN\n",
        "a \\N\\\\\n\\\\\\\nN\n",
        "// a \\\nN\nN\n",
        "N\\\nN N\\",
        "/\\\n* N */\n",
    });
}

TEST(Roads, AgreeOnComments) {
    expectSameOnAllRoads({
        "a /* N */ N/**/N /***/ N /*/ N */\n",
        "/* one\ntwo\n three */ N\nN\n",
        "N /* one\n\n\n*/\n/* N */ #define M 1\nM\n",
        "/* one\n*/ #define M 1\nM\n",
        "#define M /* one\ntwo */ 1\nM N\n",
        "N // N /* N\nN /* // */ N\n",
        "N /* \" */ N /* ' */ N\n",
        "// \" '\nN\n",
        "N /* no end\nN\n",
        "N\n#define M /* no end\nN\n",
        "N /* **** * / \n ***/ N // **\n//\n/\nN / N\n",
        "/*\n*/\n/*\n*/N/*\n*/N\n",
        "/* no end *",
        "N /",
        "N /*",
        "N //",
    });
}

TEST(Roads, AgreeOnStrangeBytes) {
    expectSameOnAllRoads({
        "N\0N\0\nN\0"s,
        "\0#define M 1\nM\n\0\0N"s,
        "\"a\0N\" N '\0' N\n"s,
        "/* \0 */ N // \0 N\nN\n"s,
        "N \xE9N \xFF\xFEN\nN\xE9\n",
        "\xE9 \"\xE9\" '\xE9' /* \xE9 */ N // \xE9\n",
        "N\v\f\tN \v#define M 1\nM\n\f\n\v#N\n",
        "@ ` $N $ N$ ~ ? : N\x7F\x01N\n",
        "\x1AN\n",
    });
}

TEST(Roads, AgreeOnNumbers) {
    expectSameOnAllRoads({
        "0x1g 1e5 08 10ULL 0N 1N 1.N .N .5N N.5\n",
        "0xN 0x 0xFN 0x1FULL 0x1FULLN 1e 1eN 1e+ 1e+N 1e+5N 1.e-3fN\n",
        "10L 10LL 10U 10UL 10LN 10uN 017 019 018N 1_N 1.2.3N ..N ...N\n",
        "N1 N_1 1N1 _N N_ 0b1N 1'N'2 1\"N\"\n",
        "#if 1N\n#elif 0x1g\n#elif 08\n#elif 10ULL\nN\n#endif\n",
        "#define E1 5\n1E1 0xE1 .E1 1.E1 E1\n",
    });
}

TEST(Roads, AgreeOnSkippedGroups) {
    expectSameOnAllRoads({
        "#if 0\n\"N\n'N\n#endif\nN\n",
        "#if 0\nit's /* N\n#endif\n*/ N\n#endif\nN\n",
        "#if 0\n\"/*\"\n#endif\nN\n",
        "#if 0\n\"\\\"/*\"\n'\"' /* \" */\n#endif\nN\n",
        "#if 0\n#\n# \n #N\n##\n# 1\n#define N 4\n#include \"no\"\n#error N\n#else\nN\n#endif\n",
        "#if 0\n#if 1\nN\n#elif\n#else\nN\n#endif\nN\n#elif 1\nN\n#endif\n",
        "#if 0\na \\\n#endif\n#endif\nN\n",
        "#if 0\n// \\\n#endif\nN\n#endif\n",
        "#if 0\n/* a\n*/ #endif\nN\n",
        "#if 0\na # else\n#/**/else\nN\n#\\\nendif\nN\n",
        "#if 0\n  /* a */ # /* b */ endif\nN\n",
        "#if 0\nN\n",
        "#if 0\n/* no end\n#endif\n",
        "#if 0\n\"N\r\n#endif\r\nN\n",
        "#if 0\n0x1g 1e5 08 \0 \xE9\n#endif\nN\n"s,
        "#if 0\n#endif",
        "#if 0\n#endi",
        "#if 0\n#",
        "#if 0\n\n\n\n#else N\nN\n#endif N\nN\n",
        "#if 0\n#ifdef\n#ifndef N\n#else\n#else\n#endif\n#endif\n#endif\nN\n",
    });
}

// Texts of up to 40 of the bytes and words that can matter, in any order.
[[nodiscard]] std::string randomText(std::mt19937& random) {
    constexpr auto kParts = std::to_array<std::string_view>(
        {"N",    "F",      "(",    ")",   " ",          " ",     "\t",
         "\n",   "\n",     "\n",   "\r",  "\r\n",       "/*",    "*/",
         "//",   "/",      "*",    "\"",  "\"",         "'",     "\\",
         "\\\n", "\\\r\n", "#",    "##",  "1",          "0x1",   "8u",
         "e5",   "NN",     "\xE9", "|",   "=",          "<",     "if 0",
         "else", "N\n#",   "\n ",  "\n#", "some_words", "endif", "a_longer_name_than_most"});
    std::string text;
    for (std::size_t count = random() % 40; count > 0; --count) {
        text += kParts[random() % kParts.size()];
    }
    return text;
}

TEST(Roads, AgreeOnTextsMadeAtRandom) {
    constexpr std::uint_fast32_t kSeed = 3;
    std::mt19937 random(kSeed);
    for (int count = 0; count < 150; ++count) {
        const std::string text = randomText(random);
        expectSameOnAllRoads(std::string(kMacros).append(text));
        expectSameOnAllRoads(std::string("#if 0\n").append(text).append("\n#endif\nN"));
    }
}

TEST(Roads, AgreeOnLinesThatAreLongerThanAWindow) {
    std::string words;
    std::string numbers;
    for (int number = 0; number < 40; ++number) {
        words += "word N ";
        numbers += "1,0x1f,";
    }
    const std::string blanks(100, ' ');
    expectSameOnAllRoads({
        words + "\nN\n",
        numbers + "N\nN\n",
        "\"" + words + "\" N\n",
        "\"" + words + " N\n" + words,
        "/* " + words + " */ N\nN\n",
        "// " + words + "\nN\n",
        "N // " + words + "\r\nN\n",
        std::string(100, 'N') + " N\n" + std::string(100, '1') + "N\n",
        blanks + "N\n" + blanks + "\n" + blanks + "#define M\nM\n",
        "#define M " + words + "\nM\n",
        "F(" + words + ")\n",
        words + "/*\n" + words + "*/ \\\n" + words + "N\nN\n",
        std::string(200, '/') + "\n" + std::string(101, '<') + "\n" + std::string(201, '\\')
            + "\nN\n",
        "it's " + words + "isn't" + words + "\nN\n",
    });
}

TEST(Roads, AgreeOnMacros) {
    expectSameOnAllRoads({
        "F(1) F (2) F( 3 ) F\n(4) F\n\n\n(5) F\nN\n",
        "F(\n1\n,\n2\n)\nN\n",
        "H(1,\n 2) N\nN\n",
        "H(1\n#define N 4\n, 2)\n",
        "F(/* a\nb */ 1) N\nN\n",
        "F /* a\nb */ (1) N\nN\n",
        "F // a\n(1) N\nN\n",
        "F(\"N\nN) N\n",
        "F(')') F(\"(\") N\n",
        "F(1\n",
        "F(",
        "F",
        "F \n\n",
        "H(1) H(1, 2, 3) G(1) G() G( ) N\n",
        "EMPTY EMPTY\nEMPTY\nN EMPTY\n",
        "EMPTY#define M 1\nEMPTY # define M 1\nM\n",
        "S(a  \"b\\n\" 'c' \\\n d) N\n",
        "J(N, 1) J(1, N) J(F, )(1) J(<, <) J(/, /) N\n",
        "F(F(F(N))) F(F)(N) N\n",
        "__FILE__ __LINE__ F(__LINE__\n) __LINE__\n",
        "#undef N\nN F(N)\n#define N 5\nN\n",
        "NN N N1 xN N.N N->N N::N N+N-N*N/N\n",
        "F\\\n(1) F(1\\\n) N\n",
    });
}

TEST(Roads, AgreeOnHashesInALine) {
    expectSameOnAllRoads({
        "a # N ## N #define N 4\nN\n",
        "##\n## N\n#N\n# N\n#\n#   \n#1\n#\"N\n#'\nN\n",
        "F(#) F(##) F(\n#\n) N\n",
        "  # define M N\nM\n\t#\tundef M\nM\n",
        "N #\nN #",
        "a #if 0\nN\n#endif\n",
        "#unknown N\nN\n#Define N 4\nN\n#define\n#define 1\n#undef\nN\n",
        "?\?=define M 1\n%:define M 1\nM N\n",
    });
}

TEST(Roads, AgreeOnLineControl) {
    expectSameOnAllRoads({
        "#line 10\nN __LINE__\n\n\nN\n",
        "#line 10 \"other\"\nN __LINE__ __FILE__\n#unknown\n",
        "#line N\n__LINE__\n#line N \"a\" N\n__LINE__\n",
        "#line\n#line x\n#line 0\n#line 08\n#line 0x1\n#line 1L\n#line 4294967297\nN\n",
        "#line 99999999999999999999\nN __LINE__\nN\n",
        "#line 10 /* a\nb */ \"c\"\nN __LINE__\n",
        "#line 10 \"no end\nN\n",
        "#line 2147483647\nN __LINE__\nN __LINE__\n",
        "#pragma N \"N\" /* N */ F(1) \\\n N\nN\n",
        "#pragma\nN\n#pragma  a  b\nN\n#pragma \"N\nN\n#pragma // N\nN\n",
        "#pragma x",
        "#error N \"N\n#error\n#error a \\\n b /* c\nd */ e\nN\n#error x",
        "\n\n\n\n\n\n\n\n\n\n\n\nN\n\n#define M\n\nM\n\n\n",
    });
}

TEST(Roads, AgreeOnDefinitions) {
    expectSameOnAllRoads({
        "#define M\nM N\n#define M \nM N\n#define M(x)\nM(N) N\n",
        "#  define  M  a  b\t c\v\f d \t\n[M]\n",
        "#define M \"a  b\" 'c  d'  \"e  f\n[M]\n",
        "#define M\"a\r\"\"\r\nM\n",
        "#define M \"a\r  b\"  c\nM\n#define M 'a  b\n[M]\n",
        "#define M a /* b */ c /**/d// e\n[M]\n",
        "#define M a /* b\nc */ d\n[M]\n#define M a /* no end\n",
        "#define M a / * b / / c /= d\n[M]\n#define M // a\n[M]\n#define M/**/a\n[M]\n",
        "#define M a\\\nb \\\n c\\\n\\\n d \\\n\n[M]\n",
        "#define \\\nM\\\n(x)\\\nx\n[M]\n#\\\ndefine M 2\nM\n",
        "#define M a \\\nb // c \\\n[M]\n#define M a \\b \\\\ \\\r\nc\n[M]\n",
        "#define M a/\\\n/b /\\\n* c\nM\n*/ N\n",
        "#define M 1\n#define M  1\n#define M 2\n#define M 2 \\\n\\\n3\nM\n",
        "#define N 3\n#define N\n#define N() 3\n#define F(y) [x]\nN F(1)\n",
        "#define M(a,b)a b\n#define L( a , b )  a  b \n#define K()k\n#define J( "
        ")\nM(1,2)L(1,2)K()J()\n",
        "#define M(a,/* b */c\\\n,d // e\nN\n#define M(a,/* b */c\\\n,d) a c d\nM(1,2,3)\n",
        "#define M(\nN\n#define M(,\nN\n#define M(a\nN\n#define M(a,\nN\n#define M(a,)\nN\n",
        "#define M(a b)\nN\n#define M(a...)\nN\n#define M(1)\nN\n#define M(defined)\nN\n",
        "#define M(a\r,b)\nN\n#define M(if,else) if else\nM(1,2)\n",
        "#define if 1\n#define define 2\n#define line 3\nif define line\n#if if\nN\n#endif\n",
        "#define defined 1\nN\n#define 1 N\nN\n#define\nN\n#define \"M\"\nN\n#define (a)\nN\n",
        "#define M#\n#define L##\n#define K-1\n#define J\xE9 1\nM L K J\n",
        "#define M \0 a\0  b\0\nM\n#define M\0 2\nM\n"s,
        "#define __LINE__ 5\n__LINE__\n#define __FILE__ __LINE__\n__FILE__\n",
        "#undef N\nN\n#undef N N\nN\n#undef F/* a */// b\nF(1)\n#undef\nN\n#undef 1\nN\n",
        "#undef H /* a\nb */\nH(1,2)\n#undef S \\\n\\\n N\nN\n# undef\tM \nM\n",
        "#undef defined\n#undef __LINE__\n__LINE__\n#undef G\r\nG()\n#undef if\n",
        "#define M 1",
        "#define M 1 \\\n",
        "#define M 1 \\",
        "#define M \"",
        "#undef N",
    });
}

TEST(Roads, AgreeOnConditionalLines) {
    expectSameOnAllRoads({
        "#ifdef N\nN\n#else\nno\n#endif\n#ifndef N\nno\n#else\nN\n#endif\nN\n",
        " # ifdef/**/M // a\nno\n\t#\telse /* b */ \nN\n#endif/* c */\nN\n",
        "#ifdef N /* a\nb */\nN\n#else /* c\nd */ N\nno\n#endif /* e\n*/\nN\n",
        "#ifdef \\\nN\nN\n#\\\nelse\nno\n#endif \\\n\nN\n#else \\\nN\n#\\\n\\\nendif\n",
        "#ifdef N M\nN\n#endif N\nN\n#ifdef\n#endif\n#ifndef 1\n#endif\n#ifdef defined\n#endif\n",
        "#ifdef N\r\nN\r\n#else\r\nno\r\n#endif\r\nN\r\n",
        "#ifdef \"N\n#endif\"\nN\n#ifdef N\"\nN\n#endif'\nN\n",
        "#if 0\n#if \"\n#elif /* a\n#else */\n#elif \"/*\"\n#else\n#endif\n#endif\nN\n",
        "#if 0\n#ifdef N \\\n#endif\n#endif // \\\n#endif\nN\n#endif\nN\n",
        "#if 0\n#define N \\\n#endif\n#define \"/*\n#error it's\n#pragma // "
        "\\\n#endif\nN\n#endif\n",
        "#if 0\n#foo\n#endif\nN\n#if 0\n#foo \\\n#endif\n#endif\nN\n#if 0\n#1\n#defined\n#endif\n",
        "#if 1\nN\n#elif \"\n#elif /* a\n*/\n#elif N \\\n#endif\n#elif 1/0\n#else\n#elif\n#endif\n",
        "#if 1\n#else\n#else\n#elif 1\n#endif\n#\\\nelse\n#\\\nendif\n#else // a\n#endif /* b "
        "*/\n#elif 1\n",
        "#if 0\n#else\n#elif 1\nN\n#else\nN\n#endif\nN\n#endif",
        "#if 0\n#if 1\n#elif 1\n#else\n#elif 1\n#else\n#endif\n#elif 1\nN\n#elif "
        "1\nno\n#else\nno\n#endif\n",
        "#ifdef N\n#ifdef M\n#ifdef N\nno\n#endif\n#else\nN\n#endif\n#endif\nN\n\n\nN\n",
        "#ifdef N",
        "#ifndef N\n#else",
        "#ifdef N\n#endif",
        "#ifdef N\n#endif \\",
    });
}

TEST(Roads, AgreeOnConditions) {
    expectSameOnAllRoads({
        "#if N == 3 && defined(N) && !defined X\nN\n#else\nno\n#endif\n",
        "#if\n#elif N\nN\n#endif\n#if 1 1\nN\n#endif\n#if (1\nN\n#endif\n",
        "#if 1 / 0\nN\n#endif\nN\n",
        "#if N /* a\nb */ > 2\nN\n#endif\n",
        "#if 'a' == 97 \\\n && \"N\"\nN\n#endif\nN\n",
        "#if F(1\n#endif\nN\n",
        "#endif\n#else\n#elif 1\nN\n#if 1\n#else\n#else\n#elif 1\n#endif x\nN\n",
        "#ifdef N x\nN\n#endif\n#ifndef\nN\n#endif\n#ifdef 1\nN\n#else\nN\n#endif\n#if 1\n",
        "N\n#if (-2147483647 - 1) / -1\nN\n#endif\nN\n",
    });
}

TEST(Roads, AgreeOnExpandedConditions) {
    const std::string definitions =
        "#define A B\n#define B A\n#define LESS <\n#define NOT !\n#define AND &\n#define HAS "
        "defined\n"
        "#define SUM (N + 1)\n#define MINUS -1\n#define SLASH /\n#define STAR *\n#define HEX 0x1\n"
        "#define SELF SELF + N\n#define L LL\n#define LL N\n#define OPEN (\n#define CALL F\n"
        "#define QUOTE '\n#define TEXT \"a\"\n#define JOINED /\\\n* a\n";
    const std::vector<std::string> conditions = {"SUM == 4",
                                                 "N==3&&NOT M",
                                                 "1N",
                                                 "N1 + N 1",
                                                 "1 LESS 2",
                                                 "1<LESS 1 == 2",
                                                 "1 LESS< 1 == 2",
                                                 "1 <EMPTY< 1 == 2",
                                                 "NOT=1",
                                                 "1 NOT EMPTY= 2",
                                                 "1 NOT= 2",
                                                 "1 AND AND 1",
                                                 "1 ANDAND 1",
                                                 "1 AND& 1",
                                                 "HAS N",
                                                 "HAS(N)",
                                                 "HAS EMPTY N",
                                                 "HAS HAS",
                                                 "HAS EMPTY",
                                                 "defined EMPTY N",
                                                 "defined(EMPTY",
                                                 "defined EMPTY(N)",
                                                 "-MINUS",
                                                 "--MINUS == MINUS",
                                                 "1 SLASH 1",
                                                 "1 SLASH/ 0",
                                                 "1 SLASH* 0",
                                                 "1 /STAR 0",
                                                 "HEX f",
                                                 "HEXf",
                                                 "HEX==1",
                                                 "SELF == 3",
                                                 "A",
                                                 "A + B == 0",
                                                 "L == 3",
                                                 "L(",
                                                 "M(1)",
                                                 "F(1)",
                                                 "F (1)",
                                                 "CALL(1)",
                                                 "CALL (N)",
                                                 "CALL",
                                                 "F",
                                                 "OPEN N)",
                                                 "OPEN 1",
                                                 "N OPEN 1)",
                                                 "EMPTY",
                                                 "EMPTY 1 EMPTY",
                                                 "(EMPTY 1 EMPTY)",
                                                 "QUOTE a'",
                                                 "'a' == 97 && N",
                                                 "TEXT",
                                                 "JOINED */ 1",
                                                 "__LINE__ > 20",
                                                 "__FILE__",
                                                 "__LINE__ == N",
                                                 "defined __LINE__",
                                                 "1 /* a */ + /* b */ 1 // c",
                                                 "1 \\\n + N \\\n",
                                                 "1 \\\n\\\n2",
                                                 "1 / 0",
                                                 "1 / 0 + F(",
                                                 "F(1 / 0",
                                                 "1 / EMPTY 0",
                                                 "N % (N - 3)",
                                                 "0 && 1 / 0",
                                                 "1 ? 1 : 1 / 0",
                                                 "N > 2 ? N < 3 ? 0 : 1 : 0",
                                                 "(((((N)))))",
                                                 "!!!!N",
                                                 "-N < 0u",
                                                 "N >> 1 << 1 == 2",
                                                 "07 == 7 && 08",
                                                 "0x",
                                                 "1e5",
                                                 "1.0",
                                                 "1 = 1",
                                                 "1, 1",
                                                 "if",
                                                 "defined if",
                                                 "if(1)",
                                                 "1 1",
                                                 "1 )",
                                                 "( 1",
                                                 "1 ?",
                                                 "1 ? 2",
                                                 "#",
                                                 "@",
                                                 "$",
                                                 "\\",
                                                 "\xE9",
                                                 "1 \r",
                                                 "1 /* a\n */ + 1",
                                                 "1 // a\r",
                                                 "1\t+\v1\f",
                                                 ""};
    for (const std::string& condition : conditions) {
        const std::string text =
            "#if " + condition + "\nif\n#elif N\nelif\n#else\nelse\n#endif\n"
            "#if !N\nif\n#elif " + condition + "\nelif\n#else\nelse\n#endif\nN\n";
        expectSameOnAllRoads(std::string(kMacros) + definitions + text);
        expectSameOnAllRoads(text);
    }
}

TEST(Roads, AgreeOnLongLines) {
    const std::string words = [] {
        std::string text;
        while (text.size() < 3000) {
            text.append("word N 0x1g \"N\" 'c' /* N */ F(1) + ");
        }
        return text;
    }();
    const std::string name(2000, 'n');
    expectSameOnAllRoads({
        words,
        "\"" + words,
        "/*" + name + "*/ N\n// " + name + "\nN\n",
        "#define " + name + " 1\n" + name + " " + name + "x N\n",
        "\"" + name + "\" '" + name + "' N\n",
        std::string(1000, ' ') + "#define M 1\nM" + std::string(1000, ' ') + "N\n",
        std::string(500, '\n') + "N\n",
        "#if 0\n" + std::string(500, '\n') + name + "\n#endif\nN\n",
        "#if 0\n/*" + std::string(500, '\n') + "#endif */\n#endif\nN\n",
    });
}

TEST(Roads, AgreeOnIncludedFiles) {
    const testing::TemporaryDirectory directory;
    const std::string name = directory.write("one.h", "N \"N\n#if 0\n'N\n#else\nN F(\n");
    const std::string empty = directory.write("empty.h", "");
    const std::string quoted = "#include \"" + name + "\"\n";
    expectSameOnAllRoads({
        quoted + "1) N\nN\n",
        quoted + quoted + "N",
        "#include \"" + empty + "\"\nN\n#include \"" + empty + "\"",
        "F(\n" + quoted + ") N\n",
        "#if 0\n" + quoted + "#endif\nN\n",
        "#include \"" + directory.nameOf("none.h") + "\"\nN\n",
        "#include <none.h\nN\n#include\nN\n#include N\nN\n",
    });
}

// Files that a defined name makes empty, and files that only look so.
TEST(Roads, AgreeOnFilesIncludedAgain) {
    for (const std::string_view text : {
             "#ifndef G\n#define G\ntext N\n#endif\n",
             "\n/* a\nb */\n\n#ifndef G\n#define G\n#define M \\\n 1\n#endif\n\n// end\n",
             "#ifndef G\n#define G\n#endif",
             "#ifndef G // why\n#define G\n#endif /* G\n */\n",
             "  #  ifndef  G\n#define G\n  #  endif\n",
             "text\n#ifndef G\n#define G\n#endif\n",
             "EMPTY\n#ifndef G\n#define G\n#endif\n",
             "#ifndef G\n#define G\n#endif\nEMPTY\n",
             "#ifndef G\n#define G\n#endif N\n",
             "#ifndef G\n#define G\n#endif\ntext\n",
             "#undef U X\n#ifndef G\n#define G\n#endif\n",
             "#define N 4\n#ifndef G\n#define G\n#endif\n",
             "#ifndef G\n#define G\n#endif\n#undef G\n",
             "#ifndef G\n#define G\n#endif\n#undef EMPTY\n",
             "#ifndef G\n#define G\n#endif\n#\n",
             "#\n#ifndef G\n#define G\n#endif\n",
             "#ifndef G\n#define G\n#else\n#endif\n",
             "#ifndef G\n#define G\n#else\nagain\n#endif\n",
             "#ifndef G\n#define G\n#elif defined U\nagain\n#endif\n",
             "#ifndef G\n#define G\n#elif 0\n#endif\n",
             "#ifndef G\n#define G\n#if 1\n#else\n#else\n#endif\n#endif\n",
             "#ifndef G\n#define G\n#if 1\n#elif\n#else\n#endif\n#endif\n",
             "#ifndef G\n#define G\n#endif\n#ifndef G\n#endif\n",
             "#ifndef G\n#define G\n#endif\n#if 0\n#endif\n",
             "#if 0\n#endif\n#ifndef G\n#define G\n#endif\n",
             "#ifndef G\n#ifndef H\n#define G\n#endif\n#endif\n",
             "#if !defined G\n#define G\n#endif\n",
             "#ifdef G\n#else\n#define G\n#endif\n",
             "#ifndef G x\n#define G\n#endif\n",
             "#ifndef\n#define G\n#endif\n",
             "#ifndef 1\n#define G\n#endif\n",
             "#ifndef G\n#define G\n",
             "#ifndef G\n#define G\n#endif\n#endif\n",
             "#ifndef G\n#define G\n#endif\n/* no end\n",
             "#ifndef G\n#define G\n/* no end\n",
             "#ifndef G\n#define G\n#endif\n#line 7 \"other\"\n",
             "#ifndef G\n#define G\n#endif\n#pragma N\n",
             "#ifndef G\n#define G\n#endif\n#error N\n",
             "#ifndef G\r\n#define G\r\n#endif\r\n",
             "#ifndef G\n#define G\n\"N\n'\n#endif\n",
             "#ifndef G\n#define G\n#\n\n#endif\n",
             "#ifndef G\n#\n#endif\n#endif\n",
             "#ifndef G\n#define G\n#endif\n#include \"none.h\"\n",
             "__LINE__ __FILE__\n#undef __LINE__\n",
             "N\n#undef N\n",
         }) {
        expectSameOnAllRoadsIncludedAgain(text);
    }
}

// What a macro comes out as is kept, as long as no definition changes that it depends on.
TEST(Roads, AgreeOnMacrosUsedAgain) {
    expectSameOnAllRoads({
        "#define O (I I)\n#define I 1\nO O\n#undef I\nO O\n#define I 2\nO O I\n",
        "#define O I\n#define I J\nO O\n#define J O I J\nO O I J\n",
        "#define O F\n#define F(x) <x>\nO O(1) O (2) O\n(3) O\n#undef F\nO O(4)\n",
        "#define O __LINE__\nO O\nO\n#define P __FILE__ O\nP P\nP\n",
        "#define O /\nO/ O* O\n#define P /O/\nP P\n",
        "#define O \"\nO O\" O\n#define P \\\nP P\nP\n",
        "#define O # if\nO O\nO\n#if 0 O\nO\n#endif\n",
        "#define O defined I\n#define I 1\nO O\n#if O\nO\n#endif\n",
        "#define O I\n#define F(x) x O x\nF(O) F(O) O\n#define I 2\nF(O) O I\n",
        "#define if else\n#define else if\nif else if else\n",
    });
}

TEST(Roads, AgreeOnCallsInCalls) {
    for (const std::size_t depth : {3U, 30U, 200U}) {
        std::string calls = "N";
        for (std::size_t level = 0; level < depth; ++level) {
            calls = level % 3 == 0   ? "F(" + calls + ")"
                    : level % 3 == 1 ? "H((" + calls + "), (a)b)"
                                     : "H(x, " + calls + " (c))";
        }
        expectSameOnAllRoads(
            "#define N 1\n#define F(x) [x]\n#define H(a,b) b (a)\n#define O F(F(H(F(2),(3)))) "
            "F(4)\n"
            + calls + "\nO F(O) " + calls + "\n");
    }
}

TEST(Roads, AgreeOnCalls) {
    std::string definitions =
        "#define F(x) [x]\n#define G() 0\n#define H(a,b) a b\n#define J(a,b) a##b\n"
        "#define S(x) #x\n#define R(x) F(x) R(x)\n#define P(x) x\n#define K(f,x) f(x)\n"
        "#define L(x) __LINE__ x\n#define Q(x) x \" x\n#define E\n#define M F(1) F\n";
    for (const std::string_view calls : {
             "F(1) F (1) F\t( 1 ) F",
             "F(a,) F() F(1,2,3) G() G(1) H(,x) H(,) H(x,)",
             "F(F(F(N))) F(R(1)) R(R(N)) P(R)(1)",
             "P(F)(1) P(F) (2) P(P)(F)(3) K(F,K(F,1)) K(K,1)",
             "F(a  b) F(a\tb) F(\"a  b\") F(a/**/b) F(a//b\n) F(c\n)",
             "J(F,(1)) J(,F)(1) J(/,/) J(/,*) J(\",\") J(\\,N) J(1,x) J(0,x1)",
             "S(a + \"b\") S('\"') S(\\) S(\"\\\") S(N) S( a  b ) S(\")",
             "L(1) L(__LINE__) F(__FILE__) F(L(1))",
             "Q(1) P(Q(2)) F(Q(\"3\"))",
             "M(2) M (2) P(M(3)) P(M)(4) F(M) M",
             "F(<)< <F(<) P(<)P(<) H(<,<) H(E,E) H(E,) F(E)",
             "F(defined) F(defined N) P(if) F(#) F(##)",
             "P(1)P(2) P(a)P(b) P(P(a)b) P(aP(b)) P(-P(-1))",
             "x F(1) \\\n F(2) F(3\n4) F(5)\n",
             "F(F (1)) P(F)(2)",
             "F('a') F('') F('a,b') F(\"\\\"\") F(\"",
         }) {
        expectSameOnAllRoads(definitions + std::string(calls) + "\nend\n" + std::string(calls));
    }
}

}  // namespace
}  // namespace umpre
