#include "service/peer_link.h"

#include <algorithm>

namespace wp {

Outcome peerLinkIsInRealTimeMode(const Known<PeerLinks>& links) {
    if (!links) return links.error();
    const std::uint32_t own = links->stationFrequency;
    const bool takesTurns = std::any_of(
        links->links.begin(), links->links.end(),
        [own](const PeerLink& link) { return own != 0 && link.frequency != 0 && link.frequency != own; });
    return problem(takesTurns || links->indicated.value_or(false));
}

}  // namespace wp
