#pragma once

#include "linux/stop_signal.h"
#include "service/link_setup.h"

namespace wp {

/// The router, and how to reach it.
struct RouterPlace {
    IPAddress address;
    std::string interfaceName;
    /// Where the search goes; the group of all such devices, a test's own place otherwise.
    IPAddress searched = *IPAddress::fromText("239.255.255.250");
    std::uint16_t port = 1900;
};

/// Searches for the router, fetches its description and asks it for its outer address. Only the router itself is
/// believed, and only what lies on it is fetched. Nothing is ever subscribed to. *Any* thread.
Known<RouterAnswers> askRouter(const RouterPlace& router, const Until& until);

}  // namespace wp
