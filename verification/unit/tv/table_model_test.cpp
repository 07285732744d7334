#include "screens/tv/table_model.h"

#include <gtest/gtest.h>

#include <QCoreApplication>

namespace wp::tv {
namespace {

Line row(int number, const std::string& text) {
    Line line;
    line.row = number;
    line.text = text;
    line.top = 66.0 * number;
    line.height = 66;
    return line;
}

std::vector<Line> rows(const std::vector<std::string>& texts) {
    std::vector<Line> lines;
    for (const std::string& text : texts) lines.push_back(row(static_cast<int>(lines.size()), text));
    return lines;
}

class TableModelTest : public testing::Test {
  protected:
    TableModelTest() { model.setWindow(0, 918); }

    QVariant at(int position, TableModel::Role role) { return model.data(model.index(position), role); }

    /// Each entry's text, one that fades away in brackets.
    std::vector<std::string> entries() {
        std::vector<std::string> all;
        for (int position = 0; position < model.rowCount(); ++position) {
            std::string text = at(position, TableModel::textRole).toString().toStdString();
            all.push_back(at(position, TableModel::isLeavingRole).toBool() ? "(" + text + ")" : text);
        }
        return all;
    }

    void release(int position) {
        model.release(at(position, TableModel::idRole).toInt());
        QCoreApplication::processEvents();
    }

    TableModel model;
};

using Texts = std::vector<std::string>;

TEST_F(TableModelTest, LinesThatComeWithMotionAreToFadeIn) {
    model.play(rows({"a", "c"}), {{}, {0, 1}}, Motion::none);
    model.play(rows({"a", "b", "c"}), {{}, {1}}, Motion::full);

    EXPECT_EQ(entries(), (Texts{"a", "b", "c"}));
    EXPECT_FALSE(at(0, TableModel::isNewRole).toBool());
    EXPECT_TRUE(at(1, TableModel::isNewRole).toBool());
    EXPECT_EQ(at(2, TableModel::topRole).toDouble(), 132);
}

TEST_F(TableModelTest, ALineThatGoesFadesAwayInItsPlaceUntilItIsReleased) {
    model.play(rows({"a", "b", "c"}), {{}, {0, 1, 2}}, Motion::none);

    model.play(rows({"a", "c"}), {{1}, {}}, Motion::full);

    EXPECT_EQ(entries(), (Texts{"a", "(b)", "c"}));
    EXPECT_EQ(at(1, TableModel::topRole).toDouble(), 66);
    EXPECT_TRUE(model.hasLeaving());

    release(1);

    EXPECT_EQ(entries(), (Texts{"a", "c"}));
    EXPECT_FALSE(model.hasLeaving());
}

TEST_F(TableModelTest, ASecondBatchInsideTheFadesOfTheFirstLosesAndDoublesNothing) {
    model.play(rows({"a", "b", "c", "d"}), {{}, {0, 1, 2, 3}}, Motion::none);

    model.play(rows({"a", "c", "x"}), {{3, 1}, {2}}, Motion::full);
    model.play(rows({"b", "c"}), {{2, 0}, {0}}, Motion::full);

    Texts staying;
    for (const std::string& entry : entries())
        if (entry.front() != '(') staying.push_back(entry);
    EXPECT_EQ(staying, (Texts{"b", "c"}));
    while (model.hasLeaving())
        for (int position = model.rowCount() - 1; position >= 0; --position)
            if (at(position, TableModel::isLeavingRole).toBool()) release(position);
    EXPECT_EQ(entries(), (Texts{"b", "c"}));
}

TEST_F(TableModelTest, WithoutMotionLinesAreGoneAtOnce) {
    model.play(rows({"a", "b"}), {{}, {0, 1}}, Motion::none);
    model.play(rows({"b"}), {{0}, {}}, Motion::none);

    EXPECT_EQ(entries(), (Texts{"b"}));
    EXPECT_FALSE(model.hasLeaving());
}

TEST_F(TableModelTest, OnlyLinesNearTheWindowAreStagedAndScrollingBringsOthers) {
    std::vector<Line> lines;
    LineChanges all;
    for (int number = 0; number < 200; ++number) {
        lines.push_back(row(number, std::to_string(number)));
        all.insertions.push_back(number);
    }

    model.play(lines, all, Motion::full);

    EXPECT_LT(model.rowCount(), 60);
    EXPECT_EQ(entries().front(), "0");

    model.setWindow(66.0 * 180, 918);

    EXPECT_LT(model.rowCount(), 60);
    EXPECT_EQ(entries().back(), "199");
    EXPECT_FALSE(at(model.rowCount() - 1, TableModel::isNewRole).toBool());
}

TEST_F(TableModelTest, TheFocusedRowIsTheOneThatTheTreeNames) {
    model.play(rows({"a", "b"}), {{}, {0, 1}}, Motion::none);

    model.setFocused(ui::IndexPath{1, 0});

    EXPECT_FALSE(at(0, TableModel::isFocusedRole).toBool());
    EXPECT_TRUE(at(1, TableModel::isFocusedRole).toBool());

    model.setFocused(std::nullopt);

    EXPECT_FALSE(at(1, TableModel::isFocusedRole).toBool());
}

}  // namespace
}  // namespace wp::tv
