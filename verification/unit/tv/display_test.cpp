#include "screens/tv/display.h"

#include <gtest/gtest.h>

namespace wp::tv {
namespace {

TEST(Display, WhatTheEnvironmentNamesCountsThenADesktopThenTheConsole) {
    Surroundings all{"offscreen", "wayland-0", ":0", true, true};
    EXPECT_EQ(platformFor(all), "offscreen");
    EXPECT_EQ(platformFor({"", "wayland-0", ":0", true, true}), "wayland;xcb");
    EXPECT_EQ(platformFor({"", "wayland-0", "", true, true}), "wayland");
    EXPECT_EQ(platformFor({"", "", ":0", true, true}), "xcb");
    EXPECT_EQ(platformFor({"", "", "", true, true}), "linuxfb");
    EXPECT_EQ(platformFor({"", "", "", false, true}), "eglfs");
    EXPECT_EQ(platformFor({}), std::nullopt);
}

TEST(Display, AllPointsFitTheScreen) {
    EXPECT_DOUBLE_EQ(unitFor({1920, 1080}), 1);
    EXPECT_DOUBLE_EQ(unitFor({3840, 2160}), 2);
    EXPECT_DOUBLE_EQ(unitFor({1280, 720}), 2.0 / 3);
    EXPECT_DOUBLE_EQ(unitFor({1920, 1200}), 1);
    EXPECT_DOUBLE_EQ(unitFor({1280, 1024}), 2.0 / 3);
    EXPECT_DOUBLE_EQ(unitFor({}), 1);
}

TEST(Display, ASizeIsTwoNumbers) {
    EXPECT_EQ(sizeFrom("1280x720"), QSize(1280, 720));
    for (const char* text : {"", "x", "1280", "1280x", "x720", "0x720", "-1x5", "1280x720p", "1280 x 720"})
        EXPECT_EQ(sizeFrom(text), std::nullopt) << text;
}

}  // namespace
}  // namespace wp::tv
