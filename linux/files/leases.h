#pragma once

#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "service/ip_address.h"

namespace wp {

/// What a DHCP client of its own, without a manager, wrote down of its lease.
struct Lease {
    std::vector<IPAddress> addresses;  ///< that it grants, and that are in force
    std::vector<IPAddress> servers;
    std::string vendorText;
    std::string portalApi;
};

/// The address of a portal's API as a network names it, as plain text. One of more than 2048 bytes counts as none: cut
/// off it would lead elsewhere. *Any* thread.
std::string portalUriFrom(std::string_view text);

/// The last lease for the interface in the form that dhclient keeps; nothing where there is none, its end has passed, or
/// it grants an address that the interface does not have: it is then another network's. *Any* thread.
/// \param assigned the interface's addresses
/// \param now seconds since 1970-01-01 UTC
std::optional<Lease> readDhclientLeases(std::string_view text, std::string_view interfaceName,
                                        const std::vector<IPAddress>& assigned, std::int64_t now);

/// The same of DHCPv6, which dhclient keeps in a file of its own. It is in force where the interface has an address that it
/// grants, and that address's time is not over. One without addresses counts for nothing: where dhclient asks for none (of a
/// network where addresses come from advertisements) it keeps no lease.
std::optional<Lease> readDhclient6Leases(std::string_view text, std::string_view interfaceName,
                                         const std::vector<IPAddress>& assigned, std::int64_t now);

/// Looks for the interface's lease in the places where dhclient keeps them, below a root folder.
std::optional<Lease> findLease(const std::string& interfaceName, const std::vector<IPAddress>& assigned,
                               std::int64_t now, const std::string& root = "");
/// The same of DHCPv6.
std::optional<Lease> findLease6(const std::string& interfaceName, const std::vector<IPAddress>& assigned,
                                std::int64_t now, const std::string& root = "");

/// The name servers of a resolver file.
std::vector<IPAddress> serversFromResolverFile(std::string_view text);

}  // namespace wp
