#pragma once

#include <optional>
#include <vector>

#include "linux/netlink_reader.h"
#include "service/facts.h"
#include "service/ip_address.h"

namespace wp {

// What the kernel's messages about addresses and routes say. Each takes a buffer of messages, as a dump leaves it,
// and passes over what it does not know or what is broken. Pure functions; *any* thread.

/// The addresses of one interface.
Addresses readAddresses(Bytes buffer, std::uint32_t interfaceIndex);

/// Where a route leads next.
struct NextHop {
    std::uint32_t interfaceIndex = 0;
    std::optional<IPAddress> router;  ///< absent: the destination is looked for on the link itself
};

/// A route to other machines.
struct Route {
    std::vector<NextHop> hops;  ///< several share what is sent
    unsigned prefixLength = 0;  ///< of the destinations that it is for; 0 for a default route

    /// The hop over the interface; null where it does not lead over that.
    const NextHop* over(std::uint32_t interfaceIndex) const;
};

/// The first route in the buffer, as the kernel's answer holds it; nothing where that leads to no other machine.
std::optional<Route> readRoute(Bytes buffer);

/// Whether a default route, of whatever table, leads over another interface: a cable's, or a tunnel's.
bool leadsElsewhere(Bytes buffer, std::uint32_t interfaceIndex);

/// Whether a route of IPv6 over the interface is marked as one that a router advertised. The kernel marks its own so, and
/// so does a program that looks at advertisements in the kernel's place.
bool hasAdvertisedRoute(Bytes buffer, std::uint32_t interfaceIndex);

/// Whether the kernel has lately heard from the neighbour of this address on the interface, though it may ignore pings.
bool isReachable(Bytes buffer, std::uint32_t interfaceIndex, Bytes address);

}  // namespace wp
