#pragma once

#include <string>
#include <vector>

#include "service/ip_address.h"

namespace wp {

/// Who told the resolver's file which name servers, as resolvconf and openresolv keep it.
struct ResolverRecords {
    std::vector<IPAddress>
        offered;  ///< a DHCP client of the interface told them, or a program that hears routers
    std::vector<IPAddress> entered;  ///< they stand in the settings of the interface, or of the whole device
    std::vector<IPAddress> elsewhere;  ///< they were told of another interface, and not of this one
    bool offerKnown = false;           ///< whether a DHCP client of IPv4 is among them
};

/// Reads the records; nothing in them where the device keeps none. *Any* thread.
/// \param root a root folder
ResolverRecords resolverRecords(const std::string& interfaceName, const std::string& root = "");

}  // namespace wp
