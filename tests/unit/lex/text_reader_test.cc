// SPDX-License-Identifier: MIT
#include "lex/text_reader.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/file_fixture.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using Stop = TextReader::Stop;
using enum TokenKind;

constexpr auto kWindowSizes = std::to_array<std::size_t>({1, 2, 3, 7, 64 * 1024});

// Tells what becomes of "KNOWN" and, up to its ")", of "CALL(...)", and of no other name.
struct MacroOfOneText : NameReader {
    explicit MacroOfOneText(bool gainsSo) : gains(gainsSo) {}

    [[nodiscard]] bool gainsByNotice() const noexcept override { return gains; }

    void notice(std::span<const std::string_view> names) override {
        noticed.insert(noticed.end(), names.begin(), names.end());
    }

    [[nodiscard]] Outcome readName(std::string_view name, const char* end) override {
        const char* const behind = name.data() + name.size();
        const char* const close = std::find(behind, end, ')');
        if (name == "CALL" && close != end) {
            return {"<call>", close + 1};
        }
        return name == "KNOWN"   ? Outcome{"<known>", behind}
               : name == "OTHER" ? Outcome{name, behind}
                                 : Outcome{{}, nullptr};
    }

    bool gains;
    std::vector<std::string> noticed;
};

// A file whose text is copied. MACRO is a name that may be a macro's, and is not told.
struct Reading : testing::FileFixture {
    Reading(std::string_view text, std::size_t windowSize, bool givesNotice = false)
        : FileFixture(text, windowSize), macros(givesNotice) {
        for (const char* const name : {"MACRO", "defined", "KNOWN", "CALL", "OTHER"}) {
            names.add(name);
        }
    }

    NameFilter names;
    MacroOfOneText macros;
    TextReader reader{output, names, macros};
};

// What is written of a text, and the name where that stopped, or the text of the token there.
struct Row {
    std::string_view text;
    std::string_view written;
    std::string_view next;
};

void expectCopy(const Row& row, std::size_t windowSize, bool givesNotice, Stop stop) {
    SCOPED_TRACE(::testing::Message() << ::testing::PrintToString(row.text) << ", window "
                                      << windowSize << ", gives notice " << givesNotice);
    Reading reading(row.text, windowSize, givesNotice);
    ASSERT_TRUE(reading.isOpen);
    EXPECT_EQ(reading.reader.copyText(reading.file, Stop::LineStart), stop);
    EXPECT_EQ(reading.written(), row.written);
    EXPECT_TRUE(reading.isInStep());
    if (stop == Stop::Name) {
        EXPECT_EQ(reading.reader.name().text, row.next);
    } else {
        EXPECT_EQ(reading.file.next().text, row.next);
    }
}

