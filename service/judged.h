#pragma once

#include <vector>

#include "service/facts.h"

namespace wp {

/// The access point that the tests judge: the joined one, or the strongest of the network asked about. *Any*
/// thread.
Known<const AccessPoint*> judgedAccessPoint(const Facts& facts);

/// The same as a later scan heard it, where one did: of a joined access point's beacons the kernel itself looks at few
/// elements, and the load that it announces is not among them. *Any* thread.
Known<const AccessPoint*> judgedAsHeardLast(const Facts& facts);

/// All access points with the judged network's name, the judged one included. *Any* thread.
Known<std::vector<const AccessPoint*>> judgedNetwork(const Facts& facts);

}  // namespace wp
