#include <gtest/gtest.h>

#include <cstdlib>
#include <set>

#include "host/locale.h"
#include "host/string_table.h"
#include "host/table_localization.h"
#include "platform/ui/text_measurer.h"

namespace wp::host {
namespace {

const std::set<std::string> kKeys = {
    "POWER_ON_WLAN",
    "POWER_ON_WIFI",
    "NO",
    "YES",
    "PROGRESS_TEXT",
    "NETWORK_CONFIRMATION_TITLE",
    "DONE",
    "CANCEL",
    "NETWORK_CONFIRMATION_MESSAGE",
    "OTHER",
    "REFRESH",
    "OTHER_NETWORK_MESSAGE",
    "CHOOSE_NETWORK",
    "SELECTED_NETWORK",
    "OTHER_NETWORK_PLACEHOLDER",
    "WLAN_DIAGNOSTICS",
    "KEY_MOVE",
    "KEY_SELECT",
    "KEY_BACK",
    "WINDOW_TOO_SMALL",
    "KEYBOARD_SHIFT",
    "KEYBOARD_SYMBOLS",
    "KEYBOARD_LETTERS",
    "KEYBOARD_BLANK",
    "KEYBOARD_LEFT",
    "KEYBOARD_RIGHT",
    "KEYBOARD_ERASE",
    "WIFI_DIAGNOSTICS",
    "WIFI_DESCRIPTION",
};

std::size_t occurrences(const std::string& text, const std::string& part) {
    std::size_t count = 0;
    for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + part.size()))
        ++count;
    return count;
}

TableLocalization localization(const std::string& table, const std::string& collation) {
    return TableLocalization(LocaleChoice{table, collation});
}

/// Sets variables of the environment and puts the earlier ones back.
class Environment {
  public:
    Environment(std::initializer_list<std::pair<const char*, const char*>> variables) {
        for (const char* name : {"LC_ALL", "LC_MESSAGES", "LC_COLLATE", "LANG"}) {
            const char* value = std::getenv(name);
            earlier_.emplace_back(name, value ? std::optional<std::string>(value) : std::nullopt);
            unsetenv(name);
        }
        for (auto [name, value] : variables) setenv(name, value, 1);
    }
    ~Environment() {
        for (const auto& [name, value] : earlier_) {
            if (value) {
                setenv(name, value->c_str(), 1);
            } else {
                unsetenv(name);
            }
        }
    }

  private:
    std::vector<std::pair<const char*, std::optional<std::string>>> earlier_;
};

TEST(StringTables, NoLanguageLacksAKeyAndNoneHasMore) {
    for (const std::string& name : stringTableNames()) {
        std::set<std::string> keys;
        StringTable table = stringTable(name).value();
        for (const auto& [key, text] : table) {
            keys.insert(key);
            EXPECT_NE(text, "") << name << ": " << key;
        }
        EXPECT_EQ(keys, kKeys) << name;
    }
}

TEST(StringTables, OnlyTheConfirmationIsAFormatAndKeepsItsArgument) {
    for (const std::string& name : stringTableNames()) {
        StringTable table = stringTable(name).value();
        for (const auto& [key, text] : table) {
            bool isFormat = key == "NETWORK_CONFIRMATION_MESSAGE";
            EXPECT_EQ(occurrences(text, "%@"), isFormat ? 1u : 0u) << name << ": " << key;
            EXPECT_EQ(occurrences(text, "%"), isFormat ? 1u : 0u) << name << ": " << key;
        }
    }
}

TEST(StringTables, TheDescriptionFitsThreeLinesInEveryLanguage) {
    constexpr double kWidth = 870;
    for (const std::string& name : stringTableNames()) {
        std::string text = stringTable(name).value()["WIFI_DESCRIPTION"];
        ui::TextSize size = ui::FixedTextMeasurer::shared().measure(text, ui::Font::body(), kWidth, 0);
        EXPECT_LE(size.lines, 3) << name;
    }
}

TEST(StringTables, TheKeysTableShowsKeysAndAFormatsArgumentAfterOneBlank) {
    StringTable table = stringTable("x-keys").value();

    EXPECT_EQ(table["REFRESH"], "REFRESH");
    EXPECT_EQ(formatted(table["NETWORK_CONFIRMATION_MESSAGE"], "Home"), "NETWORK_CONFIRMATION_MESSAGE Home");
}

