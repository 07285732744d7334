// Each state of the screen as a picture, compared with the one that was looked at and found good. To take new ones
// over: WP_TAKE_PICTURES=1 build/tv_pictures_test, and look at every one.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QAccessible>
#include <QGuiApplication>
#include <QInputMethodQueryEvent>
#include <QKeyEvent>
#include <QWindow>
#include <cstdlib>
#include <filesystem>

#include "host/closing_page.h"
#include "host/running_page.h"
#include "host/string_table.h"
#include "screens/tv/tv_screen.h"
#include "verification/unit/network_list/list_run.h"
#include "verification/unit/places.h"
#include "verification/unit/tv/picture_compare.h"

namespace wp::tv {
namespace {

using fakes::AccessPoint;
using fakes::ListRun;
using ui::Key;

const std::filesystem::path kGood = std::filesystem::path(sourceFolder()) / "verification/unit/tv/pictures";
const std::filesystem::path kTaken = std::filesystem::path(buildFolder()) / "pictures";

std::vector<AccessPoint> neighbourhood(int count) {
    const char* names[] = {"Blue Kite",      "Café am Eck",   "Corner Shop", "Flat 12",        "Garden Room",
                           "Harbour Guests", "Ivy House",     "Kestrel",     "Maison Lavande", "Old Mill",
                           "Orchard 5G",     "Printer Setup", "Quayside",    "Rowan",          "Station Café",
                           "Upstairs",       "Vicarage",      "Willow"};
    std::vector<AccessPoint> points;
    for (int i = 0; i < count; ++i) points.push_back({names[i], std::to_string(i), -40 - i});
    return points;
}

class Pictures : public testing::Test {
  protected:
    Pictures() {
        setenv("QT_QPA_PLATFORM", "offscreen", 1);
        setenv("FONTCONFIG_FILE", (sourceFolder() + "/verification/unit/tv/fonts.conf").c_str(), 1);
        setenv("WIFI_PROFILE_TV_SIZE", "1280x720", 1);
        setenv("WIFI_PROFILE_TV_MOTION", "none", 1);
        std::filesystem::create_directories(kTaken);
    }

    void open(const std::string& locale = "en") {
        host::StringTable table = host::stringTable(locale).value();
        for (const auto& [key, text] : table) run.device.localization.setText(key, text);
        Texts texts{table["KEYBOARD_SHIFT"],   table["KEYBOARD_SYMBOLS"],
                    table["KEYBOARD_LETTERS"], table["KEYBOARD_BLANK"],
                    table["KEYBOARD_LEFT"],    table["KEYBOARD_RIGHT"],
                    table["KEYBOARD_ERASE"],   table["DONE"]};
        Display::Messages messages;
        messages.note = [](std::string_view line) { ADD_FAILURE() << line; };
        TvScreen::Opened opened = TvScreen::open(run.device.screen, queue, texts, messages);
        ASSERT_TRUE(std::holds_alternative<std::unique_ptr<TvScreen>>(opened))
            << std::get<std::string>(opened);
        tv = std::move(std::get<std::unique_ptr<TvScreen>>(opened));
    }

    void showList(const std::vector<AccessPoint>& points) {
        run.join("Northlight", "n");
        run.hear(points);
        run.showList();
    }

    /// Presses keys of the remote control.
    void pressKeys(const std::vector<Qt::Key>& keys) {
        QWindow* window = QGuiApplication::topLevelWindows().front();
        for (Qt::Key key : keys) {
            QKeyEvent event(QEvent::KeyPress, key, Qt::NoModifier);
            QCoreApplication::sendEvent(window, &event);
        }
    }

    /// Puts the focus on the row without a key.
    void focus(const std::string& text) { run.focus(text); }

    /// What is shown, as it is written to the file of that name.
    QImage picture(const std::string& name) {
        std::filesystem::path file = kTaken / (name + ".png");
        EXPECT_EQ(tv->savePicture(file.string()), std::nullopt);
        return QImage(QString::fromStdString(file.string()));
    }

