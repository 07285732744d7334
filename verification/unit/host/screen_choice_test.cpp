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

TEST(ScreenChoice, WhatTheScreenCannotDoIsRefused) {
    EXPECT_THROW(chooseScreen(automatic, {.hasList = true}), Exit);
    EXPECT_THROW(chooseScreen(none, {.hasTerminal = true, .hasList = true}), Exit);
    EXPECT_THROW(chooseScreen(none, {.hasTerminal = true, .hasScript = true}), Exit);
    EXPECT_THROW(chooseScreen(automatic, {.hasTerminal = true, .hasScript = true}), Exit);
    EXPECT_THROW(chooseScreen(terminal, {}), Exit);
    EXPECT_THROW(chooseScreen(tv, {.hasTerminal = true}), Exit);
}

}  // namespace
}  // namespace wp::host
