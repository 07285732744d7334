#pragma once

#include <vector>

#include "service/facts.h"

namespace wp {

/// The access point that the tests judge: the joined one, or the strongest of the network asked about. *Any*
/// thread.
Known<const AccessPoint*> judgedAccessPoint(const Facts& facts);

/// All access points with the judged network's name, the judged one included. *Any* thread.
Known<std::vector<const AccessPoint*>> judgedNetwork(const Facts& facts);

}  // namespace wp