void expectCopies(const std::vector<Row>& table, Stop stop) {
    for (const Row& row : table) {
        for (const std::size_t windowSize : {std::size_t{64}, std::size_t{65'536}}) {
            expectCopy(row, windowSize, false, stop);
            expectCopy(row, windowSize, true, stop);
        }
    }
}

TEST(TextReader, CopiesTextToItsEnd) {
    expectCopies(
        {
            {"", "", ""},
            {"a\n", "a\n", ""},
            {"a + b;\n\nc\n", "a + b;\n\nc\n", ""},
            {"\ta \v\f\n b  \n", "\ta \v\f\n b  \n", ""},
            {"x\0y\n\xE9\n"sv, "x\0y\n\xE9\n"sv, ""},
            {"a / b \\ c # d\n", "a / b \\ c # d\n", ""},
        },
        Stop::LineStart);
}

TEST(TextReader, DropsTheBlanksOfLinesThatHoldNothingElse) {
    expectCopies({{"  \n\t\v\f\na\n \n", "\n\na\n\n", ""}}, Stop::LineStart);
}

TEST(TextReader, StopsAtADirective) {
    for (const Row& row : {
             Row{"#x\n", "", "#"},
             Row{"a\n#x\n", "a\n", "#"},
             Row{"a\n #x\n", "a\n", "#"},
             Row{"a\n\n\t\t#x\n", "a\n\n", "#"},
             Row{"a\n/**/#x\n", "a\n", "#"},
             Row{"a\n /* b */ #x\n", "a\n", "#"},
             Row{"a\n\r\n\r #x\n", "a\n\n\n", "#"},
         }) {
        Reading reading(row.text, 64);
        EXPECT_EQ(reading.reader.copyText(reading.file, Stop::LineStart), Stop::LineStart);
        EXPECT_EQ(reading.written(), row.written);
        EXPECT_EQ(reading.file.next().text, row.next);
    }
}

TEST(TextReader, LeavesTheBlanksOfALineThatAContinuationBeginsToTheScanner) {
    expectCopies(
        {
            {"a\n\\\n#x\n", "a\n", "\\\n"},
            {"a\n \\\r\n#x\n", "a\n", " "},
        },
        Stop::LineStart);
    Reading reading("/* */ \\\n#x\n", 64);
    EXPECT_EQ(reading.reader.copyText(reading.file, Stop::LineStart), Stop::LineStart);
    EXPECT_EQ(reading.file.next().text, " ");
}

TEST(TextReader, StopsAtANameThatMayBeAMacro) {
    expectCopies(
        {
            {"MACRO\n", "", "MACRO"},
            {"a\n  MACRO\n", "a\n  ", "MACRO"},
            {"a MACRO b\n", "a ", "MACRO"},
            {"(MACRO)\n", "(", "MACRO"},
            {"a\0MACRO\n"sv, "a\0"sv, "MACRO"},
            {"\xE9MACRO\n", "\xE9", "MACRO"},
            {"\\MACRO\n", "\\", "MACRO"},
            {"\"\"MACRO\n", "\"\"", "MACRO"},
        },
        Stop::Name);
}

TEST(TextReader, WritesWhatNamesComeOutAs) {
    expectCopies(
        {
            {"KNOWN\n", "<known>\n", ""},
            {"a\n  KNOWN\n", "a\n  <known>\n", ""},
            {"a KNOWN b KNOWN\n", "a <known> b <known>\n", ""},
            {"a OTHER b\n", "a OTHER b\n", ""},
            {"CALL(1)CALL(KNOWN) CALL(\")\n", "<call><call> <call>\n", ""},
            {"CALL() /* x */ KNOWN\n\nKNOWN\n", "<call>   <known>\n\n<known>\n", ""},
            {"KNOWN KNOWN CALL (KNOWN) KNOWN\n", "<known> <known> <call> <known>\n", ""},
            {"KNOWN OTHER defined KNOWN\n", "<known> OTHER defined <known>\n", ""},
            {"KNOWN KNOWN /* x */\n \nKNOWN\n", "<known> <known>  \n\n<known>\n", ""},
            {"KNOWN KNOWN\r\nKNOWN \r KNOWN\n", "<known> <known>\n<known> \n <known>\n", ""},
        },
        Stop::LineStart);
    expectCopies(
        {
            {"KNOWN CALL(1\n", "<known> ", "CALL"},
            {"KNOWN KNOWN MACRO KNOWN\n", "<known> <known> ", "MACRO"},
        },
        Stop::Name);
}

TEST(TextReader, GivesNoticeOfNamesThatFollowOneAsItStands) {
    Reading reading("KNOWN KNOWN a OTHER\nKNOWN CALL(x) KNOWN OTHER\n", 1024, true);
    EXPECT_EQ(reading.reader.copyText(reading.file, Stop::LineStart), Stop::LineStart);
    EXPECT_EQ(reading.macros.noticed,
              (std::vector<std::string>{"KNOWN", "OTHER", "KNOWN", "CALL", "OTHER"}));
}

TEST(TextReader, ReadsAsManyNamesInALineAsThereAre) {
    for (std::size_t count = 1; count < 30; ++count) {
        std::string text;
        std::string written;
        for (std::size_t index = 0; index < count; ++index) {
            text += index % 7 == 6 ? "OTHER x " : "KNOWN ";
            written += index % 7 == 6 ? "OTHER x " : "<known> ";
        }
        expectCopies({Row{text + "\n", written + "\n", ""}}, Stop::LineStart);
        expectCopies({Row{text + "MACRO\n", written, "MACRO"}}, Stop::Name);
    }
}

TEST(TextReader, StopsAtANameRightBehindANumber) {
    expectCopies(
        {
            {"1MACRO\n", "1", "MACRO"},
            {"0MACRO\n", "0", "MACRO"},
            {"08MACRO\n", "08", "MACRO"},
            {"1LMACRO\n", "1L", "MACRO"},
            {"1uMACRO\n", "1u", "MACRO"},
            {"1ULMACRO\n", "1UL", "MACRO"},
            {"1luMACRO\n", "1lu", "MACRO"},
            {"0x1FMACRO\n", "0x1F", "MACRO"},
            {"0xFuLMACRO\n", "0xFuL", "MACRO"},
            {"1.5MACRO\n", "1.5", "MACRO"},
        },
        Stop::Name);
}

TEST(TextReader, PassesNamesThatOnlyHoldOne) {
    expectCopies(
        {
            {"MACRO1 XMACRO _MACRO MACRO_\n", "MACRO1 XMACRO _MACRO MACRO_\n", ""},
            {"0xMACRO 1LLMACRO 1xMACRO\n", "0xMACRO 1LLMACRO 1xMACRO\n", ""},
            {"macro MACR\n", "macro MACR\n", ""},
        },
        Stop::LineStart);
}

TEST(TextReader, PassesNamesInLiterals) {
    expectCopies(
        {
            {"\"MACRO\" 'MACRO'\n", "\"MACRO\" 'MACRO'\n", ""},
            {R"("\"MACRO")"
             "\n",
             R"("\"MACRO")"
             "\n",
             ""},
            {R"('\'MACRO')"
             "\n",
             R"('\'MACRO')"
             "\n",
             ""},
            {"\"// MACRO\" '/*'\n", "\"// MACRO\" '/*'\n", ""},
        },
        Stop::LineStart);
}

