#include "verification/unit/tests/catalogue_fixture.h"

namespace wp::rows {
namespace {

using fakes::outcome;
using Entries = Dictionary::Entries;
using Lines = std::vector<std::string>;

TEST_F(CatalogueTest, StoresTheBeaconIntervalWhenTheTestPassed) {
    service.setOutcome(34, outcome(false, true, Dictionary::make({{"BeaconInterval", 100}})));

    controller.runCurrentNetworkLongBeaconIntervalWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"isBeaconIntervalLong", false}, {"beaconInterval", 100}}));
}

TEST_F(CatalogueTest, StoresTheDTIMIntervalUnderTheServicesSpelling) {
    service.setOutcome(35, outcome(true, false, Dictionary::make({{"DTIMInterval", 5}})));

    controller.runCurrentNetworkLongDTIMIntervalWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"isDTIMIntervalLong", true}, {"DTIMInterval", 5}}));
}

TEST_F(CatalogueTest, KeepsTheSecurityOfTheLastOfTheSecurityTests) {
    service.setOutcome(38, outcome(false, true, Dictionary::make({{"Security", "of the open test"}})));
    service.setOutcome(39, outcome(false, true, Dictionary::make({{"Security", "of the WEP test"}})));
    service.setOutcome(40, outcome(false, true, Dictionary::make({{"Security", "of the WPA test"}})));

    controller.runCurrentNetworkNoSecurityWithConfiguration(configuration, results);
    controller.runCurrentNetworkLegacySecurityWEPWithConfiguration(configuration, results);
    controller.runCurrentNetworkLegacySecurityWPAWithConfiguration(configuration, results);

    EXPECT_EQ(results->value("security"), Value("of the WPA test"));
}

TEST_F(CatalogueTest, KeepsTheModesOfTheLastOfThePHYModeTests) {
    service.setOutcome(36, outcome(false, true, Dictionary::make({{"SupportedPHYModes", "first"}})));
    service.setOutcome(37, outcome(false, true, Dictionary::make({{"SupportedPHYModes", "second"}})));

    controller.runCurrentNetworkConflictingPHYMode11ACWithConfiguration(configuration, results);
    controller.runCurrentNetworkConflictingPHYMode11NWithConfiguration(configuration, results);

    EXPECT_EQ(results->value("supportedPHYModes"), Value("second"));
}

TEST_F(CatalogueTest, KeepsTheBaseStationsModelOutWhenTheTestDidNotPass) {
    service.setOutcome(33, outcome(false, false, Dictionary::make({{"MarlixModelName", "M1"}})));

    controller.runCurrentNetworkMarlixBaseStationWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"isHostedByMarlixBaseStation", false}}));
    EXPECT_EQ(logLines(), Lines());
}

TEST_F(CatalogueTest, LogsAPassedBaseStationWithoutAModel) {
    service.setOutcome(33, outcome(true, true, Dictionary::make()));

    controller.runCurrentNetworkMarlixBaseStationWithConfiguration(configuration, results);

    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: MarlixModelName not found."});
}

TEST_F(CatalogueTest, WritesTheSameKeysForTheSelectedNetworkAndLeavesTheCurrentOneAlone) {
    service.setOutcome(34, outcome(true, false, Dictionary::make({{"BeaconInterval", 1000}})));

    controller.runCurrentNetworkLongBeaconIntervalWithConfiguration(configuration,
                                                                    controller.selectedNetworkData());

    EXPECT_EQ(controller.selectedNetworkData()->entries(),
              (Entries{{"isBeaconIntervalLong", true}, {"beaconInterval", 1000}}));
    EXPECT_EQ(controller.currentNetworkData()->size(), 0U);
}

std::shared_ptr<PreferredNetworkRecord> rememberedNetwork() {
    auto record = std::make_shared<PreferredNetworkRecord>();
    record->ssid = "Home";
    record->security = 4;
    record->passpoint = true;
    record->enabled = true;
    record->captive = false;
    record->hidden = true;
    record->multiAP = true;
    record->lastJoined = Date{86400};
    return record;
}

DiagnosticsTestResponse captive(bool result, bool didPass, std::shared_ptr<PreferredNetworkRecord> record) {
    return outcome(result, didPass, Dictionary::make({{"PreferredNetwork", std::move(record)}}));
}

TEST_F(CatalogueTest, StoresTheRememberedNetworkOfTheCaptivePortalTest) {
    for (bool didPass : {true, false}) {
        service.setOutcome(46, captive(true, didPass, rememberedNetwork()));

        controller.runCurrentNetworkCaptivePortalWithConfiguration(configuration, results);

        DictionaryPointer network = Dictionary::make({{"SSID", "Home"},
                                                      {"security", 4},
                                                      {"isPasspoint", true},
                                                      {"isEnabled", true},
                                                      {"isCaptive", false},
                                                      {"isHidden", true},
                                                      {"isMultiAP", true},
                                                      {"lastJoined", "2001-01-02T00:00:00Z"}});
        EXPECT_EQ(results->entries(), (Entries{{"isCaptive", true}, {"preferredNetwork", network}}));
    }
}

TEST_F(CatalogueTest, KeepsTheTestsVerdictAndTheRememberedNetworksOwnFlagApart) {
    auto record = rememberedNetwork();
    record->captive = true;
    service.setOutcome(46, captive(false, true, record));

    controller.runCurrentNetworkCaptivePortalWithConfiguration(configuration, results);

    EXPECT_EQ(results->value("isCaptive"), Value(false));
    DictionaryPointer network = *results->value("preferredNetwork")->as<DictionaryPointer>();
    EXPECT_EQ(network->value("isCaptive"), Value(true));
}

TEST_F(CatalogueTest, StoresNullForARememberedNetworkWithoutANameOrWithoutADate) {
    auto record = rememberedNetwork();
    record->ssid.reset();
    record->lastJoined.reset();
    service.setOutcome(46, captive(false, true, record));

    controller.runCurrentNetworkCaptivePortalWithConfiguration(configuration, results);

    DictionaryPointer network = *results->value("preferredNetwork")->as<DictionaryPointer>();
    EXPECT_EQ(network->value("SSID"), Value(NullMarker()));
    EXPECT_EQ(network->value("lastJoined"), Value(NullMarker()));
    EXPECT_EQ(network->size(), 8U);
}

TEST_F(CatalogueTest, LogsACaptivePortalWithoutARememberedNetwork) {
    service.setOutcome(46, outcome(true, true, Dictionary::make()));

    controller.runCurrentNetworkCaptivePortalWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"isCaptive", true}}));
    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: currentPreferredNetwork not found."});
}

TEST_F(CatalogueTest, TakesAnythingButARecordForAMissingRememberedNetwork) {
    service.setOutcome(46, outcome(true, true, Dictionary::make({{"PreferredNetwork", "Home"}})));

    controller.runCurrentNetworkCaptivePortalWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"isCaptive", true}}));
    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: currentPreferredNetwork not found."});
}

TEST_F(CatalogueTest, ReplacesTheRememberedNetworkOfAnEarlierRun) {
    service.setOutcome(46, captive(false, true, rememberedNetwork()));
    controller.runCurrentNetworkCaptivePortalWithConfiguration(configuration, results);
    DictionaryPointer first = *results->value("preferredNetwork")->as<DictionaryPointer>();

    controller.runCurrentNetworkCaptivePortalWithConfiguration(configuration, results);

    EXPECT_NE(*results->value("preferredNetwork")->as<DictionaryPointer>(), first);
}

}  // namespace
}  // namespace wp::rows
