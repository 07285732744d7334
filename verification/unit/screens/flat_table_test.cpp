#include "screens/tv/flat_table.h"

#include <gtest/gtest.h>

#include "verification/unit/screens/sample_controller.h"

namespace wp::tv {
namespace {

/// Plays what the flat table says on a list of texts, as the scene does.
class FlatTableTest : public testing::Test, private ui::ScreenObserver {
  protected:
    FlatTableTest() {
        controller->buildViews();
        screen.setRootViewController(controller);
        screen.layoutIfNeeded();
        play(flat.reload(table()));
        screen.setObserver(this);
    }
    ~FlatTableTest() override { screen.setObserver(nullptr); }

    ui::SettingsTableView& table() { return controller->table(); }

    void play(const LineChanges& changes) {
        last = changes;
        for (int removal : changes.removals) shown.erase(shown.begin() + removal);
        for (int insertion : changes.insertions)
            shown.insert(shown.begin() + insertion, flat.lines()[static_cast<std::size_t>(insertion)].text);
    }

    std::vector<std::string> texts() const {
        std::vector<std::string> all;
        for (const Line& line : flat.lines()) all.push_back(line.text);
        return all;
    }

    void tableChanged(ui::SettingsTableView& changed, const ui::TableChanges& changes) override {
        play(flat.apply(changed, changes));
    }
    void tableReloaded(ui::SettingsTableView& reloaded) override { play(flat.reload(reloaded)); }

    ui::Screen screen;
    std::shared_ptr<SampleController> controller = std::make_shared<SampleController>();
    FlatTable flat;
    LineChanges last;
    std::vector<std::string> shown;
};

TEST_F(FlatTableTest, TitlesAndRowsStandInOneOrderAtTheTablesPlaces) {
    EXPECT_EQ(texts(), (std::vector<std::string>{"Selected network", "Home", "Choose a network", "Café",
                                                 "Office", "Other ...", "Refresh"}));
    EXPECT_EQ(flat.lines()[3].top, table().rectForRow({0, 1}).y);
    EXPECT_TRUE(flat.lines()[0].isHeader());
    EXPECT_TRUE(flat.lines()[3].isFirst);
    EXPECT_FALSE(flat.lines()[3].isLast);
    EXPECT_TRUE(flat.lines()[4].isLast);
}

TEST_F(FlatTableTest, ABatchIsOneSetOfChangesWithOldAndNewPositions) {
    controller->names = {"Attic", "Office", "Zoo"};

    table().beginUpdates();
    table().deleteRows({{0, 1}}, ui::RowAnimation::fade);
    table().insertRows({{0, 1}, {2, 1}}, ui::RowAnimation::fade);
    table().endUpdates();

    EXPECT_EQ(last, (LineChanges{{3}, {3, 5}}));
    EXPECT_EQ(shown, texts());
}

TEST_F(FlatTableTest, ATitleComesAndGoesWithItsSection) {
    controller->selected.clear();

    table().deleteRows({{0, 0}}, ui::RowAnimation::fade);

    EXPECT_EQ(last, (LineChanges{{1, 0}, {}}));
    EXPECT_EQ(shown, texts());

    controller->selected = "Home";
    table().insertRows({{0, 0}}, ui::RowAnimation::fade);

    EXPECT_EQ(last, (LineChanges{{}, {0, 1}}));
    EXPECT_EQ(shown, texts());
}

TEST_F(FlatTableTest, ARowThatIsReloadedStaysTheLineThatItWas) {
    table().reloadRows({{0, 3}}, ui::RowAnimation::fade);

    EXPECT_TRUE(last.isEmpty());
}

TEST_F(FlatTableTest, ARowThatIsDeletedAndInsertedAgainGoesAndComes) {
    controller->selected = "Elsewhere";

    table().beginUpdates();
    table().deleteRows({{0, 0}}, ui::RowAnimation::fade);
    table().insertRows({{0, 0}}, ui::RowAnimation::fade);
    table().endUpdates();

    EXPECT_EQ(last, (LineChanges{{1}, {1}}));
    EXPECT_EQ(texts()[1], "Elsewhere");
}

TEST_F(FlatTableTest, AWholeReloadKeepsTheLinesThatAreStillThere) {
    controller->names = {"Attic", "Café", "Zoo"};

    table().reloadData();

    EXPECT_EQ(last, (LineChanges{{4}, {3, 5}}));
    shown = texts();
}

TEST_F(FlatTableTest, AReloadOfTheFrozenListChangesNothingButTheRowsLooks) {
    controller->showProgress(0, 11);

    EXPECT_TRUE(last.isEmpty());
    EXPECT_TRUE(flat.lines()[1].isEnabled);
    EXPECT_FALSE(flat.lines()[3].isEnabled);
}

TEST_F(FlatTableTest, NamesStandInTheirDisplayForm) {
    controller->names = {"a\x1b[31m", "b\u202E"};

    table().reloadData();

    EXPECT_EQ(texts()[3], "a\\x1B[31m");
    EXPECT_EQ(texts()[4], "b\\u{202E}");
}

}  // namespace
}  // namespace wp::tv
