#include <gtest/gtest.h>

#include "network_list/scan_list.h"
#include "verification/unit/network_list/list_run.h"

namespace wp {
namespace {

using namespace fakes;
using ui::Key;

struct Neighbourhood : ::testing::Test {
    ListRun run;

    Neighbourhood() {
        run.device.localization.setText("NETWORK_CONFIRMATION_MESSAGE", "Test %@?");
        run.hear({{"Home", "1"}, {"Cafe", "2"}, {"Zoo", "3"}});
    }
    void showJoined() {
        run.join("Home", "1");
        run.showList();
    }
};

TEST_F(Neighbourhood, ARowAsksForConfirmationWithTheNameOfItsNetwork) {
    run.showList();

    run.choose("Cafe");

    EXPECT_EQ(run.alert(), "NETWORK_CONFIRMATION_TITLE | Test Cafe? | >YES, NO");
    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) Cafe, Home, Zoo / OTHER / REFRESH");
}

TEST_F(Neighbourhood, NoLeavesEverythingAsItWas) {
    run.showList();

    run.choose("Cafe");
    run.press({Key::down, Key::select});

    EXPECT_EQ(run.selected(), "(none)");
    EXPECT_EQ(run.controller->previousSelectedNetworkName(), std::nullopt);
    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) >Cafe, Home, Zoo / OTHER / REFRESH");
    EXPECT_EQ(run.device.queues.readyInBackground(), 0u);
}

TEST_F(Neighbourhood, ChoosingWithNothingSelectedPutsNothingBack) {
    run.showList();

    run.controller->updateSelectedNetwork(run.controller->filteredWiFiScanResults()[0]);

    EXPECT_EQ(run.selected(), "Cafe");
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Cafe / (CHOOSE_NETWORK) Home, Zoo / >OTHER / REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST_F(Neighbourhood, AnOpenQuestionForTheNetworkThatIsSelectedMeanwhileShowsItOnce) {
    run.showList();
    run.choose("Cafe");

    run.join("Cafe", "2");
    run.controller->displayNetworkList();
    run.device.queues.runReady();
    run.press({Key::select});
    run.device.queues.runMain();

    EXPECT_EQ(run.selected(), "Cafe");
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Cafe / (CHOOSE_NETWORK) ~Home, ~Zoo / ~OTHER / ~REFRESH");
}

TEST_F(Neighbourhood, ChoosingPutsTheNetworkSelectedBeforeBackInItsSortedPlace) {
    showJoined();

    run.controller->updateSelectedNetwork(run.controller->filteredWiFiScanResults()[0]);
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Cafe / (CHOOSE_NETWORK) Home, Zoo / OTHER / REFRESH");
    EXPECT_EQ(run.controller->previousSelectedNetworkName(), "Home");

    run.controller->updateSelectedNetwork(run.controller->filteredWiFiScanResults()[1]);
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Zoo / (CHOOSE_NETWORK) Cafe, Home / OTHER / REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST_F(Neighbourhood, YesSelectsTheNetworkAndRunsTheTests) {
    showJoined();

    run.choose("Zoo");
    run.press({Key::select});

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Zoo / (CHOOSE_NETWORK) ~Cafe, ~Home / ~OTHER / ~REFRESH");
    EXPECT_TRUE(run.controller->progressScreenVisible());
    run.device.queues.runAll();
    EXPECT_EQ(run.statusCode(), 0);
    EXPECT_EQ(run.controller->totalTests(), 56);
    EXPECT_EQ(run.controller->configuration()->value("NetworkName"), Value("Zoo"));
    EXPECT_EQ(run.repairs(), 0);
}

TEST_F(Neighbourhood, ConfirmingTheSelectedRowRunsTheTestsWithoutChangingTheSelection) {
    showJoined();

    run.choose("Home");
    EXPECT_EQ(run.alert(), "NETWORK_CONFIRMATION_TITLE | Test Home? | >YES, NO");
    run.press({Key::select});

    EXPECT_EQ(run.selected(), "Home");
    EXPECT_EQ(run.controller->previousSelectedNetworkName(), std::nullopt);
    EXPECT_TRUE(run.controller->progressScreenVisible());
}

TEST_F(Neighbourhood, ANameWithAFormatInItIsShownAsItIs) {
    run.hear({{"100%@ %s", "4"}});
    run.showList();

    run.choose("100%@ %s");

    EXPECT_EQ(run.alert(), "NETWORK_CONFIRMATION_TITLE | Test 100%@ %s? | >YES, NO");
}

TEST_F(Neighbourhood, TheQuestionForAnotherNetworkHasDoneAsItsLastActionDisabledAtFirst) {
    run.showList();

    run.choose("OTHER");

    EXPECT_EQ(run.alert(), "- | OTHER_NETWORK_MESSAGE | [] | CANCEL, ~DONE");
    auto alert = run.device.screen.alert();
    EXPECT_EQ(alert->textFields()[0]->placeholder(), "text of OTHER_NETWORK_PLACEHOLDER");
    EXPECT_TRUE(alert->textFields()[0]->isDictationDisabled());
    EXPECT_EQ(alert->actions()[0]->style(), ui::AlertAction::Style::cancel);
    EXPECT_EQ(alert->actions()[1]->style(), ui::AlertAction::Style::standard);
    EXPECT_NE(alert->focusedTextField(), nullptr);
}

TEST_F(Neighbourhood, DoneIsEnabledExactlyWhileThereIsText) {
    run.showList();
    run.choose("OTHER");

    run.device.screen.typeText(" ");
    EXPECT_EQ(run.alert(), "- | OTHER_NETWORK_MESSAGE | [ ] | CANCEL, DONE");
    run.press({Key::backspace});
    EXPECT_EQ(run.alert(), "- | OTHER_NETWORK_MESSAGE | [] | CANCEL, ~DONE");
    run.press({Key::down, Key::down, Key::select});
    EXPECT_EQ(run.alert(), "- | OTHER_NETWORK_MESSAGE | [] | CANCEL, >~DONE");
}

TEST_F(Neighbourhood, ATypedBlankIsANetworksName) {
    run.showList();

    run.typeOther(" ");

    EXPECT_EQ(run.selected(), " ");
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK)   / (CHOOSE_NETWORK) Cafe, Home, Zoo / >OTHER / REFRESH");
}

TEST_F(Neighbourhood, ASelectionBeforeThereAreViewsIsKeptAndShownWithThem) {
    run.controller->updateSelectedNetworkFromOtherWithSSID("Attic");
    run.controller->updateSelectedNetwork(scanEntry({"Cafe", "2"}));

    EXPECT_EQ(run.selected(), "Cafe");
    EXPECT_EQ(run.controller->previousSelectedNetworkName(), "Attic");
    run.showList();
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Cafe / (CHOOSE_NETWORK) Home, Zoo / OTHER / REFRESH");
}

TEST_F(Neighbourhood, CancelLeavesEverythingAsItWas) {
    showJoined();

    run.choose("OTHER");
    run.device.screen.typeText("Zoo");
    run.press({Key::down, Key::select});

    EXPECT_EQ(run.selected(), "Home");
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Home / (CHOOSE_NETWORK) Cafe, Zoo / >OTHER / REFRESH");
}

TEST_F(Neighbourhood, TypingTheNameThatIsSelectedChangesNothing) {
    showJoined();

    run.typeOther("Home");

    EXPECT_EQ(run.controller->previousSelectedNetworkName(), std::nullopt);
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Home / (CHOOSE_NETWORK) Cafe, Zoo / >OTHER / REFRESH");
}

TEST_F(Neighbourhood, TypingTheNameOfAListedNetworkTakesItsRowAwayAndPutsTheOtherBack) {
    showJoined();

    run.typeOther("Zoo");

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Zoo / (CHOOSE_NETWORK) Cafe, Home / >OTHER / REFRESH");
    EXPECT_EQ(run.repairs(), 0);
    EXPECT_FALSE(run.controller->progressScreenVisible());
}

TEST_F(Neighbourhood, TypingANameInAnotherCaseIsAnotherNetwork) {
    showJoined();

    run.typeOther("zoo");

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) zoo / (CHOOSE_NETWORK) Cafe, Home, Zoo / >OTHER / REFRESH");
}