// Copies a text, and takes a token wherever copying stops. MACRO comes out in angle brackets.
[[nodiscard]] std::string copyAll(std::string_view text, std::size_t windowSize) {
    Reading reading(text, windowSize);
    Stop stop = Stop::LineStart;
    for (;;) {
        stop = reading.reader.copyText(reading.file, stop);
        if (stop == Stop::Name) {
            reading.output.write("<" + std::string(reading.reader.name().text) + ">");
            stop = Stop::InLine;
            continue;
        }
        const Token token = reading.file.next();
        if (token.kind == END_OF_INPUT) {
            return reading.written() + reading.comments.effects();
        }
        if (token.kind == NEWLINE) {
            reading.output.endLine();
        } else {
            reading.output.write(token.text);
        }
        stop = token.kind == NEWLINE ? Stop::LineStart : Stop::InLine;
    }
}

TEST(TextReader, LeavesEveryNameThatMayBeAMacro) {
    struct Copy {
        std::string_view text;
        std::string_view output;
    };

    for (const Copy& copy : {
             Copy{"don't MACRO\n", "don't <MACRO>\n"},
             Copy{"a \"b MACRO\n\"MACRO\"\n", "a \"b <MACRO>\n\"MACRO\"\n"},
             Copy{"'' MACRO '''MACRO\n", "'' MACRO '''<MACRO>\n"},
             Copy{"\"MACRO 'MACRO' MACRO\n", "\"<MACRO> 'MACRO' <MACRO>\n"},
             Copy{"\"\\\"MACRO\n", "\"\\\"<MACRO>\n"},
             Copy{"\"\\\\\\\"MACRO\n", "\"\\\\\\\"<MACRO>\n"},
             Copy{"a /* MACRO */ MACRO // MACRO\n", "a   <MACRO>  \n"},
             Copy{"MACRO\rMACRO\r\nMACRO", "<MACRO>\n<MACRO>\n<MACRO>\n"},
             Copy{"MACRO \"MACRO\" \"MACRO\n", "<MACRO> \"MACRO\" \"<MACRO>\n"},
             Copy{"defined MACRO\n", "defined <MACRO>\n"},
         }) {
        for (const std::size_t windowSize : kWindowSizes) {
            EXPECT_EQ(copyAll(copy.text, windowSize), copy.output)
                << ::testing::PrintToString(copy.text) << ", window " << windowSize;
        }
    }
}

