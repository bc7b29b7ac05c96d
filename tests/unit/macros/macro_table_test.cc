// SPDX-License-Identifier: MIT
#include "macros/macro_table.h"

#include <array>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "support/macro_fixture.h"

namespace umpre {
namespace {

using std::string_view_literals::operator""sv;
using testing::definitionOf;
using Definition = MacroTable::Definition;

[[nodiscard]] MacroText objectLike(std::string_view text) {
    return {text, {}, false};
}

[[nodiscard]] MacroText functionLike(std::string_view text, std::string_view parameters) {
    return {text, parameters, true};
}

// Writes what it is told.
class RecordingMacroEvents final : public MacroEvents {
public:
    void macroDefined(std::string_view name) override { told.append("+").append(name); }

    void macroUndefined(std::string_view name) override { told.append("-").append(name); }

    void macroMet() override { told.append("?"); }

    void macroExpanded(std::string_view name) override { told.append("!").append(name); }

    std::string told;
};

TEST(MacroTable, FindsNothingAtFirst) {
    MacroTable macros;
    EXPECT_EQ(macros.find("A"), nullptr);
    EXPECT_EQ(macros.find(""), nullptr);
}

TEST(MacroTable, FindsWhatWasDefined) {
    MacroTable macros;
    EXPECT_EQ(macros.define("A", objectLike("1")), Definition::Added);
    const MacroName* const found = macros.find("A");
    ASSERT_NE(found, nullptr);
    EXPECT_EQ(found->text, "A");
    EXPECT_EQ(found->macro.text(), "1");
    EXPECT_FALSE(found->macro.functionLike());
}

TEST(MacroTable, KeepsParametersInTheirOrder) {
    MacroTable macros;
    macros.define("F", functionLike("x", "b,a,b"));
    EXPECT_EQ(macros.find("F")->macro.parameters(), "b,a,b");
    EXPECT_EQ(macros.find("F")->macro.parameterCount(), 3);
    EXPECT_TRUE(macros.find("F")->macro.functionLike());
}

TEST(MacroTable, AFunctionLikeMacroMayHaveNoParameters) {
    MacroTable macros;
    macros.define("F", functionLike("1", ""));
    EXPECT_TRUE(macros.find("F")->macro.functionLike());
    EXPECT_EQ(macros.find("F")->macro.parameterCount(), 0);
}

TEST(MacroTable, NamesAreBytes) {
    MacroTable macros;
    macros.define("a", objectLike("lower"));
    macros.define("A", objectLike("upper"));
    macros.define("", objectLike("empty"));
    macros.define("a\0"sv, objectLike("zero"));
    macros.define("a\0b"sv, objectLike("more"));
    EXPECT_EQ(definitionOf(macros, "a"), "lower");
    EXPECT_EQ(definitionOf(macros, "A"), "upper");
    EXPECT_EQ(definitionOf(macros, ""), "empty");
    EXPECT_EQ(definitionOf(macros, "a\0"sv), "zero");
    EXPECT_EQ(definitionOf(macros, "a\0b"sv), "more");
    EXPECT_EQ(definitionOf(macros, "a\0c"sv), "(not defined)");
}

TEST(MacroTable, TheSameTextChangesNothing) {
    MacroTable macros;
    macros.define("F", functionLike("x", "x"));
    EXPECT_EQ(macros.define("F", objectLike("x")), Definition::Same);
    EXPECT_TRUE(macros.find("F")->macro.functionLike());
    EXPECT_EQ(macros.find("F")->macro.parameters(), "x");
}

TEST(MacroTable, AnotherTextReplacesTheWholeDefinition) {
    MacroTable macros;
    macros.define("F", functionLike("x", "x"));
    EXPECT_EQ(macros.define("F", objectLike("y")), Definition::Replaced);
    EXPECT_EQ(definitionOf(macros, "F"), "y");
    EXPECT_FALSE(macros.find("F")->macro.functionLike());
    EXPECT_EQ(macros.find("F")->macro.parameterCount(), 0);
}

TEST(MacroTable, DefineMacroKeepsWhatIsDefined) {
    MacroTable macros;
    macros.defineMacro("A", "1");
    macros.defineMacro("A", "2");
    EXPECT_EQ(definitionOf(macros, "A"), "1");
}

TEST(MacroTable, DefineMacroTakesTheTextAsItIs) {
    MacroTable macros;
    macros.defineMacro("A", "  x   y ");
    EXPECT_EQ(definitionOf(macros, "A"), "  x   y ");
    EXPECT_FALSE(macros.find("A")->macro.functionLike());
}

TEST(MacroTable, AnUndefinedNameIsNotFound) {
    MacroTable macros;
    macros.define("A", objectLike("1"));
    macros.define("B", objectLike("2"));
    macros.undefine("A");
    EXPECT_EQ(macros.find("A"), nullptr);
    EXPECT_EQ(definitionOf(macros, "B"), "2");
}

TEST(MacroTable, UndefiningWhatIsNotDefinedDoesNothing) {
    MacroTable macros;
    macros.undefine("A");
    macros.define("B", objectLike("2"));
    macros.undefine("A");
    macros.undefine("B");
    macros.undefine("B");
    EXPECT_EQ(macros.find("B"), nullptr);
}

TEST(MacroTable, AnUndefinedNameCanBeDefinedAgain) {
    MacroTable macros;
    macros.define("A", objectLike("1"));
    macros.undefine("A");
    EXPECT_EQ(macros.define("A", objectLike("1")), Definition::Added);
    macros.undefine("A");
    macros.defineMacro("A", "3");
    EXPECT_EQ(definitionOf(macros, "A"), "3");
}

TEST(MacroTable, AnEntryStaysWhereItIs) {
    MacroTable macros;
    macros.define("A", objectLike("1"));
    MacroName* const entry = macros.find("A");
    for (int number = 0; number < 3000; ++number) {
        macros.define("N" + std::to_string(number), objectLike(""));
    }
    macros.undefine("A");
    macros.define("A", objectLike("2"));
    EXPECT_EQ(macros.find("A"), entry);
    EXPECT_EQ(entry->text, "A");
    EXPECT_EQ(entry->macro.text(), "2");
}

TEST(MacroTable, ANameIsDefinedAnewInItsOwnBytes) {
    MacroTable macros;
    macros.define("A", functionLike("0123456789", "a,b"));
    const char* const bytes = macros.find("A")->macro.parameters().data();
    for (const std::string text : {"1", "", "9876543210abc", "a"}) {
        macros.undefine("A");
        EXPECT_EQ(macros.define("A", objectLike(text)), Definition::Added);
        EXPECT_EQ(definitionOf(macros, "A"), text);
        EXPECT_EQ(macros.find("A")->macro.text().data(), bytes);
    }
    EXPECT_EQ(macros.define("A", objectLike("0123456789abcd")), Definition::Replaced);
    EXPECT_EQ(definitionOf(macros, "A"), "0123456789abcd");
}

TEST(MacroTable, DefinitionsDoNotTouchEachOther) {
    MacroTable macros;
    macros.define("A", objectLike("1"));
    macros.define("F", functionLike("x", "x"));
    macros.define("A", objectLike("a longer one"));
    macros.define("B", objectLike("2"));
    EXPECT_EQ(definitionOf(macros, "A"), "a longer one");
    EXPECT_EQ(definitionOf(macros, "F"), "x");
    EXPECT_EQ(macros.find("F")->macro.parameters(), "x");
    EXPECT_EQ(definitionOf(macros, "B"), "2");
}

TEST(MacroTable, HoldsThousandsOfNames) {
    MacroTable macros;
    constexpr int kCount = 5000;
    const auto nameOf = [](int number) { return "NAME_" + std::to_string(number); };
    for (int number = 0; number < kCount; ++number) {
        EXPECT_EQ(macros.define(nameOf(number), objectLike(std::to_string(number))),
                  Definition::Added);
    }
    for (int number = 0; number < kCount; number += 3) {
        macros.undefine(nameOf(number));
    }
    for (int number = 0; number < kCount; number += 6) {
        macros.define(nameOf(number), objectLike("again"));
    }
    for (int number = 0; number < kCount; ++number) {
        const std::string expected = number % 6 == 0   ? "again"
                                     : number % 3 == 0 ? "(not defined)"
                                                       : std::to_string(number);
        EXPECT_EQ(definitionOf(macros, nameOf(number)), expected);
    }
}

TEST(MacroTable, FindsTheEntriesOfNamesAskedForTogether) {
    MacroTable macros;
    for (const char* const name : {"A", "B", "C"}) {
        macros.define(name, objectLike("1"));
    }
    macros.undefine("B");
    std::array<MacroTable::Sought, 4> names{{{"C"}, {"none"}, {"A"}, {"B"}}};
    macros.prefetchUses(names);
    for (const MacroTable::Sought& sought : names) {
        EXPECT_EQ(sought.entry, macros.findEntry(sought.name)) << sought.name;
    }
    macros.prefetchUses({});
}

TEST(MacroTable, HoldsNamesOfAllSizes) {
    MacroTable macros;
    std::vector<std::string> names;
    for (const int size : {1, 7, 8, 9, 32, 33, 32000, 1, 32672, 32673, 2, 100000, 3, 4}) {
        names.push_back(std::to_string(names.size()).append(static_cast<std::size_t>(size), 'n'));
        macros.define(names.back(), objectLike("is " + std::to_string(size)));
    }
    std::string inOrder;
    for (const std::string& name : names) {
        EXPECT_EQ(macros.find(name)->text, name);
        EXPECT_EQ(definitionOf(macros, name), "is " + std::to_string(name.size() - name.find('n')));
        inOrder.append("+").append(name);
    }
    RecordingMacroEvents events;
    macros.setEvents(events);
    EXPECT_EQ(events.told, inOrder);
}

TEST(MacroTable, EveryDefinedNamePassesTheFilter) {
    MacroTable macros;
    for (int number = 0; number < 2000; ++number) {
        const std::string name = "N" + std::to_string(number);
        if (number % 2 == 0) {
            macros.define(name, objectLike(""));
        } else {
            macros.defineMacro(name, "");
        }
        EXPECT_TRUE(macros.filter().mayHold(name));
    }
    macros.undefine("N0");
    macros.define("N0", objectLike("1"));
    for (int number = 0; number < 2000; ++number) {
        EXPECT_TRUE(macros.filter().mayHold("N" + std::to_string(number)));
    }
}

TEST(MacroTable, TheFilterStopsNamesNeverDefined) {
    const MacroTable macros;
    EXPECT_FALSE(macros.filter().mayHold("a"));
    EXPECT_FALSE(macros.filter().mayHold("anything"));
}

TEST(MacroTable, TellsOfChangesOfDefinitions) {
    MacroTable macros;
    macros.defineMacro("A", "");
    macros.defineMacro("B", "");
    macros.undefine("B");
    RecordingMacroEvents events;
    macros.setEvents(events);
    EXPECT_EQ(events.told, "+A");
    events.told.clear();
    macros.defineMacro("A", "1");
    macros.define("A", {"", {}, false});
    macros.undefine("B");
    EXPECT_EQ(events.told, "");
    macros.define("A", {"1", {}, false});
    macros.define("B", {"1", {}, false});
    macros.undefine("B");
    EXPECT_EQ(events.told, "+A+B-B");
}

}  // namespace
}  // namespace umpre