TEST_F(Neighbourhood, ATypedNameThatNoScanShowsLeavesTheTableWithTheNextChoice) {
    showJoined();
    run.typeOther("Nowhere");
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Nowhere / (CHOOSE_NETWORK) Cafe, Home, Zoo / >OTHER / REFRESH");

    run.typeOther("Cafe");

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Cafe / (CHOOSE_NETWORK) Home, Zoo / >OTHER / REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST_F(Neighbourhood, ATypedNameThatNoScanShowsIsConfirmedByItself) {
    run.showList();
    run.typeOther("Nowhere");

    run.choose("Nowhere");
    EXPECT_EQ(run.alert(), "NETWORK_CONFIRMATION_TITLE | Test Nowhere? | >YES, NO");
    run.press({Key::select});
    run.device.queues.runAll();

    EXPECT_EQ(run.controller->configuration()->value("NetworkName"), Value("Nowhere"));
    EXPECT_EQ(run.controller->totalTests(), 27);
}

TEST_F(Neighbourhood, ANetworkThatIsGoneWhenItIsConfirmedIsSelectedAllTheSame) {
    showJoined();
    run.choose("Cafe");

    run.hear({{"Home", "1"}, {"Zoo", "3"}});
    run.device.wifi.turnPower(1);
    run.device.queues.runReady();
    int repairs = run.repairs();
    run.press({Key::select});

    EXPECT_EQ(run.selected(), "Cafe");
    EXPECT_EQ(picture(run.device.screen),
              "(SELECTED_NETWORK) >Cafe / (CHOOSE_NETWORK) ~Home, ~Zoo / ~OTHER / ~REFRESH");
    EXPECT_EQ(run.repairs(), repairs);
}

TEST_F(Neighbourhood, ANetworkThatWasHeardAgainWhenItIsConfirmedIsFoundByItsName) {
    showJoined();
    run.choose("Cafe");

    run.hear({{"Home", "1"}, {"Cafe", "7", -20}, {"Zoo", "3"}});
    run.device.wifi.turnPower(1);
    run.device.queues.runReady();
    int repairs = run.repairs();
    run.press({Key::select});

    EXPECT_EQ(picture(run.device.screen),
              "(SELECTED_NETWORK) >Cafe / (CHOOSE_NETWORK) ~Home, ~Zoo / ~OTHER / ~REFRESH");
    EXPECT_EQ(run.repairs(), repairs);
}

TEST_F(Neighbourhood, TheRowBeforeTheFirstListTakesAConfirmationToo) {
    run.join("Home", "1");
    run.controller->start();
    run.device.queues.runBackground();
    run.device.queues.runOneOnMain();
    run.choose("Home");
    run.press({Key::select});

    run.device.queues.runAll();

    EXPECT_EQ(run.statusCode(), 0);
    EXPECT_EQ(run.repairs(), 0);
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Home / (CHOOSE_NETWORK) ~Cafe, ~Zoo / ~OTHER / ~REFRESH");
}

}  // namespace
}  // namespace wp
