#pragma once

#include <string>
#include <vector>

#include "linux/dbus/bus.h"
#include "service/address_configuration.h"

namespace wp {

/// What ConnMan knows of one interface that it has connected.
struct ConnmanLink {
    AddressMethods methods;
    std::vector<IPAddress> manualServers;
    std::vector<IPAddress> servers;           ///< in use
    std::vector<IPAddress> offeredServers;    ///< those of them that the network may have named
    std::vector<IPAddress> serversElsewhere;  ///< of other interfaces alone
    std::string proxy;                        ///< where one was entered; empty where none was
};

/// Reads it out of ConnMan's services, as `GetServices` lists them: nothing where none of them is connected over the interface.
/// *Any* thread.
std::optional<ConnmanLink> connmanLinkIn(const BusValue& services, const std::string& interfaceName);

/// Asks ConnMan. Fails as `unavailable` where it does not run, as `notFound` where it has not connected the interface.
Known<ConnmanLink> readConnmanLink(Bus& bus, const std::string& interfaceName, const Until& until);

}  // namespace wp