    void expectPicture(const std::string& name) {
        std::filesystem::path file = kTaken / (name + ".png");
        QImage got = picture(name);
        std::filesystem::path good = kGood / (name + ".png");
        if (std::getenv("WP_TAKE_PICTURES"))
            std::filesystem::copy_file(file, good, std::filesystem::copy_options::overwrite_existing);
        PictureDifference difference = compare(QImage(QString::fromStdString(good.string())), got);
        std::filesystem::path differing = kTaken / (name + ".difference.png");
        if (!difference.what.empty()) difference.picture.save(QString::fromStdString(differing.string()));
        EXPECT_EQ(difference.what, "") << good << "\n" << file << "\n" << differing;
    }

    Activity activity;
    MainQueue queue{activity};
    ListRun run;
    std::unique_ptr<TvScreen> tv;
};

/// What a screen reader is told of the rows below an element: name and state.
std::vector<std::string> rowsRead(QAccessibleInterface& element) {
    std::vector<std::string> rows;
    for (int index = 0; index < element.childCount(); ++index) {
        QAccessibleInterface& child = *element.child(index);
        QAccessible::State state = child.state();
        std::string words = std::string(state.disabled ? ", disabled" : "") +
                            (state.focusable ? ", focusable" : "") + (state.focused ? ", focused" : "");
        if (child.role() == QAccessible::ListItem)
            rows.push_back(child.text(QAccessible::Name).toStdString() + words);
        for (std::string& row : rowsRead(child)) rows.push_back(std::move(row));
    }
    return rows;
}

// The first test: with its first application the toolkit forgets for good how a scene is read.
TEST_F(Pictures, RowsAreReadAsDisabledAndFocusableWhileARescanRuns) {
    open();
    showList({{"Rowan", "1"}});
    QAccessibleInterface* window =
        QAccessible::queryAccessibleInterface(QGuiApplication::topLevelWindows().front());
    ASSERT_NE(window, nullptr);
    auto read = [&] {
        tv->runUntil([] { return true; });
        return rowsRead(*window);
    };
    EXPECT_EQ(read(), (std::vector<std::string>{"Northlight, focusable, focused", "Rowan, focusable",
                                                "Other…, focusable", "Search Again, focusable"}));

    run.choose("Search Again");
    run.device.queues.runMain();

    EXPECT_EQ(read(), (std::vector<std::string>{"Northlight, disabled, focusable",
                                                "Rowan, disabled, focusable", "Other…, disabled, focusable",
                                                "Search Again, disabled, focusable, focused"}));
}

TEST_F(Pictures, ListBeforeTheFirstScan) {
    open();
    showList({});

    expectPicture("list_empty");
}

TEST_F(Pictures, ListOfAFewNetworks) {
    open();
    showList(neighbourhood(4));

    expectPicture("list");
}

TEST_F(Pictures, ListOfManyNetworks) {
    open();
    showList(neighbourhood(18));

    expectPicture("list_full");
}

TEST_F(Pictures, ListScrolledToItsMiddle) {
    open();
    showList(neighbourhood(18));

    focus("Rowan");

    expectPicture("list_scrolled");
}

TEST_F(Pictures, FocusOnANetwork) {
    open();
    showList(neighbourhood(4));

    focus("Café am Eck");

    expectPicture("focus_network");
}

TEST_F(Pictures, TextAndGroundTurnTogetherWhenTheFocusMoves) {
    setenv("WIFI_PROFILE_TV_MOTION", "full", 1);
    open();
    showList(neighbourhood(4));
    auto rest = [&] { tv->runUntil([&] { return !tv->isAnimating(); }); };
    pressKeys({Qt::Key_Down});
    rest();
    QImage before = picture("turning");

    pressKeys({Qt::Key_Down});
    QImage atOnce = picture("turning");

    EXPECT_TRUE(tv->isAnimating());
    EXPECT_EQ(compare(before, atOnce).what, "");
    rest();
    QImage good(QString::fromStdString((kGood / "focus_network.png").string()));
    EXPECT_EQ(compare(good, picture("turning")).what, "");
}

TEST_F(Pictures, FocusOnOther) {
    open();
    showList(neighbourhood(4));

    focus("Other…");

    expectPicture("focus_other");
}

TEST_F(Pictures, FocusOnSearchAgain) {
    open();
    showList(neighbourhood(4));

    focus("Search Again");

    expectPicture("focus_search");
}

TEST_F(Pictures, ScrolledToTheEnd) {
    open();
    showList(neighbourhood(18));

    focus("Search Again");

    expectPicture("list_end");
}

TEST_F(Pictures, FocusIsMutedWhileARescanRuns) {
    open();
    showList(neighbourhood(4));

    run.choose("Search Again");
    run.device.queues.runMain();

    expectPicture("rescan");
}

TEST_F(Pictures, Confirmation) {
    open();
    showList(neighbourhood(4));

    run.choose("Café am Eck");

    expectPicture("confirmation");
}

TEST_F(Pictures, TextEntry) {
    open();
    showList(neighbourhood(4));

    run.choose("Other…");

    expectPicture("text_entry");
}

TEST_F(Pictures, TextEntryOfALongName) {
    open();
    showList(neighbourhood(4));

    run.choose("Other…");
    run.device.screen.typeText("The network of the house at the far end of the lane, second floor");
    run.press({Key::down, Key::down});

    expectPicture("text_entry_done");
}

TEST_F(Pictures, TextEntryWithShiftAndSymbols) {
    open();
    showList(neighbourhood(4));

    run.choose("Other…");
    // From "q" to the lowest row's first key, which is shift; pressed twice it locks.
    pressKeys({Qt::Key_Down, Qt::Key_Down, Qt::Key_Down, Qt::Key_Select, Qt::Key_Select, Qt::Key_Up});
    pressKeys({Qt::Key_Select});
    expectPicture("text_entry_shift");
    pressKeys({Qt::Key_Down, Qt::Key_Right, Qt::Key_Select});
    expectPicture("text_entry_symbols");
}

TEST_F(Pictures, TextEntryInGerman) {
    open("de");
    showList(neighbourhood(4));
    run.choose("Anderes …");
    expectPicture("text_entry_german");
}

TEST_F(Pictures, TextEntryInJapanese) {
    open("ja");
    showList(neighbourhood(4));
    run.choose("その他…");
    expectPicture("text_entry_japanese");
}

TEST_F(Pictures, ConfirmationOfAHostileName) {
    open();
    showList({{"<b>\u202Eabc</b>\x1b[2J WWWWWWWWWWWWWWW", "1"}});
    run.choose("<b>\u202Eabc</b>\x1b[2J WWWWWWWWWWWWWWW");
    expectPicture("confirmation_hostile");
}

TEST_F(Pictures, WiFiIsOff) {
    run.device.wifi.setInitialPower(0);
    open();
    run.showList();

    expectPicture("wifi_off");
}

TEST_F(Pictures, Progress) {
    open();
    showList(neighbourhood(4));

    run.controller->showProgress();
    expectPicture("progress_none");
    run.controller->progressView()->setProgress(4.0F / 11.0F);
    expectPicture("progress_part");
    run.controller->progressView()->setProgress(1);
    expectPicture("progress_whole");
}

TEST_F(Pictures, German) {
    open("de");
    showList(neighbourhood(4));

    expectPicture("german");
}

TEST_F(Pictures, Japanese) {
    open("ja");
    showList({{"東京ネット", "1"}, {"ゲスト用", "2"}, {"커피숍", "3"}, {"咖啡館", "4"}});

    expectPicture("japanese");
}

TEST_F(Pictures, NamesOfAllKinds) {
    open();
    showList({{"<b>bold</b><img src=x>", "1"},
              {"line\nbreak\x1b[31m", "2"},
              {"abc\u202Egnp.exe", "3"},
              {"שלום עולם", "4"},
              {"مقهى الزاوية", "5"},
              {"WWWWWWWWWWWWWWWWWWWWWWWWWWWWWWWW", "6"},
              {"東京ネットワーク東京ネット", "7"},
              {"👩‍👩‍👧 family", "8"},
              {std::string("\xff\xfe\x41"), "9"}});

    expectPicture("names");
}

TEST_F(Pictures, KeysThatReachTheWindowWorkTheScreen) {
    open();
    showList(neighbourhood(4));
    QWindow* window = QGuiApplication::topLevelWindows().front();
    auto press = [&](Qt::Key key, const QString& text = {}) {
        QKeyEvent event(QEvent::KeyPress, key, Qt::NoModifier, text);
        QCoreApplication::sendEvent(window, &event);
    };

    for (int i = 0; i < 5; ++i) press(Qt::Key_Down);
    press(Qt::Key_Select);
    EXPECT_EQ(
        run.alert(),
        "- | Enter the name of the network to test. Capital and small letters matter. | [] | Cancel, ~Done");
    for (int i = 0; i < 3; ++i) press(Qt::Key_Right);
    press(Qt::Key_Return);
    press(Qt::Key_A, QStringLiteral("ä"));
    EXPECT_EQ(run.device.screen.alert()->textFields().front()->text(), "rä");

    press(Qt::Key_Return);

    EXPECT_EQ(run.selected(), "rä");
    press(Qt::Key_Select);
    EXPECT_NE(run.device.screen.alert(), nullptr);
    press(Qt::Key_Back);
    EXPECT_EQ(run.device.screen.alert(), nullptr);
}

TEST_F(Pictures, AHeldKeyChoosesAndGoesBackOnceButKeepsMovingTheFocus) {
    open();
    showList(neighbourhood(4));
    QWindow* window = QGuiApplication::topLevelWindows().front();
    auto hold = [&](Qt::Key key) {
        for (bool isRepeated : {false, true, true}) {
            QKeyEvent event(QEvent::KeyPress, key, Qt::NoModifier, {}, isRepeated);
            QCoreApplication::sendEvent(window, &event);
        }
    };
    int timesLeft = 0;
    run.device.screen.setBackHandler([&timesLeft] { ++timesLeft; });

    hold(Qt::Key_Down);
    EXPECT_THAT(run.list(), testing::HasSubstr(">Corner Shop"));
    hold(Qt::Key_Select);
    EXPECT_NE(run.device.screen.alert(), nullptr);
    hold(Qt::Key_Back);
    EXPECT_EQ(run.device.screen.alert(), nullptr);
    EXPECT_EQ(timesLeft, 0);
}

TEST_F(Pictures, AHeldKeyOfTheKeyboardOnTheScreenTypesOn) {
    open();
    showList(neighbourhood(4));
    run.choose("Other…");
    QWindow* window = QGuiApplication::topLevelWindows().front();
    for (bool isRepeated : {false, true, true}) {
        QKeyEvent event(QEvent::KeyPress, Qt::Key_Select, Qt::NoModifier, {}, isRepeated);
        QCoreApplication::sendEvent(window, &event);
    }

    EXPECT_EQ(run.device.screen.alert()->textFields().front()->text().size(), 3U);
}

TEST_F(Pictures, AnInputMethodIsToldWhereTheCursorIsPainted) {
    open();
    showList(neighbourhood(4));
    run.choose("Other…");
    run.device.screen.typeText("il");
    std::string file = (kTaken / "cursor.png").string();
    ASSERT_EQ(tv->savePicture(file), std::nullopt);

    QInputMethodQueryEvent query(Qt::ImCursorRectangle);
    QCoreApplication::sendEvent(QGuiApplication::focusObject(), &query);

    QRectF cursor = query.value(Qt::ImCursorRectangle).toRectF();
    QImage picture(QString::fromStdString(file));
    QColor blue(0x1b, 0x5f, 0xc1);
    auto colorAt = [&](double x, double y) {
        return picture.pixelColor(static_cast<int>(x), static_cast<int>(y));
    };
    EXPECT_EQ(colorAt(cursor.center().x(), cursor.top() + 2), blue);
    EXPECT_EQ(colorAt(cursor.center().x(), cursor.bottom() - 2), blue);
    EXPECT_NE(colorAt(cursor.right() + 2, cursor.center().y()), blue);
    EXPECT_NE(colorAt(cursor.center().x(), cursor.bottom() + 2), blue);
}

/// A page of the host's own, as it stands after a run with these results of the joined network or while one runs.
class HostPictures : public Pictures {
  protected:
    void showClosingPage(const std::string& language, Dictionary::Entries joined) {
        open(language);
        joined.merge(
            Dictionary::Entries{{"networkName", "Northlight"}, {"pingedWAN", true}, {"reachedVantor", true}});
        host::Evidence evidence = host::evidenceFrom(
            0, Dictionary::make({{"currentNetwork", Dictionary::make(std::move(joined))}}));
        texts = std::make_unique<host::Texts>(language);
        show(std::make_shared<host::ClosingPage>(host::makeReport(evidence, {}, *texts), *texts));
    }

