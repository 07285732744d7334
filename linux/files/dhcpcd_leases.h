#pragma once

#include "linux/files/leases.h"

namespace wp {

/// The leases that dhcpcd keeps, byte for byte as they came; absent where it has none of the family.
struct DhcpcdLeases {
    std::optional<Lease> ipv4, ipv6;
};

/// Looks for the interface's leases in the places where dhcpcd keeps them, below a root folder. There is one for each
/// network that was ever joined: it counts that grants an address which the interface has, and whose time is not over.
/// \param assigned the interface's addresses
/// \param now seconds since 1970-01-01 UTC
/// *Any* thread.
DhcpcdLeases findDhcpcdLeases(const std::string& interfaceName, const std::vector<IPAddress>& assigned,
                              std::int64_t now, const std::string& root = "");

}  // namespace wp
