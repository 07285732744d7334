#pragma once

#include <map>
#include <optional>
#include <string>

#include "linux/files/key_value_file.h"
#include "service/address_configuration.h"

namespace wp {

/// What systemd-networkd knows of one interface that it manages.
struct NetworkdLink {
    AddressMethods methods;
    std::vector<IPAddress> manualServers;
    std::vector<IPAddress> offeredServers;
    bool advertisementsKnown = false;  ///< whether those that a router advertised are among them
    bool hasLease = false;
    std::string portalApi;   ///< what lease or advertisement names; empty where none does
    std::string vendorText;  ///< of the lease
};

/// The methods that the settings stand for, in the connection manager's words.
AddressMethods methodsFromNetworkd(const UnitFile& settings);

/// Reads state, settings and lease below a root folder; absent where networkd does not run, or does not manage the interface.
/// *Any* thread.
std::optional<NetworkdLink> readNetworkdLink(unsigned interfaceIndex, const std::string& root = "");

}  // namespace wp
