#pragma once

#include <cstdint>
#include <vector>

#include "linux/dbus/bus.h"
#include "service/ip_address.h"

namespace wp {

/// The addresses in the resolver's list of one link's name servers.
std::vector<IPAddress> serversFrom(const BusValue& list);
/// Those in its list of all name servers that are of no link: a person has set them for the whole device.
std::vector<IPAddress> deviceServersFrom(const BusValue& list);

/// The name servers that the system's resolver asks.
struct ResolvedServers {
    std::vector<IPAddress> ofLink;
    std::vector<IPAddress> ofDevice;  ///< for every link; those that it falls back to are not among them
};
/// \param interfaceIndex the kernel's number
Known<ResolvedServers> resolvedServers(Bus& bus, std::uint32_t interfaceIndex, const Until& until);

}  // namespace wp
