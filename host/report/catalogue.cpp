#include "host/report/catalogue.h"

namespace wp::host {
namespace {

using enum TestScope;
using enum FoundWhen;
using enum Severity;
using enum Doer;

// clang-format off
constexpr CatalogueEntry kCatalogue[] = {
    {14, device, "isUsingCustomIPv4",                     isTrue,  advice,  viewer,      "IPv4ConfigMethod",          "Custom IPv4"},
    {15, device, "isUsingCustomIPv6",                     isTrue,  advice,  viewer,      "IPv6ConfigMethod",          "Custom IPv6"},
    {16, device, "isUsingCustomDNS",                      isTrue,  advice,  viewer,      nullptr,                     "Custom DNS"},
    {17, device, "isUsingCustomWebProxy",                 isTrue,  advice,  viewer,      nullptr,                     "Custom Web Proxy"},
    {22, device, "isHalvoInRealTimeMode",                 isTrue,  problem, viewer,      nullptr,                     "Halvo Real Time Mode"},
    {19, device, "isLargeConnectedBT",                    isTrue,  advice,  viewer,      "bluetoothConnectedCount",   "Bluetooth Connected"},
    {18, device, "isLargePairedBT",                       isTrue,  notice,  viewer,      "bluetoothPairedCount",      "Bluetooth Paired"},
    {20, device, "isHYBRIDBTCoexistenceMode",             isTrue,  advice,  viewer,      nullptr,                     "Bluetooth Coex"},
    {47, device, "isLargePNL",                            isTrue,  notice,  viewer,      "preferredNetworkListCount", "Large PNL"},
    {48, device, "doesPNLContainHiddenNetworks",          isTrue,  notice,  viewer,      nullptr,                     "PNL Contains Hidden"},
    {29, device, "doesPNLContainConflictingSecurityType", isTrue,  advice,  viewer,      nullptr,                     "Conflicting Security Type in PNL"},

    { 8, joined, "hasDoubleNATConfiguration",             isTrue,  advice,  routerOwner, nullptr,                     "Detect Double NAT"},
    {34, joinedAndSelected, "isBeaconIntervalLong",       isTrue,  advice,  routerOwner, "beaconInterval",            "Long Beacon Interval"},
    {35, joined, "isDTIMIntervalLong",                    isTrue,  advice,  routerOwner, "DTIMInterval",              "Long DTIM Interval"},
    {38, joinedAndSelected, "isUsingOpenSecurity",        isTrue,  problem, routerOwner, "security",                  "No Security"},
    {39, joinedAndSelected, "isUsingWEPSecurity",         isTrue,  problem, routerOwner, "security",                  "Legacy Security: WEP"},
    {40, joinedAndSelected, "isUsingWPASecurity",         isTrue,  problem, routerOwner, "security",                  "Legacy Security: WPA"},
    {41, joinedAndSelected, "isUsingLegacyRates",         isTrue,  advice,  routerOwner, nullptr,                     "Legacy Rates (802.11b)"},
    {42, joinedAndSelected, "isUsingAmbiguousNetworkName", isTrue, advice,  routerOwner, "networkName",               "Ambiguous Network Name"},
    {43, joinedAndSelected, "isHiddenNetwork",            isTrue,  advice,  routerOwner, nullptr,                     "Hidden Network"},
    {44, joinedAndSelected, "isPyloPersonalHotspot",      never,   notice,  viewer,      nullptr,                     "Pylo Personal Hotspot"},
    {46, joinedAndSelected, "isCaptive",                  isTrue,  broken,  viewer,      nullptr,                     "Captive Portal"},
    {45, joinedAndSelected, "isPasspointNetwork",         never,   notice,  nobody,      nullptr,                     "Passpoint"},
    {36, joinedAndSelected, "hasConflictingPHYMode11AC",  isTrue,  advice,  routerOwner, "supportedPHYModes",         "Conflicting PHY Mode (11AC)"},
    {37, joinedAndSelected, "hasConflictingPHYMode11N",   isTrue,  advice,  routerOwner, "supportedPHYModes",         "Conflicting PHY Mode (11N)"},
    {33, joinedAndSelected, "isHostedByMarlixBaseStation", never,  notice,  nobody,      "marlixModelName",           "Marlix Base Station"},
    { 3, joined, "pingedLAN",                             isFalse, problem, routerOwner, nullptr,                     "Ping LAN"},
    { 6, joined, "pingedWAN",                             isFalse, problem, provider,    nullptr,                     "Ping WAN"},
    {12, joined, "isIPv4Assigned",                        isFalse, problem, routerOwner, nullptr,                     "IPv4 Assigned"},
    {13, joined, "isIPv6Assigned",                        isFalse, notice,  nobody,      nullptr,                     "IPv6 Assigned"},
    { 7, joined, "resolvedDNS",                           isFalse, broken,  routerOwner, nullptr,                     "Resolve DNS"},
    { 9, joined, "reachedVantor",                         isFalse, problem, routerOwner, nullptr,                     "Reach Vantor"},
    {11, joined, "retrievedVantor",                       isFalse, problem, deviceMaker, nullptr,                     "Retrieve Vantor"},
    {24, joinedAndSelected, "isChannelCongested",         isTrue,  problem, routerOwner, "currentChannel",            "Congested Channel"},
    {25, joined, "is2GHzCongested",                       isTrue,  advice,  routerOwner, nullptr,                     "Congested 2.4GHz"},
    {26, joined, "is5GHzCongested",                       isTrue,  advice,  routerOwner, nullptr,                     "Congested 5GHz"},
    {27, joined, "hasHT40Channel",                        isTrue,  advice,  routerOwner, nullptr,                     "HT 40 Channel"},
    {28, joinedAndSelected, "foundConflictingCountryCode", isTrue, advice,  routerOwner, "adoptedCountryCode",        "Conflicting Country Code"},
    {32, joinedAndSelected, "hasPoorSignal",              isTrue,  problem, viewer,      "RSSI",                      "Poor Signal"},
    {30, joined, "foundHiddenNetworks",                   isTrue,  notice,  nobody,      "hiddenNetworkCount",        "Hidden Scan Results"},

    {31, list,   "foundScanResults",                      isFalse, broken,  viewer,      nullptr,                     "No Scan Results"},
};
// clang-format on

}  // namespace

std::span<const CatalogueEntry> catalogue() {
    return kCatalogue;
}

const CatalogueEntry* catalogueEntry(int testID) {
    for (const CatalogueEntry& entry : kCatalogue)
        if (entry.testID == testID) return &entry;
    return nullptr;
}

std::string testKey(int testID, const char* what) {
    return "T" + std::to_string(testID) + "_" + what;
}

}  // namespace wp::host
