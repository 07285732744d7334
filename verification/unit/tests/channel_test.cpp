#include "verification/unit/tests/catalogue_fixture.h"

namespace wp::rows {
namespace {

using fakes::outcome;
using Entries = Dictionary::Entries;
using Lines = std::vector<std::string>;

std::shared_ptr<WiFiChannel> channel(std::int64_t number) {
    return std::make_shared<WiFiChannel>(number);
}

DictionaryPointer allChannels(std::int64_t first) {
    return Dictionary::make({{"CurrentChannel", channel(first)},
                             {"2GHzChannel", channel(first + 1)},
                             {"5GHzChannel", channel(first + 2)},
                             {"5GHz40MHzChannel", channel(first + 3)},
                             {"5GHzNonDFSChannel", channel(first + 4)}});
}

TEST_F(CatalogueTest, StoresTheFiveChannelsOfTheCongestedChannelTest) {
    service.setOutcome(24, outcome(true, false, allChannels(10)));

    controller.runCurrentNetworkCongestedChannelWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"isChannelCongested", true},
                                           {"currentChannel", 10},
                                           {"2GHzChannel", 11},
                                           {"5GHzChannel", 12},
                                           {"5GHz40MHzChannel", 13},
                                           {"5GHzNonDFSChannel", 14}}));
}

TEST_F(CatalogueTest, LeavesTheCurrentChannelToTheCongestedChannelTest) {
    service.setOutcome(25, outcome(false, true, allChannels(10)));
    service.setOutcome(26, outcome(false, true, allChannels(10)));

    controller.runCurrentNetworkCongested2GHzWithConfiguration(configuration, results);
    controller.runCurrentNetworkCongested5GHzWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"is2GHzCongested", false},
                                           {"is5GHzCongested", false},
                                           {"2GHzChannel", 11},
                                           {"5GHzChannel", 12},
                                           {"5GHz40MHzChannel", 13},
                                           {"5GHzNonDFSChannel", 14}}));
}

TEST_F(CatalogueTest, SkipsAbsentChannelsSilently) {
    service.setOutcome(24, outcome(false, true, Dictionary::make({{"5GHzChannel", channel(36)}})));

    controller.runCurrentNetworkCongestedChannelWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"isChannelCongested", false}, {"5GHzChannel", 36}}));
    EXPECT_EQ(logLines(), Lines());
}

TEST_F(CatalogueTest, RecordsTheChannelsOfACongestionTestThatDidNotPass) {
    service.setOutcome(25, outcome(true, false, allChannels(1)));

    controller.runCurrentNetworkCongested2GHzWithConfiguration(configuration, results);

    EXPECT_EQ(results->value("2GHzChannel"), Value(2));
}

TEST_F(CatalogueTest, KeepsTheChannelsOfTheCongestionTestThatRanLast) {
    service.setOutcome(25, outcome(true, false, allChannels(1)));
    service.setOutcome(26, outcome(true, false, allChannels(100)));

    controller.runCurrentNetworkCongested2GHzWithConfiguration(configuration, results);
    controller.runCurrentNetworkCongested5GHzWithConfiguration(configuration, results);

    EXPECT_EQ(results->value("2GHzChannel"), Value(101));
    EXPECT_EQ(results->value("5GHzNonDFSChannel"), Value(104));
}

TEST_F(CatalogueTest, StoresAChannelAsASignedInteger) {
    service.setOutcome(25, outcome(true, false, allChannels(1)));

    controller.runCurrentNetworkCongested2GHzWithConfiguration(configuration, results);

    EXPECT_NE(results->value("2GHzChannel")->as<std::int64_t>(), nullptr);
}

TEST_F(CatalogueTest, StoresTheNoiseAlsoWithoutTheSignalStrength) {
    service.setOutcome(32, outcome(true, false, Dictionary::make({{"Noise", -95}})));

    controller.runCurrentNetworkPoorSignalWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"hasPoorSignal", true}, {"noise", -95}}));
    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: RSSI not found."});
}

TEST_F(CatalogueTest, StoresTheSignalStrengthAlsoWithoutTheNoise) {
    service.setOutcome(32, outcome(false, true, Dictionary::make({{"RSSI", -40}})));

    controller.runCurrentNetworkPoorSignalWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"hasPoorSignal", false}, {"RSSI", -40}}));
    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: Noise not found."});
}

