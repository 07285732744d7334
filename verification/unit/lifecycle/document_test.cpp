#include <gtest/gtest.h>

#include "verification/unit/fakes/diagnostic_run.h"
#include "verification/unit/fakes/printing.h"

namespace wp {
namespace {

using fakes::DiagnosticRun;
using fakes::NetworkList;
using fakes::outcome;
using Entries = Dictionary::Entries;

DictionaryPointer info(Entries entries) {
    return Dictionary::make(std::move(entries));
}

std::shared_ptr<WiFiChannel> channel(std::int64_t number) {
    return std::make_shared<WiFiChannel>(number);
}

std::shared_ptr<PingStatistics> ping(double average) {
    auto statistics = std::make_shared<PingStatistics>();
    statistics->interfaceName = "wlan0";
    statistics->count = 3;
    statistics->packetLoss = 0;
    statistics->min = 1;
    statistics->max = 3;
    statistics->avg = average;
    statistics->timestamp = 60;
    return statistics;
}

void setOutcomes(fakes::FakeDiagnosticsClient& service) {
    auto remembered = std::make_shared<PreferredNetworkRecord>();
    remembered->ssid = "Home";
    remembered->security = 2;
    remembered->enabled = true;
    DictionaryPointer channels = info({{"CurrentChannel", channel(6)},
                                       {"2GHzChannel", channel(11)},
                                       {"5GHzChannel", channel(36)},
                                       {"5GHz40MHzChannel", channel(44)},
                                       {"5GHzNonDFSChannel", channel(149)}});
    service.setJoinedNetwork("Home");
    service.setOutcome(14, outcome(true, false, info({{"IPv4ConfigMethod", "Manual"}})));
    service.setOutcome(15, outcome(false, true, info({{"IPv6ConfigMethod", "Automatic"}})));
    service.setOutcome(19, outcome(false, true, info({{"BTConnectedCount", 1}})));
    service.setOutcome(18, outcome(true, false, info({{"BTPairedCount", 12}})));
    service.setOutcome(47, outcome(false, true, info({{"PNLCount", 4}})));
    service.setOutcome(34, outcome(false, true, info({{"BeaconInterval", 100}})));
    service.setOutcome(35, outcome(false, true, info({{"DTIMInterval", 2}})));
    for (int testID : {38, 39, 40}) service.setOutcome(testID, outcome(false, true, info({{"Security", 2}})));
    service.setOutcome(42, outcome(true, false, info({{"NetworkName", "Home"}})));
    service.setOutcome(46, outcome(false, true, info({{"PreferredNetwork", remembered}})));
    for (int testID : {36, 37})
        service.setOutcome(testID, outcome(false, true, info({{"SupportedPHYModes", 7}})));
    service.setOutcome(33, outcome(true, true, info({{"MarlixModelName", "M5"}})));
    service.setOutcome(3, outcome(true, true, info({{"PingResult", ping(2)}})));
    service.setOutcome(6, outcome(true, true, info({{"PingResult", ping(PingStatistics::unknown)}})));
    for (int testID : {24, 25, 26}) service.setOutcome(testID, outcome(true, false, channels));
    service.setOutcome(28, outcome(false, true, info({{"AdoptedCountryCode", "DE"}})));
    service.setOutcome(32, outcome(false, true, info({{"RSSI", -52}, {"Noise", -95}})));
    service.setOutcome(30, outcome(true, false, info({{"ScanResults", Array{1, 2}}})));
}

const Entries kDevice = {{"isUsingCustomIPv4", true},
                         {"IPv4ConfigMethod", "Manual"},
                         {"isUsingCustomIPv6", false},
                         {"isUsingCustomDNS", false},
                         {"isUsingCustomWebProxy", false},
                         {"isHalvoInRealTimeMode", false},
                         {"isLargeConnectedBT", false},
                         {"bluetoothConnectedCount", 1},
                         {"isLargePairedBT", true},
                         {"bluetoothPairedCount", 12},
                         {"isHYBRIDBTCoexistenceMode", false},
                         {"isLargePNL", false},
                         {"preferredNetworkListCount", 4},
                         {"doesPNLContainHiddenNetworks", false},
                         {"doesPNLContainConflictingSecurityType", false}};

/// What the tests that both networks go through leave.
Entries propertiesOfANetwork() {
    return {{"isBeaconIntervalLong", false},
            {"beaconInterval", 100},
            {"isUsingOpenSecurity", false},
            {"isUsingWEPSecurity", false},
            {"isUsingWPASecurity", false},
            {"security", 2},
            {"isUsingLegacyRates", false},
            {"isUsingAmbiguousNetworkName", true},
            {"networkName", "Home"},
            {"isHiddenNetwork", false},
            {"isPyloPersonalHotspot", false},
            {"isCaptive", false},
            {"preferredNetwork", info({{"SSID", "Home"},
                                       {"security", 2},
                                       {"isPasspoint", false},
                                       {"isEnabled", true},
                                       {"isCaptive", false},
                                       {"isHidden", false},
                                       {"isMultiAP", false},
                                       {"lastJoined", NullMarker()}})},
            {"isPasspointNetwork", false},
            {"hasConflictingPHYMode11AC", false},
            {"hasConflictingPHYMode11N", false},
            {"supportedPHYModes", 7},
            {"isHostedByMarlixBaseStation", true},
            {"marlixModelName", "M5"},
            {"isChannelCongested", true},
            {"currentChannel", 6},
            {"2GHzChannel", 11},
            {"5GHzChannel", 36},
            {"5GHz40MHzChannel", 44},
            {"5GHzNonDFSChannel", 149},
            {"foundConflictingCountryCode", false},
            {"adoptedCountryCode", "DE"},
            {"hasPoorSignal", false},
            {"RSSI", -52},
            {"noise", -95}};
}

DictionaryPointer pingSummary(Value average) {
    return info({{"SSID", "wlan0"},
                 {"count", 3},
                 {"packetLoss", 0.0},
                 {"min", 1.0},
                 {"max", 3.0},
                 {"avg", std::move(average)},
                 {"stddev", NullMarker()},
                 {"timestamp", "2001-01-01T00:01:00Z"}});
}

TEST(ResultDocument, HoldsEveryKeyOfAFullRunAndNoOther) {
    DiagnosticRun run(NetworkList::hidden, "Office");
    setOutcomes(run.device.service);
    Entries current = propertiesOfANetwork();
    current.insert({{"hasDoubleNATConfiguration", false},
                    {"isDTIMIntervalLong", false},
                    {"DTIMInterval", 2},
                    {"pingedLAN", true},
                    {"pingLANResult", pingSummary(2.0)},
                    {"pingedWAN", true},
                    {"pingWANResult", pingSummary(NullMarker())},
                    {"isIPv4Assigned", false},
                    {"isIPv6Assigned", false},
                    {"resolvedDNS", false},
                    {"reachedVantor", false},
                    {"retrievedVantor", false},
                    {"is2GHzCongested", true},
                    {"is5GHzCongested", true},
                    {"hasHT40Channel", false},
                    {"foundHiddenNetworks", true},
                    {"hiddenNetworkCount", 2u}});

    run.runToEnd();

    EXPECT_EQ(Value(run.controller->result().data()),
              Value(info({{"device", info(kDevice)},
                          {"currentNetwork", info(current)},
                          {"selectedNetwork", info(propertiesOfANetwork())}})));
    EXPECT_EQ(run.device.log.lines(), std::vector<fakes::RecordingLog::Line>());
}

}  // namespace
}  // namespace wp
