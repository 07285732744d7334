#pragma once

#include "service/facts.h"
#include "service/outcome.h"

namespace wp {

// The verdicts on how far the joined network reaches, on its maker and on its air. All are pure functions; *any*
// thread.

/// 6. "PingResult".
Outcome outsideAnswers(const Facts& facts);
/// 7.
Outcome namesResolve(const Facts& facts);
/// 8.
Outcome isTranslatedTwice(const Facts& facts);
/// 9.
Outcome vendorIsReached(const Facts& facts);
/// 11.
Outcome vendorContentArrives(const Facts& facts);
/// 24. "CurrentChannel" and the recommended channels.
Outcome channelIsFull(const Facts& facts);
/// 25. The recommended channels.
Outcome band2IsFull(const Facts& facts);
/// 26. The same.
Outcome band5IsFull(const Facts& facts);
/// 33. "MarlixModelName".
Outcome isVendorsBaseStation(const Facts& facts);
/// The vendor's text in the joined network's lease, for 44; else why it is not known.
Known<std::string> leaseTextOf(const Facts& facts);
/// 44.
Outcome isVendorsHotspot(const Facts& facts);
/// 46. "PreferredNetwork".
Outcome hasPortal(const Facts& facts);

}  // namespace wp
