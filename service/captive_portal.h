#pragma once

#include <optional>
#include <string>
#include <vector>

#include "service/ip_address.h"
#include "service/saved_networks.h"

namespace wp {

/// What one request for the portal probe's page got. No redirect was followed.
struct PortalAnswer {
    enum class End { answered, noAnswer };
    End end = End::noAnswer;
    int status = 0;
    std::size_t bodySize = 0;         ///< as far as it was read
    std::string location;             ///< of a redirect
    std::optional<IPAddress> server;  ///< who answered
    std::string why;                  ///< of no answer
};

/// What the network says of itself at the address that it names by DHCP or in its advertisements (RFC 8910).
struct PortalDeclaration {
    bool unrestricted = false;    ///< named the address that means "no portal here"
    std::optional<bool> captive;  ///< what its API answered (RFC 8908); absent: no usable answer
};

/// What is known about a portal in front of the joined network.
struct PortalEvidence {
    PortalDeclaration declared;
    PortalAnswer plain;   ///< over HTTP
    PortalAnswer secure;  ///< over HTTPS
};

/// The verdict with its reason, for the log.
struct PortalVerdict {
    bool captive = false;
    std::string why;
};

/// The network's own word comes first. Then the plain answer: 204 is open; a redirect or 511 is a portal; any
/// other page in place of the expected emptiness is one too. An empty page with status 200 is open where the
/// secure request got through, else it tells nothing. Without a plain answer, a secure one means partial
/// connectivity, not a portal. Where nothing answered the test cannot tell, which is not the same as "no
/// portal". A probe host that suddenly has a private address and does not answer is no portal but no
/// Internet. (The union of what two television and desktop systems and a connection manager do.)
Known<PortalVerdict> judgePortal(const PortalEvidence& evidence);

/// Test 46 for the joined network. Information: "PreferredNetwork", the remembered network.
Outcome isCaptive(const Known<PortalEvidence>& evidence, const Known<SavedNetworks>& saved,
                  const NetworkName& name, bool seenSeveralAPs);
/// Test 46 for a network that is not joined, which cannot be probed: what its profile remembers.
Outcome isRememberedAsCaptive(const Known<SavedNetworks>& saved, const NetworkName& name,
                              bool seenSeveralAPs);

}  // namespace wp
