#include "lifecycle/null_markers.h"
#include "lifecycle/wifi_profile_view_controller.h"
#include "tests/info_record.h"
#include "tests/test_row.h"

namespace wp {
namespace {

using enum InfoGate;
constexpr std::string_view none;

}  // namespace

// clang-format off
// operation                                                                                                                ID  verdict            read    information key  result key       name when missing  name on failure
void WiFiProfileViewController::runCurrentNetworkPingLANWithConfiguration(Configuration c, Results r)        { runPingTest({ 3, "pingedLAN",       passed, "PingResult",    "pingLANResult", "PingResult",      "Ping LAN"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkPingWANWithConfiguration(Configuration c, Results r)        { runPingTest({ 6, "pingedWAN",       passed, "PingResult",    "pingWANResult", "PingResult",      "Ping WAN"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkIPv4AssignedWithConfiguration(Configuration c, Results r)   { runTest({    12, "isIPv4Assigned",  never,  none,            none,            none,              "IPv4 Assigned"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkIPv6AssignedWithConfiguration(Configuration c, Results r)   { runTest({    13, "isIPv6Assigned",  never,  none,            none,            none,              "IPv6 Assigned"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkResolveDNSWithConfiguration(Configuration c, Results r)     { runTest({     7, "resolvedDNS",     never,  none,            none,            none,              "Resolve DNS"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkReachVantorWithConfiguration(Configuration c, Results r)    { runTest({     9, "reachedVantor",   never,  none,            none,            none,              "Reach Vantor"}, c, r); }
void WiFiProfileViewController::runCurrentNetworkRetrieveVantorWithConfiguration(Configuration c, Results r) { runTest({    11, "retrievedVantor", never,  none,            none,            none,              "Retrieve Vantor"}, c, r); }
// clang-format on

void WiFiProfileViewController::runPingTest(const TestRow& row, Configuration configuration,
                                            Results resultsDictionary) const {
    DictionaryPointer info = infoOfTest(row, configuration, resultsDictionary);
    if (!info) return;
    auto statistics = infoRecord<PingStatistics>(row, *info);
    if (statistics) resultsDictionary->setValue(row.infoResultKey, pingSummary(*statistics));
}

DictionaryPointer WiFiProfileViewController::pingSummary(const PingStatistics& statistics) const {
    return Dictionary::make({
        // Deliberate: this "SSID" is the name of the interface that the requests went out on.
        {"SSID", stringOrNull(statistics.interfaceName)},
        {"count", statistics.count},
        {"packetLoss", numberOrNullForDouble(statistics.packetLoss)},
        // Deliberate: unlike the others, an unknown minimum or maximum stays a number, NaN.
        {"min", statistics.min},
        {"max", statistics.max},
        {"avg", numberOrNullForDouble(statistics.avg)},
        {"stddev", numberOrNullForDouble(statistics.stddev)},
        {"timestamp", timestampFormattedInISO8601({statistics.timestamp})},
    });
}

}  // namespace wp
