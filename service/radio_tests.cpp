#include "service/radio_tests.h"

#include <algorithm>
#include <map>
#include <set>

#include "service/judged.h"

namespace wp {
namespace {

constexpr std::uint8_t kSecondaryAbove = 1;
constexpr std::uint8_t kSecondaryBelow = 3;

constexpr std::uint8_t kOlderStationsPresent = 1;
constexpr std::uint8_t kProtectionInUse = 2;

/// World-wide and combined regulatory domains name no country that others could contradict.
bool isCountry(const std::string& code) {
    return code.size() == 2 && code != "XX" &&
           std::ranges::all_of(code, [](char letter) { return letter >= 'A' && letter <= 'Z'; });
}

bool neighboursDisagree(const Facts& facts, const AccessPoint& judged) {
    std::size_t believed = 0;
    for (const auto& [country, addresses] : countryWitnesses(facts, judged)) {
        if (addresses.size() >= kCountryWitnesses || addresses.contains(judged.address)) ++believed;
    }
    return believed > 1;
}

bool hasVht(const AccessPoint& each) {
    return each.says.vht || each.says.he || each.says.eht;
}
bool hasHt(const AccessPoint& each) {
    return each.says.ht || hasVht(each);
}

/// Whether, of the network's access points in a band, some offer the mode and some do not.
template <class Offers>
bool mixedIn(Band band, const std::vector<const AccessPoint*>& network, Offers offers) {
    bool with = false;
    bool without = false;
    for (const AccessPoint* each : network) {
        if (each->band() == band) (offers(*each) ? with : without) = true;
    }
    return with && without;
}

Outcome modeConflict(bool found, const AccessPoint& judged) {
    return problem(found, {{"SupportedPHYModes", phyModesOf(judged)}});
}

}  // namespace

Known<int> signalOf(const Facts& facts, const AccessPoint& judged) {
    if (facts.named || !facts.station || facts.station->signals.empty()) {
        if (judged.signal) return *judged.signal;
        return failure(Reason::unsupported, "the driver does not tell the signal strength in dBm");
    }
    std::vector<int> samples = facts.station->signals;
    std::ranges::sort(samples);
    return samples[samples.size() / 2];
}

std::optional<int> noiseOf(const Facts& facts, const AccessPoint& judged) {
    if (!facts.survey) return std::nullopt;
    for (const SurveyedChannel& channel : *facts.survey) {
        if (channel.frequency == judged.frequency && channel.noise && isLevel(*channel.noise))
            return channel.noise;
    }
    return std::nullopt;
}

std::map<CountryCode, std::set<MacAddress>> countryWitnesses(const Facts& facts, const AccessPoint& judged) {
    std::map<CountryCode, std::set<MacAddress>> witnesses;
    if (judged.says.country) witnesses[*judged.says.country].insert(judged.address);
    if (!facts.nearby) return witnesses;
    for (const AccessPoint& each : *facts.nearby) {
        if (!each.says.country || each.directOnly || each.address == judged.address) continue;
        if (!each.signal || !isLevel(*each.signal) || *each.signal < kWeakestCountrySignal) continue;
        witnesses[*each.says.country].insert(each.address);
    }
    return witnesses;
}

bool forbidsHtByCipher(const AccessPoint& accessPoint) {
    const SecuritySuites& suites = accessPoint.says.security;
    if (securityOf(suites) == Security::wep) return true;
    constexpr std::uint8_t kOld = SecuritySuites::kWep | SecuritySuites::kTkip;
    return suites.pairwise != 0 && (suites.pairwise & ~kOld) == 0;
}

Outcome usesFortyMegahertzIn2GHz(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    // Deliberate: the offset alone decides. Access points that use 40 MHz leave the bit for the stations'
    // width unset now and then.
    const std::uint8_t secondary = (*judged)->says.htSecondary;
    return problem((*judged)->band() == Band::ghz2 &&
                   (secondary == kSecondaryAbove || secondary == kSecondaryBelow));
}

Outcome countryCodesConflict(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    if (!facts.regulation) return facts.regulation.error();
    const std::string& adopted = facts.regulation->country;
    const std::optional<CountryCode>& said = (*judged)->says.country;
    bool found = isCountry(adopted) && said && std::string(said->begin(), said->end()) != adopted;
    if (!found) {
        if (!facts.nearby) return facts.nearby.error();
        found = neighboursDisagree(facts, **judged);
    }
    return problem(found, {{"AdoptedCountryCode", adopted}});
}

Outcome signalIsPoor(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    const Known<int> signal = signalOf(facts, **judged);
    if (!signal) return signal.error();
    if (!isLevel(*signal))
        return failure(Reason::malformed, "the driver names a signal of " + std::to_string(*signal) + " dBm");
    Dictionary::Entries info{{"RSSI", std::int64_t{*signal}}};
    const std::optional<int> noise = noiseOf(facts, **judged);
    if (noise) info.emplace("Noise", std::int64_t{*noise});
    return problem(*signal < kWeakestSignal || (noise && *signal - *noise < kLeastSignalToNoise),
                   std::move(info));
}

Outcome modesConflict11AC(const Facts& facts) {
    const Known<std::vector<const AccessPoint*>> network = judgedNetwork(facts);
    if (!network) return network.error();
    return modeConflict(mixedIn(Band::ghz5, *network, hasVht), *network->front());
}

Outcome modesConflict11N(const Facts& facts) {
    const Known<std::vector<const AccessPoint*>> network = judgedNetwork(facts);
    if (!network) return network.error();
    const bool mixed = mixedIn(Band::ghz2, *network, hasHt) || mixedIn(Band::ghz5, *network, hasHt);
    const bool inVain = std::ranges::any_of(
        *network, [](const AccessPoint* each) { return each->says.ht && forbidsHtByCipher(*each); });
    return modeConflict(mixed || inVain, *network->front());
}

Outcome ratesAreLegacy(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    if ((*judged)->band() != Band::ghz2) return problem(false);
    const Advertised& says = (*judged)->says;
    if (says.fastestRate == 0) return failure(Reason::malformed, "the access point names no rates");
    // 802.11b rates among the basic ones are every access point's default and say nothing.
    const bool older = says.protection.value_or(0) & (kOlderStationsPresent | kProtectionInUse);
    return problem(says.fastestRate <= kFastest11bRate || older);
}

}  // namespace wp
