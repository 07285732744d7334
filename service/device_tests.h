#pragma once

#include "service/facts.h"
#include "service/outcome.h"

namespace wp {

// The verdicts on the device's own configuration. All are pure functions; *any* thread.

/// 14. "IPv4ConfigMethod".
Outcome ipv4IsCustom(const Facts& facts);
/// 15. "IPv6ConfigMethod".
Outcome ipv6IsCustom(const Facts& facts);
/// 16.
Outcome nameServersAreCustom(const Facts& facts);
/// 17.
Outcome webProxyIsCustom(const Facts& facts);
/// 18. "BTPairedCount".
Outcome manyBluetoothPaired(const Facts& facts);
/// 19. "BTConnectedCount".
Outcome manyBluetoothConnected(const Facts& facts);
/// 20.
Outcome bluetoothSharesAirtime(const Facts& facts);
/// 22.
Outcome peerLinkTakesTurns(const Facts& facts);
/// 29.
Outcome savedSecurityConflicts(const Facts& facts);
/// 47. "PNLCount".
Outcome manyNetworksSaved(const Facts& facts);
/// 48.
Outcome hiddenNetworksSaved(const Facts& facts);

}  // namespace wp