TEST(StringTables, CommentsBlankLinesAndLineBreaksAreRead) {
    StringTable table = parseStringTable("# note = none\n\n  A =  one\\ntwo = 3  \r\nnothing\nB=");

    EXPECT_EQ(table, (StringTable{{"A", "one\ntwo = 3"}, {"B", ""}}));
}

TEST(Localization, AMissingKeyIsTheEmptyText) {
    EXPECT_EQ(localization("de", "de").localizedString("YES"), "Ja");
    EXPECT_EQ(localization("de", "de").localizedString("no such key"), "");
}

TEST(Localization, CaseIsIgnoredAndAccentsAreKept) {
    TableLocalization root = localization("x-keys", "");

    EXPECT_EQ(root.collationKey("HOME"), root.collationKey("home"));
    EXPECT_NE(root.collationKey("cafe"), root.collationKey("café"));
    EXPECT_LT(root.collationKey("cafe"), root.collationKey("café"));
    EXPECT_LT(root.collationKey("café"), root.collationKey("cafes"));
    EXPECT_LT(root.collationKey("Äpfel"), root.collationKey("Banane"));
}

TEST(Localization, BlanksAndPunctuationCountAlsoWhereTheLocaleWouldIgnoreThem) {
    for (const char* locale : {"", "th", "de"}) {
        TableLocalization names = localization("en", locale);
        EXPECT_NE(names.collationKey("a b"), names.collationKey("ab")) << locale;
        EXPECT_NE(names.collationKey("a-b"), names.collationKey("ab")) << locale;
        EXPECT_NE(names.collationKey(" "), names.collationKey("")) << locale;
    }
}

TEST(Localization, NamesSortByTheRulesOfTheirLocale) {
    TableLocalization german = localization("de", "de_DE");
    TableLocalization swedish = localization("en", "sv_SE");

    EXPECT_LT(german.collationKey("Öland"), german.collationKey("Zebra"));
    EXPECT_GT(swedish.collationKey("Öland"), swedish.collationKey("Zebra"));
}

TEST(Localization, ALongNameHasAKeyToo) {
    TableLocalization names = localization("ja", "ja");
    std::string name;
    for (int i = 0; i < 1000; ++i) name += "漢字";

    EXPECT_EQ(names.collationKey(name), names.collationKey(name));
    EXPECT_LT(names.collationKey(name), names.collationKey(name + "x"));
}

TEST(Locale, ANameIsTakenWithCountryAndCharacterSet) {
    EXPECT_EQ(localeNamed("de"), (LocaleChoice{"de", "de"}));
    EXPECT_EQ(localeNamed("de_AT.UTF-8"), (LocaleChoice{"de", "de_AT"}));
    EXPECT_EQ(localeNamed("ja-JP"), (LocaleChoice{"ja", "ja-JP"}));
    EXPECT_EQ(localeNamed("x-keys"), (LocaleChoice{"x-keys", ""}));
    EXPECT_EQ(localeNamed("fr"), std::nullopt);
    EXPECT_EQ(localeNamed(""), std::nullopt);
    EXPECT_EQ(localeNamed("C"), std::nullopt);
}

TEST(Locale, TheEnvironmentIsAskedInItsUsualOrder) {
    {
        Environment environment({{"LC_ALL", "ja_JP.UTF-8"}, {"LC_MESSAGES", "de_DE"}, {"LANG", "en_GB"}});
        EXPECT_EQ(localeOfEnvironment(), (LocaleChoice{"ja", "ja_JP"}));
    }
    {
        Environment environment({{"LC_ALL", ""}, {"LC_MESSAGES", "de_DE"}, {"LC_COLLATE", "sv_SE"}});
        EXPECT_EQ(localeOfEnvironment(), (LocaleChoice{"de", "sv_SE"}));
    }
    {
        Environment environment({{"LANG", "fr_FR.UTF-8"}});
        EXPECT_EQ(localeOfEnvironment(), (LocaleChoice{"en", "fr_FR"}));
    }
    {
        Environment environment({{"LANG", "C.UTF-8"}});
        EXPECT_EQ(localeOfEnvironment(), (LocaleChoice{"en", ""}));
    }
    {
        Environment environment({});
        EXPECT_EQ(localeOfEnvironment(), (LocaleChoice{"en", ""}));
    }
}

}  // namespace
}  // namespace wp::host
