#pragma once

#include <cstdint>
#include <vector>

#include "linux/dbus/bus.h"
#include "service/ip_address.h"

namespace wp {

/// The addresses in the resolver's list of name servers.
std::vector<IPAddress> serversFrom(const BusValue& list);

/// The name servers that the system's resolver asks for the link. \param interfaceIndex the kernel's number
Known<std::vector<IPAddress>> resolvedServers(Bus& bus, std::uint32_t interfaceIndex, const Until& until);

}  // namespace wp
