#include <gtest/gtest.h>

#include "verification/unit/ui/table_fixture.h"

namespace wp::ui::testing {
namespace {

using Style = AlertAction::Style;

struct AlertOnScreen : TableOnScreen {
    AlertOnScreen() : TableOnScreen("a b") {}

    std::shared_ptr<AlertAction> action(const std::string& title, Style style = Style::standard,
                                        bool hasHandler = true) {
        AlertAction::Handler handler;
        if (hasHandler) handler = [this, title](AlertAction&) { done.push_back(title); };
        return std::make_shared<AlertAction>(title, style, handler);
    }

    void present(std::vector<std::shared_ptr<AlertAction>> actions, bool withField = false) {
        auto alert = std::make_shared<AlertController>("title", "message", AlertController::Style::alert);
        if (withField) alert->addTextField(nullptr);
        for (auto& each : actions) alert->addAction(std::move(each));
        controller->presentAlert(alert, Animated::yes);
    }

    std::string focusedInAlert() {
        auto alert = screen.alert();
        if (!alert) return "no alert";
        if (alert->focusedTextField()) return "field";
        return alert->actions()[alert->focus().index]->title();
    }

    std::vector<std::string> done;
};

TEST(Alert, TakesTheKeysAndLeavesNoRowFocused) {
    AlertOnScreen given;
    given.present({given.action("yes"), given.action("no")});

    given.screen.press(Key::down);

    EXPECT_EQ(given.screen.focusedIndexPath(), std::nullopt);
    EXPECT_EQ(given.focusedText(), "a");
    EXPECT_EQ(given.focusedInAlert(), "no");
}

TEST(Alert, GoesThroughFieldAndActionsInTheirOrderAndStopsAtTheEnds) {
    AlertOnScreen given;
    given.present({given.action("cancel"), given.action("done")}, true);
    std::vector<std::string> path = {given.focusedInAlert()};

    for (Key key : {Key::up, Key::down, Key::down, Key::down, Key::left, Key::left, Key::right, Key::up}) {
        given.screen.press(key);
        path.push_back(given.focusedInAlert());
    }

    EXPECT_EQ(path, (std::vector<std::string>{"field", "field", "cancel", "done", "done", "cancel", "cancel",
                                              "done", "cancel"}));
}

TEST(Alert, ClosesBeforeItsActionIsRun) {
    AlertOnScreen given;
    bool wasOpen = true;
    auto action = std::make_shared<AlertAction>(
        "yes", Style::standard, [&](AlertAction&) { wasOpen = given.screen.alert() != nullptr; });
    given.present({action});

    given.screen.press(Key::select);

    EXPECT_FALSE(wasOpen);
    EXPECT_EQ(given.screen.focusedIndexPath(), (IndexPath{0, 0}));
}

TEST(Alert, ADisabledActionCanBeFocusedButNotChosen) {
    AlertOnScreen given;
    auto done = given.action("done");
    done->setEnabled(false);
    given.present({done});

    given.screen.press(Key::select);

    EXPECT_EQ(given.focusedInAlert(), "done");
    EXPECT_TRUE(given.done.empty());
}

TEST(Alert, BackRunsTheActionOfTheCancelStyle) {
    AlertOnScreen given;
    given.present({given.action("cancel", Style::cancel), given.action("done")});

    given.screen.press(Key::back);

    EXPECT_EQ(given.done, std::vector<std::string>{"cancel"});
    EXPECT_EQ(given.screen.alert(), nullptr);
}

TEST(Alert, BackClosesItWhenAnActionHasNoHandler) {
    AlertOnScreen given;
    given.present({given.action("yes"), given.action("no", Style::standard, false)});

    given.screen.press(Key::back);

    EXPECT_TRUE(given.done.empty());
    EXPECT_EQ(given.screen.alert(), nullptr);
}

TEST(Alert, BackDoesNothingWhenEveryActionHasAHandler) {
    AlertOnScreen given;
    given.present({given.action("no"), given.action("yes")});

    given.screen.press(Key::back);

    EXPECT_TRUE(given.done.empty());
    EXPECT_EQ(given.focusedInAlert(), "no");
}

TEST(Alert, UnderAnotherOneKeepsItsFocus) {
    AlertOnScreen given;
    given.present({given.action("first"), given.action("second")});
    given.screen.press(Key::down);
    given.present({given.action("on top", Style::cancel)});

    given.screen.press(Key::back);

    EXPECT_EQ(given.focusedInAlert(), "second");
}

TEST(Alert, PresentedBeforeTheViewsKeepsItsFocusWhenTheyAreBuilt) {
    AlertOnScreen given;
    given.controller->setView(std::make_shared<View>());
    given.present({given.action("no"), given.action("yes")});
    given.screen.press(Key::down);

    auto root = std::make_shared<View>();
    root->addSubview(given.table);
    given.controller->setView(root);
    given.controller->setNeedsFocusUpdate();
    given.controller->updateFocusIfNeeded();

    EXPECT_EQ(given.focusedInAlert(), "yes");
    EXPECT_EQ(given.screen.focusedIndexPath(), std::nullopt);
}

TEST(Alert, WaitsForAScreen) {
    auto controller = std::make_shared<FakeController>();
    controller->presentAlert(
        std::make_shared<AlertController>(std::nullopt, "early", AlertController::Style::alert),
        Animated::yes);
    Screen screen;

    screen.setRootViewController(controller);

    ASSERT_NE(screen.alert(), nullptr);
    EXPECT_EQ(screen.alert()->message(), "early");
    EXPECT_EQ(screen.alert()->title(), std::nullopt);
}

TEST(Keys, WithoutAnAlertBackTellsTheHostThatTheViewerLeft) {
    AlertOnScreen given;
    int left = 0;
    given.screen.setBackHandler([&] { ++left; });

    given.screen.press(Key::back);

    EXPECT_EQ(left, 1);
}

TEST(Keys, DoNothingAfterTheEndOfTheRun) {
    AlertOnScreen given;
    int left = 0;
    given.screen.setBackHandler([&] { ++left; });
    given.present({given.action("yes"), given.action("no", Style::cancel)}, true);
    given.controller->accepts = false;

    for (Key key : {Key::down, Key::select, Key::back}) given.screen.press(key);

    EXPECT_FALSE(given.screen.typeText("x"));
    EXPECT_EQ(given.focusedInAlert(), "field");
    EXPECT_TRUE(given.done.empty());
    EXPECT_EQ(left, 0);
}

TEST(Keys, TypedTextGoesToTheFocusedFieldOnly) {
    AlertOnScreen given;
    EXPECT_FALSE(given.screen.typeText("x"));
    given.present({given.action("done")}, true);

    EXPECT_TRUE(given.screen.typeText("abc"));
    given.screen.press(Key::left);
    given.screen.press(Key::backspace);
    EXPECT_TRUE(given.screen.typeText("X"));
    given.screen.press(Key::down);
    EXPECT_FALSE(given.screen.typeText("y"));

    EXPECT_EQ(given.screen.alert()->textFields().front()->text(), "aXc");
}

TEST(Keys, TheFrontEndIsToldOfEveryChange) {
    AlertOnScreen given;
    given.present({given.action("done")}, true);
    given.screen.typeText("abc");
    given.screen.clearText();
    given.screen.press(Key::down);
    given.screen.press(Key::select);

    EXPECT_EQ(given.observer.alertsPresented, 1);
    EXPECT_EQ(given.observer.alertChanges, 2);
    EXPECT_EQ(given.observer.alertsDismissed, 1);
    EXPECT_GE(given.observer.focusChanges, 3);
}

}  // namespace
}  // namespace wp::ui::testing
