#include "screens/terminal/picture.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <clocale>

#include "screens/terminal/list_picture.h"
#include "verification/unit/screens/sample_controller.h"

namespace wp::terminal {
namespace {

using testing::HasSubstr;
using testing::Not;

class PictureTest : public testing::Test {
  protected:
    PictureTest() {
        std::setlocale(LC_CTYPE, "C.UTF-8");
        screen.setRootViewController(controller);
    }
    ~PictureTest() override { std::setlocale(LC_CTYPE, "C"); }

    void build() {
        controller->buildViews();
        screen.focusPreferredView();
    }

    Canvas drawn(int rows = 18, int columns = 60, Charset charset = Charset::unicode) {
        screen.layoutIfNeeded();
        return draw(screen, rows, columns, charset, {}, firstLine);
    }

    std::string text(int rows = 18, int columns = 60) { return drawn(rows, columns).text(); }

    void press(ui::Key key, int times = 1) {
        for (int i = 0; i < times; ++i) screen.press(key);
    }

    void useNames(int count) {
        controller->names.clear();
        for (int i = 0; i < count; ++i) controller->names.push_back("Network " + std::to_string(100 + i));
    }

    std::shared_ptr<SampleController> controller = std::make_shared<SampleController>();
    ui::Screen screen;
    int firstLine = 0;
};

/// The style of the first square of the line that holds the text.
Style styleOf(const Canvas& canvas, const std::wstring& letter) {
    for (int row = 0; row < canvas.rows(); ++row)
        for (int column = 0; column < canvas.columns(); ++column)
            if (canvas.at(row, column).text == letter) return canvas.at(row, column).style;
    ADD_FAILURE() << "not in the picture";
    return {};
}

TEST_F(PictureTest, ShowsTitleDescriptionAndTheListInItsOrder) {
    build();

    EXPECT_EQ(text(), R"(  Wi-Fi Diagnostics

  Choose the network to look at. What is measured stays on
  this device until you hand it on.

  ┌──────────────────────────────────────────────────────┐
  │ Selected network                                     │
  │ ▸ Home                                               │
  │                                                      │
  │ Choose a network                                     │
  │   Café                                               │
  │   Office                                             │
  │   Other ...                                          │
  │   Refresh                                            │
  │                                                      │
  │                                                      │
  └──────────────────────────────────────────────────────┘
  ↑↓ Move   Enter Select   Esc Back
)");
}

TEST_F(PictureTest, NeedsNothingButAsciiWhereTheTerminalHasNoMore) {
    build();

    std::string picture = drawn(18, 60, Charset::ascii).text();

    EXPECT_TRUE(std::all_of(picture.begin(), picture.end(),
                            [](char c) { return c == '\n' || (c >= ' ' && c < 0x7F); }));
    EXPECT_THAT(picture, HasSubstr("| > Home "));
    EXPECT_THAT(picture, HasSubstr("Caf\\u{00E9}"));
}

TEST_F(PictureTest, ShowsOnlyItsGroundBeforeThereAreViews) {
    EXPECT_EQ(text().find_first_not_of('\n'), text().find("  ↑↓ Move"));
}

TEST_F(PictureTest, ShowsTheFocusByAMarkAndByReversedColours) {
    build();
    press(ui::Key::down);

    Canvas canvas = drawn();

    EXPECT_THAT(canvas.text(), HasSubstr("▸ Café"));
    EXPECT_THAT(canvas.text(), HasSubstr("  Home"));
    EXPECT_EQ(styleOf(canvas, L"▸"), (Style{.bold = true, .reverse = true}));
}

TEST_F(PictureTest, ShowsTheFocusMutedWhileSelectionIsOff) {
    build();
    controller->table().setAllowsSelection(false);

    Canvas canvas = drawn();

    EXPECT_THAT(canvas.text(), HasSubstr("▹ Home"));
    EXPECT_FALSE(styleOf(canvas, L"▹").reverse);
}

TEST_F(PictureTest, DrawsHalfOpacityAndRowsWithoutTouchesDim) {
    build();
    EXPECT_FALSE(styleOf(drawn(), L"f").dim);

    controller->table().setAlpha(0.5);
    EXPECT_TRUE(styleOf(drawn(), L"▸").dim);

    controller->table().setAlpha(1);
    controller->table().cellForRow({1, 1})->setUserInteractionEnabled(false);
    Canvas canvas = drawn();
    EXPECT_TRUE(styleOf(canvas, L"O").dim);
    EXPECT_FALSE(styleOf(canvas, L"R").dim);
}

TEST_F(PictureTest, ShowsTheBarWithItsCountInPlaceOfTheDescription) {
    build();
    controller->showProgress(4, 11);

    std::string picture = text();

    EXPECT_THAT(picture, HasSubstr("\n  [████████████████░░░░░░░░░░░░░░░░░░░░░░░░░░░░] 4/11\n"
                                   "  Looking at the network ...\n\n  ┌"));
    EXPECT_THAT(picture, Not(HasSubstr("Choose the network to look")));
    EXPECT_THAT(picture, HasSubstr("▹ Home"));

    controller->showProgress(11, 11);
    EXPECT_THAT(text(), HasSubstr("██] 11/11"));
}

TEST_F(PictureTest, ShowsAConfirmationAsABox) {
    build();
    press(ui::Key::select);
    press(ui::Key::right);

    EXPECT_EQ(text(), R"(  Wi-Fi Diagnostics

  Choose the network to look at. What is measured stays on
  this device until you hand it on.
     ┌────────────────────────────────────────────────┐
  ┌─ │                                                │ ─┐
  │  │  Confirm                                       │  │
  │  │                                                │  │
  │  │  Look at the network “Home”?                   │  │
  │  │                                                │  │
  │  │                               [ Yes ] ▸[ No ]  │  │
  │  │                                                │  │
  │  └────────────────────────────────────────────────┘  │
  │   Refresh                                            │
  │                                                      │
  │                                                      │
  └──────────────────────────────────────────────────────┘
  ↑↓ Move   Enter Select   Esc Back
)");
}

TEST_F(PictureTest, TakesTheBracketsFromADisabledAction) {
    build();
    controller->askForName();
    EXPECT_THAT(text(), HasSubstr("[ Cancel ]    Done   "));
    EXPECT_THAT(text(), HasSubstr("› Network name"));

    screen.typeText("x");
    EXPECT_THAT(text(), HasSubstr("[ Cancel ]  [ Done ]"));
    EXPECT_THAT(text(), HasSubstr("› x "));
}

TEST_F(PictureTest, PutsTheCursorWhereTheTextIsEdited) {
    build();
    EXPECT_FALSE(drawn().cursor.isVisible());
    controller->askForName();
    int start = drawn().cursor.column;

    screen.typeText("東京a");
    EXPECT_EQ(drawn().cursor.column, start + 5);
    press(ui::Key::left);
    EXPECT_EQ(drawn().cursor.column, start + 4);
    press(ui::Key::home);
    EXPECT_EQ(drawn().cursor.column, start);

    press(ui::Key::down);
    EXPECT_FALSE(drawn().cursor.isVisible());
}

TEST_F(PictureTest, ShowsThePartOfALongTextInWhichTheCursorIs) {
    build();
    controller->askForName();
    screen.typeText(std::string(200, 'a') + "END");
    EXPECT_THAT(text(), HasSubstr("aaaEND"));

    press(ui::Key::home);
    screen.typeText("START");
    EXPECT_THAT(text(), HasSubstr("STARTaaa"));
}

TEST_F(PictureTest, KeepsTheFocusInsideALongList) {
    useNames(40);
    build();
    for (int step = 0; step < 45; ++step) {
        ASSERT_THAT(text(), HasSubstr("▸ ")) << step;
        press(ui::Key::down);
    }
    EXPECT_THAT(text(), HasSubstr("▸ Refresh"));
    for (int step = 0; step < 45; ++step) {
        press(ui::Key::up);
        ASSERT_THAT(text(), HasSubstr("▸ ")) << step;
    }
    EXPECT_THAT(text(), HasSubstr("Selected network"));
}

TEST_F(PictureTest, MarksWhichPartOfALongListIsShown) {
    useNames(40);
    build();
    EXPECT_THAT(text(), HasSubstr("Selected network                                     █"));

    press(ui::Key::down, 50);
    EXPECT_THAT(text(), HasSubstr("▸ Refresh                                            █"));
}

TEST_F(PictureTest, ShowsTheTitleAboveASectionsFirstRow) {
    useNames(40);
    build();
    press(ui::Key::down, 30);
    text();
    press(ui::Key::up, 29);

    EXPECT_THAT(text(), HasSubstr("│ Choose a network"));
}

TEST_F(PictureTest, CutsLongNamesWithAnEllipsis) {
    controller->selected = std::string(80, 'n');
    build();

    EXPECT_THAT(text(), HasSubstr("nnn…  │"));
}

TEST_F(PictureTest, KeepsWideAndCombiningCharactersInTheirCells) {
    controller->names = {"東京ネット", "cafe\u0301 x", "\U0001F600 home", "plain"};
    build();

    std::string picture = text();

    EXPECT_THAT(picture, HasSubstr("│   東京ネット                                         │"));
    EXPECT_THAT(picture, HasSubstr("│   cafe\u0301 x                                             │"));
    EXPECT_THAT(picture, HasSubstr("│   \U0001F600 home                                            │"));
}

TEST_F(PictureTest, BlanksAWideCharacterThatABoxCoversByHalf) {
    controller->names = {"東京東京東京東京", "a東京東京東京東京"};
    build();
    controller->ask("x");
    Canvas canvas = drawn();

    for (int row = 0; row < canvas.rows(); ++row) {
        int columns = 0;
        for (int column = 0; column < canvas.columns(); ++column)
            if (const std::wstring& square = canvas.at(row, column).text; !square.empty())
                columns += wcwidth(square[0]);
        EXPECT_EQ(columns, canvas.columns()) << row;
    }
}

TEST_F(PictureTest, LetsTheDescriptionFlow) {
    build();
    controller->description().setText("One line\nand another.");

    EXPECT_THAT(text(), HasSubstr("\n  One line and another.\n"));
}

TEST_F(PictureTest, ShowsNamesFromTheAirInTheirDisplayForm) {
    controller->names = {"\x1B]0;owned\x07", "\x1B[2J", "\u202Eevil", "a\nb", std::string(32, '\xFF')};
    build();
    EXPECT_THAT(text(), HasSubstr("  \\u{202E}evil "));
    press(ui::Key::down);
    press(ui::Key::select);

    Canvas canvas = drawn(30, 100);

    for (int row = 0; row < canvas.rows(); ++row)
        for (int column = 0; column < canvas.columns(); ++column)
            for (wchar_t c : canvas.at(row, column).text) {
                EXPECT_GE(c, L' ');
                EXPECT_FALSE(c >= 0x7F && c < 0xA0);
                EXPECT_NE(c, wchar_t{0x202E});
            }
    EXPECT_THAT(canvas.text(), HasSubstr("“\\x1B]0;owned\\x07”"));
}

TEST_F(PictureTest, AsksForALargerWindowBelowSixtyBySixteen) {
    build();
    for (auto [rows, columns] : {std::pair(15, 60), std::pair(16, 59), std::pair(1, 200)})
        EXPECT_THAT(text(rows, columns), HasSubstr("at least 60 by 16.")) << rows << " " << columns;
    EXPECT_EQ(text(0, 0), "");
    EXPECT_THAT(text(16, 60), HasSubstr("▸ Home"));
}

TEST_F(PictureTest, SaysHowLargeTheWindowMustBeAsFarAsThereIsRoom) {
    build();

    EXPECT_EQ(text(5, 20), R"(
  Please make this
 window larger: at
  least 60 by 16.

)");
    EXPECT_EQ(text(2, 10), "  Please\nmake this…\n");
    EXPECT_EQ(text(1, 1), "…\n");
}

TEST_F(PictureTest, FitsEveryWindowFromTheSmallestOn) {
    useNames(40);
    build();
    controller->description().setText(std::string(600, 'd'));
    controller->askForName();
    for (int rows = 16; rows < 70; ++rows)
        for (int columns = 60; columns < 220; columns += 9) {
            std::string picture = text(rows, columns);
            ASSERT_THAT(picture, HasSubstr("[ Cancel ]")) << rows << "x" << columns;
            ASSERT_EQ(std::count(picture.begin(), picture.end(), '\n'), rows);
        }
}

TEST(ListWindow, MovesAsLittleAsItTakes) {
    std::vector<ListLine> lines;
    for (int row = 0; row < 20; ++row) lines.push_back({ListLine::Kind::row, {row, 0}});
    auto first = [&](int focused, int before) {
        return firstLineToShow(lines, ui::IndexPath{focused, 0}, 5, before);
    };

    EXPECT_EQ(first(4, 0), 0);
    EXPECT_EQ(first(5, 0), 1);
    EXPECT_EQ(first(3, 1), 1);
    EXPECT_EQ(first(0, 1), 0);
    EXPECT_EQ(first(19, 0), 15);
    EXPECT_EQ(firstLineToShow(lines, std::nullopt, 5, 99), 15);
    EXPECT_EQ(firstLineToShow(lines, std::nullopt, 50, 3), 0);
}

}  // namespace
}  // namespace wp::terminal