// Whatever a text begins with, what matters may stand anywhere in the 64 bytes that are looked at.
TEST(TextReader, FindsWhatMattersInAnyPlace) {
    for (std::size_t size = 52; size < 68; ++size) {
        const std::string words = std::string(size, 'x') + "-";
        EXPECT_EQ(copyAll(words + "MACRO x\n", 1024), words + "<MACRO> x\n");
        EXPECT_EQ(copyAll(words + "1xMACRO 08MACRO\n", 1024), words + "1xMACRO 08<MACRO>\n");
        EXPECT_EQ(copyAll(words + "\"MACRO\" MACRO\n", 1024), words + "\"MACRO\" <MACRO>\n");
        EXPECT_EQ(copyAll(words + "/*MACRO*/MACRO\n", 1024), words + " <MACRO>\n");
        EXPECT_EQ(copyAll(words + "//MACRO\n \nMACRO\n", 1024), words + " \n\n<MACRO>\n");
        EXPECT_EQ(copyAll(words + "\n  \r\nMACRO\n", 1024), words + "\n\n<MACRO>\n");
    }
}

TEST(TextReader, FindsANameBehindALongNumber) {
    for (std::size_t size : {1U, 55U, 56U, 57U, 58U, 59U, 60U, 61U, 62U, 63U, 64U, 65U, 130U}) {
        const std::string digits(size, '1');
        EXPECT_EQ(copyAll(digits + "MACRO", 1024), digits + "<MACRO>\n");
        EXPECT_EQ(copyAll("0x" + digits + "MACRO", 1024), "0x" + digits + "<MACRO>\n");
        EXPECT_EQ(copyAll("x" + digits + "MACRO", 1024), "x" + digits + "MACRO\n");
    }
}

TEST(TextReader, MakesACommentWithinALineABlank) {
    expectCopies(
        {
            {"a/* b */c\n", "a c\n", ""},
            {"a // b\nc\n", "a  \nc\n", ""},
            {"a /* b *//**/ // c\n", "a     \n", ""},
            {"a // b\r\nc\n", "a  \nc\n", ""},
        },
        Stop::LineStart);
}

TEST(TextReader, DropsTheCommentsOfLinesThatHoldNothingElse) {
    for (const Row& row : {
             Row{"/* a */\n// b\n  /* c */ // d\ne\n", "\n\n\ne\n", ""},
             Row{"a\n\t/* b */\n\n// c\r\nd\n", "a\n\n\n\nd\n", ""},
         }) {
        EXPECT_EQ(copyAll(row.text, 1024), row.written) << row.text;
    }
}

