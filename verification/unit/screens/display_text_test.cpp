#include "platform/ui/display_text.h"

#include <gtest/gtest.h>

#include <string>

namespace wp::ui {
namespace {

TEST(DisplayForm, LeavesWhatPeopleCallTheirNetworksAlone) {
    for (const char* name :
         {"Northlight", "Café Zoë", "東京ネット", "Мой дом", "שלום", "a\\b 'c' \"d\" <e> %s $(f)",
          "  two  blanks ", "\U0001F600 home", "", "\u2764\uFE0F"})
        EXPECT_EQ(displayForm(name), name);
}

TEST(DisplayForm, ShowsEveryControlCharacterAsAnEscape) {
    using namespace std::string_literals;

    EXPECT_EQ(displayForm("\x1B]0;owned\x07"), "\\x1B]0;owned\\x07");
    EXPECT_EQ(displayForm("\x1B[2J"), "\\x1B[2J");
    EXPECT_EQ(displayForm("\x1B]52;c;aGk=\x07"), "\\x1B]52;c;aGk=\\x07");
    EXPECT_EQ(displayForm("a\rb\bc\nd\te"), "a\\x0Db\\x08c\\x0Ad\\x09e");
    EXPECT_EQ(displayForm("a\0b"s), "a\\x00b");
    EXPECT_EQ(displayForm("\x7F"), "\\x7F");
    for (unsigned c = 0x80; c <= 0x9F; ++c) {
        std::string form = displayForm(encodeUtf8(c));
        ASSERT_EQ(form.size(), 4U) << c;
        EXPECT_EQ(form.substr(0, 2), "\\x") << c;
    }
}

TEST(DisplayForm, ShowsBytesThatAreNoTextAsEscapes) {
    EXPECT_EQ(displayForm(std::string(32, '\xFF')).size(), 32U * 4);
    EXPECT_EQ(displayForm("\x9B"
                          "2J"),
              "\\x9B2J");
    EXPECT_EQ(displayForm("\xC0\xAF"), "\\xC0\\xAF");           // overlong
    EXPECT_EQ(displayForm("\xED\xA0\x80"), "\\xED\\xA0\\x80");  // surrogate
    EXPECT_EQ(displayForm("\xF4\x90\x80\x80"), "\\xF4\\x90\\x80\\x80");
    EXPECT_EQ(displayForm("caf\xC3"), "caf\\xC3");  // cut in the middle
}

TEST(DisplayForm, ShowsWhatTurnsOrHidesTextAsEscapes) {
    for (char32_t c : {0x202AU, 0x202BU, 0x202CU, 0x202DU, 0x202EU, 0x2066U,  0x2067U,  0x2068U,  0x2069U,
                       0x200EU, 0x200FU, 0x061CU, 0x2028U, 0x2029U, 0x200BU,  0x200CU,  0x200DU,  0x2060U,
                       0xFEFFU, 0x00ADU, 0x180EU, 0x3164U, 0xFE00U, 0xE0001U, 0xE0041U, 0xE007FU, 0xE0100U}) {
        std::string form = displayForm("a" + encodeUtf8(c) + "b");
        EXPECT_TRUE(form.starts_with("a\\u{") && form.ends_with("}b")) << std::hex << unsigned(c) << form;
    }
    EXPECT_EQ(displayForm("safe\u202Eelif"), "safe\\u{202E}elif");
}

TEST(DisplayForm, KeepsAVariationSelectorOnlyWhereThereIsAChoice) {
    EXPECT_EQ(displayForm("a\uFE0F"), "a\\u{FE0F}");
    EXPECT_EQ(displayForm("\uFE0F"), "\\u{FE0F}");
    EXPECT_EQ(displayForm("\u2764\uFE0F\uFE0F"), "\u2764\uFE0F\\u{FE0F}");
}

TEST(DisplayForm, IsItsOwnDisplayForm) {
    std::string form = displayForm("\x1B[2J\u202E\xFF\u2764\uFE0F");

    EXPECT_EQ(displayForm(form), form);
}

TEST(CodePoints, ComeBackFromTheirUtf8Form) {
    for (char32_t c = 0; c <= 0x10FFFF; ++c) {
        if (c >= 0xD800 && c <= 0xDFFF) continue;
        std::string encoded = encodeUtf8(c);
        std::string_view rest = encoded;
        Utf8Character taken = takeCharacter(rest);
        ASSERT_EQ(taken.value, c);
        ASSERT_TRUE(rest.empty());
    }
}

}  // namespace
}  // namespace wp::ui
