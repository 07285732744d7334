#include "lifecycle/wifi_profile_view_controller.h"
#include "tests/test_row.h"

namespace wp {
namespace {

using enum InfoGate;
constexpr std::string_view none;

}  // namespace

// Deliberate: the scan test reads its information when it has passed, the test for hidden networks when it
// has not. The two congestion tests of a band have no channel of their own.
// clang-format off
// operation                                                                                                                                     ID  verdict                        read       information key       result key            name when missing     name on failure
void WiFiProfileViewController::runCurrentNetworkCongestedChannelWithConfiguration(Configuration c, Results r)       { runCongestionTest({       24, "isChannelCongested",          always,    "CurrentChannel",     "currentChannel",     none,                 "Congested Channel"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkCongested2GHzWithConfiguration(Configuration c, Results r)          { runCongestionTest({       25, "is2GHzCongested",             always,    none,                 none,                 none,                 "Congested 2.4GHz"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkCongested5GHzWithConfiguration(Configuration c, Results r)          { runCongestionTest({       26, "is5GHzCongested",             always,    none,                 none,                 none,                 "Congested 5GHz"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkHT402GHzChannelWithConfiguration(Configuration c, Results r)        { runTest({                 27, "hasHT40Channel",              never,     none,                 none,                 none,                 "HT 40 Channel"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkConflictingCountryCodeWithConfiguration(Configuration c, Results r) { runTest({                 28, "foundConflictingCountryCode", always,    "AdoptedCountryCode", "adoptedCountryCode", "AdoptedCountryCode", "Conflicting Country Code"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkPoorSignalWithConfiguration(Configuration c, Results r)             { runSignalTest({           32, "hasPoorSignal",               always,    "RSSI",               "RSSI",               "RSSI",               "Poor Signal"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkNoScanResultsWithConfiguration(Configuration c, Results r)          { runNoScanResultsTest({    31, "foundScanResults",            passed,    "ScanResults",        none,                 "Scan Results",       "No Scan Results"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkHiddenScanResultsWithConfiguration(Configuration c, Results r)      { runHiddenScanResultsTest({30, "foundHiddenNetworks",         notPassed, "ScanResults",        "hiddenNetworkCount", "Scan Results",       "Hidden Scan Results"}, c, r); }
// clang-format on

void WiFiProfileViewController::runCongestionTest(const TestRow& row, Configuration configuration,
                                                  Results resultsDictionary) const {
    static constexpr std::string_view kBandKeys[] = {"2GHzChannel", "5GHzChannel", "5GHz40MHzChannel",
                                                     "5GHzNonDFSChannel"};
    DictionaryPointer info = infoOfTest(row, configuration, resultsDictionary);
    if (!info) return;
    auto storeChannel = [&](std::string_view infoKey, std::string_view resultKey) {
        // Deliberate: a channel that the service does not name is no error and leaves no log line.
        std::optional<Value> value = info->value(infoKey);
        auto channel = value ? value->asRecord<WiFiChannel>() : nullptr;
        if (channel) resultsDictionary->setValue(resultKey, channel->channel);
    };
    if (!row.infoKey.empty()) storeChannel(row.infoKey, row.infoResultKey);
    for (std::string_view key : kBandKeys) storeChannel(key, key);
}

void WiFiProfileViewController::runSignalTest(const TestRow& row, Configuration configuration,
                                              Results resultsDictionary) const {
    DictionaryPointer info = infoOfTest(row, configuration, resultsDictionary);
    if (!info) return;
    storeInfoValue(row, *info, resultsDictionary);
    TestRow noise = row;
    noise.infoKey = noise.missingName = "Noise";
    noise.infoResultKey = "noise";
    storeInfoValue(noise, *info, resultsDictionary);
}

void WiFiProfileViewController::runNoScanResultsTest(const TestRow& row, Configuration configuration,
                                                     Results resultsDictionary) {
    DiagnosticsTestResultPointer result = resultOfTest(row, configuration);
    if (!result) return;
    // Deliberate: a number, not a boolean, and the inverse of a verdict that says "no scan results".
    resultsDictionary->setValue(row.resultKey, result->result ? 0 : 1);
    DictionaryPointer info = infoOfResult(row, *result);
    if (!info) return;
    // A scan that passed without a list clears the list of the scan before.
    setWifiScanResults(infoArray(row, *info));
}

void WiFiProfileViewController::runHiddenScanResultsTest(const TestRow& row, Configuration configuration,
                                                         Results resultsDictionary) const {
    DictionaryPointer info = infoOfTest(row, configuration, resultsDictionary);
    if (!info) return;
    ArrayPointer networks = infoArray(row, *info);
    if (networks) resultsDictionary->setValue(row.infoResultKey, std::uint64_t{networks->size()});
}

}  // namespace wp
