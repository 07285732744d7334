#include "screens/tv/text_measurer.h"

#include <gtest/gtest.h>

#include <QFontInfo>

namespace wp::tv {
namespace {

class TextMeasurerTest : public testing::Test {
  protected:
    TextMeasurerTest() { loadFonts(); }

    ui::TextSize measure(const std::string& text, double width = 0, int lines = 0) {
        return measurer.measure(text, ui::Font::body(), width, lines);
    }

    TextMeasurer measurer;
};

TEST_F(TextMeasurerTest, TheFaceComesWithTheModule) {
    EXPECT_EQ(QFontInfo(fontOf(ui::Font::body())).family(), QString::fromLatin1(kFontFamily));
    EXPECT_EQ(QFontInfo(fontOf(ui::Font::body())).pixelSize(), 29);
}

TEST_F(TextMeasurerTest, ALineOfTheBodyFontIs34PointsHighWith7BelowItsBaseline) {
    ui::TextSize size = measure("Network");

    EXPECT_EQ(size.size.height, 34);
    EXPECT_NEAR(size.descent, 7, 0.5);
    EXPECT_EQ(size.lines, 1);
    EXPECT_TRUE(size.fits);
}

TEST_F(TextMeasurerTest, ATextWrapsAtItsWordsAndBreaksWhereItSays) {
    double width = measure("one two").size.width;

    EXPECT_EQ(measure("one two three", width).lines, 2);
    EXPECT_EQ(measure("one\ntwo\nthree").lines, 3);
    EXPECT_LE(measure("one two three", width).size.width, width);
}

TEST_F(TextMeasurerTest, AWordWiderThanTheLineIsBrokenInside) {
    ui::TextSize size = measure(std::string(40, 'W'), 200);

    EXPECT_GT(size.lines, 3);
    EXPECT_LE(size.size.width, 200);
}

TEST_F(TextMeasurerTest, WhatTheLimitCutsOffDoesNotFit) {
    ui::TextSize size = measure("one two three four five six", 100, 2);

    EXPECT_EQ(size.lines, 2);
    EXPECT_FALSE(size.fits);
    EXPECT_EQ(size.size.height, 68);
}

TEST_F(TextMeasurerTest, NothingTakesNoRoom) {
    EXPECT_EQ(measure("").size.height, 0);
    EXPECT_EQ(measure("").lines, 0);
}

TEST_F(TextMeasurerTest, ABalancedTextTakesNoMoreLinesAndLeavesNoWordAlone) {
    QString text = QStringLiteral("Wi-Fi is turned off. Turn it on to see the networks nearby?");
    double width = measure("Wi-Fi is turned off. Turn it on to see the networks").size.width;

    double balanced = balancedWidth(measurer, text, ui::Font::body(), width);

    EXPECT_EQ(measure(text.toStdString(), balanced).lines, 2);
    EXPECT_LT(balanced, 0.7 * width);
    EXPECT_EQ(balancedWidth(measurer, QStringLiteral("nearby?"), ui::Font::body(), width), width);
}

TEST_F(TextMeasurerTest, BalancingBreaksNoWord) {
    QString text = QStringLiteral("to ") + QString(20, QLatin1Char('W')) + QStringLiteral(" now");
    double word = measure(std::string(20, 'W')).size.width;

    EXPECT_GE(balancedWidth(measurer, text, ui::Font::body(), 1.1 * word), word);
}

TEST_F(TextMeasurerTest, TheCursorStandsBehindWhatIsBeforeIt) {
    QString text = QStringLiteral("Home");

    EXPECT_EQ(cursorPosition(text, 0, ui::Font::body()), 0);
    EXPECT_LT(cursorPosition(text, 1, ui::Font::body()), cursorPosition(text, 4, ui::Font::body()));
    EXPECT_NEAR(cursorPosition(text, 4, ui::Font::body()), measure("Home").size.width, 1);
}

}  // namespace
}  // namespace wp::tv
