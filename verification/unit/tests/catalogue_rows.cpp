#include "verification/unit/tests/catalogue_rows.h"

namespace wp::rows {

// clang-format off
const std::vector<Row>& deviceRows() {
    static const std::vector<Row> rows = {
        {"CustomIPv4"                  , &Controller::runDeviceConfigurationCustomIPv4                  , nullptr, 14, "isUsingCustomIPv4"                    , Gate::notPassed, "IPv4ConfigMethod", "IPv4ConfigMethod"         , "[ERROR] - Wi-Fi Profile: IPv4ConfigMethod not found."         , "[ERROR] - Wi-Fi Profile: Custom IPv4 failed with error: "},
        {"CustomIPv6"                  , &Controller::runDeviceConfigurationCustomIPv6                  , nullptr, 15, "isUsingCustomIPv6"                    , Gate::notPassed, "IPv6ConfigMethod", "IPv6ConfigMethod"         , "[ERROR] - Wi-Fi Profile: IPv6ConfigMethod not found."         , "[ERROR] - Wi-Fi Profile: Custom IPv6 failed with error: "},
        {"CustomDNS"                   , &Controller::runDeviceConfigurationCustomDNS                   , nullptr, 16, "isUsingCustomDNS"                     , Gate::never    , nullptr           , nullptr                    , nullptr                                                        , "[ERROR] - Wi-Fi Profile: Custom DNS failed with error: "},
        {"CustomWebProxy"              , &Controller::runDeviceConfigurationCustomWebProxy              , nullptr, 17, "isUsingCustomWebProxy"                , Gate::never    , nullptr           , nullptr                    , nullptr                                                        , "[ERROR] - Wi-Fi Profile: Custom Web Proxy failed with error: "},
        {"HalvoRealTimeMode"           , &Controller::runDeviceConfigurationHalvoRealTimeMode           , nullptr, 22, "isHalvoInRealTimeMode"                , Gate::never    , nullptr           , nullptr                    , nullptr                                                        , "[ERROR] - Wi-Fi Profile: Halvo Real Time Mode failed with error: "},
        {"BluetoothConnected"          , &Controller::runDeviceConfigurationBluetoothConnected          , nullptr, 19, "isLargeConnectedBT"                   , Gate::always   , "BTConnectedCount", "bluetoothConnectedCount"  , "[ERROR] - Wi-Fi Profile: BluetoothConnectedCount not found."  , "[ERROR] - Wi-Fi Profile: Bluetooth Connected failed with error: "},
        {"BluetoothPaired"             , &Controller::runDeviceConfigurationBluetoothPaired             , nullptr, 18, "isLargePairedBT"                      , Gate::always   , "BTPairedCount"   , "bluetoothPairedCount"     , "[ERROR] - Wi-Fi Profile: BluetoothPairedCount not found."     , "[ERROR] - Wi-Fi Profile: Bluetooth Paired failed with error: "},
        {"BTCoex"                      , &Controller::runDeviceConfigurationBTCoex                      , nullptr, 20, "isHYBRIDBTCoexistenceMode"            , Gate::never    , nullptr           , nullptr                    , nullptr                                                        , "[ERROR] - Wi-Fi Profile: Bluetooth Coex failed with error: "},
        {"LargePNL"                    , &Controller::runDeviceConfigurationLargePNL                    , nullptr, 47, "isLargePNL"                           , Gate::always   , "PNLCount"        , "preferredNetworkListCount", "[ERROR] - Wi-Fi Profile: PreferredNetworkListCount not found.", "[ERROR] - Wi-Fi Profile: Large PNL failed with error: "},
        {"PNLContainsHidden"           , &Controller::runDeviceConfigurationPNLContainsHidden           , nullptr, 48, "doesPNLContainHiddenNetworks"         , Gate::never    , nullptr           , nullptr                    , nullptr                                                        , "[ERROR] - Wi-Fi Profile: PNL Contains Hidden failed with error: "},
        {"ConflictingSecurityTypeInPNL", &Controller::runDeviceConfigurationConflictingSecurityTypeInPNL, nullptr, 29, "doesPNLContainConflictingSecurityType", Gate::never    , nullptr           , nullptr                    , nullptr                                                        , "[ERROR] - Wi-Fi Profile: Conflicting Security Type in PNL failed with error: "},
    };
    return rows;
}

const std::vector<Row>& networkRows() {
    static const std::vector<Row> rows = {
        {"DetectDoubleNAT"       , nullptr, &Controller::runCurrentNetworkDetectDoubleNATWithConfiguration       ,  8, "hasDoubleNATConfiguration"  , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Detect Double NAT failed with error: "},
        {"LongBeaconInterval"    , nullptr, &Controller::runCurrentNetworkLongBeaconIntervalWithConfiguration    , 34, "isBeaconIntervalLong"       , Gate::always   , "BeaconInterval"    , "beaconInterval"    , "[ERROR] - Wi-Fi Profile: BeaconInterval not found."         , "[ERROR] - Wi-Fi Profile: Long Beacon Interval failed with error: "},
        {"LongDTIMInterval"      , nullptr, &Controller::runCurrentNetworkLongDTIMIntervalWithConfiguration      , 35, "isDTIMIntervalLong"         , Gate::always   , "DTIMInterval"      , "DTIMInterval"      , "[ERROR] - Wi-Fi Profile: DTIMInterval not found."           , "[ERROR] - Wi-Fi Profile: Long DTIM Interval failed with error: "},
        {"NoSecurity"            , nullptr, &Controller::runCurrentNetworkNoSecurityWithConfiguration            , 38, "isUsingOpenSecurity"        , Gate::always   , "Security"          , "security"          , "[ERROR] - Wi-Fi Profile: Security not found."               , "[ERROR] - Wi-Fi Profile: No Security failed with error: "},
        {"LegacySecurityWEP"     , nullptr, &Controller::runCurrentNetworkLegacySecurityWEPWithConfiguration     , 39, "isUsingWEPSecurity"         , Gate::always   , "Security"          , "security"          , "[ERROR] - Wi-Fi Profile: Security not found."               , "[ERROR] - Wi-Fi Profile: Legacy Security: WEP failed with error: "},
        {"LegacySecurityWPA"     , nullptr, &Controller::runCurrentNetworkLegacySecurityWPAWithConfiguration     , 40, "isUsingWPASecurity"         , Gate::always   , "Security"          , "security"          , "[ERROR] - Wi-Fi Profile: Security not found."               , "[ERROR] - Wi-Fi Profile: Legacy Security: WPA failed with error: "},
        {"LegacyRates11b"        , nullptr, &Controller::runCurrentNetworkLegacyRates11bWithConfiguration        , 41, "isUsingLegacyRates"         , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Legacy Rates (802.11b) failed with error: "},
        {"AmbiguousNetworkName"  , nullptr, &Controller::runCurrentNetworkAmbiguousNetworkNameWithConfiguration  , 42, "isUsingAmbiguousNetworkName", Gate::always   , "NetworkName"       , "networkName"       , "[ERROR] - Wi-Fi Profile: NetworkName not found."            , "[ERROR] - Wi-Fi Profile: Ambiguous Network Name failed with error: "},
        {"HiddenNetwork"         , nullptr, &Controller::runCurrentNetworkHiddenNetworkWithConfiguration         , 43, "isHiddenNetwork"            , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Hidden Network failed with error: "},
        {"PyloPersonalHotspot"   , nullptr, &Controller::runCurrentNetworkPyloPersonalHotspotWithConfiguration   , 44, "isPyloPersonalHotspot"      , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Pylo Personal Hotspot failed with error: "},
        {"CaptivePortal"         , nullptr, &Controller::runCurrentNetworkCaptivePortalWithConfiguration         , 46, "isCaptive"                  , Gate::always   , "PreferredNetwork"  , "preferredNetwork"  , "[ERROR] - Wi-Fi Profile: currentPreferredNetwork not found.", "[ERROR] - Wi-Fi Profile: Captive Portal failed with error: "},
        {"Passpoint"             , nullptr, &Controller::runCurrentNetworkPasspointWithConfiguration             , 45, "isPasspointNetwork"         , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Passpoint failed with error: "},
        {"ConflictingPHYMode11AC", nullptr, &Controller::runCurrentNetworkConflictingPHYMode11ACWithConfiguration, 36, "hasConflictingPHYMode11AC"  , Gate::always   , "SupportedPHYModes" , "supportedPHYModes" , "[ERROR] - Wi-Fi Profile: SupportedPHYModes not found."      , "[ERROR] - Wi-Fi Profile: Conflicting PHY Mode (11AC) failed with error: "},
        {"ConflictingPHYMode11N" , nullptr, &Controller::runCurrentNetworkConflictingPHYMode11NWithConfiguration , 37, "hasConflictingPHYMode11N"   , Gate::always   , "SupportedPHYModes" , "supportedPHYModes" , "[ERROR] - Wi-Fi Profile: SupportedPHYModes not found."      , "[ERROR] - Wi-Fi Profile: Conflicting PHY Mode (11N) failed with error: "},
        {"MarlixBaseStation"     , nullptr, &Controller::runCurrentNetworkMarlixBaseStationWithConfiguration     , 33, "isHostedByMarlixBaseStation", Gate::passed   , "MarlixModelName"   , "marlixModelName"   , "[ERROR] - Wi-Fi Profile: MarlixModelName not found."        , "[ERROR] - Wi-Fi Profile: Marlix Base Station failed with error: "},
        {"PingLAN"               , nullptr, &Controller::runCurrentNetworkPingLANWithConfiguration               ,  3, "pingedLAN"                  , Gate::passed   , "PingResult"        , "pingLANResult"     , "[ERROR] - Wi-Fi Profile: PingResult not found."             , "[ERROR] - Wi-Fi Profile: Ping LAN failed with error: "},
        {"PingWAN"               , nullptr, &Controller::runCurrentNetworkPingWANWithConfiguration               ,  6, "pingedWAN"                  , Gate::passed   , "PingResult"        , "pingWANResult"     , "[ERROR] - Wi-Fi Profile: PingResult not found."             , "[ERROR] - Wi-Fi Profile: Ping WAN failed with error: "},
        {"IPv4Assigned"          , nullptr, &Controller::runCurrentNetworkIPv4AssignedWithConfiguration          , 12, "isIPv4Assigned"             , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: IPv4 Assigned failed with error: "},
        {"IPv6Assigned"          , nullptr, &Controller::runCurrentNetworkIPv6AssignedWithConfiguration          , 13, "isIPv6Assigned"             , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: IPv6 Assigned failed with error: "},
        {"ResolveDNS"            , nullptr, &Controller::runCurrentNetworkResolveDNSWithConfiguration            ,  7, "resolvedDNS"                , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Resolve DNS failed with error: "},
        {"ReachVantor"           , nullptr, &Controller::runCurrentNetworkReachVantorWithConfiguration           ,  9, "reachedVantor"              , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Reach Vantor failed with error: "},
        {"RetrieveVantor"        , nullptr, &Controller::runCurrentNetworkRetrieveVantorWithConfiguration        , 11, "retrievedVantor"            , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Retrieve Vantor failed with error: "},
        {"CongestedChannel"      , nullptr, &Controller::runCurrentNetworkCongestedChannelWithConfiguration      , 24, "isChannelCongested"         , Gate::always   , "CurrentChannel"    , "currentChannel"    , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Congested Channel failed with error: "},
        {"Congested2GHz"         , nullptr, &Controller::runCurrentNetworkCongested2GHzWithConfiguration         , 25, "is2GHzCongested"            , Gate::always   , "5GHzChannel"       , "5GHzChannel"       , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Congested 2.4GHz failed with error: "},
        {"Congested5GHz"         , nullptr, &Controller::runCurrentNetworkCongested5GHzWithConfiguration         , 26, "is5GHzCongested"            , Gate::always   , "5GHzChannel"       , "5GHzChannel"       , nullptr                                                      , "[ERROR] - Wi-Fi Profile: Congested 5GHz failed with error: "},
        {"HT402GHzChannel"       , nullptr, &Controller::runCurrentNetworkHT402GHzChannelWithConfiguration       , 27, "hasHT40Channel"             , Gate::never    , nullptr             , nullptr             , nullptr                                                      , "[ERROR] - Wi-Fi Profile: HT 40 Channel failed with error: "},
        {"ConflictingCountryCode", nullptr, &Controller::runCurrentNetworkConflictingCountryCodeWithConfiguration, 28, "foundConflictingCountryCode", Gate::always   , "AdoptedCountryCode", "adoptedCountryCode", "[ERROR] - Wi-Fi Profile: AdoptedCountryCode not found."     , "[ERROR] - Wi-Fi Profile: Conflicting Country Code failed with error: "},
        {"PoorSignal"            , nullptr, &Controller::runCurrentNetworkPoorSignalWithConfiguration            , 32, "hasPoorSignal"              , Gate::always   , "RSSI"              , "RSSI"              , "[ERROR] - Wi-Fi Profile: RSSI not found."                   , "[ERROR] - Wi-Fi Profile: Poor Signal failed with error: "},
        {"HiddenScanResults"     , nullptr, &Controller::runCurrentNetworkHiddenScanResultsWithConfiguration     , 30, "foundHiddenNetworks"        , Gate::notPassed, "ScanResults"       , "hiddenNetworkCount", "[ERROR] - Wi-Fi Profile: Scan Results not found."           , "[ERROR] - Wi-Fi Profile: Hidden Scan Results failed with error: "},
        {"NoScanResults"         , nullptr, &Controller::runCurrentNetworkNoScanResultsWithConfiguration         , 31, "foundScanResults"           , Gate::passed   , "ScanResults"       , nullptr             , "[ERROR] - Wi-Fi Profile: Scan Results not found."           , "[ERROR] - Wi-Fi Profile: No Scan Results failed with error: "},
    };
    return rows;
}
// clang-format on

std::vector<Row> allRows() {
    std::vector<Row> rows = deviceRows();
    rows.insert(rows.end(), networkRows().begin(), networkRows().end());
    return rows;
}

Value sampleInformation(const Row& row, const char* text) {
    std::string key = row.infoKey;
    if (key == "PreferredNetwork") {
        auto record = std::make_shared<PreferredNetworkRecord>();
        record->ssid = text;
        return record;
    }
    if (key == "PingResult") {
        auto statistics = std::make_shared<PingStatistics>();
        statistics->interfaceName = text;
        return statistics;
    }
    if (key == "CurrentChannel" || key == "5GHzChannel") return std::make_shared<WiFiChannel>(36);
    if (key == "ScanResults") return Array{std::make_shared<WiFiScanResult>()};
    return text;
}

}  // namespace wp::rows
