#include <gtest/gtest.h>

#include "network_list/scan_list.h"
#include "verification/unit/network_list/list_run.h"

namespace wp {
namespace {

using namespace fakes;

/// A front end that keeps the last change of the table.
struct LastChange final : ui::ScreenObserver {
    explicit LastChange(ui::Screen& shown) : screen(shown) { screen.setObserver(this); }
    ~LastChange() override { screen.setObserver(nullptr); }
    void tableChanged(ui::SettingsTableView&, const ui::TableChanges& change) override {
        ++count;
        last = change;
    }
    std::vector<ui::IndexPath> deletedNetworks() const { return networks(last.deletions); }
    std::vector<ui::IndexPath> insertedNetworks() const { return networks(last.insertions); }

    static std::vector<ui::IndexPath> networks(std::vector<ui::IndexPath> paths) {
        std::erase_if(paths, [](ui::IndexPath path) { return path.section != 1; });
        return paths;
    }

    ui::Screen& screen;
    int count = 0;
    ui::TableChanges last;
};

using Paths = std::vector<ui::IndexPath>;

TEST(ListUpdate, OfTheSameNamesTouchesNoNetworksRow) {
    ListRun run;
    run.hear({{"a", "1"}, {"b", "2"}});
    run.showList();
    LastChange change(run.device.screen);
    auto cell = run.controller->tableView()->cellForRow({1, 1});

    run.hear({{"b", "2"}, {"a", "1"}});
    run.refresh();

    EXPECT_EQ(change.deletedNetworks(), Paths{});
    EXPECT_EQ(change.insertedNetworks(), Paths{});
    EXPECT_EQ(run.controller->tableView()->cellForRow({1, 1}), cell);
    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) a, b / OTHER / >REFRESH");
}

TEST(ListUpdate, OfANetworkThatBecameStrongerKeepsItsRowAndCell) {
    ListRun run;
    run.hear({{"a", "1", -80}});
    run.showList();
    auto cell = run.controller->tableView()->cellForRow({0, 1});

    run.hear({{"a", "9", -30}});
    run.refresh();

    EXPECT_EQ(run.controller->tableView()->cellForRow({0, 1}), cell);
    EXPECT_EQ(run.controller->filteredWiFiScanResults()[0]->bssid, "9");
}

TEST(ListUpdate, DeletesLostNetworksAndInsertsNewOnesAsOneChange) {
    ListRun run;
    run.hear({{"a", "1"}, {"c", "2"}, {"e", "3"}});
    run.showList();
    run.focus("e");
    LastChange change(run.device.screen);
    run.hear({{"b", "4"}, {"c", "2"}, {"f", "5"}});

    run.choose("REFRESH");
    int before = change.count;
    run.focus("e");
    run.device.queues.runReady();

    EXPECT_EQ(change.count, before + 1);
    EXPECT_EQ(change.deletedNetworks(), (Paths{{0, 1}, {2, 1}}));
    EXPECT_EQ(change.insertedNetworks(), (Paths{{0, 1}, {2, 1}}));
    EXPECT_EQ(change.last.reloads, (Paths{{0, 3}}));
    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) b, c, >f / OTHER / REFRESH");
}

TEST(ListUpdate, AfterWhichEveryNameChangedReplacesEveryRow) {
    ListRun run;
    run.hear({{"a", "1"}, {"b", "2"}});
    run.showList();
    LastChange change(run.device.screen);

    run.hear({{"x", "1"}, {"y", "2"}, {"z", "3"}});
    run.refresh();

    EXPECT_EQ(change.deletedNetworks(), (Paths{{0, 1}, {1, 1}}));
    EXPECT_EQ(change.insertedNetworks(), (Paths{{0, 1}, {1, 1}, {2, 1}}));
    EXPECT_EQ(run.repairs(), 0);
}

TEST(ListUpdate, CountsANetworkThatBecameTheSelectedOneAsLost) {
    ListRun run;
    run.hear({{"Home", "1"}, {"Cafe", "2"}});
    run.showList();
    LastChange change(run.device.screen);

    run.join("Home", "1");
    run.refresh();

    EXPECT_EQ(change.deletedNetworks(), (Paths{{1, 1}}));
    EXPECT_EQ(change.last.insertions, (Paths{{0, 0}}));
    EXPECT_TRUE(change.last.titlesChanged);
}

TEST(ListUpdate, OfAnEmptyFirstScanStillReloadsTheRefreshRow) {
    ListRun run;
    run.hear({});
    LastChange change(run.device.screen);

    run.showList();

    EXPECT_EQ(change.last.insertions, Paths{});
    EXPECT_EQ(change.last.reloads, (Paths{{0, 3}}));
}

TEST(ListUpdate, KeepsTheFocusOnItsNetwork) {
    ListRun run;
    run.hear({{"m", "1"}, {"n", "2"}});
    run.showList();

    run.choose("REFRESH");
    run.focus("n");
    run.hear({{"a", "3"}, {"b", "4"}, {"n", "2"}});
    run.device.queues.runReady();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) a, b, >n / OTHER / REFRESH");
}

TEST(ListUpdate, ThatLosesAllOfALongListHandsTheFocusToTheFirstRowLeft) {
    ListRun run;
    std::vector<AccessPoint> many;
    for (char name = 'a'; name <= 'l'; ++name) many.push_back({std::string(1, name), "1"});
    run.hear(many);
    run.showList();

    run.choose("REFRESH");
    run.focus("d");  // the list stays scrolled almost to its end
    run.hear({});
    run.device.queues.runReady();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) / >OTHER / REFRESH");
}

TEST(ListUpdate, OfNamesThatDifferOnlyInCaseAndChangedPlacesRepairsTheTableOnce) {
    ListRun run;
    run.hear({{"Home", "1"}, {"home", "2"}});
    run.showList();

    run.hear({{"home", "2"}, {"Home", "1"}});
    run.refresh();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) home, Home / OTHER / >REFRESH");
    EXPECT_EQ(run.repairs(), 1);
}

TEST(ListUpdate, ShownTwiceByASecondPowerOnIsRepairedToOneOfEach) {
    ListRun run;
    run.hear({{"a", "1"}, {"b", "2"}});
    run.showList();

    run.hear({{"b", "2"}, {"c", "3"}});
    run.device.wifi.turnPower(1);
    run.device.queues.runReady();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) >b, c / OTHER / REFRESH");
    EXPECT_EQ(run.repairs(), 1);
}

TEST(ListUpdate, OfARescanThatEndsAfterASecondPowerOnLosesAndDoublesNothing) {
    ListRun run;
    run.hear({{"a", "1"}, {"b", "2"}});
    run.showList();

    run.choose("REFRESH");
    run.device.wifi.turnPower(1);
    run.device.queues.runOneOnMain();  // the power callback: two scans are under way now
    run.device.queues.runOneInBackground();
    run.hear({{"b", "2"}, {"c", "3"}});
    run.device.queues.runReady();

    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) b, c / OTHER / >REFRESH");
    EXPECT_LE(run.repairs(), 1);
}

}  // namespace
}  // namespace wp
