#pragma once

#include <map>
#include <set>

#include "service/facts.h"
#include "service/outcome.h"
#include "service/thresholds.h"

namespace wp {

// The verdicts on modes, rates, channels and signal. All are pure functions; *any* thread.

/// Which access points, by address, say which country; the judged one whatever its strength. None where nothing
/// was heard.
std::map<CountryCode, std::set<MacAddress>> countryWitnesses(const Facts& facts, const AccessPoint& judged);
/// The signal in dBm. That of the joined link swings: the middle of several samples counts.
Known<int> signalOf(const Facts& facts, const AccessPoint& judged);
/// The noise in dBm on the judged access point's channel, where the radio measures it.
std::optional<int> noiseOf(const Facts& facts, const AccessPoint& judged);
/// 802.11n must not be used with the ciphers of before: an access point that allows no other offers it in vain.
bool forbidsHtByCipher(const AccessPoint& accessPoint);

/// 27.
Outcome usesFortyMegahertzIn2GHz(const Facts& facts);
/// 28. "AdoptedCountryCode".
Outcome countryCodesConflict(const Facts& facts);
/// 32. "RSSI" and, where the radio measures it, "Noise", in dBm.
Outcome signalIsPoor(const Facts& facts);
/// 36. "SupportedPHYModes", for example "a/n/ac", here and in the next one.
Outcome modesConflict11AC(const Facts& facts);
/// 37.
Outcome modesConflict11N(const Facts& facts);
/// 41.
Outcome ratesAreLegacy(const Facts& facts);

}  // namespace wp
