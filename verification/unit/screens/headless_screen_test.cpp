#include "screens/headless/headless_screen.h"

#include <gtest/gtest.h>

#include "verification/unit/screens/sample_controller.h"

namespace wp::headless {
namespace {

using Rows = std::vector<std::vector<std::string>>;

class HeadlessScreenTest : public testing::Test {
  protected:
    HeadlessScreenTest() {
        controller->buildViews();
        screen.setRootViewController(controller);
        frontEnd.draw();
    }

    Activity activity;
    MainQueue queue{activity};
    std::shared_ptr<SampleController> controller = std::make_shared<SampleController>();
    ui::Screen screen;
    HeadlessScreen frontEnd{screen, queue};
};

TEST_F(HeadlessScreenTest, MirrorsTheFirstList) {
    EXPECT_EQ(frontEnd.rows(), (Rows{{"Home"}, {"Café", "Office"}, {"Other ..."}, {"Refresh"}}));
}

TEST_F(HeadlessScreenTest, FollowsABatchOfChanges) {
    ui::SettingsTableView& table = controller->table();
    controller->names = {"Attic", "Office", "Zoo"};
    controller->selected = "Café";

    table.beginUpdates();
    table.deleteRows({{0, 0}, {0, 1}}, ui::RowAnimation::fade);
    table.insertRows({{0, 0}, {0, 1}, {2, 1}}, ui::RowAnimation::fade);
    table.endUpdates();

    EXPECT_EQ(frontEnd.rows(), (Rows{{"Café"}, {"Attic", "Office", "Zoo"}, {"Other ..."}, {"Refresh"}}));
    EXPECT_EQ(frontEnd.faults(), 0);
    EXPECT_EQ(table.repairs(), 0);
}

TEST_F(HeadlessScreenTest, FollowsAReload) {
    controller->names.clear();

    controller->table().reloadData();

    EXPECT_EQ(frontEnd.rows(), (Rows{{"Home"}, {}, {"Other ..."}, {"Refresh"}}));
}

TEST_F(HeadlessScreenTest, CountsChangesThatDoNotLeadToTheTablesRows) {
    ui::TableChanges wrong;
    wrong.deletions = {{5, 1}};

    screen.tableChanged(controller->table(), wrong);

    EXPECT_EQ(frontEnd.faults(), 1);
    EXPECT_EQ(frontEnd.rows()[1].size(), 2U);
}

TEST_F(HeadlessScreenTest, TurnsTheMainQueueUntilTheConditionHolds) {
    bool isDone = false;
    queue.after(std::chrono::milliseconds(5), [&] { isDone = true; });

    EXPECT_TRUE(frontEnd.runUntil([&] { return isDone; }));
    EXPECT_FALSE(frontEnd.runUntil([] { return false; }, ui::FrontEnd::Clock::now()));
}

}  // namespace
}  // namespace wp::headless
