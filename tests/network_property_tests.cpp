#include "lifecycle/network_name.h"
#include "lifecycle/null_markers.h"
#include "lifecycle/wifi_profile_view_controller.h"
#include "tests/info_record.h"
#include "tests/test_row.h"

namespace wp {
namespace {

using enum InfoGate;
constexpr std::string_view none;

}  // namespace

// Deliberate: the DTIM interval keeps the service's spelling, the beacon interval does not. The security
// tests share one result key, as do the PHY mode tests: the last one stands. The base station's model is the
// one value that is read only when its test has passed: only then there is one.
// clang-format off
// operation                                                                                                                                 ID  verdict                        read    information key      result key           name when missing          name on failure
void WiFiProfileViewController::runCurrentNetworkDetectDoubleNATWithConfiguration(Configuration c, Results r)        { runTest({              8, "hasDoubleNATConfiguration",   never,  none,                none,                none,                      "Detect Double NAT"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkLongBeaconIntervalWithConfiguration(Configuration c, Results r)     { runTest({             34, "isBeaconIntervalLong",        always, "BeaconInterval",    "beaconInterval",    "BeaconInterval",          "Long Beacon Interval"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkLongDTIMIntervalWithConfiguration(Configuration c, Results r)       { runTest({             35, "isDTIMIntervalLong",          always, "DTIMInterval",      "DTIMInterval",      "DTIMInterval",            "Long DTIM Interval"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkNoSecurityWithConfiguration(Configuration c, Results r)             { runTest({             38, "isUsingOpenSecurity",         always, "Security",          "security",          "Security",                "No Security"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkLegacySecurityWEPWithConfiguration(Configuration c, Results r)      { runTest({             39, "isUsingWEPSecurity",          always, "Security",          "security",          "Security",                "Legacy Security: WEP"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkLegacySecurityWPAWithConfiguration(Configuration c, Results r)      { runTest({             40, "isUsingWPASecurity",          always, "Security",          "security",          "Security",                "Legacy Security: WPA"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkLegacyRates11bWithConfiguration(Configuration c, Results r)         { runTest({             41, "isUsingLegacyRates",          never,  none,                none,                none,                      "Legacy Rates (802.11b)"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkAmbiguousNetworkNameWithConfiguration(Configuration c, Results r)   { runTest({             42, "isUsingAmbiguousNetworkName", always, "NetworkName",       kNetworkName,        "NetworkName",             "Ambiguous Network Name"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkHiddenNetworkWithConfiguration(Configuration c, Results r)          { runTest({             43, "isHiddenNetwork",             never,  none,                none,                none,                      "Hidden Network"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkPyloPersonalHotspotWithConfiguration(Configuration c, Results r)    { runTest({             44, "isPyloPersonalHotspot",       never,  none,                none,                none,                      "Pylo Personal Hotspot"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkCaptivePortalWithConfiguration(Configuration c, Results r)          { runCaptivePortalTest({46, "isCaptive",                   always, "PreferredNetwork",  "preferredNetwork",  "currentPreferredNetwork", "Captive Portal"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkPasspointWithConfiguration(Configuration c, Results r)              { runTest({             45, "isPasspointNetwork",          never,  none,                none,                none,                      "Passpoint"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkConflictingPHYMode11ACWithConfiguration(Configuration c, Results r) { runTest({             36, "hasConflictingPHYMode11AC",   always, "SupportedPHYModes", "supportedPHYModes", "SupportedPHYModes",       "Conflicting PHY Mode (11AC)"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkConflictingPHYMode11NWithConfiguration(Configuration c, Results r)  { runTest({             37, "hasConflictingPHYMode11N",    always, "SupportedPHYModes", "supportedPHYModes", "SupportedPHYModes",       "Conflicting PHY Mode (11N)"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkMarlixBaseStationWithConfiguration(Configuration c, Results r)      { runTest({             33, "isHostedByMarlixBaseStation", passed, "MarlixModelName",   "marlixModelName",   "MarlixModelName",         "Marlix Base Station"}, c, r); }
// clang-format on

void WiFiProfileViewController::runCaptivePortalTest(const TestRow& row, Configuration configuration,
                                                     Results resultsDictionary) const {
    DictionaryPointer info = infoOfTest(row, configuration, resultsDictionary);
    if (!info) return;
    auto record = infoRecord<PreferredNetworkRecord>(row, *info);
    if (record) resultsDictionary->setValue(row.infoResultKey, preferredNetworkDictionary(*record));
}

DictionaryPointer WiFiProfileViewController::preferredNetworkDictionary(
    const PreferredNetworkRecord& record) const {
    Value lastJoined = NullMarker();
    if (record.lastJoined) lastJoined = timestampFormattedInISO8601(*record.lastJoined);
    return Dictionary::make({
        {"SSID", stringOrNull(record.ssid)},
        {"security", record.security},
        {"isPasspoint", record.passpoint},
        {"isEnabled", record.enabled},
        // Deliberate: the remembered network's own flag, beside the test's verdict of the same name.
        {"isCaptive", record.captive},
        {"isHidden", record.hidden},
        {"isMultiAP", record.multiAP},
        {"lastJoined", lastJoined},
    });
}

}  // namespace wp