    void show(const std::shared_ptr<ui::ViewController>& page) {
        run.device.screen.setRootViewController(page);
        run.device.screen.focusPreferredView();
    }

    static Dictionary::Entries threeProblems() {
        return {{"isCaptive", true},
                {"reachedVantor", false},
                {"hasPoorSignal", true},
                {"isBeaconIntervalLong", true},
                {"isIPv6Assigned", false}};
    }

    std::unique_ptr<host::Texts> texts;
};

TEST_F(HostPictures, ClosingPageOfASoundNetwork) {
    showClosingPage("en", {});

    expectPicture("closing_sound");
}

TEST_F(HostPictures, ClosingPageOfThreeProblems) {
    showClosingPage("en", threeProblems());

    expectPicture("closing");
    run.press({Key::down, Key::down, Key::down});
    expectPicture("closing_end");
}

TEST_F(HostPictures, ClosingPageWithTheDesktopsScaleFactors) {
    setenv("QT_SCALE_FACTOR", "2", 1);
    setenv("QT_SCREEN_SCALE_FACTORS", "1.5", 1);
    showClosingPage("en", threeProblems());

    QImage good(QString::fromStdString((kGood / "closing.png").string()));
    EXPECT_EQ(compare(good, picture("scaled")).what, "");
}

TEST_F(HostPictures, ClosingPageInGerman) {
    showClosingPage("de", threeProblems());

    expectPicture("closing_german");
}

TEST_F(HostPictures, ClosingPageInJapanese) {
    showClosingPage("ja", threeProblems());

    expectPicture("closing_japanese");
}

TEST_F(HostPictures, WhichTestIsRunning) {
    open();
    texts = std::make_unique<host::Texts>("en");
    host::StringTable strings = host::stringTable("en").value();
    auto page =
        std::make_shared<host::RunningPage>(strings["WIFI_DIAGNOSTICS"], strings["PROGRESS_TEXT"], *texts);
    show(page);
    page->show({19, "Bluetooth devices", 16, 40});

    expectPicture("running");
}

TEST_F(Pictures, InFullSize) {
    setenv("WIFI_PROFILE_TV_SIZE", "1920x1080", 1);
    open();
    showList(neighbourhood(18));

    expectPicture("list_1080");
}

TEST_F(Pictures, InFourTimesFullSize) {
    setenv("WIFI_PROFILE_TV_SIZE", "3840x2160", 1);
    open();
    showList(neighbourhood(4));

    expectPicture("list_2160");
}

}  // namespace
}  // namespace wp::tv
