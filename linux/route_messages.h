#pragma once

#include <optional>
#include <vector>

#include "linux/netlink_reader.h"
#include "service/facts.h"

namespace wp {

// What the kernel's messages about addresses and routes say. Each takes a buffer of messages, as a dump leaves it,
// and passes over what it does not know or what is broken. Pure functions; *any* thread.

/// The addresses of one interface.
Addresses readAddresses(Bytes buffer, std::uint32_t interfaceIndex);

/// A default route's next hop.
struct Gateway {
    Address::Family family = Address::Family::ipv4;
    std::vector<std::uint8_t> bytes;  ///< 4 or 16
    std::uint32_t metric = 0;         ///< the lowest is used
};

/// The next hops of the interface's default routes in the main table, the ones in use first, IPv4 before IPv6.
std::vector<Gateway> readGateways(Bytes buffer, std::uint32_t interfaceIndex);

/// Whether a default route, of whatever table, leads over another interface: a cable's, or a tunnel's.
bool leadsElsewhere(Bytes buffer, std::uint32_t interfaceIndex);

/// Whether a route of IPv6 over the interface is marked as one that a router advertised. The kernel marks its own so, and
/// so does a program that looks at advertisements in the kernel's place.
bool hasAdvertisedRoute(Bytes buffer, std::uint32_t interfaceIndex);

/// Whether the kernel has lately heard from the neighbour of this address on the interface, though it may ignore pings.
bool isReachable(Bytes buffer, std::uint32_t interfaceIndex, Bytes address);

/// "10.0.0.1", "fe80::1". *Any* thread.
std::string textOf(Address::Family family, Bytes address);

}  // namespace wp
