#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "service/outcome.h"

namespace wp {

/// A direct link to another device (Wi-Fi Direct) that shares the station's radio.
struct PeerLink {
    std::string interfaceName;
    std::uint32_t frequency = 0;  ///< MHz; 0 while the link is not active
};

struct PeerLinks {
    std::vector<PeerLink> links;
    std::uint32_t stationFrequency = 0;  ///< MHz; 0 when not joined
    /// What the file says that the device's maker names for it; absent where none is named.
    std::optional<bool> indicated;
};

/// Test 22: whether a peer-to-peer link is in its real-time mode: active on the station's radio, and on
/// another channel, so that both take turns. A link on the station's own channel costs no turns. The maker's
/// indicator counts where there is one.
Outcome peerLinkIsInRealTimeMode(const Known<PeerLinks>& links);

}  // namespace wp