TEST(TextReader, WritesALineMarkerBeforeTheTextBehindACommentOfLines) {
    for (const Row& row : {
             Row{"/* a\n */\nb\nc\n", "\n\n#line 3 \"main\"\nb\nc\n", ""},
             Row{"/* a\n */\n\n \n // c\n b\n", "\n\n\n\n\n#line 6 \"main\"\n b\n", ""},
             Row{"a /* a\n */ b\nc\n", "a \n  b\n#line 3 \"main\"\nc\n", ""},
             Row{"/* a\n */ b\nc\n", "\n#line 2 \"main\"\n  b\nc\n", ""},
             Row{"\t/**/ /* a\n */\tb\n", "\n#line 2 \"main\"\n\t   \tb\n", ""},
             Row{"a /* a\n */\n#b\n", "a \n \n", "#"},
             Row{"a /* a\n */\n##b\n", "a \n \n#line 3 \"main\"\n##b\n", ""},
             Row{"a \\\nb\nc\n", "a \\\nb\n#line 3 \"main\"\nc\n", ""},
             Row{"a \\\r\nb\nc\n", "a \\\r\nb\n#line 3 \"main\"\nc\n", ""},
             Row{"a\\\rb\r c\n", "a\\\rb\n#line 3 \"main\"\n c\n", ""},
         }) {
        Reading reading(row.text, 1024);
        EXPECT_EQ(reading.reader.copyText(reading.file, Stop::LineStart), Stop::LineStart);
        EXPECT_EQ(reading.written(), row.written) << ::testing::PrintToString(row.text);
        EXPECT_EQ(reading.file.next().text, row.next);
    }
}

TEST(TextReader, WritesALineFeedForACarriageReturn) {
    expectCopies(
        {
            {"a\r\nb\r\n", "a\nb\n", ""},
            {"a\rb\r\r", "a\nb\n\n", ""},
            {" \r\n\t\r  \rb\n", "\n\n\nb\n", ""},
            {"a \r\n \"\r\"\n", "a \n \"\r\"\n", ""},
        },
        Stop::LineStart);
}

TEST(TextReader, LeavesWhatTheWindowDoesNotHoldToTheScanner) {
    Reading reading("a /* b c d e f */ g\n", 8);
    EXPECT_EQ(reading.reader.copyText(reading.file, Stop::LineStart), Stop::InLine);
    EXPECT_EQ(reading.written(), "a ");
    EXPECT_EQ(reading.file.next().text, " ");
    Reading other("a \"b c d e f\" g\n", 8);
    EXPECT_EQ(other.reader.copyText(other.file, Stop::LineStart), Stop::InLine);
    EXPECT_EQ(other.written(), "a ");
    EXPECT_EQ(other.file.next().text, "\"b c d e f\"");
}

TEST(TextReader, TellsOfACommentThatIsNeverClosed) {
    EXPECT_EQ(copyAll("a /* b\n c", 1024), "a  \n\n[2]");
}

TEST(TextReader, LeavesALastLineThatHasNoLineEndToBeClosed) {
    expectCopies({{"a", "a", ""}, {"a\nb ", "a\nb ", ""}}, Stop::InLine);
    Reading reading("a", 16);
    (void)reading.reader.copyText(reading.file, Stop::LineStart);
    EXPECT_EQ(reading.file.next().kind, NEWLINE);
    EXPECT_EQ(reading.file.next().kind, END_OF_INPUT);
}

TEST(TextReader, GoesOnWithinALine) {
    Reading reading("MACRO a #b\n c MACRO\n", 64);
    ASSERT_TRUE(reading.isOpen);
    EXPECT_EQ(reading.file.next().text, "MACRO");
    EXPECT_EQ(reading.reader.copyText(reading.file, Stop::InLine), Stop::Name);
    EXPECT_EQ(reading.written(), " a #b\n c ");
    EXPECT_EQ(reading.reader.name().text, "MACRO");
    EXPECT_EQ(reading.file.next().kind, NEWLINE);
}

TEST(TextReader, CopiesNothingBehindATokenLookedAheadAt) {
    Reading reading("a b\n", 16);
    EXPECT_EQ(reading.file.peek(), IDENTIFIER);
    EXPECT_EQ(reading.reader.copyText(reading.file, Stop::LineStart), Stop::LineStart);
    EXPECT_EQ(reading.reader.copyText(reading.file, Stop::InLine), Stop::InLine);
    EXPECT_EQ(reading.written(), "");
    EXPECT_EQ(reading.file.next().text, "a");
}

}  // namespace
}  // namespace umpre
