#pragma once

#include <optional>
#include <string>
#include <vector>

#include "service/ip_address.h"
#include "service/saved_networks.h"

namespace wp {

/// What one request for the portal probe's page got. No redirect was followed.
struct PortalAnswer {
    enum class End {
        answered,
        noAnswer,
        untold,  ///< it was not asked, or this device could not judge who answered
    };
    End end = End::noAnswer;
    int status = 0;
    std::uint64_t bodySize = 0;                 ///< as far as it came, whatever was announced
    std::string location;                       ///< of a redirect
    std::optional<IPAddress> server;            ///< who answered
    std::string why;                            ///< of no answer, or of a body that is not whole
    std::optional<std::int64_t> clockOffset{};  ///< s by which this device is ahead of the answer's date
    bool bodyIsWhole = true;                    ///< where it is read: with status 200
};

/// What the network says of itself at the address that it names by DHCP or in its advertisements (RFC 8910).
struct PortalDeclaration {
    bool unrestricted = false;    ///< named the address that means "no portal here"
    std::optional<bool> captive;  ///< what its API answered (RFC 8908); absent: no usable answer
    std::string page{};           ///< where its API sends the user; empty where that is too long to tell
};

/// What is known about a portal in front of the joined network.
struct PortalEvidence {
    PortalDeclaration declared;
    PortalAnswer plain;   ///< over HTTP
    PortalAnswer secure;  ///< over HTTPS
};

/// By what a portal gave itself away; `none` without one.
enum class PortalKind { none, declared, redirect, status511, alteredPage };

/// The verdict with its reason.
struct PortalVerdict {
    bool captive = false;
    PortalKind kind = PortalKind::none;
    std::string why;
};

/// How far the joined network reaches, by the portal's probes: `full` where both HTTP and HTTPS get through, `partial` where
/// only one of them does, `none` where nothing answers.
enum class Connectivity { full, partial, portal, none };

/// The network's own word comes first. Then the plain answer: 204 is open; a redirect or 511 is a portal; any other
/// page in place of the expected emptiness is one too, for which its beginning suffices. An empty page with status
/// 200 is open where the secure request got through, else it tells nothing; one of which nothing came before it
/// broke off or time was over is, however long it was said to be, neither page nor emptiness, and thus no answer.
/// Without a plain answer, a secure one means partial connectivity, not a portal. Where nothing answered the test
/// cannot tell, which is not the same as "no portal". A probe host that suddenly has a private address and does not
/// answer is no portal but no Internet. (The union of what two television and desktop systems and a connection
/// manager do.)
Known<PortalVerdict> judgePortal(const PortalEvidence& evidence);

/// What the probes say about the reach; nothing where a page that is neither empty nor a portal's tells nothing, or where
/// nobody knows of HTTPS.
std::optional<Connectivity> connectivityOf(const PortalEvidence& evidence);

/// Test 46 for the joined network. Information: "PreferredNetwork", the remembered network.
Outcome isCaptive(const Known<PortalEvidence>& evidence, const Known<SavedNetworks>& saved,
                  const NetworkName& name, bool seenSeveralAPs);
/// Test 46 for a network that is not joined, which cannot be probed: what its profile remembers.
Outcome isRememberedAsCaptive(const Known<SavedNetworks>& saved, const NetworkName& name,
                              bool seenSeveralAPs);

}  // namespace wp
