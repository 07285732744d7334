#include <gtest/gtest.h>

#include "network_list/scan_list.h"
#include "verification/unit/network_list/list_run.h"

namespace wp {
namespace {

using namespace fakes;

TEST(FirstList, ShowsTheNetworksByNameUnderTheirTitle) {
    ListRun run;
    run.hear({{"zoo", "1"}, {"Apple", "2"}, {"berry", "3"}});

    run.showList();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) Apple, berry, zoo / >OTHER / REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST(FirstList, BeforeTheScanIsDoneShowsWhatItHasAndNoUsableRefreshRow) {
    ListRun run;
    run.join("Home", "1");
    run.hear({{"Cafe", "2"}});

    run.controller->start();
    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) / >OTHER / ~REFRESH");
    EXPECT_FALSE(run.controller->scanFinished());
    EXPECT_FALSE(run.controller->refreshEnabled());

    run.device.queues.runBackground();
    run.device.queues.runOneOnMain();
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Home / (CHOOSE_NETWORK) / OTHER / ~REFRESH");

    run.device.queues.runReady();
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Home / (CHOOSE_NETWORK) Cafe / OTHER / REFRESH");
    EXPECT_TRUE(run.controller->scanFinished());
    EXPECT_TRUE(run.controller->refreshEnabled());
}

TEST(FirstList, TakesTheJoinedNetworkAsTheSelectedOneWhenNoneIsGiven) {
    ListRun run;
    run.join("Home", "1");
    run.hear({{"Home", "1"}, {"Home", "9", -20}, {"Cafe", "2"}});

    run.showList();

    EXPECT_EQ(run.selected(), "Home");
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Home / (CHOOSE_NETWORK) Cafe / OTHER / REFRESH");
    EXPECT_EQ(run.controller->currentNetwork()->bssid, "1");
}

TEST(FirstList, ShowsTheSelectedNetworkAloneAndMakesTheJoinedOneChoosable) {
    ListRun run("Cafe");
    run.join("Home", "1");
    run.hear({{"Home", "1"}, {"Cafe", "2"}, {"Zoo", "3"}});

    run.showList();

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Cafe / (CHOOSE_NETWORK) Home, Zoo / OTHER / REFRESH");
}

TEST(FirstList, WithASelectedNetworkThatNoScanShowsLeavesTheJoinedOneOut) {
    ListRun run("Faraway");
    run.join("Home", "1");
    run.hear({{"Home", "1"}, {"Cafe", "2"}});

    run.showList();

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Faraway / (CHOOSE_NETWORK) Cafe / OTHER / REFRESH");
}

TEST(FirstList, WithTheSelectedNetworkBeingTheJoinedOneShowsItInNeitherPlaceBelow) {
    ListRun run("Home");
    run.join("Home", "1");
    run.hear({{"Home", "1"}, {"Cafe", "2"}});

    run.showList();

    EXPECT_FALSE(run.controller->filteredNetworks().contains("Home"));
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Home / (CHOOSE_NETWORK) Cafe / OTHER / REFRESH");
}

TEST(FirstList, WithTheSelectedNetworkHeardButNoConnectionAddsNothing) {
    ListRun run("Cafe");
    run.hear({{"Cafe", "2"}, {"Zoo", "3"}});

    run.showList();

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Cafe / (CHOOSE_NETWORK) Zoo / OTHER / REFRESH");
}

TEST(FirstList, OfAnEmptyScanShowsTheTitleOverNoRowsAndARefreshRowThatTakesTouches) {
    ListRun run;
    run.hear({});

    run.showList();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) / >OTHER / REFRESH");
}

TEST(FirstList, OfAFailedScanIsEmpty) {
    ListRun run;
    run.device.service.setOutcome(kScanTest, failure(7, "radio busy"));

    run.showList();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) / >OTHER / REFRESH");
}

TEST(FirstList, ScansAfreshIntoTheCurrentNetworksSection) {
    ListRun run;
    run.hear({{"Cafe", "2"}});

    run.showList();

    auto requests = run.device.service.requests();
    ASSERT_EQ(requests.size(), 1u);
    EXPECT_EQ(requests[0].testID, kScanTest);
    EXPECT_EQ(requests[0].configuration, run.controller->freshScanConfiguration());
    EXPECT_EQ(run.controller->currentNetworkData()->value("foundScanResults"), Value(1));
}

