// SPDX-License-Identifier: MIT
#include "macros/predefined_macros.h"

#include <ctime>
#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "support/macro_fixture.h"

namespace umpre {
namespace {

struct PredefinedMacros : ::testing::Test {
    PredefinedMacros() { definePredefinedMacros(macros); }

    [[nodiscard]] std::string textOf(std::string_view name) {
        return testing::definitionOf(macros, name);
    }

    // Returns a name's text after refreshing it.
    [[nodiscard]] std::string refreshed(std::string_view name, const SourcePosition& position) {
        refreshPredefined(macros, *macros.find(name), position);
        return textOf(name);
    }

    MacroTable macros;
};

TEST_F(PredefinedMacros, AreFourObjectLikeMacros) {
    for (const char* const name : {"__FILE__", "__LINE__", "__DATE__", "__TIME__"}) {
        ASSERT_NE(macros.find(name), nullptr) << name;
        EXPECT_FALSE(macros.find(name)->macro.functionLike()) << name;
    }
}

TEST_F(PredefinedMacros, FileAndLineAreEmptyUntilRefreshed) {
    EXPECT_EQ(textOf("__FILE__"), "");
    EXPECT_EQ(textOf("__LINE__"), "");
}

TEST_F(PredefinedMacros, DateAndTimeAreThoseOfNowWithTwoPlacesForTheDay) {
    // The second may change between two calls; then one more try settles it.
    for (int attempt = 0;; ++attempt) {
        MacroTable fresh;
        const std::time_t before = std::time(nullptr);
        definePredefinedMacros(fresh);
        const std::time_t after = std::time(nullptr);
        if (before != after && attempt < 5) {
            continue;
        }
        std::tm local{};
        ::localtime_r(&after, &local);
        std::string date(32, '\0');
        date.resize(std::strftime(date.data(), date.size(), "%b %e %Y", &local));
        std::string time(32, '\0');
        time.resize(std::strftime(time.data(), time.size(), "%H:%M:%S", &local));
        EXPECT_EQ(fresh.find("__DATE__")->macro.text(), date);
        EXPECT_EQ(fresh.find("__TIME__")->macro.text(), time);
        return;
    }
}

TEST_F(PredefinedMacros, CannotBeReplacedByDefineMacro) {
    macros.defineMacro("__LINE__", "7");
    EXPECT_EQ(refreshed("__LINE__", {"f", 3}), "3");
}

TEST_F(PredefinedMacros, DoNotReplaceWhatIsDefined) {
    MacroTable own;
    own.defineMacro("__DATE__", "today");
    definePredefinedMacros(own);
    EXPECT_EQ(own.find("__DATE__")->macro.text(), "today");
}

TEST_F(PredefinedMacros, TheLineIsThatOfThePosition) {
    EXPECT_EQ(refreshed("__LINE__", {"f", 12}), "12");
    EXPECT_EQ(refreshed("__LINE__", {"f", 0}), "0");
    EXPECT_EQ(refreshed("__LINE__", {"f", -2147483647 - 1}), "-2147483648");
}

TEST_F(PredefinedMacros, TheFileIsTheNameInQuotesAsItIs) {
    EXPECT_EQ(refreshed("__FILE__", {"a.src", 1}), "\"a.src\"");
    EXPECT_EQ(refreshed("__FILE__", {R"(dir\a.src)", 1}), R"("dir\a.src")");
    EXPECT_EQ(refreshed("__FILE__", {R"(a"b)", 1}), R"("a"b")");
    EXPECT_EQ(refreshed("__FILE__", {"", 1}), R"("")");
}

TEST_F(PredefinedMacros, DateAndTimeAreNotRefreshed) {
    const std::string date = textOf("__DATE__");
    const std::string time = textOf("__TIME__");
    EXPECT_EQ(refreshed("__DATE__", {"f", 12}), date);
    EXPECT_EQ(refreshed("__TIME__", {"f", 12}), time);
}

TEST_F(PredefinedMacros, OtherMacrosAreLeftAlone) {
    for (const char* const name : {"A", "__FILE", "__FILE_", "__FILE__X", "__LINES_", "__line__"}) {
        macros.defineMacro(name, "text");
        EXPECT_EQ(refreshed(name, {"f", 12}), "text");
    }
}

TEST_F(PredefinedMacros, ADefinitionOfTheSourceGetsItsTextReplacedButStaysFunctionLike) {
    macros.define("__LINE__", {"x + 1", "x", true});
    EXPECT_EQ(refreshed("__LINE__", {"f", 12}), "12");
    EXPECT_TRUE(macros.find("__LINE__")->macro.functionLike());
    EXPECT_EQ(macros.find("__LINE__")->macro.parameters(), "x");
}

TEST_F(PredefinedMacros, CanBeUndefined) {
    macros.undefine("__FILE__");
    EXPECT_EQ(macros.find("__FILE__"), nullptr);
}

}  // namespace
}  // namespace umpre
