#include "service/access_point.h"

#include <algorithm>
#include <cstdlib>
#include <string_view>

namespace wp {
namespace {

/// Values from here on tell what a station must support; they are no rates.
constexpr std::uint8_t kFirstMembershipSelector = 120;
constexpr std::uint8_t kFastestDirectSequenceRate = 22;

bool isDirectSequence(std::uint8_t rate) {
    return rate == 2 || rate == 4 || rate == 11 || rate == 22;
}

void readRates(Advertised& says, Bytes rates) {
    for (const std::uint8_t entry : rates) {
        const std::uint8_t rate = entry & 0x7F;  // the highest bit marks a basic rate
        if (rate == 0 || rate >= kFirstMembershipSelector) continue;
        says.fastestRate = std::max(says.fastestRate, rate);
        (isDirectSequence(rate) && rate <= kFastestDirectSequenceRate ? says.directSequence
                                                                      : says.orthogonal) = true;
    }
}

/// Codes that name no country: those that ISO 3166 leaves to its users, of which makers take "XZ" and others for
/// settings of their own (Kosovo's, XK, is one that countries have agreed on), and "EU", where each member
/// has a code too.
bool namesNoCountry(const CountryCode& code) {
    const auto [first, second] = code;
    if (first == 'X') return second != 'K';
    if (first == 'Q') return second >= 'M';
    return code == CountryCode{'A', 'A'} || code == CountryCode{'Z', 'Z'} || code == CountryCode{'E', 'U'};
}

std::optional<CountryCode> countryOf(Bytes element) {
    if (element.size() < 2) return std::nullopt;
    // The third letter is the environment; in one of "X" the others are no country's.
    if (element.size() > 2 && element[2] == 'X') return std::nullopt;
    CountryCode code{};
    for (std::size_t i = 0; i < code.size(); ++i) {
        const char letter = static_cast<char>(element[i] & ~0x20);
        if (element[i] >= 0x80 || letter < 'A' || letter > 'Z') return std::nullopt;
        code[i] = letter;
    }
    return namesNoCountry(code) ? std::nullopt : std::optional(code);
}

std::optional<std::uint8_t> byteAt(const Element& element, std::size_t at) {
    return element.size > at ? std::optional(element.data[at]) : std::nullopt;
}

NetworkName nameIn(const Elements& elements) {
    const NetworkName name(elements.name.bytes());
    return name.absent() ? NetworkName() : name;
}

/// A beacon of one blank only is taken for hidden when the access point answers a probe with another name.
bool hides(const NetworkName& beacon, const NetworkName& answered) {
    static constexpr std::uint8_t kBlank[] = {' '};
    return beacon.absent() || (beacon == NetworkName(kBlank) && !answered.absent() && answered != beacon);
}

/// What a beacon says, completed by the latest frame; of an access point of which no beacon was heard that frame. Broken
/// off where both are.
Elements united(const Elements& latest, const std::optional<Elements>& beacon) {
    if (!beacon) return latest;
    Elements elements = *beacon;
    addMissingElements(elements, latest);
    elements.malformed &= latest.malformed;
    return elements;
}

std::optional<Elements> decodeBeacon(const Elements& inLatest, Bytes latest, std::optional<Bytes> beacon) {
    if (!beacon) return std::nullopt;
    // The latest frame often is the beacon.
    return std::ranges::equal(*beacon, latest) ? inLatest : decodeElements(*beacon);
}

void readNames(Advertised& says, const Elements& latest, const std::optional<Elements>& beacon) {
    says.name = nameIn(latest);
    if (beacon) {
        const NetworkName inBeacon = nameIn(*beacon);
        says.hidesName = hides(inBeacon, says.name);
        if (says.name.absent()) says.name = inBeacon;
    } else if (says.name.absent()) {
        says.hidesName = true;  // an answer without a name: its beacon has none either
    }
}

/// A network that another one's beacon tells has a DTIM period of its own there.
std::optional<std::uint8_t> dtimPeriodIn(const Elements& beacon) {
    const auto own = byteAt(beacon.multipleBssidIndex, 1);
    return own ? own : byteAt(beacon.trafficMap, 1);
}

}  // namespace

std::string textOf(const MacAddress& address) {
    static constexpr char kDigits[] = "0123456789abcdef";
    std::string text;
    for (const std::uint8_t byte : address) {
        if (!text.empty()) text += ':';
        text += kDigits[byte >> 4];
        text += kDigits[byte & 15];
    }
    return text;
}

bool shareRadio(const AccessPoint& one, const AccessPoint& other) {
    // Multiple BSSID sets of an access point have at most 16 addresses in use.
    constexpr int kMostApart = 15;
    return one.frequency == other.frequency &&
           std::equal(one.address.begin() + 1, one.address.end() - 1, other.address.begin() + 1) &&
           std::abs(one.address.back() - other.address.back()) <= kMostApart;
}

Advertised decodeAdvertised(std::uint16_t capability, Bytes latest, std::optional<Bytes> beacon) {
    const Elements inLatest = decodeElements(latest);
    const std::optional<Elements> inBeacon = decodeBeacon(inLatest, latest, beacon);
    const Elements elements = united(inLatest, inBeacon);
    Advertised says;
    readNames(says, inLatest, inBeacon);
    if (inBeacon) says.dtimPeriod = dtimPeriodIn(*inBeacon);
    readRates(says, elements.rates.bytes());
    readRates(says, elements.extendedRates.bytes());
    says.security = decodeSecurity(capability, elements);
    says.country = countryOf(elements.country.bytes());
    says.load = byteAt(elements.load, 2);
    says.protection = byteAt(elements.protection, 0);
    says.ht = elements.htCapabilities.present();
    says.vht = elements.vhtCapabilities.present();
    says.he = elements.heCapabilities.present();
    says.eht = elements.ehtCapabilities.present();
    says.htSecondary = byteAt(elements.htOperation, 1).value_or(0) & 3;
    says.hotspot = elements.hotspot.present();
    says.onlineSignUp = elements.onlineSignUp.present();
    says.interworking = elements.interworking.present();
    says.malformed = inLatest.malformed || (inBeacon && inBeacon->malformed);
    return says;
}

Elements elementsOf(const AccessPoint& accessPoint) {
    const Elements inLatest = decodeElements(accessPoint.elements);
    return united(inLatest, decodeBeacon(inLatest, accessPoint.elements, accessPoint.beaconElements));
}

std::string phyModesOf(const AccessPoint& accessPoint) {
    const Advertised& says = accessPoint.says;
    const bool below5 = accessPoint.band() == Band::ghz2;
    const std::pair<bool, std::string_view> modes[] = {
        {!below5 && says.orthogonal && accessPoint.band() == Band::ghz5, "a"},
        {below5 && says.directSequence, "b"},
        {below5 && says.orthogonal, "g"},
        {says.ht, "n"},
        {!below5 && says.vht, "ac"},
        {says.he, "ax"},
        {says.eht, "be"},
    };
    std::string text;
    for (const auto& [offered, name] : modes) {
        if (!offered) continue;
        if (!text.empty()) text += '/';
        text += name;
    }
    return text;
}

}  // namespace wp
