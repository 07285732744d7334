#pragma once

#include "service/facts.h"
#include "service/outcome.h"
#include "service/thresholds.h"

namespace wp {

// The verdicts on a network's own properties. All are pure functions; *any* thread. An error says what could
// not be told.

/// Whether access points carry the name out of the box, or it says nothing: two unrelated networks with it are
/// likely to be in reach of each other. \param common such names; letters of ASCII have no case
bool isCommonName(const NetworkName& name, const std::vector<NetworkName>& common);

/// 34. "BeaconInterval" in units of 1.024 ms.
Outcome beaconIntervalIsLong(const Facts& facts);
/// 35. "DTIMInterval" in beacons.
Outcome dtimIntervalIsLong(const Facts& facts);
/// 38. "Security" is the document's word, here and in the next two.
Outcome securityIsOpen(const Facts& facts);
/// 39.
Outcome securityIsWep(const Facts& facts);
/// 40.
Outcome securityIsWpa(const Facts& facts);
/// 42. "NetworkName".
Outcome nameIsAmbiguous(const Facts& facts);
/// 43.
Outcome nameIsHidden(const Facts& facts);
/// 45.
Outcome isPasspoint(const Facts& facts);

}  // namespace wp