TEST_F(CatalogueTest, LogsTheSignalStrengthBeforeTheNoiseWhenBothAreMissing) {
    service.setOutcome(32, outcome(false, true, Dictionary::make()));

    controller.runCurrentNetworkPoorSignalWithConfiguration(configuration, results);

    EXPECT_EQ(logLines(), (Lines{"[ERROR] - Wi-Fi Profile: RSSI not found.",
                                 "[ERROR] - Wi-Fi Profile: Noise not found."}));
}

DictionaryPointer scanOf(std::size_t count) {
    Array networks;
    for (std::size_t i = 0; i < count; ++i) networks.push_back(std::make_shared<WiFiScanResult>());
    return Dictionary::make({{"ScanResults", std::move(networks)}});
}

TEST_F(CatalogueTest, StoresWhetherAScanFoundNetworksAsTheInverseNumber) {
    service.setOutcome(31, outcome(true, true, scanOf(0)));
    controller.runCurrentNetworkNoScanResultsWithConfiguration(configuration, results);
    EXPECT_EQ(results->entries(), (Entries{{"foundScanResults", 0}}));

    service.setOutcome(31, outcome(false, true, scanOf(2)));
    controller.runCurrentNetworkNoScanResultsWithConfiguration(configuration, results);
    EXPECT_EQ(results->entries(), (Entries{{"foundScanResults", 1}}));
}

TEST_F(CatalogueTest, KeepsTheVeryListOfAPassedScan) {
    DictionaryPointer info = scanOf(2);
    service.setOutcome(31, outcome(false, true, info));

    controller.runCurrentNetworkNoScanResultsWithConfiguration(configuration, results);

    EXPECT_EQ(controller.wifiScanResults(), *info->value("ScanResults")->as<ArrayPointer>());
    EXPECT_FALSE(results->value("ScanResults"));
}

TEST_F(CatalogueTest, KeepsTheListOfTheScanBeforeWhenAScanDidNotPass) {
    auto earlier = std::make_shared<const Array>();
    controller.setWifiScanResults(earlier);
    for (DictionaryPointer info : {scanOf(3), DictionaryPointer()}) {
        service.setOutcome(31, outcome(true, false, info));

        controller.runCurrentNetworkNoScanResultsWithConfiguration(configuration, results);

        EXPECT_EQ(controller.wifiScanResults(), earlier);
        EXPECT_EQ(logLines(), Lines());
    }
}

TEST_F(CatalogueTest, KeepsTheListOfTheScanBeforeOnAServiceErrorAndWithoutInformation) {
    auto earlier = std::make_shared<const Array>();
    controller.setWifiScanResults(earlier);
    for (const auto& response : {fakes::failure(16, "busy"), outcome(false, true)}) {
        service.setOutcome(31, response);

        controller.runCurrentNetworkNoScanResultsWithConfiguration(configuration, results);

        EXPECT_EQ(controller.wifiScanResults(), earlier);
    }
}

TEST_F(CatalogueTest, ClearsTheListOnAPassedScanWithoutOne) {
    controller.setWifiScanResults(std::make_shared<const Array>());
    service.setOutcome(31, outcome(false, true, Dictionary::make()));

    controller.runCurrentNetworkNoScanResultsWithConfiguration(configuration, results);

    EXPECT_EQ(controller.wifiScanResults(), nullptr);
    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: Scan Results not found."});
}

TEST_F(CatalogueTest, TakesAnEmptyListForAList) {
    service.setOutcome(31, outcome(true, true, scanOf(0)));

    controller.runCurrentNetworkNoScanResultsWithConfiguration(configuration, results);

    ASSERT_NE(controller.wifiScanResults(), nullptr);
    EXPECT_EQ(controller.wifiScanResults()->size(), 0U);
    EXPECT_EQ(logLines(), Lines());
}

TEST_F(CatalogueTest, RecordsNoCountOfHiddenNetworksWhenTheTestPassed) {
    service.setOutcome(30, outcome(false, true, scanOf(3)));

    controller.runCurrentNetworkHiddenScanResultsWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"foundHiddenNetworks", false}}));
}

TEST_F(CatalogueTest, CountsTheHiddenNetworksWhenTheTestDidNotPass) {
    service.setOutcome(30, outcome(true, false, scanOf(3)));

    controller.runCurrentNetworkHiddenScanResultsWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"foundHiddenNetworks", true}, {"hiddenNetworkCount", 3u}}));
    EXPECT_EQ(controller.wifiScanResults(), nullptr);
}

}  // namespace
}  // namespace wp::rows
