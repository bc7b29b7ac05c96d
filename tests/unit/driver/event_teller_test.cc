// SPDX-License-Identifier: MIT
#include "driver/event_teller.h"

#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "driver/preprocessor.h"
#include "support/event_list.h"
#include "support/recording_sink.h"
#include "support/temporary_directory.h"

namespace umpre {
namespace {

constexpr std::string_view kPredefined =
    "define __FILE__; define __LINE__; define __DATE__; define __TIME__; ";

// A run, and what it tells of the source's own doing.
struct Fixture {
    explicit Fixture(bool plainRoad = false, bool tellsMacros = true)
        : preprocessor(linesTo(errors), {.plainRoad = plainRoad, .tellsMacros = tellsMacros}) {
        preprocessor.setOutput(output);
        preprocessor.setObserver(events.observer());
    }

    [[nodiscard]] std::string run(std::string_view text) {
        preprocessor.openText("main", text);
        (void)preprocessor.run();
        const std::string begin = std::string(kPredefined) + "enter main; ";
        return events.text().starts_with(begin) ? events.text().substr(begin.size())
                                                : events.text();
    }

    testing::EventList events;
    testing::RecordingSink output;
    testing::RecordingSink errors;
    Preprocessor preprocessor;
};

// Both roads tell this.
void expectTold(std::string_view text, const std::string& expected) {
    for (const bool plainRoad : {true, false}) {
        EXPECT_EQ(Fixture(plainRoad).run(text), expected + "leave main; ") << text;
    }
}

TEST(EventTeller, TellsDefinitionsFromOutsideBeforeTheSource) {
    Fixture f;
    f.preprocessor.defineMacro("A", "1");
    f.preprocessor.defineMacro("A", "2");
    EXPECT_EQ(f.run(""), std::string(kPredefined) + "define A; enter main; leave main; ");
}

TEST(EventTeller, TellsWhatChangesDefinitions) {
    expectTold("#define A\n\n#define A 1\n#define A 1\n#define F(x) x\n",
               "define A main:1; define A main:3; define F main:5; ");
    expectTold("#undef A\n#define A\n#undef A\n#undef __LINE__\n",
               "define A main:2; undefine A main:3; undefine __LINE__ main:4; ");
    expectTold("#if 0\n#define A\n#undef __LINE__\n#endif\n", "");
    expectTold("#define\n#define 1\n#define F(\n#undef\n", "");
}

TEST(EventTeller, TellsTheLineOfTheHash) {
    expectTold("\\\n#define A \\\n 1\n", "define A main:2; ");
    expectTold("/*\n\n*/ #define A /*\n*/ 1\n#undef A // c\n",
               "define A main:3; undefine A main:5; ");
    expectTold("#\\\ndefine A\n#\\\nif A\n#endif\n", "define A main:1; expand A main:3; ");
    expectTold("#line 7 \"b\"\n#define A\n", "define A b:7; ");
}

TEST(EventTeller, TellsWhatIsExpanded) {
    expectTold("#define A 1\nA B A\nA\n",
               "define A main:1; expand A main:2; expand A main:2; expand A main:3; ");
    expectTold("#define A B\n#define B A\nA\n",
               "define A main:1; define B main:2; expand A main:3; expand B main:3; ");
    expectTold("__LINE__ __FILE__\n", "expand __LINE__ main:1; expand __FILE__ main:1; ");
    expectTold("\"__LINE__\" /* __LINE__ */ // __LINE__\n", "");
}

TEST(EventTeller, TellsACallBeforeItsArgumentsWithTheLineOfItsName) {
    expectTold("#define F(x) x x\n#define A 1\nF(\nF\n(A))\n",
               "define F main:1; define A main:2; expand F main:3; expand F main:3; "
               "expand A main:3; ");
    expectTold("#define F(x) x\n#define G F\nG\n(1)\n",
               "define F main:1; define G main:2; expand G main:3; expand F main:3; ");
}

TEST(EventTeller, TellsNothingOfNamesThatStay) {
    expectTold("#define F(x) #x x##1\n#define A 1\nF F(A)\n",
               "define F main:1; define A main:2; expand F main:3; ");
    expectTold("#define F(x) x\nF(1,2) F", "define F main:1; ");
    expectTold("#define A\n#ifdef A\n#endif\n#if defined A\n#endif\n", "define A main:1; ");
}

TEST(EventTeller, TellsWhatDirectivesExpand) {
    expectTold("#define A 1\n#if A + \\\nA\n#elif A\n#endif\n#if 0\n#if A\n#endif\n#endif\n",
               "define A main:1; expand A main:2; expand A main:2; ");
    expectTold("#define A 9\n#line A\nA\n", "define A main:1; expand A main:2; expand A main:9; ");
    expectTold("#define A \"no\"\n#include A\n",
               "define A main:1; expand A main:2; miss no main:2; ");
}

TEST(EventTeller, TellsAnArgumentOnceUnlessItsExpansionHasAnEffect) {
    const std::string two = "#define F(x) x x\n#define G(x) x\n";
    const std::string told = "define F main:1; define G main:2; define A main:3; expand F main:4; ";
    expectTold(two + "#define A 1\nF(A)\n", told + "expand A main:4; ");
    expectTold(two + "#define A G(1,2)\nF(A)\n", told + "expand A main:4; expand A main:4; ");
}

TEST(EventTeller, TellsFilesAsTheyAreOpenedAndLeft) {
    const testing::TemporaryDirectory folder;
    const std::string inner = folder.write("b.h", "#line 1 \"x\"\n#define B\n");
    const std::string outer = folder.write("a.h", "#include \"" + inner + "\"");
    for (const bool plainRoad : {true, false}) {
        Fixture f(plainRoad);
        EXPECT_EQ(f.run("\n# include \\\n \"" + outer + "\"\nB\n"),
                  "enter " + outer + " main:2; enter " + inner + " " + outer + ":1; define B x:1; "
                      "leave " + inner + " " + outer + ":1; leave " + outer
                      + " main:4; expand B main:4; leave main; ");
    }
}

// A file that is passed over as it would come out empty is entered and left all the same.
TEST(EventTeller, TellsEachTimeThatAFileIsIncluded) {
    const testing::TemporaryDirectory folder;
    const std::string name = folder.write("a.h", "#ifndef A\n#define A\n#endif\n");
    const std::string include = "#include \"" + name + "\"\n";
    for (const bool plainRoad : {true, false}) {
        Fixture f(plainRoad, false);
        std::string expected = "enter main; ";
        std::string text;
        for (int line = 1; line <= 20; ++line) {
            text.append(include);
            expected.append("enter " + name + " main:" + std::to_string(line) + "; leave " + name
                            + " main:" + std::to_string(line + 1) + "; ");
        }
        EXPECT_EQ(f.run(text), expected + "leave main; ");
    }
}

TEST(EventTeller, TellsOfNoEndWhereReadingStops) {
    EXPECT_EQ(Fixture().run("#if 1 / 0\n#endif\n"), "");
}

TEST(EventTeller, TellsOfFilesAloneUnlessTheOptionsSayMore) {
    EXPECT_EQ(Fixture(false, false).run("#define A\nA\n"), "enter main; leave main; ");
}

}  // namespace
}  // namespace umpre
