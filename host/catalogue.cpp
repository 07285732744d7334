#include "host/catalogue.h"

#include <cstdio>

namespace wp::host {
namespace {

using enum TestScope;
using enum Finding;

// The one place for these texts, so that a translation has one table to follow. The numbers in the last
// column are the defaults of the service's rules.
// clang-format off
constexpr CatalogueEntry kCatalogue[] = {
    {14, device, "isUsingCustomIPv4", whenTrue, "Custom IPv4",
     "Was this device's IPv4 address set by hand?",
     "the method is anything but automatic"},
    {15, device, "isUsingCustomIPv6", whenTrue, "Custom IPv6",
     "Was this device's IPv6 address set by hand?",
     "the method is neither automatic nor DHCP; a disabled IPv6 counts too"},
    {16, device, "isUsingCustomDNS", whenTrue, "Custom DNS",
     "Were name servers set by hand?",
     "a server was set by hand, or one is in use that the network did not offer"},
    {17, device, "isUsingCustomWebProxy", whenTrue, "Custom Web Proxy",
     "Does web traffic go through a proxy that was set by hand?",
     "a proxy or a proxy script is set; one that the network offers does not count"},
    {22, device, "isHalvoInRealTimeMode", whenTrue, "Halvo Real Time Mode",
     "Does a peer-to-peer link take the radio's time?",
     "a link to another device is active on another channel than the network's"},
    {19, device, "isLargeConnectedBT", whenTrue, "Bluetooth Connected",
     "Are many Bluetooth devices connected?",
     "more than 3"},
    {18, device, "isLargePairedBT", whenTrue, "Bluetooth Paired",
     "Are many Bluetooth devices paired?",
     "more than 16"},
    {20, device, "isHYBRIDBTCoexistenceMode", whenTrue, "Bluetooth Coex",
     "Do Wi-Fi and Bluetooth share the radio's time?",
     "sharing is on, a Bluetooth device is connected and the network is on 2.4 GHz"},
    {47, device, "isLargePNL", whenTrue, "Large PNL",
     "Does this device remember many networks?",
     "more than 50"},
    {48, device, "doesPNLContainHiddenNetworks", whenTrue, "PNL Contains Hidden",
     "Does this device remember hidden networks?",
     "at least one; each costs a question in every scan"},
    {29, device, "doesPNLContainConflictingSecurityType", whenTrue, "Conflicting Security Type in PNL",
     "Is one name remembered with different kinds of security?",
     "two enabled entries of one name differ; WPA2 beside WPA3 does not count"},

    {8, joined, "hasDoubleNATConfiguration", whenTrue, "Detect Double NAT",
     "Do two routers translate addresses one behind the other?",
     "the router's own outside address, or a hop behind it, is private"},
    {34, joinedAndSelected, "isBeaconIntervalLong", whenTrue, "Long Beacon Interval",
     "Does the access point announce itself rarely?",
     "an interval above 110 time units (of 1.024 ms)"},
    {35, joined, "isDTIMIntervalLong", whenTrue, "Long DTIM Interval",
     "Does the access point deliver stored group traffic rarely?",
     "a period above 3 beacons"},
    {38, joinedAndSelected, "isUsingOpenSecurity", whenTrue, "No Security",
     "Is the network open?",
     "it encrypts nothing; an open network with opportunistic encryption does not count"},
    {39, joinedAndSelected, "isUsingWEPSecurity", whenTrue, "Legacy Security: WEP",
     "Is the network secured with WEP?",
     "WEP alone, or a WEP cipher"},
    {40, joinedAndSelected, "isUsingWPASecurity", whenTrue, "Legacy Security: WPA",
     "Is the network secured with the first WPA?",
     "WPA is offered, also beside WPA2, or TKIP is offered as a pairwise cipher"},
    {41, joinedAndSelected, "isUsingLegacyRates", whenTrue, "Legacy Rates (802.11b)",
     "Does 802.11b slow the network down?",
     "no rate above 11 Mb/s, or 802.11b devices present or guarded against (2.4 GHz)"},
    {42, joinedAndSelected, "isUsingAmbiguousNetworkName", whenTrue, "Ambiguous Network Name",
     "Could the network's name belong to somebody else's network?",
     "a maker's default or a generic word, or one name with different kinds of security"},
    {43, joinedAndSelected, "isHiddenNetwork", whenTrue, "Hidden Network",
     "Does the network hide its name?",
     "its beacons carry no name, or zeros in its place"},
    {44, joinedAndSelected, "isPyloPersonalHotspot", never, "Pylo Personal Hotspot",
     "Is the network a telephone's personal hotspot?",
     "never; it explains other findings"},
    {46, joinedAndSelected, "isCaptive", whenTrue, "Captive Portal",
     "Does a sign-in page stand between this device and the Internet?",
     "the network says so, or answers a probe in the place of the server asked"},
    {45, joinedAndSelected, "isPasspointNetwork", never, "Passpoint",
     "Is the network a Passpoint hotspot?",
     "never; it is a property"},
    {36, joinedAndSelected, "hasConflictingPHYMode11AC", whenTrue, "Conflicting PHY Mode (11AC)",
     "Do only some of the network's 5 GHz access points speak 802.11ac?",
     "some do and some do not"},
    {37, joinedAndSelected, "hasConflictingPHYMode11N", whenTrue, "Conflicting PHY Mode (11N)",
     "Do only some of the network's access points in a band speak 802.11n?",
     "some do and some do not, or WEP or TKIP forbid its rates"},
    {33, joinedAndSelected, "isHostedByMarlixBaseStation", never, "Marlix Base Station",
     "Is the access point a Marlix base station?",
     "never; it is a property"},
    {3, joined, "pingedLAN", whenFalse, "Ping LAN",
     "Does the router answer?",
     "none of 5 echo requests is answered"},
    {6, joined, "pingedWAN", whenFalse, "Ping WAN",
     "Does a host on the Internet answer?",
     "none of 5 echo requests is answered"},
    {12, joined, "isIPv4Assigned", whenFalse, "IPv4 Assigned",
     "Does this device have an IPv4 address on the network?",
     "none but a self-assigned one"},
    {13, joined, "isIPv6Assigned", whenFalse, "IPv6 Assigned",
     "Does this device have an IPv6 address on the network?",
     "none but a link-local one"},
    {7, joined, "resolvedDNS", whenFalse, "Resolve DNS",
     "Do the network's name servers answer?",
     "no public address comes back within 4 s"},
    {9, joined, "reachedVantor", whenFalse, "Reach Vantor",
     "Can the maker's service be reached?",
     "no secure connection within 5 s"},
    {11, joined, "retrievedVantor", whenFalse, "Retrieve Vantor",
     "Does the maker's service answer as it should?",
     "another answer than the expected one, or none within 5 s"},
    {24, joinedAndSelected, "isChannelCongested", whenTrue, "Congested Channel",
     "Is the network's channel crowded?",
     "busy half of the time by others, else load 128 of 255 or 3 strong neighbours"},
    {25, joined, "is2GHzCongested", whenTrue, "Congested 2.4GHz",
     "Is the whole 2.4 GHz band crowded?",
     "each of the channels 1, 6 and 11 is"},
    {26, joined, "is5GHzCongested", whenTrue, "Congested 5GHz",
     "Is the whole 5 GHz band crowded?",
     "each allowed channel is"},
    {27, joined, "hasHT40Channel", whenTrue, "HT 40 Channel",
     "Does the network use a double-width channel in the 2.4 GHz band?",
     "a second channel above or below is announced"},
    {28, joinedAndSelected, "foundConflictingCountryCode", whenTrue, "Conflicting Country Code",
     "Do access points nearby announce different countries?",
     "another country than this device's, or two in the air, heard at -85 dBm or better"},
    {32, joinedAndSelected, "hasPoorSignal", whenTrue, "Poor Signal",
     "Is the signal weak?",
     "below -75 dBm, or less than 18 dB above the noise"},
    {30, joined, "foundHiddenNetworks", whenTrue, "Hidden Scan Results",
     "Are there networks nearby that hide their names?",
     "at least one"},

    {31, list, "foundScanResults", whenFalse, "No Scan Results",
     "Does a scan find any network at all?",
     "it finds none"},
};
// clang-format on

const char* headline(TestScope scope) {
    switch (scope) {
        case device:
            return "Device";
        case list:
            return "List of networks";
        case joined:
        case joinedAndSelected:
            break;
    }
    return "Network (* also of a selected network)";
}

bool sameHeadline(TestScope left, TestScope right) {
    return std::string_view(headline(left)) == headline(right);
}

const char* valueOf(Finding finding) {
    switch (finding) {
        case whenTrue:
            return "true: ";
        case whenFalse:
            return "false: ";
        case never:
            break;
    }
    return "";
}

std::string entryText(const CatalogueEntry& entry) {
    char number[16];
    std::snprintf(number, sizeof number, "%4d%c ", entry.testID,
                  entry.scope == joinedAndSelected ? '*' : ' ');
    return std::string(number) + entry.resultKey + "\n      asks:    " + entry.asks +
           "\n      finding: " + valueOf(entry.finding) + entry.because + "\n";
}

}  // namespace

std::span<const CatalogueEntry> catalogue() {
    return kCatalogue;
}

const CatalogueEntry* catalogueEntry(int testID) {
    for (const CatalogueEntry& entry : kCatalogue)
        if (entry.testID == testID) return &entry;
    return nullptr;
}

std::string catalogueText() {
    std::string text;
    const CatalogueEntry* previous = nullptr;
    for (const CatalogueEntry& entry : kCatalogue) {
        if (!previous || !sameHeadline(previous->scope, entry.scope))
            text += std::string(previous ? "\n" : "") + headline(entry.scope) + "\n";
        text += entryText(entry);
        previous = &entry;
    }
    return text;
}

}  // namespace wp::host
