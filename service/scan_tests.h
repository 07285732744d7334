#pragma once

#include "service/facts.h"
#include "service/outcome.h"

namespace wp {

// The verdicts on a scan as a whole. All are pure functions; *any* thread.

/// Those that hide their names, each once: neither of the two scans heard any other frame tell it. Places in both.
std::vector<const AccessPoint*> hiddenAccessPoints(const std::vector<AccessPoint>& nearby,
                                                   const std::vector<AccessPoint>& listened);
/// All of a scan, those that the kernel keeps twice, with and without a name, by their name alone. Places in it.
std::vector<const AccessPoint*> distinctAccessPoints(const std::vector<AccessPoint>& nearby);

/// 30. "ScanResults" holds the hidden access points only.
Outcome foundHiddenNetworks(const Facts& facts);
/// 31. "ScanResults" holds all access points, hidden ones and the joined one included.
Outcome foundNoNetworks(const Facts& facts);

}  // namespace wp
