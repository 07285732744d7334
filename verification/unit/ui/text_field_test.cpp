#include "platform/ui/text_field.h"

#include <gtest/gtest.h>

#include "platform/ui/unicode.h"

namespace wp::ui {
namespace {

struct Characters {
    const char* name;
    const char* text;
    std::size_t count;
};

class TextByCharacters : public ::testing::TestWithParam<Characters> {};

TEST_P(TextByCharacters, IsWalkedForwardsBackwardsAndDeletedInWholeCharacters) {
    TextField field;
    field.setText(GetParam().text);

    std::size_t backwards = 0;
    while (field.moveLeft()) ++backwards;
    std::size_t forwards = 0;
    while (field.moveRight()) ++forwards;
    std::size_t deleted = 0;
    while (field.deleteBackward()) ++deleted;

    EXPECT_EQ(backwards, GetParam().count);
    EXPECT_EQ(forwards, GetParam().count);
    EXPECT_EQ(deleted, GetParam().count);
    EXPECT_EQ(field.text(), "");
}

INSTANTIATE_TEST_SUITE_P(
    Texts, TextByCharacters,
    ::testing::Values(Characters{"Empty", "", 0}, Characters{"Ascii", "abc", 3},
                      Characters{"Umlaut", "B\u00FCro", 4}, Characters{"CombiningMark", "e\u0301x", 2},
                      Characters{"Japanese", "\u30CD\u30C3\u30C8", 3},
                      Characters{"JoinedFamily", "\U0001F468\u200D\U0001F469\u200D\U0001F467!", 2},
                      Characters{"SkinTone", "\U0001F44D\U0001F3FD", 1},
                      Characters{"TwoFlags", "\U0001F1E9\U0001F1EA\U0001F1EF\U0001F1F5", 2},
                      Characters{"DirectionControl", "a\u202Eb", 3},
                      Characters{"BytesThatAreNoText", "a\xFF\xC3", 3}),
    [](const auto& test) { return std::string(test.param.name); });

TEST(TextField, TellsItsTargetsOfNewTextOnly) {
    TextField field;
    std::vector<std::string> told;
    field.addTarget([&](TextField& changed) { told.push_back(changed.text()); });

    field.setText("set by the program");
    field.moveLeft();
    field.insert("");
    field.clear();
    field.clear();
    field.insert("ab");
    field.moveToStart();
    field.deleteForward();

    EXPECT_EQ(told, (std::vector<std::string>{"", "ab", "b"}));
}

TEST(TextField, InsertsAtTheCursor) {
    TextField field;
    field.insert("Hoe");
    field.moveLeft();
    field.insert("m");
    field.moveToEnd();
    field.insert("!");

    EXPECT_EQ(field.text(), "Home!");
    EXPECT_EQ(field.cursor(), 5u);
}

TEST(TextField, HasNoLimitOfLength) {
    TextField field;
    for (int i = 0; i < 10'000; ++i) field.insert("ab");

    EXPECT_EQ(field.text().size(), 20'000u);
}

TEST(CellWidth, CountsColumnsAsAGridShowsThem) {
    EXPECT_EQ(cellWidth(U'a'), 1);
    EXPECT_EQ(cellWidth(U'\u0301'), 0);
    EXPECT_EQ(cellWidth(U'\u30CD'), 2);
    EXPECT_EQ(cellWidth(U'\U0001F44D'), 2);
    EXPECT_EQ(cellWidth(U'\u202E'), 0);
}

}  // namespace
}  // namespace wp::ui
