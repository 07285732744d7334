#include <gtest/gtest.h>

#include "verification/unit/ui/table_fixture.h"

namespace wp::ui::testing {
namespace {

struct FocusCase {
    const char* name;
    const char* before;
    IndexPath focused;
    std::vector<IndexPath> deleted;
    std::vector<IndexPath> inserted;
    const char* after;
    const char* focusedAfter;
};

class FocusThroughABatch : public ::testing::TestWithParam<FocusCase> {};

TEST_P(FocusThroughABatch, StaysOrGoesToTheNearestRow) {
    const FocusCase& given = GetParam();
    TableOnScreen screen(std::string(given.before));
    screen.moveFocusTo(given.focused);

    screen.data.sections = sectionsOf(given.after);
    screen.table->beginUpdates();
    screen.table->deleteRows(given.deleted, RowAnimation::fade);
    screen.table->insertRows(given.inserted, RowAnimation::fade);
    screen.table->endUpdates();

    EXPECT_EQ(screen.focusedText(), given.focusedAfter);
    EXPECT_EQ(screen.table->repairs(), 0);
}

INSTANTIATE_TEST_SUITE_P(
    Rows, FocusThroughABatch,
    ::testing::Values(
        FocusCase{"KeptRowThatMovesDown", "b", {0, 0}, {}, {{0, 0}}, "a b", "b"},
        FocusCase{"KeptRowThatMovesUp", "a b", {1, 0}, {{0, 0}}, {}, "b", "b"},
        FocusCase{"DeletedAndInsertedAgain", "Home|a", {0, 0}, {{0, 0}}, {{0, 0}}, "Home|a", "Home"},
        FocusCase{
            "DeletedAndInsertedUnderAnotherName", "Home|a", {0, 0}, {{0, 0}}, {{0, 0}}, "Office|a", "Office"},
        FocusCase{"InsertedAgainElsewhere", "a b c", {0, 0}, {{0, 0}}, {{2, 0}}, "b c a", "a"},
        FocusCase{"GoneToTheRowInItsPlace", "a b c", {1, 0}, {{1, 0}}, {}, "a c", "c"},
        FocusCase{"GoneWithRowsBeforeIt", "a b c d e", {2, 0}, {{0, 0}, {2, 0}}, {}, "b d e", "d"},
        FocusCase{"GoneWithANewRowInItsPlace", "a b c", {1, 0}, {{1, 0}}, {{1, 0}}, "a x c", "x"},
        FocusCase{"GoneAtTheEndToTheOneBefore", "a b", {1, 0}, {{1, 0}}, {}, "a", "a"},
        FocusCase{"GoneWithItsSectionToTheSectionBefore",
                  "Home|a|other",
                  {0, 1},
                  {{0, 1}},
                  {},
                  "Home||other",
                  "Home"},
        FocusCase{"AllRowsChanged",
                  "a b c",
                  {1, 0},
                  {{0, 0}, {1, 0}, {2, 0}},
                  {{0, 0}, {1, 0}, {2, 0}},
                  "x y z",
                  "y"},
        FocusCase{"NothingLeftBeforeItToTheFirstRow", "|a|other", {0, 1}, {{0, 1}}, {}, "||other", "other"}),
    [](const auto& test) { return std::string(test.param.name); });

TEST(TableFocus, WithNothingBeforeItGoesToThePreferredRow) {
    TableOnScreen given("a|other refresh");
    given.moveFocusTo({0, 0});
    given.data.preferred = IndexPath{1, 1};

    given.data.sections[0] = {};
    given.table->deleteRows({{0, 0}}, RowAnimation::fade);

    EXPECT_EQ(given.focusedText(), "refresh");
}

TEST(TableFocus, ArrowsGoThroughAllRowsOfAllSectionsAndStopAtTheEnds) {
    TableOnScreen given("a||b c");
    std::string path;

    for (int i = 0; i < 4; ++i) {
        path += given.focusedText();
        given.screen.press(Key::down);
    }
    for (int i = 0; i < 4; ++i) {
        path += given.focusedText();
        given.screen.press(Key::up);
    }

    EXPECT_EQ(path, "abcccbaa");
}

TEST(TableFocus, SkipsRowsThatCannotHaveIt) {
    TableOnScreen given("a b c");
    given.data.unfocusable = {"b"};

    given.screen.press(Key::down);

    EXPECT_EQ(given.focusedText(), "c");
}

TEST(TableFocus, FollowsThePreferredRowThroughReloadsUntilAKeyIsPressed) {
    TableOnScreen given("|other");
    EXPECT_EQ(given.focusedText(), "other");

    given.data.sections[0] = {"Home"};
    given.data.preferred = IndexPath{0, 0};
    given.table->reloadData();
    EXPECT_EQ(given.focusedText(), "Home");

    given.screen.press(Key::down);
    given.table->reloadData();
    EXPECT_EQ(given.focusedText(), "other");
}

TEST(TableFocus, StaysOnItsRowThroughAReloadThatMovesTheRow) {
    TableOnScreen given("b c");
    given.moveFocusTo({1, 0});

    given.data.sections[0] = {"a", "b", "c"};
    given.table->reloadData();

    EXPECT_EQ(given.focusedText(), "c");
}

TEST(TableFocus, GoesToTheRowBeforeWhenAReloadLeavesNoneInItsPlace) {
    TableOnScreen given("a b c");
    given.moveFocusTo({2, 0});

    given.data.sections[0] = {"x"};
    given.table->reloadData();

    EXPECT_EQ(given.focusedText(), "x");
}

TEST(TableFocus, StaysOnARowThatIsReloaded) {
    TableOnScreen given("a refresh");
    given.moveFocusTo({1, 0});

    given.table->reloadRows({{1, 0}}, RowAnimation::fade);

    EXPECT_EQ(given.focusedText(), "refresh");
}

TEST(TableSelection, ChoosesARowOnlyWhileSelectionIsOnAndTheRowTakesTouches) {
    TableOnScreen given("a b");
    given.data.disabled = {"b"};
    given.table->reloadData();

    given.screen.press(Key::select);
    given.screen.press(Key::down);
    given.screen.press(Key::select);
    given.screen.press(Key::up);
    given.table->setAllowsSelection(false);
    given.screen.press(Key::select);

    EXPECT_EQ(given.data.chosen, (std::vector<IndexPath>{{0, 0}}));
    EXPECT_EQ(given.table->indexPathForSelectedRow(), std::nullopt);
}

TEST(TableScrolling, KeepsTheFocusedRowInsideTheTableWithRoomBelow) {
    Rows rows;
    for (int i = 0; i < 100; ++i) rows.push_back("row " + std::to_string(i));
    TableOnScreen given({rows});
    given.table->setContentInset({0, 0, 60, 0});

    for (int i = 0; i < 50; ++i) given.screen.press(Key::down);

    Rect row = given.table->rectForRow({50, 0});
    double offset = given.table->contentOffset();
    EXPECT_EQ(row.bottom() + 60, offset + 918);
    auto visible = given.table->indexPathsForVisibleRows();
    EXPECT_EQ(visible.back().row, 51);  // its upper edge shows in the room below
    EXPECT_LT(visible.size(), 16u);
    EXPECT_GE(visible.size(), 13u);
}

TEST(TableScrolling, ShowsTheRowAboveTheFocusedOne) {
    Rows rows;
    for (int i = 0; i < 100; ++i) rows.push_back("row " + std::to_string(i));
    TableOnScreen given({rows});

    for (int i = 0; i < 50; ++i) given.screen.press(Key::down);
    for (int i = 0; i < 30; ++i) given.screen.press(Key::up);

    EXPECT_EQ(given.table->indexPathsForVisibleRows().front(), (IndexPath{19, 0}));
    EXPECT_EQ(given.table->contentOffset(), given.table->rectForRow({19, 0}).y);
}

TEST(TableGroups, AreApartWhereNoTitleStandsBetweenThem) {
    TableOnScreen given("a b||c|d");

    double gap = SettingsTableView::kGroupGap;
    EXPECT_EQ(given.table->rectForRow({0, 2}).y - given.table->rectForRow({1, 0}).bottom(), gap);
    EXPECT_EQ(given.table->rectForRow({0, 3}).y - given.table->rectForRow({0, 2}).bottom(), gap);
    EXPECT_EQ(given.table->contentHeight(), given.table->rectForRow({0, 3}).bottom());
}

TEST(TableScrolling, DoesNothingForARowThatThereIsNot) {
    TableOnScreen given("a");

    given.table->scrollToRow({0, 7}, SettingsTableView::ScrollPosition::none, Animated::yes);

    EXPECT_EQ(given.table->contentOffset(), 0);
}

}  // namespace
}  // namespace wp::ui::testing
