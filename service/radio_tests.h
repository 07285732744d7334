#pragma once

#include "service/facts.h"
#include "service/outcome.h"

namespace wp {

// The verdicts on modes, rates, channels and signal. All are pure functions; *any* thread.

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
