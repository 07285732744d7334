#include "screens/terminal/cells.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cwchar>

namespace wp::terminal {
namespace {

class CellsTest : public testing::Test {
  protected:
    void SetUp() override { ASSERT_NE(std::setlocale(LC_CTYPE, "C.UTF-8"), nullptr); }
    void TearDown() override { std::setlocale(LC_CTYPE, "C"); }
};

std::wstring plain(const Cells& cells) {
    std::wstring text;
    for (const Cell& cell : cells) text += cell.text;
    return text;
}

std::wstring shown(std::string_view text, Charset charset = Charset::unicode) {
    return plain(cellsOf(text, charset));
}

int columns(std::string_view text) {
    return columnsOf(cellsOf(text, Charset::unicode));
}

std::vector<std::wstring> lines(std::string_view text, int width, int maxLines = 9) {
    std::vector<std::wstring> shownLines;
    for (const Cells& line : wrapped(cellsOf(text, Charset::unicode), width, maxLines, Charset::unicode))
        shownLines.push_back(plain(line));
    return shownLines;
}

TEST_F(CellsTest, CountColumnsByGrapheme) {
    EXPECT_EQ(columns("Home"), 4);
    EXPECT_EQ(columns("東京"), 4);
    EXPECT_EQ(columns("cafe\u0301"), 4);
    EXPECT_EQ(columns("\U0001F600"), 2);
    EXPECT_EQ(columns("\u2764\uFE0F"), 1);
    EXPECT_EQ(columns("\u1112\u1161\u11AB"), 2);  // one Hangul syllable of three letters
    EXPECT_EQ(columns(""), 0);
}

TEST_F(CellsTest, KeepMarksWithTheirBase) {
    Cells cells = cellsOf("e\u0301x", Charset::unicode);

    ASSERT_EQ(cells.size(), 2U);
    EXPECT_EQ(cells[0].text, L"e\u0301");
}

TEST_F(CellsTest, GiveAMarkWithoutABaseADottedCircle) {
    EXPECT_EQ(shown("\u0301a"), L"\u25CC\u0301a");
    EXPECT_EQ(shown("\x1B\u0301"), L"\\x1B\u0301");
}

TEST_F(CellsTest, ShowMarksBeyondWhatACellHoldsAsEscapes) {
    std::string name = "a";
    for (int i = 0; i < 6; ++i) name += "\u0301";

    EXPECT_EQ(shown(name), L"a\u0301\u0301\u0301\u0301\\u{0301}\u25CC\u0301");
}

TEST_F(CellsTest, NeverHoldAControlCharacter) {
    for (const char* name : {"\x1B]0;x\x07", "\x1B[2J",
                             "\x9B"
                             "2J",
                             "\u009B2J", "a\rb\b", "\x1B]52;c;aGk=\x07", "\u202Eabc", "\U000E0041", "\u2028"})
        for (Charset charset : {Charset::ascii, Charset::unicode})
            for (const Cell& cell : cellsOf(name, charset))
                for (wchar_t c : cell.text) {
                    EXPECT_GE(c, 0x20) << name;
                    EXPECT_LT(c, 0x7F) << name;
                }
}

TEST_F(CellsTest, HoldOnlyAsciiWhereTheTerminalHasNoMore) {
    EXPECT_EQ(shown("Café 東", Charset::ascii), L"Caf\\u{00E9} \\u{6771}");
    EXPECT_EQ(shown("Other… “Home” – it’s", Charset::ascii), L"Other... \"Home\" - it's");
}

TEST_F(CellsTest, ShowWhatTheSystemKnowsNoWidthOfAsAnEscape) {
    EXPECT_EQ(wcwidth(0x0378), -1);

    EXPECT_EQ(shown("a\u0378"), L"a\\u{0378}");
}

TEST_F(CellsTest, EndInAnEllipsisWhereTheyAreCut) {
    auto cut = [](std::string_view text, int width) {
        return plain(elided(cellsOf(text, Charset::unicode), width, Charset::unicode));
    };
    EXPECT_EQ(cut("Northlight", 10), L"Northlight");
    EXPECT_EQ(cut("Northlight", 9), L"Northlig\u2026");
    EXPECT_EQ(cut("東京ネット", 6), L"東京\u2026");
    EXPECT_EQ(cut("Northlight", 1), L"\u2026");
    EXPECT_EQ(cut("Northlight", 0), L"");
    EXPECT_EQ(plain(elided(cellsOf("Northlight", Charset::ascii), 4, Charset::ascii)), L"Nor~");
}

TEST_F(CellsTest, WrapAtBlanks) {
    EXPECT_EQ(lines("one two three", 8), (std::vector<std::wstring>{L"one two", L"three"}));
    EXPECT_EQ(lines("one two three", 7), (std::vector<std::wstring>{L"one two", L"three"}));
    EXPECT_EQ(lines("onetwothree", 4), (std::vector<std::wstring>{L"onet", L"woth", L"ree"}));
    EXPECT_EQ(lines("", 4), (std::vector<std::wstring>{}));
}

TEST_F(CellsTest, WrapBesideWideCharactersButNotBeforeClosingMarks) {
    EXPECT_EQ(lines("東京大阪", 5), (std::vector<std::wstring>{L"東京", L"大阪"}));
    EXPECT_EQ(lines("東京大。阪", 6), (std::vector<std::wstring>{L"東京", L"大。阪"}));
}

TEST_F(CellsTest, ElideTheLastOfTheLinesThatTheyMayFill) {
    EXPECT_EQ(lines("one two three four", 5, 2), (std::vector<std::wstring>{L"one", L"two \u2026"}));
}

}  // namespace
}  // namespace wp::terminal
