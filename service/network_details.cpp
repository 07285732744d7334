#include <algorithm>
#include <set>

#include "service/detail_values.h"
#include "service/elements.h"
#include "service/judged.h"
#include "service/maker.h"
#include "service/network_tests.h"
#include "service/radio_tests.h"
#include "service/reach_tests.h"

namespace wp {
namespace {

struct Word {
    unsigned bit;
    std::string_view word;
};

constexpr Word kCiphers[] = {{SecuritySuites::kWep, "WEP"},
                             {SecuritySuites::kTkip, "TKIP"},
                             {SecuritySuites::kCcmpOrBetter, "CCMP"},
                             {SecuritySuites::kOtherCipher, "other"}};
constexpr Word kKeys[] = {{SecuritySuites::kEnterprise, "EAP"},
                          {SecuritySuites::kEnterpriseSha256, "EAP-SHA256"},
                          {SecuritySuites::kEnterpriseStrong, "EAP-192"},
                          {SecuritySuites::kPreSharedKey, "PSK"},
                          {SecuritySuites::kSae, "SAE"},
                          {SecuritySuites::kOwe, "OWE"},
                          {SecuritySuites::kOtherKeyManagement, "other"}};

template <std::size_t count>
Value wordsOf(unsigned bits, const Word (&words)[count]) {
    Array found;
    for (const Word& each : words)
        if ((bits & each.bit) != 0) found.push_back(each.word);
    return found;
}

/// The network's access points, as far as the scan heard them.
std::vector<const AccessPoint*> networkOf(const Facts& facts) {
    const auto network = judgedNetwork(facts);
    return network ? *network : std::vector<const AccessPoint*>();
}

DictionaryPointer modesOf(const AccessPoint* each) {
    return Dictionary::make({{"bssid", textOf(each->address)},
                             {"band", wordOf(each->band())},
                             {"modes", phyModesOf(*each)},
                             {"joined", each->joined}});
}

}  // namespace

Details baseStationDetails(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return {};
    const WpsDescription wps = decodeWps((*judged)->elements);
    Details details;
    addText(details, "manufacturer", wps.manufacturer);
    addText(details, "modelName", wps.modelName);
    addText(details, "modelNumber", wps.modelNumber);
    if (facts.named || !facts.router) return details;
    addText(details, "routerManufacturer", facts.router->description.manufacturer);
    addText(details, "routerModelName", facts.router->description.modelName);
    return details;
}

Details beaconDetails(const Facts&) {
    Details details;
    addThresholds(details, {{"beaconInterval", kLongestBeaconInterval}});
    return details;
}

Details dtimDetails(const Facts&) {
    Details details;
    addThresholds(details, {{"DTIMInterval", kLongestDtimPeriod}});
    return details;
}

Details modes11ACDetails(const Facts& facts) {
    const auto network = networkOf(facts);
    if (network.empty()) return {};
    return {{"accessPoints", listOf(network, modesOf)}};
}

Details modes11NDetails(const Facts& facts) {
    Details details = modes11ACDetails(facts);
    Array inVain;
    for (const AccessPoint* each : networkOf(facts))
        if (each->says.ht && forbidsHtByCipher(*each)) inVain.push_back(textOf(each->address));
    if (!inVain.empty()) details.emplace("oldCiphersOnly", std::move(inVain));
    return details;
}

Details securityDetails(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return {};
    const SecuritySuites& suites = (*judged)->says.security;
    if (!suites.rsn && !suites.wpa) return {};
    return {{"ciphers", wordsOf(suites.pairwise, kCiphers)},
            {"groupCiphers", wordsOf(suites.group, kCiphers)},
            {"keyManagement", wordsOf(suites.keyManagement | suites.wpaKeyManagement, kKeys)},
            {"frameProtectionRequired", suites.frameProtectionRequired}};
}

Details rateDetails(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return {};
    const Advertised& says = (*judged)->says;
    Details details{{"band", wordOf((*judged)->band())}};
    if (says.fastestRate != 0) details.emplace("fastestRate", says.fastestRate / 2.0);
    if (!says.protection) return details;
    details.emplace("olderStations", (*says.protection & 1) != 0);
    details.emplace("protection", (*says.protection & 2) != 0);
    return details;
}

Details ambiguousNameDetails(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged || (*judged)->says.name.absent()) return {};
    std::set<std::string_view> words;
    for (const AccessPoint* each : networkOf(facts)) words.insert(nameOf(securityOf(each->says.security)));
    Details details{{"commonName", isCommonName((*judged)->says.name, facts.settings.vendors.commonNames)}};
    if (!words.empty())
        details.emplace("securities", listOf(words, [](std::string_view word) { return word; }));
    return details;
}

Details hiddenNameDetails(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return {};
    Details details{{"nameKnown", !(*judged)->says.name.absent()}};
    if (!(*judged)->beaconElements) return details;
    const Bytes name = decodeElements(*(*judged)->beaconElements).name.bytes();
    details.emplace("inBeacon", name.empty() ? "empty" : NetworkName(name).absent() ? "zeros" : "name");
    return details;
}

Details hotspotDetails(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return {};
    const Known<std::string> leaseText = leaseTextOf(facts);
    const HotspotMatches matches = hotspotMatches(**judged, leaseText, facts.settings.vendors.hotspot);
    Array matched;
    if (matches.element) matched.emplace_back("vendorElement");
    if (matches.addressPrefix) matched.emplace_back("addressPrefix");
    if (matches.leaseText) matched.emplace_back("leaseText");
    return {{"matched", std::move(matched)}, {"leaseRead", static_cast<bool>(leaseText)}};
}

Details hotspotElementDetails(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return {};
    const Advertised& says = (*judged)->says;
    return {
        {"hotspot", says.hotspot}, {"onlineSignUp", says.onlineSignUp}, {"interworking", says.interworking}};
}

}  // namespace wp
