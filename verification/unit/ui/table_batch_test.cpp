#include <gtest/gtest.h>

#include "verification/unit/ui/table_fixture.h"

namespace wp::ui::testing {
namespace {

struct Batch {
    const char* name;
    Rows before;
    std::vector<int> deleted;
    std::vector<int> inserted;
    Rows after;
};

std::vector<IndexPath> inSectionZero(const std::vector<int>& rows) {
    std::vector<IndexPath> paths;
    for (int row : rows) paths.push_back({row, 0});
    return paths;
}

class ABatchThatAgrees : public ::testing::TestWithParam<Batch> {};

TEST_P(ABatchThatAgrees, DeletesByOldPositionsAndInsertsByNewOnes) {
    const Batch& batch = GetParam();
    TableOnScreen given(std::vector<Rows>{batch.before});

    given.data.sections = {batch.after};
    given.table->beginUpdates();
    given.table->insertRows(inSectionZero(batch.inserted), RowAnimation::fade);
    given.table->deleteRows(inSectionZero(batch.deleted), RowAnimation::fade);
    given.table->endUpdates();

    EXPECT_EQ(given.shown(), std::vector<Rows>{batch.after});
    EXPECT_EQ(given.table->repairs(), 0);
    EXPECT_TRUE(given.notes.empty());
}

INSTANTIATE_TEST_SUITE_P(
    Rows, ABatchThatAgrees,
    ::testing::Values(Batch{"Nothing", {"a", "b"}, {}, {}, {"a", "b"}},
                      Batch{"FirstGone", {"a", "b", "c"}, {0}, {}, {"b", "c"}},
                      Batch{"LastGone", {"a", "b", "c"}, {2}, {}, {"a", "b"}},
                      Batch{"AllGone", {"a", "b"}, {0, 1}, {}, {}},
                      Batch{"FromNothing", {}, {}, {0, 1}, {"a", "b"}},
                      Batch{"NewBetween", {"a", "c"}, {}, {1}, {"a", "b", "c"}},
                      Batch{"OneInOneOut", {"a", "b", "c"}, {0}, {2}, {"b", "c", "d"}},
                      Batch{"EveryOther", {"a", "c", "e"}, {1}, {1, 3}, {"a", "b", "e", "f"}},
                      Batch{"AllChanged", {"a", "b"}, {0, 1}, {0, 1, 2}, {"x", "y", "z"}}),
    [](const auto& test) { return std::string(test.param.name); });

struct Disagreement {
    const char* name;
    Rows before;
    std::vector<int> deleted;
    std::vector<int> inserted;
    Rows after;
    const char* note;
};

class ABatchThatDisagrees : public ::testing::TestWithParam<Disagreement> {};

TEST_P(ABatchThatDisagrees, ReloadsOnceSaysSoOnceAndIsCounted) {
    const Disagreement& batch = GetParam();
    TableOnScreen given(std::vector<Rows>{batch.before});

    given.data.sections = {batch.after};
    given.table->beginUpdates();
    given.table->deleteRows(inSectionZero(batch.deleted), RowAnimation::fade);
    given.table->insertRows(inSectionZero(batch.inserted), RowAnimation::fade);
    given.table->endUpdates();

    EXPECT_EQ(given.shown(), std::vector<Rows>{batch.after});
    EXPECT_EQ(given.table->repairs(), 1);
    EXPECT_EQ(given.notes, std::vector<std::string>{batch.note});
    EXPECT_EQ(given.observer.reloads, 1);
    EXPECT_TRUE(given.observer.changes.empty());
}

INSTANTIATE_TEST_SUITE_P(
    Rows, ABatchThatDisagrees,
    ::testing::Values(Disagreement{"Counts",
                                   {"a", "b"},
                                   {},
                                   {0},
                                   {"a"},
                                   "table: section 0 has 1 rows where 2 - 0 + 1 were expected; reloaded"},
                      Disagreement{"DeletesWhatIsNotThere",
                                   {"a"},
                                   {4},
                                   {},
                                   {},
                                   "table: there is no row 4 of section 0 to delete; reloaded"},
                      Disagreement{"DeletesTwice",
                                   {"a", "b"},
                                   {0, 0},
                                   {},
                                   {"b"},
                                   "table: a row is deleted or inserted twice; reloaded"},
                      Disagreement{"InsertsBeyondTheEnd",
                                   {"a"},
                                   {},
                                   {7},
                                   {"a", "b"},
                                   "table: a row is inserted beyond the end of section 0; reloaded"},
                      Disagreement{
                          "KeptRowsChangedPlaces",
                          {"Home", "home"},
                          {},
                          {},
                          {"home", "Home"},
                          "table: row 0 of section 0 is no longer the row that was kept there; reloaded"}),
    [](const auto& test) { return std::string(test.param.name); });

TEST(TableBatch, NestedBatchesAreOneChangeForTheFrontEnd) {
    TableOnScreen given("a b|other");

    given.data.sections[0] = {"b", "c"};
    given.table->beginUpdates();
    given.table->beginUpdates();
    given.table->deleteRows({{0, 0}}, RowAnimation::fade);
    given.table->endUpdates();
    EXPECT_TRUE(given.observer.changes.empty());
    given.table->insertRows({{1, 0}}, RowAnimation::fade);
    given.table->reloadRows({{0, 1}}, RowAnimation::fade);
    given.table->endUpdates();

    ASSERT_EQ(given.observer.changes.size(), 1u);
    const TableChanges& change = given.observer.changes.front();
    EXPECT_EQ(change.deletions, (std::vector<IndexPath>{{0, 0}}));
    EXPECT_EQ(change.insertions, (std::vector<IndexPath>{{1, 0}}));
    EXPECT_EQ(change.reloads, (std::vector<IndexPath>{{0, 1}}));
}

TEST(TableBatch, ReloadedRowsAreToldByTheirNewPositions) {
    TableOnScreen given("a b c");

    given.data.sections[0] = {"b", "c*"};
    given.table->beginUpdates();
    given.table->reloadRows({{2, 0}}, RowAnimation::fade);
    given.table->deleteRows({{0, 0}}, RowAnimation::fade);
    given.table->endUpdates();

    EXPECT_EQ(given.shown(), sectionsOf("b c*"));
    EXPECT_EQ(given.observer.changes.front().reloads, (std::vector<IndexPath>{{1, 0}}));
    EXPECT_EQ(given.table->repairs(), 0);
}

TEST(TableBatch, AKeptRowKeepsItsCell) {
    TableOnScreen given("a b");
    auto cell = given.table->cellForRow({1, 0});

    given.data.sections[0] = {"b"};
    given.table->deleteRows({{0, 0}}, RowAnimation::fade);

    EXPECT_EQ(given.table->cellForRow({0, 0}), cell);
}

TEST(TableBatch, SectionTitlesAreAskedAgainAtTheEndOfEveryOutermostBatch) {
    TableOnScreen given("a");
    EXPECT_EQ(given.table->titleForHeader(0), std::nullopt);

    given.data.titles = {"Chosen"};
    given.table->beginUpdates();
    given.table->beginUpdates();
    given.table->endUpdates();
    EXPECT_EQ(given.table->titleForHeader(0), std::nullopt);
    given.table->endUpdates();

    EXPECT_EQ(given.table->titleForHeader(0), "Chosen");
    ASSERT_EQ(given.observer.changes.size(), 1u);
    EXPECT_TRUE(given.observer.changes.front().titlesChanged);
}

TEST(TableBatch, TheTableDrawsFromItsOwnRowsWhileTheDataSourceChanges) {
    TableOnScreen given("a b");
    int asked = given.data.cellsAsked;

    given.data.sections[0] = {};
    given.screen.press(Key::down);
    given.screen.press(Key::down);
    given.screen.layoutIfNeeded();

    EXPECT_EQ(given.shown(), sectionsOf("a b"));
    EXPECT_EQ(given.focusedText(), "b");
    EXPECT_EQ(given.data.cellsAsked, asked);
}

TEST(TableBatch, ABatchBeforeTheFirstLayoutLoadsTheTableWithoutARepair) {
    FakeTable data;
    data.sections = {{"a", "b", "c"}};
    SettingsTableView table({}, SettingsTableView::Style::grouped);
    table.setDataSource(&data);

    table.insertRows({{2, 0}}, RowAnimation::fade);

    EXPECT_EQ(table.numberOfRows(0), 3);
    EXPECT_EQ(table.repairs(), 0);
}

TEST(TableBatch, AnEndWithoutABeginningDoesNothing) {
    TableOnScreen given("a");

    given.table->endUpdates();
    given.data.sections[0] = {"a", "b"};
    given.table->insertRows({{1, 0}}, RowAnimation::fade);

    EXPECT_EQ(given.shown(), sectionsOf("a b"));
    EXPECT_EQ(given.table->repairs(), 0);
}

TEST(TableCells, AreOfTheClassRegisteredForTheirIdentifier) {
    struct OwnCell : TableViewCell {
        using TableViewCell::TableViewCell;
    };
    SettingsTableView table({}, SettingsTableView::Style::grouped);
    table.registerCellClass<OwnCell>("own");

    auto own = table.dequeueReusableCell("own", {0, 0});
    auto plain = table.dequeueReusableCell("unknown", {0, 0});

    EXPECT_NE(std::dynamic_pointer_cast<OwnCell>(own), nullptr);
    EXPECT_EQ(std::dynamic_pointer_cast<OwnCell>(plain), nullptr);
    EXPECT_EQ(plain->reuseIdentifier(), "unknown");
}

TEST(TableCells, ThatWereUsedBeforeAreAsGoodAsNew) {
    TableOnScreen given("a");
    TableViewCell* used = given.table->cellForRow({0, 0}).get();
    used->setDetailText("detail");
    used->setUserInteractionEnabled(false);

    given.data.sections[0] = {};
    given.table->deleteRows({{0, 0}}, RowAnimation::fade);
    auto again = given.table->dequeueReusableCell("cell", {0, 0});

    EXPECT_EQ(again.get(), used);
    EXPECT_EQ(again->text(), "");
    EXPECT_EQ(again->detailText(), "");
    EXPECT_TRUE(again->isUserInteractionEnabled());
}

}  // namespace
}  // namespace wp::ui::testing
