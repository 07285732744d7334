#include "screens/tv/keyboard.h"

#include <gtest/gtest.h>

#include <set>

#include "screens/tv/typist.h"
#include "verification/unit/screens/sample_controller.h"

namespace wp::tv {
namespace {

using ui::Key;
using Kind = Keyboard::Kind;

const Keyboard::Key& focused(const Keyboard& keyboard) {
    return keyboard.rows()[keyboard.focusedRow()][keyboard.focusedKey()];
}

void press(Keyboard& keyboard, Key arrow, int times) {
    for (int i = 0; i < times; ++i) keyboard.move(arrow);
}

void focus(Keyboard& keyboard, Kind kind) {
    press(keyboard, Key::down, 9);
    press(keyboard, Key::left, 30);
    while (focused(keyboard).kind != kind && keyboard.move(Key::right)) {
    }
}

TEST(Keyboard, EveryRowIsAsWideAsTheOthersWithoutAGap) {
    Keyboard keyboard;
    for (const Keyboard::Row& row : keyboard.rows()) {
        int column = 0;
        for (const Keyboard::Key& key : row) {
            EXPECT_EQ(key.column, column);
            column += key.width;
        }
        EXPECT_EQ(column, Keyboard::kColumns);
    }
}

TEST(Keyboard, EveryPrintableCharacterOfAsciiCanBeTyped) {
    std::set<std::string> typed = {" "};
    Keyboard keyboard;
    for (int page = 0; page < 2; ++page) {
        for (int shift = 0; shift < 3; ++shift) {
            for (const Keyboard::Row& row : keyboard.rows())
                for (const Keyboard::Key& key : row)
                    if (key.kind == Kind::text) typed.insert(key.text);
            focus(keyboard, Kind::shift);
            keyboard.press();
        }
        focus(keyboard, Kind::page);
        keyboard.press();
    }
    for (char c = ' '; c <= '~'; ++c) EXPECT_TRUE(typed.contains(std::string(1, c))) << c;
    for (const char* letter : {"ä", "Ö", "ß", "é", "€"}) EXPECT_TRUE(typed.contains(letter)) << letter;
}

TEST(Keyboard, ArrowsStopAtTheEdges) {
    Keyboard keyboard;
    EXPECT_FALSE(keyboard.move(Key::left));
    EXPECT_TRUE(keyboard.move(Key::up));
    EXPECT_FALSE(keyboard.move(Key::up));
    press(keyboard, Key::right, 10);
    EXPECT_EQ(focused(keyboard).text, "-");
    EXPECT_FALSE(keyboard.move(Key::right));
    press(keyboard, Key::down, 4);
    EXPECT_EQ(focused(keyboard).kind, Kind::done);
    EXPECT_FALSE(keyboard.move(Key::down));
}

TEST(Keyboard, UpAndDownKeepTheirColumnAcrossAWideKey) {
    Keyboard keyboard;
    press(keyboard, Key::right, 4);
    EXPECT_EQ(focused(keyboard).text, "t");

    press(keyboard, Key::down, 3);
    EXPECT_EQ(focused(keyboard).kind, Kind::blank);
    keyboard.move(Key::up);

    EXPECT_EQ(focused(keyboard).text, "b");
}

TEST(Keyboard, ShiftHoldsForOneLetterAndPressedTwiceForAll) {
    Keyboard keyboard;
    focus(keyboard, Kind::shift);
    keyboard.press();
    press(keyboard, Key::up, 1);
    EXPECT_EQ(keyboard.press().text, "Z");
    EXPECT_EQ(focused(keyboard).text, "z");

    focus(keyboard, Kind::shift);
    keyboard.press();
    keyboard.press();
    press(keyboard, Key::up, 1);
    EXPECT_EQ(keyboard.press().text, "Z");
    EXPECT_EQ(keyboard.press().text, "Z");

    focus(keyboard, Kind::shift);
    keyboard.press();
    EXPECT_EQ(keyboard.shift(), Keyboard::Shift::off);
}

class TypistTest : public testing::Test {
  protected:
    TypistTest() {
        controller->buildViews();
        screen.setRootViewController(controller);
        controller->askForName();
        typist.begin();
    }

    void press(std::initializer_list<Key> keys) {
        for (Key key : keys) typist.press(key);
    }
    const std::string& text() { return screen.alert()->textFields().front()->text(); }

    ui::Screen screen;
    std::shared_ptr<SampleController> controller = std::make_shared<SampleController>();
    Typist typist{screen};
};

TEST_F(TypistTest, FiveKeysTypeANameAndChooseDone) {
    press({Key::select, Key::right, Key::select});
    EXPECT_EQ(text(), "qw");

    press({Key::down, Key::down, Key::down});
    while (focused(typist.keyboard()).kind != Kind::done) typist.press(Key::right);
    press({Key::select});

    EXPECT_EQ(screen.alert(), nullptr);
    EXPECT_EQ(controller->selected, "qw");
}

TEST_F(TypistTest, DoneWithoutATextDoesNothing) {
    press({Key::down, Key::down, Key::down});
    while (focused(typist.keyboard()).kind != Kind::done) typist.press(Key::right);

    press({Key::select});

    ASSERT_NE(screen.alert(), nullptr);
    EXPECT_TRUE(typist.isInField());
}

TEST_F(TypistTest, BelowTheKeyboardAreTheActionsAndUpLeadsBack) {
    press({Key::down, Key::down, Key::down, Key::down});
    EXPECT_FALSE(typist.isInField());
    press({Key::down, Key::up});

    EXPECT_TRUE(typist.isOnKeyboard());
    EXPECT_EQ(typist.keyboard().focusedRow(), 4U);
}

TEST_F(TypistTest, EraseAndTheCursorKeysEditTheField) {
    screen.typeText("ab");
    typist.press(Key::down);
    press({Key::down, Key::down});
    while (focused(typist.keyboard()).kind != Kind::left) typist.press(Key::right);
    press({Key::select});
    while (focused(typist.keyboard()).kind != Kind::erase) typist.press(Key::right);
    press({Key::select});

    EXPECT_EQ(text(), "b");
}

TEST_F(TypistTest, OnARealKeyboardArrowsMoveTheCursorAndEnterFinishes) {
    typist.type("Hme");
    EXPECT_FALSE(typist.isOnKeyboard());
    press({Key::left, Key::left});
    typist.type("o");
    EXPECT_EQ(text(), "Home");

    press({Key::select});

    EXPECT_EQ(controller->selected, "Home");
}

TEST_F(TypistTest, UpReturnsFromARealKeyboardToTheOneOnTheScreen) {
    typist.type("x");

    press({Key::up, Key::select});

    EXPECT_TRUE(typist.isOnKeyboard());
    EXPECT_EQ(text(), "xq");
}

TEST_F(TypistTest, BackLeavesTheAlert) {
    press({Key::back});

    EXPECT_EQ(screen.alert(), nullptr);
}

}  // namespace
}  // namespace wp::tv
