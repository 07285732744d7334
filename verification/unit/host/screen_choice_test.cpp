#include "host/screen_choice.h"

#include <gtest/gtest.h>

#include "host/exit.h"

namespace wp::host {
namespace {

using enum ScreenChoice;

TEST(ScreenChoice, WithoutTheListNothingIsDrawnUnlessItIsAskedFor) {
    EXPECT_EQ(chooseScreen(automatic, {.hasTerminal = true}), none);
    EXPECT_EQ(chooseScreen(automatic, {}), none);
    EXPECT_EQ(chooseScreen(terminal, {.hasTerminal = true}), terminal);
    EXPECT_EQ(chooseScreen(headless, {.hasScript = true}), headless);
}

TEST(ScreenChoice, TheListIsDrawnOnATerminalWhereThereIsOne) {
    EXPECT_EQ(chooseScreen(automatic, {.hasTerminal = true, .hasList = true}), terminal);
    EXPECT_EQ(chooseScreen(headless, {.hasTerminal = true, .hasList = true}), headless);
}

TEST(ScreenChoice, TheListIsDrawnOnATelevisionWhereThereIsADisplay) {
    ScreenSurroundings desktop{.hasTerminal = true, .hasList = true, .hasDisplay = true};
    EXPECT_EQ(chooseScreen(automatic, desktop), tv);

    desktop.hasList = false;
    EXPECT_EQ(chooseScreen(automatic, desktop), none);
    EXPECT_EQ(chooseScreen(tv, {}), tv);
}

TEST(ScreenChoice, WithoutATelevisionScreenInTheBuildATerminalServes) {
    ScreenSurroundings desktop{.hasTerminal = true, .hasList = true, .hasDisplay = true};
    desktop.televisionFault = [] { return "it is not there"; };

    EXPECT_EQ(chooseScreen(automatic, desktop), terminal);
    EXPECT_THROW(chooseScreen(tv, desktop), Exit);
}

TEST(ScreenChoice, TheTelevisionScreenIsLookedForOnlyWhereItIsWanted) {
    bool isAsked = false;
    ScreenSurroundings desktop{.hasTerminal = true, .hasDisplay = true};
    desktop.televisionFault = [&] {
        isAsked = true;
        return std::nullopt;
    };

    chooseScreen(automatic, desktop);
    chooseScreen(terminal, desktop);

    EXPECT_FALSE(isAsked);
}

TEST(ScreenChoice, WhatTheScreenCannotDoIsRefused) {
    EXPECT_THROW(chooseScreen(automatic, {.hasList = true}), Exit);
    EXPECT_THROW(chooseScreen(none, {.hasTerminal = true, .hasList = true}), Exit);
    EXPECT_THROW(chooseScreen(none, {.hasTerminal = true, .hasScript = true}), Exit);
    EXPECT_THROW(chooseScreen(automatic, {.hasTerminal = true, .hasScript = true}), Exit);
    EXPECT_THROW(chooseScreen(terminal, {}), Exit);
}

}  // namespace
}  // namespace wp::host
