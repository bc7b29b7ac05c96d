// SPDX-License-Identifier: MIT
#include "lex/text_reader.h"

#include <array>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/recording_comment_sink.h"
#include "support/recording_sink.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using Stop = TextReader::Stop;
using enum TokenKind;

constexpr auto kWindowSizes = std::to_array<std::size_t>({1, 2, 3, 7, 64 * 1024});

// A file that is read through windows, and an output in step with it. MACRO is the one name that
// may be a macro's.
struct Reading {
    Reading(std::string_view text, std::size_t windowSize) : file(comments, {false, windowSize}) {
        isOpen = file.open(directory.write("main", text));
        output.redirect(sink);
        output.countLines(1);
        names.add("MACRO");
    }

    [[nodiscard]] const std::string& written() {
        output.flush();
        return sink.bytes();
    }

    [[nodiscard]] bool isInStep() const { return output.isAt(file.position()); }

    testing::TemporaryDirectory directory;
    testing::RecordingCommentSink comments;
    CppFileScanner file;
    bool isOpen = false;
    testing::RecordingSink sink;
    OutputWriter output;
    NameFilter names;
    TextReader reader{output, names};
};

// What is read of a text, and the text of the token that is left next.
struct Row {
    std::string_view text;
    std::string_view written;
    std::string_view next;
};

void expectCopies(const std::vector<Row>& table, Stop stop) {
    for (const Row& row : table) {
        for (const std::size_t windowSize : kWindowSizes) {
            SCOPED_TRACE(::testing::Message()
                         << ::testing::PrintToString(row.text) << ", window " << windowSize);
            Reading reading(row.text, windowSize);
            ASSERT_TRUE(reading.isOpen);
            EXPECT_EQ(reading.reader.copyText(reading.file, Stop::LineStart), stop);
            EXPECT_EQ(reading.written(), row.written);
            EXPECT_TRUE(reading.isInStep());
            EXPECT_EQ(reading.file.next().text, row.next);
        }
    }
}

void expectSkips(const std::vector<Row>& table, Stop stop) {
    for (const Row& row : table) {
        for (const std::size_t windowSize : kWindowSizes) {
            SCOPED_TRACE(::testing::Message()
                         << ::testing::PrintToString(row.text) << ", window " << windowSize);
            Reading reading(row.text, windowSize);
            ASSERT_TRUE(reading.isOpen);
            EXPECT_EQ(reading.reader.skipText(reading.file), stop);
            EXPECT_EQ(reading.written(), row.written);
            EXPECT_TRUE(reading.isInStep());
            EXPECT_EQ(reading.file.next().text, row.next);
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

TEST(TextReader, StopsBeforeADirective) {
    expectCopies(
        {
            {"#x\n", "", "#"},
            {"a\n#x\n", "a\n", "#"},
            {"a\n #x\n", "a\n", " "},
            {"a\n\n\t\t#x\n", "a\n\n", "\t"},
        },
        Stop::LineStart);
}

TEST(TextReader, StopsBeforeALineThatMayTurnOutToBeADirective) {
    expectCopies(
        {
            {"a\n/**/#x\n", "a\n", " "},
            {"a\n /**/ #x\n", "a\n", " "},
            {"a\n// b\n", "a\n", " "},
            {"a\n\\\n#x\n", "a\n", "\\\n"},
            {"a\n \\\r\n#x\n", "a\n", " "},
            {"a\n\r\nb\n", "a\n", "\n"},
        },
        Stop::LineStart);
}

TEST(TextReader, StopsBeforeANameThatMayBeAMacro) {
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
        Stop::InLine);
}

TEST(TextReader, StopsBeforeANameRightBehindANumber) {
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
        Stop::InLine);
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
        const Token token = reading.file.next();
        if (token.kind == END_OF_INPUT) {
            return reading.written();
        }
        if (token.kind == NEWLINE) {
            reading.output.endLine();
        } else {
            reading.output.write(token.text == "MACRO" ? "<MACRO>" : token.text);
        }
        stop = token.kind == NEWLINE ? Stop::LineStart : Stop::InLine;
    }
}

TEST(TextReader, LeavesEveryNameThatMayBeAMacroToTheScanner) {
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
         }) {
        for (const std::size_t windowSize : kWindowSizes) {
            EXPECT_EQ(copyAll(copy.text, windowSize), copy.output)
                << ::testing::PrintToString(copy.text) << ", window " << windowSize;
        }
    }
}

TEST(TextReader, LeavesCommentsContinuationsAndCarriageReturnsToTheScanner) {
    expectCopies(
        {
            {"a // b\n", "a ", " "},
            {"a/* b */\n", "a", " "},
            {"a \\\nb\n", "a ", "\\\n"},
            {"a\\\r\nb\n", "a", "\\\r\n"},
            {"a\rb\n", "a", "\n"},
            {"a\r\n", "a", "\n"},
        },
        Stop::InLine);
}

TEST(TextReader, LeavesALastLineThatHasNoLineEndToBeClosed) {
    expectCopies({{"a", "a", ""}, {"a\nb ", "a\nb ", ""}}, Stop::InLine);
    Reading reading("a", 16);
    (void)reading.reader.copyText(reading.file, Stop::LineStart);
    EXPECT_EQ(reading.file.next().kind, NEWLINE);
    EXPECT_EQ(reading.file.next().kind, END_OF_INPUT);
}

TEST(TextReader, GoesOnWithinALine) {
    for (const std::size_t windowSize : kWindowSizes) {
        Reading reading("MACRO a #b\n c MACRO\n", windowSize);
        ASSERT_TRUE(reading.isOpen);
        EXPECT_EQ(reading.file.next().text, "MACRO");
        EXPECT_EQ(reading.reader.copyText(reading.file, Stop::InLine), Stop::InLine);
        EXPECT_EQ(reading.written(), " a #b\n c ");
        EXPECT_EQ(reading.file.next().text, "MACRO");
    }
}

TEST(TextReader, CopiesNothingBehindATokenLookedAheadAt) {
    Reading reading("a b\n", 16);
    EXPECT_EQ(reading.file.peek(), IDENTIFIER);
    (void)reading.reader.copyText(reading.file, Stop::LineStart);
    EXPECT_EQ(reading.written(), "");
    EXPECT_EQ(reading.file.next().text, "a");
}

TEST(TextReader, WritesALineFeedForEachLineSkipped) {
    expectSkips(
        {
            {"", "", ""},
            {"a\n\n  \nMACRO \"b\" 1\n", "\n\n\n\n", ""},
            {"a # b\n", "\n", ""},
            {"x\0y\n\xE9\n"sv, "\n\n", ""},
        },
        Stop::LineStart);
}

TEST(TextReader, StopsSkippingBeforeADirective) {
    expectSkips(
        {
            {"#x\n", "", "#"},
            {"a\n#x\n", "\n", "#"},
            {"a\n  #x\n", "\n", " "},
            {"a\n/**/#x\n", "\n", " "},
            {"a\n\\\n#x\n", "\n", "\\\n"},
            {"a\n\r\n#x\n", "\n", "\n"},
        },
        Stop::LineStart);
}

TEST(TextReader, StopsSkippingWithinALineThatMayGoOn) {
    expectSkips(
        {
            {"a\nb /* c\n*/\n", "\n", " "},
            {"a\nb // c\n", "\n", " "},
            {"a\nb \\\n#c\n", "\n", "\\\n"},
            {"a\nb\rc\n", "\n", "\n"},
            {"a\nb", "\n", ""},
        },
        Stop::InLine);
}

}  // namespace
}  // namespace umpre
