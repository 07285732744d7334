#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <set>
#include <sstream>

#include "host/report/catalogue.h"
#include "host/report/limits.h"
#include "host/report/texts.h"
#include "verification/unit/places.h"

namespace wp::host {
namespace {

const std::vector<std::string> kLanguages = {"en", "de", "ja"};

std::vector<std::string> sortedPlaces(const std::string& text) {
    std::vector<std::string> places = placesOf(text);
    std::ranges::sort(places);
    return places;
}

std::set<std::string> keysOf(const StringTable& table) {
    std::set<std::string> keys;
    for (const auto& [key, text] : table) keys.insert(key);
    return keys;
}

/// All sources of the folder as one text.
std::string sourcesOf(const std::filesystem::path& folder) {
    std::ostringstream all;
    for (const auto& file : std::filesystem::recursive_directory_iterator(folder)) {
        if (file.path().extension() == ".cpp") all << std::ifstream(file.path()).rdbuf();
    }
    return all.str();
}

bool isOfATest(const std::string& key) {
    return key.size() > 1 && key[0] == 'T' && std::isdigit(static_cast<unsigned char>(key[1]));
}

TEST(ReportTexts, NoLanguageLacksAKeyAndNoneHasMore) {
    std::set<std::string> keys = keysOf(reportTable("en"));
    for (const std::string& language : kLanguages) EXPECT_EQ(keysOf(reportTable(language)), keys) << language;
}

TEST(ReportTexts, EveryTextHasTheSamePlacesInEveryLanguage) {
    for (const auto& [key, text] : reportTable("en")) {
        for (const std::string& language : kLanguages) {
            std::string translated = reportTable(language)[key];
            EXPECT_NE(translated, "") << language << ": " << key;
            EXPECT_EQ(sortedPlaces(translated), sortedPlaces(text)) << language << ": " << key;
        }
    }
}

TEST(ReportTexts, NoTextOfAnotherLanguageIsLeftInEnglish) {
    const std::set<std::string> international = {"T36_VALUE",
                                                 "T37_VALUE",
                                                 "T38_VALUE",
                                                 "T39_VALUE",
                                                 "T40_VALUE",
                                                 "T39_NAME",
                                                 "T41_NAME",
                                                 "T45_NAME",
                                                 "T32_VALUE",
                                                 "BAND_5",
                                                 "BAND_6",
                                                 "BAND_2",
                                                 "FACT_SIGNAL",
                                                 "FACT_ROUTER",
                                                 "CATALOGUE_WHEN_TRUE",
                                                 "CATALOGUE_WHEN_FALSE",
                                                 "T42_VALUE",
                                                 "FACT_CHANNEL_VALUE",
                                                 "T32_NAME",
                                                 "FACT_QUIETEST_2",
                                                 "FACT_QUIETEST_5",
                                                 "LIST_COMMA",
                                                 "DECIMAL_MARK",
                                                 "SEVERITY_PROBLEM",
                                                 "TEST_NUMBER",
                                                 "FACT_SIGNAL_VALUE",
                                                 "HTML_COLUMN_SIGNAL",
                                                 "HTML_SIGNAL",
                                                 "HTML_TIME",
                                                 "HTML_WIDTH"};
    for (const auto& [key, text] : reportTable("en")) {
        for (const char* language : {"de", "ja"}) {
            if (international.contains(key)) continue;
            EXPECT_NE(reportTable(language)[key], text) << language << ": " << key;
        }
    }
}

TEST(ReportTexts, EveryTestHasAllItsTextsAndNoOther) {
    std::set<std::string> expected, found;
    for (const CatalogueEntry& test : catalogue()) {
        for (const char* what : {"NAME", "ASKS", "RULE", "FOUND", "MEANS", "DO"})
            expected.insert(testKey(test.testID, what));
        if (test.valueKey) expected.insert(testKey(test.testID, "VALUE"));
        if (!limitsOf(test.testID, {}, Texts("en")).empty()) expected.insert(testKey(test.testID, "SOURCE"));
    }
    expected.insert({"T32_VALUE_NOISE", "T24_DO_CHANNEL", "T24_DO_NONE", "T24_VALUE_MEASURED",
                     "T24_VALUE_ADVERTISED", "T24_VALUE_OVERLAP", "T46_VALUE"});

    for (const std::string& key : keysOf(reportTable("en")))
        if (isOfATest(key)) found.insert(key);

    EXPECT_EQ(found, expected);
}

TEST(ReportTexts, ARuleNamesExactlyTheThresholdsThatTheServiceGoesBy) {
    for (const CatalogueEntry& test : catalogue()) {
        std::vector<std::string> names;
        for (const auto& [name, value] : limitsOf(test.testID, {}, Texts("en"))) names.push_back(name);
        std::ranges::sort(names);

        EXPECT_EQ(sortedPlaces(reportTable("en")[testKey(test.testID, "RULE")]), names) << test.testID;
    }
}

TEST(ReportTexts, EveryKeyIsUsed) {
    std::string sources = sourcesOf(sourceFolder() + "/host");
    for (const std::string& key : keysOf(reportTable("en"))) {
        if (isOfATest(key)) continue;
        // The words of a cause or a reason, and the plural forms, are put together from a prefix.
        std::string prefix = key;
        for (const char* ending : {"_FOUND", "_MEANS", "_DO", "_ONE", "_MANY"})
            if (key.ends_with(ending)) prefix = key.substr(0, key.size() - std::string_view(ending).size());
        for (const char* beginning : {"REASON_", "REMEDY_"})
            if (key.starts_with(beginning)) prefix = key.substr(std::string_view(beginning).size());
        bool isUsed = sources.find('"' + key + '"') != std::string::npos ||
                      sources.find('"' + prefix + '"') != std::string::npos;
        EXPECT_TRUE(isUsed) << key;
    }
}

TEST(ReportTexts, PlacesAreFilledByNameAndNeverTwice) {
    Texts english("en");

    EXPECT_EQ(english.text("QUOTED_NETWORK", {{"name", "{count} %s"}}), "“{count} %s”");
    EXPECT_EQ(english.text("PART_JOINED", {{"network", ""}}), "Network");
    EXPECT_EQ(english.text("no such key"), "no such key");
    EXPECT_EQ(english.number(1.25, 1), "1.2");
    EXPECT_EQ(Texts("de").number(1234.5, 1), "1234,5");
    EXPECT_EQ(english.list({"a", "b"}), "a, b");
    EXPECT_EQ(english.aside("b"), " (b)");
    EXPECT_EQ(Texts("ja").aside("b"), "（b）");
    EXPECT_EQ(english.aside(""), "");
}

TEST(ReportTexts, TheKeysTableShowsKeysWithTheValuesOfTheirPlaces) {
    Texts keys("x-keys");

    EXPECT_EQ(keys.text("TITLE"), "TITLE");
    EXPECT_EQ(keys.text("PING_VALUE", {{"count", "5"}, {"answered", "2"}}), "PING_VALUE 2 5");
}

}  // namespace
}  // namespace wp::host
