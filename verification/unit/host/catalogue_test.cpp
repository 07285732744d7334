#include "host/report/catalogue.h"

#include <gtest/gtest.h>

#include <map>
#include <set>

#include "host/report/catalogue_text.h"
#include "host/report/planned_tests.h"

namespace wp::host {
namespace {

TEST(Catalogue, HoldsEveryNumberedTestOnceUnderItsResultKey) {
    const std::map<int, std::string> keys = {
        {14, "isUsingCustomIPv4"},
        {15, "isUsingCustomIPv6"},
        {16, "isUsingCustomDNS"},
        {17, "isUsingCustomWebProxy"},
        {22, "isHalvoInRealTimeMode"},
        {19, "isLargeConnectedBT"},
        {18, "isLargePairedBT"},
        {20, "isHYBRIDBTCoexistenceMode"},
        {47, "isLargePNL"},
        {48, "doesPNLContainHiddenNetworks"},
        {29, "doesPNLContainConflictingSecurityType"},
        {8, "hasDoubleNATConfiguration"},
        {34, "isBeaconIntervalLong"},
        {35, "isDTIMIntervalLong"},
        {38, "isUsingOpenSecurity"},
        {39, "isUsingWEPSecurity"},
        {40, "isUsingWPASecurity"},
        {41, "isUsingLegacyRates"},
        {42, "isUsingAmbiguousNetworkName"},
        {43, "isHiddenNetwork"},
        {44, "isPyloPersonalHotspot"},
        {46, "isCaptive"},
        {45, "isPasspointNetwork"},
        {36, "hasConflictingPHYMode11AC"},
        {37, "hasConflictingPHYMode11N"},
        {33, "isHostedByMarlixBaseStation"},
        {3, "pingedLAN"},
        {6, "pingedWAN"},
        {12, "isIPv4Assigned"},
        {13, "isIPv6Assigned"},
        {7, "resolvedDNS"},
        {9, "reachedVantor"},
        {11, "retrievedVantor"},
        {24, "isChannelCongested"},
        {25, "is2GHzCongested"},
        {26, "is5GHzCongested"},
        {27, "hasHT40Channel"},
        {28, "foundConflictingCountryCode"},
        {32, "hasPoorSignal"},
        {30, "foundHiddenNetworks"},
        {31, "foundScanResults"},
    };

    std::map<int, std::string> found;
    for (const CatalogueEntry& entry : catalogue()) found[entry.testID] = entry.resultKey;

    EXPECT_EQ(found, keys);
    EXPECT_EQ(catalogue().size(), keys.size());
}

TEST(Catalogue, KnowsWhichTestsAreRepeatedForASelectedNetwork) {
    std::set<int> repeated;
    for (const CatalogueEntry& entry : catalogue())
        if (entry.scope == TestScope::joinedAndSelected) repeated.insert(entry.testID);

    EXPECT_EQ(repeated, (std::set<int>{34, 38, 39, 40, 41, 42, 43, 44, 46, 45, 36, 37, 33, 24, 28, 32}));
}

TEST(Catalogue, PrintsOfEveryTestWhatItAsksAndWhatAFindingMeans) {
    std::string text = catalogueText({}, Texts("en"));

    EXPECT_EQ(
        text.substr(0, text.find("  15")),
        "This device\n"
        "  14  isUsingCustomIPv4\n"
        "      asks: Was this device's IPv4 address set by hand?\n"
        "      finding: true: the method is anything but automatic\n"
        "      means: A fixed address stops working when the router changes, and can collide with another\n"
        "        device's.\n"
        "      do: Set IPv4 to automatic in this device's network settings, unless somebody chose the "
        "address\n"
        "        on purpose.\n"
        "      by: you, at this device\n");
    EXPECT_NE(text.find("\nNetwork (* also of a selected network)\n   8  hasDoubleNATConfiguration\n"),
              std::string::npos);
    EXPECT_NE(text.find("  34* isBeaconIntervalLong\n"), std::string::npos);
    EXPECT_NE(text.find("\nList of networks\n  31  foundScanResults\n"), std::string::npos);
}

TEST(Catalogue, PrintsTheThresholdsThatAConfigurationChanged) {
    Thresholds thresholds =
        thresholdsFrom(Dictionary::make({{"connectedBluetooth", 7}, {"channelLoad", 0.25}}));

    std::string text = catalogueText(thresholds, Texts("en"));

    EXPECT_NE(text.find("finding: true: more than 7\n"), std::string::npos);
    EXPECT_NE(text.find("finding: true: busy 25 % of the time"), std::string::npos);
    EXPECT_NE(text.find("finding: true: more than 16\n"), std::string::npos);
}

TEST(Catalogue, PlansTheTestsThatARunPerforms) {
    EXPECT_EQ(plannedTests(std::nullopt, std::nullopt), 11);
    EXPECT_EQ(plannedTests("Home", "Home"), 40);
    EXPECT_EQ(plannedTests("Home", "Office"), 56);
    EXPECT_EQ(plannedTests("Home", "home"), 56);
    EXPECT_EQ(plannedTests(std::nullopt, "Office"), 27);
    EXPECT_EQ(plannedTests("Cafe_NoMap", "Office"), 27);
    EXPECT_EQ(plannedTests("Home", "Office_NOMAP"), 40);
    EXPECT_EQ(plannedTests("Cafe_nomap", "Cafe_nomap"), 11);
}

}  // namespace
}  // namespace wp::host
