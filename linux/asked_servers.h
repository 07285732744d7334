#pragma once

#include "linux/dbus/bus.h"
#include "linux/stop_signal.h"
#include "service/facts.h"

namespace wp {

using Servers = std::vector<IPAddress>;

/// The name servers that are asked.
struct AskedServers {
    Servers all;
    Servers entered;           ///< those that stand in the settings of a resolver on the device
    bool ofLinkAlone = false;  ///< but for those entered; else another interface may have brought some along
    Servers elsewhere{};       ///< those of all that a route over another interface leads to, as to a VPN's
};

/// Those of the resolver's file; in place of a resolver on the device (systemd-resolved, dnsmasq), and of the file that
/// systemd-resolved keeps of all links' servers, those that it asks for the link. Where it does not tell, or asks them as
/// nobody else could, its own address stays. *Any* thread; blocks while the bus is asked.
/// \param ofManager what the interface's manager hands to a resolver that cannot be asked
AskedServers askedServers(Known<Bus>& bus, const Link& link, const Servers& ofManager, const Until& until);

}  // namespace wp
