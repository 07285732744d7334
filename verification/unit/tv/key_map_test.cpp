#include "screens/tv/key_map.h"

#include <gtest/gtest.h>

namespace wp::tv {
namespace {

constexpr Qt::Key kNone = Qt::Key_unknown;

TEST(KeyMap, WhatRemoteControlsSendForOkIsTheSelectKey) {
    for (Qt::Key key : {Qt::Key_Return, Qt::Key_Enter, Qt::Key_Select})
        EXPECT_EQ(keyOf(key, 0), ui::Key::select) << key;
    for (std::uint32_t scanCode : {360U, 361U})
        EXPECT_EQ(keyOf(kNone, scanCode), ui::Key::select) << scanCode;
}

TEST(KeyMap, WhatRemoteControlsSendForBackIsTheBackKey) {
    for (Qt::Key key : {Qt::Key_Back, Qt::Key_Escape, Qt::Key_Exit, Qt::Key_Close, Qt::Key_Cancel})
        EXPECT_EQ(keyOf(key, 0), ui::Key::back) << key;
    for (std::uint32_t scanCode : {166U, 182U}) EXPECT_EQ(keyOf(kNone, scanCode), ui::Key::back) << scanCode;
}

TEST(KeyMap, ArrowsAndEditingKeysAreThemselves) {
    EXPECT_EQ(keyOf(Qt::Key_Up, 111), ui::Key::up);
    EXPECT_EQ(keyOf(Qt::Key_Down, 116), ui::Key::down);
    EXPECT_EQ(keyOf(Qt::Key_Left, 113), ui::Key::left);
    EXPECT_EQ(keyOf(Qt::Key_Right, 114), ui::Key::right);
    EXPECT_EQ(keyOf(Qt::Key_Backspace, 22), ui::Key::backspace);
    EXPECT_EQ(keyOf(Qt::Key_Delete, 119), ui::Key::deleteForward);
    EXPECT_EQ(keyOf(Qt::Key_Home, 110), ui::Key::home);
    EXPECT_EQ(keyOf(Qt::Key_End, 115), ui::Key::end);
}

TEST(KeyMap, TheBlankAndLettersAreText) {
    EXPECT_EQ(keyOf(Qt::Key_Space, 65), std::nullopt);
    EXPECT_EQ(keyOf(Qt::Key_A, 38), std::nullopt);
    EXPECT_EQ(keyOf(kNone, 0), std::nullopt);
}

}  // namespace
}  // namespace wp::tv
