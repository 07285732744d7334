#pragma once

#include "linux/config.h"
#include "linux/echo_socket.h"
#include "service/facts.h"

namespace wp {

// How far the joined network reaches. Each function contacts only what the configuration names, or the router; it
// blocks until it has the fact, cannot have it, or `until` ends it. An endpoint that is the empty text is a fact
// that cannot be had. *Any* thread.

/// Echo requests to the configured address of a family that has a default route, IPv4 first.
Known<Echo> gatherOutsideEcho(const Link& link, const Endpoints& endpoints, EchoSocket& socket,
                              HomeChannel::Stay& stay, const Until& until);

/// A name outside, asked of the link's own servers.
Known<NameAnswer> gatherNameAnswer(const Link& link, const LinkSetup& setup, const Endpoints& endpoints,
                                   const Until& until);

/// The portal's own word where the lease names its API, and the two probes.
Known<PortalEvidence> gatherPortal(const Link& link, const LinkSetup& setup, const Endpoints& endpoints,
                                   const Until& until);

/// The secure connection to the vendor's service, and its content.
Known<VendorContacts> gatherVendorService(const Link& link, const LinkSetup& setup,
                                          const Endpoints& endpoints, const Until& until);

/// What the router says of itself when it is searched for (SSDP) and its description is fetched.
Known<RouterAnswers> gatherRouter(const Link& link, const Until& until);

/// Own addresses, the router's outer address (NAT-PMP, PCP, or as UPnP told), the one seen outside (STUN), and who
/// answers on the way.
Known<TranslationEvidence> gatherTranslation(const Link& link, const LinkSetup& setup,
                                             const std::optional<IPAddress>& toldByRouter,
                                             const Endpoints& endpoints, const Until& until);

}  // namespace wp
