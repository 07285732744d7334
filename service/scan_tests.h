#pragma once

#include "service/facts.h"
#include "service/outcome.h"

namespace wp {

// The verdicts on a scan as a whole. All are pure functions; *any* thread.

/// 30. "ScanResults" holds the hidden access points only.
Outcome foundHiddenNetworks(const Facts& facts);
/// 31. "ScanResults" holds all access points, hidden ones and the joined one included.
Outcome foundNoNetworks(const Facts& facts);

}  // namespace wp
