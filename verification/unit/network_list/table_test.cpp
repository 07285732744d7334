#include <gtest/gtest.h>

#include <algorithm>

#include "network_list/scan_list.h"
#include "verification/unit/network_list/list_run.h"

namespace wp {
namespace {

using namespace fakes;
using ui::Key;
using Table = ui::SettingsTableView;

struct ShownList : ::testing::Test {
    ListRun run;

    ShownList() {
        run.join("Home", "1");
        run.hear({{"Home", "1"}, {"Cafe", "2"}});
        run.showList();
    }
    Table& table() { return *run.controller->tableView(); }
};

TEST_F(ShownList, HasFourSectionsAndNothingInAnyOther) {
    EXPECT_EQ(run.controller->numberOfSectionsInTableView(table()), 4);
    EXPECT_EQ(run.controller->networksOffset(), 2);
    for (int section : {-1, 4, 99}) {
        EXPECT_EQ(run.controller->tableViewNumberOfRowsInSection(table(), section), 0);
        EXPECT_EQ(run.controller->tableViewTitleForHeaderInSection(table(), section), std::nullopt);
    }
}

TEST_F(ShownList, GivesEachSectionTheHeightsOfItsHeaderAndFooter) {
    constexpr double automatic = Table::kAutomaticDimension;
    constexpr double smallest = 2.2250738585072014e-308;
    const double headers[] = {automatic, automatic, smallest, smallest};
    const double footers[] = {automatic, smallest, smallest, smallest};

    for (int section = 0; section < 4; ++section) {
        EXPECT_EQ(run.controller->tableViewHeightForHeaderInSection(table(), section), headers[section]);
        EXPECT_EQ(run.controller->tableViewHeightForFooterInSection(table(), section), footers[section]);
    }
}

TEST_F(ShownList, LetsEveryRowHaveTheFocusAndPrefersTheFirstVisibleOne) {
    EXPECT_TRUE(run.controller->tableViewCanFocusRowAtIndexPath(table(), {0, 3}));
    EXPECT_EQ(run.controller->indexPathForPreferredFocusedViewInTableView(table()), (ui::IndexPath{0, 0}));
    EXPECT_EQ(run.controller->positionForBar(), 3);
}

TEST_F(ShownList, PrefersTheSelectedRowWhileTheTestsRun) {
    run.focus("OTHER");

    run.controller->showProgress();

    EXPECT_EQ(run.controller->indexPathForPreferredFocusedViewInTableView(table()), (ui::IndexPath{0, 0}));
    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) >Home / (CHOOSE_NETWORK) ~Cafe / ~OTHER / ~REFRESH");
}

TEST_F(ShownList, DeselectsTheRowThatWasChosen) {
    run.choose("Cafe");

    EXPECT_EQ(table().indexPathForSelectedRow(), std::nullopt);
    EXPECT_FALSE(table().cellForRow({0, 1})->isSelected());
}

TEST_F(ShownList, HasNoHeaderViewsAndNoImagesInAnyRow) {
    run.controller->showSpinner();

    EXPECT_EQ(run.controller->networksGroupHeaderView(), nullptr);
    EXPECT_EQ(run.controller->selectedNetworkHeaderView(), nullptr);
    EXPECT_EQ(run.controller->blueCheck(), nullptr);
    EXPECT_EQ(run.controller->spacer(), nullptr);
    EXPECT_FALSE(run.controller->scanFinished());
    EXPECT_EQ(table().cellForRow({0, 1})->detailText(), "");
}

TEST_F(ShownList, HasNoButtonsInItsBar) {
    std::string before = run.list();

    run.controller->enableRightBarButtonItem(true);
    run.controller->removeNavigationBarButtons();

    EXPECT_EQ(run.list(), before);
}

TEST_F(ShownList, MovesThroughTheSectionsByArrowsWhileSelectionIsOff) {
    run.controller->enableTableViewSelection(false);

    run.press({Key::down, Key::down, Key::select, Key::down, Key::down});

    EXPECT_EQ(run.list(), "(SELECTED_NETWORK) Home / (CHOOSE_NETWORK) Cafe / OTHER / >REFRESH");
    EXPECT_EQ(run.alert(), "no alert");
}

struct LongList : ::testing::Test {
    ListRun run;

    LongList() {
        std::vector<AccessPoint> many;
        for (int i = 10; i < 90; ++i) many.push_back({"net" + std::to_string(i), std::to_string(i)});
        run.hear(many);
    }
    bool isVisible(ui::IndexPath path) {
        auto visible = run.controller->tableView()->indexPathsForVisibleRows();
        return std::find(visible.begin(), visible.end(), path) != visible.end();
    }
};

TEST_F(LongList, IsScrolledToTheRowThatHadTheFocusLast) {
    run.showList();

    EXPECT_EQ(run.controller->tableView()->lastFocusedIndexPath(), (ui::IndexPath{0, 2}));
    EXPECT_TRUE(isVisible({0, 2}));
    EXPECT_FALSE(isVisible({0, 1}));
}

TEST_F(LongList, IsScrolledToTheSelectedRowWhenTheTestsBegin) {
    run.join("Home", "1");
    run.showList();
    run.focus("OTHER");
    EXPECT_FALSE(isVisible({0, 0}));

    run.controller->showProgress();

    EXPECT_TRUE(isVisible({0, 0}));
    EXPECT_EQ(run.controller->tableView()->contentOffset(), 0);
}

TEST(RefreshRow, IgnoresTouchesBeforeTheFirstList) {
    ListRun run;
    run.controller->start();

    run.choose("REFRESH");

    EXPECT_EQ(run.device.queues.readyInBackground(), 1u);  // the first scan alone
    EXPECT_TRUE(run.controller->tableView()->allowsSelection());
}

}  // namespace
}  // namespace wp