TEST(FirstList, OfATypedNameMeanwhileIsBuiltForIt) {
    ListRun run;
    run.join("Home", "1");
    run.hear({{"Home", "1"}, {"Cafe", "2"}, {"Zoo", "3"}});
    run.controller->start();
    run.device.queues.runBackground();  // scanned and built, but nothing of it shown yet

    run.typeOther("Zoo");
    run.device.queues.runReady();

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Zoo / (CHOOSE_NETWORK) Cafe, Home / >OTHER / REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST(Rescan, LeavesASelectedNameThatIsTheJoinedOneAlone) {
    ListRun run;
    run.join("Home", "1");
    run.hear({{"Home", "1"}, {"Cafe", "2"}});
    run.showList();

    run.hear({{"Home", "1"}, {"Cafe", "2"}, {"Zoo", "3"}});
    run.refresh();

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Home / (CHOOSE_NETWORK) Cafe, Zoo / OTHER / >REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST(Rescan, WithoutASelectionTakesTheNetworkJoinedMeanwhileAndDoesNotMakeItChoosable) {
    ListRun run;
    run.hear({{"Home", "1"}, {"Cafe", "2"}});
    run.showList();
    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) Cafe, Home / >OTHER / REFRESH");

    run.join("Home", "1");
    run.refresh();

    EXPECT_EQ(run.selected(), "Home");
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Home / (CHOOSE_NETWORK) Cafe / OTHER / >REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST(Rescan, WithoutASelectionOrAConnectionLeavesTheFirstSectionEmpty) {
    ListRun run;
    run.hear({{"Cafe", "2"}});
    run.showList();

    run.hear({{"Zoo", "3"}});
    run.refresh();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) Zoo / OTHER / >REFRESH");
    EXPECT_EQ(run.selected(), "(none)");
}

TEST(Rescan, MakesTheJoinedNetworkChoosableWhenAnotherOneWasSelectedBefore) {
    ListRun run("Cafe");
    run.join("Home", "1");
    run.hear({{"Home", "1"}, {"Cafe", "2"}});
    run.showList();

    run.hear({{"Home", "1"}, {"Cafe", "2"}, {"Zoo", "3"}});
    run.refresh();

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Cafe / (CHOOSE_NETWORK) Home, Zoo / OTHER / >REFRESH");
}

TEST(Rescan, WithASelectedNameThatIsNotHeardTakesTheJoinedOneOutOfTheList) {
    ListRun run("Cafe");
    run.join("Home", "1");
    run.hear({{"Home", "1"}, {"Cafe", "2"}});
    run.showList();
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Cafe / (CHOOSE_NETWORK) Home / OTHER / REFRESH");

    run.hear({{"Home", "1"}});
    run.refresh();

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Cafe / (CHOOSE_NETWORK) / OTHER / >REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST(Rescan, RemembersTheJoinedAccessPointOfAnEarlierScan) {
    ListRun run("Cafe");
    run.join("Home", "1");
    run.hear({{"Home", "1", -40}, {"Cafe", "2"}});
    run.showList();
    auto remembered = run.controller->currentNetwork();

    run.hear({{"Home", "9"}, {"Cafe", "2"}});
    run.refresh();

    EXPECT_EQ(run.controller->currentNetwork(), remembered);
    EXPECT_EQ(run.controller->distinctNetworks().network("Home"), nullptr);
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Cafe / (CHOOSE_NETWORK) Home / OTHER / >REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST(Rescan, AfterTheConnectionIsLostShowsTheRememberedNameTwiceByOneRepair) {
    ListRun run("Cafe");
    run.join("Home", "1");
    run.hear({{"Home", "1"}, {"Cafe", "2"}});
    run.showList();

    run.device.service.setJoinedNetwork(std::nullopt);
    run.refresh();

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Cafe / (CHOOSE_NETWORK) Home, Home / OTHER / >REFRESH");
    EXPECT_EQ(run.repairs(), 1);
}

TEST(Rescan, SwitchesSelectionOffUntilItIsDone) {
    ListRun run;
    run.hear({{"Cafe", "2"}});
    run.showList();

    run.choose("REFRESH");
    EXPECT_FALSE(run.controller->tableView()->allowsSelection());
    EXPECT_FALSE(run.controller->scanFinished());
    run.choose("Cafe");
    EXPECT_EQ(run.alert(), "no alert");
    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) >Cafe / OTHER / REFRESH");

    run.device.queues.runReady();
    EXPECT_TRUE(run.controller->tableView()->allowsSelection());
    EXPECT_TRUE(run.controller->scanFinished());
    run.choose("Cafe");
    EXPECT_NE(run.alert(), "no alert");
}

TEST(Rescan, ThatFailsRebuildsTheListFromTheEarlierScan) {
    ListRun run;
    run.hear({{"Cafe", "2"}, {"Zoo", "3"}});
    run.showList();

    run.device.service.setOutcome(kScanTest, failure(7, "radio busy"));
    run.refresh();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) Cafe, Zoo / OTHER / >REFRESH");
    EXPECT_EQ(run.repairs(), 0);
}

TEST(Rescan, KeepsTheListOfBeforeAsItWas) {
    ListRun run;
    run.hear({{"Cafe", "2"}, {"Zoo", "3"}});
    run.showList();

    run.choose("REFRESH");
    run.hear({{"New", "4"}});
    run.device.queues.runReady();

    EXPECT_EQ(run.controller->previousScanFilteredWiFiScanResults().size(), 2u);
    EXPECT_TRUE(run.controller->previousScanFilteredNetworks().contains("Zoo"));
    EXPECT_EQ(run.controller->filteredWiFiScanResults().size(), 1u);
}

}  // namespace
}  // namespace wp
