// SPDX-License-Identifier: MIT
#include "directives/conditional_stack.h"

#include <cstddef>
#include <ostream>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {

static void PrintTo(GroupState state, std::ostream* out) {
    switch (state) {
    case GroupState::Dead: *out << "Dead"; break;
    case GroupState::Taking: *out << "Taking"; break;
    case GroupState::Seeking: *out << "Seeking"; break;
    case GroupState::AfterElse: *out << "AfterElse"; break;
    }
}

namespace {

using enum GroupState;

constexpr bool kSkipped = true;
constexpr bool kActive = false;

// Carries out steps, each a letter: "t" opens a group that is taken and "f" one that is not, "d"
// one in skipped text, "+" and "-" decide the branch that begins, "p" passes over it, "e" is an
// else, "c" closes, "(" enters a file and ")" leaves it.
void carryOut(ConditionalStack& stack, std::string_view steps) {
    for (const char step : steps) {
        switch (step) {
        case 't':
        case 'f':
            stack.open();
            stack.decide(step == 't');
            break;
        case 'd': stack.open(); break;
        case '+': stack.decide(true); break;
        case '-': stack.decide(false); break;
        case 'p': stack.passOver(); break;
        case 'e': stack.takeElse(); break;
        case 'c': stack.close(); break;
        case '(': stack.enterFile(); break;
        case ')': stack.leaveFile(); break;
        default: ADD_FAILURE() << "no step: " << step;
        }
    }
}

struct Row {
    std::string_view steps;
    GroupState state;
    bool skipping;
    std::size_t depth;
};

void expectStates(const std::vector<Row>& table) {
    for (const Row& row : table) {
        ConditionalStack stack;
        carryOut(stack, row.steps);
        EXPECT_EQ(stack.groupState(), row.state) << row.steps;
        EXPECT_EQ(stack.skipping(), row.skipping) << row.steps;
        EXPECT_EQ(stack.conditionalDepth(), row.depth) << row.steps;
    }
}

TEST(ConditionalStack, BeginsWithoutGroups) {
    const ConditionalStack stack;
    EXPECT_EQ(stack.conditionalDepth(), 0U);
    EXPECT_FALSE(stack.skipping());
}

TEST(ConditionalStack, MovesFromStateToState) {
    expectStates({
        {"t", Taking, kActive, 1},
        {"f", Seeking, kSkipped, 1},
        {"tp", Taking, kSkipped, 1},
        {"tpp", Taking, kSkipped, 1},
        {"f-", Seeking, kSkipped, 1},
        {"f+", Taking, kActive, 1},
        {"f+p", Taking, kSkipped, 1},
        {"te", AfterElse, kSkipped, 1},
        {"tpe", AfterElse, kSkipped, 1},
        {"f+pe", AfterElse, kSkipped, 1},
    });
}

// An `#else` after branches none of which was taken.
TEST(ConditionalStack, TakesTheElseOfASeekingGroup) {
    for (const std::string_view steps : {"fe", "f-e", "f--e"}) {
        ConditionalStack stack;
        carryOut(stack, steps);
        EXPECT_EQ(stack.groupState(), AfterElse) << steps;
        EXPECT_FALSE(stack.skipping()) << steps;
    }
}

TEST(ConditionalStack, KeepsADeadGroupSkipped) {
    expectStates({
        {"fd", Dead, kSkipped, 2},
        {"fde", AfterElse, kSkipped, 2},
        {"fdd", Dead, kSkipped, 3},
        {"fdde", AfterElse, kSkipped, 3},
        {"tpd", Dead, kSkipped, 2},
        {"ted", Dead, kSkipped, 2},
    });
}

TEST(ConditionalStack, ReturnsToWhatWasInForceOutside) {
    expectStates({
        {"ttc", Taking, kActive, 1},
        {"tfc", Taking, kActive, 1},
        {"ttec", Taking, kActive, 1},
        {"fdc", Seeking, kSkipped, 1},
        {"fdec", Seeking, kSkipped, 1},
        {"fdc+", Taking, kActive, 1},
        {"fdce", AfterElse, kActive, 1},
        {"tpdcdc", Taking, kSkipped, 1},
        {"fefc", AfterElse, kActive, 1},
    });
}

TEST(ConditionalStack, SkipsNothingAfterTheLastGroup) {
    for (const std::string_view steps : {"tc", "fc", "tec", "fec", "fdcc", "tfcc", "tpc"}) {
        ConditionalStack stack;
        carryOut(stack, steps);
        EXPECT_EQ(stack.conditionalDepth(), 0U) << steps;
        EXPECT_FALSE(stack.skipping()) << steps;
    }
}

TEST(ConditionalStack, CountsTheGroupsOfTheCurrentFileOnly) {
    ConditionalStack stack;
    stack.enterFile();
    carryOut(stack, "tt");
    stack.enterFile();
    EXPECT_EQ(stack.conditionalDepth(), 0U);
    EXPECT_FALSE(stack.skipping());
    carryOut(stack, "ttf");
    EXPECT_EQ(stack.conditionalDepth(), 3U);
    EXPECT_TRUE(stack.skipping());
    EXPECT_EQ(stack.leaveFile(), 3U);
    EXPECT_EQ(stack.conditionalDepth(), 2U);
    EXPECT_FALSE(stack.skipping());
    EXPECT_EQ(stack.groupState(), Taking);
    EXPECT_EQ(stack.leaveFile(), 2U);
    EXPECT_EQ(stack.conditionalDepth(), 0U);
}

TEST(ConditionalStack, LeavesTheGroupsOfTheIncluderAlone) {
    expectStates({
        {"(t()", Taking, kActive, 1},
        {"(fe(tfd)", AfterElse, kActive, 1},
        {"(t(f(d)", Seeking, kSkipped, 1},
        {"(t(f(d))", Taking, kActive, 1},
        {"(t(tc)", Taking, kActive, 1},
    });
}

}  // namespace
}  // namespace umpre
