#pragma once

#include <optional>
#include <vector>

#include "linux/route_messages.h"
#include "linux/stop_signal.h"

namespace wp {

// Which way the kernel leads what is sent, by all its rules and tables. *Any* thread.

/// What is to be sent.
struct RouteQuestion {
    IPAddress destination;
    std::uint32_t interfaceIndex = 0;   ///< over this one alone; 0: over any
    std::optional<IPAddress> source{};  ///< from this address; rules may go by it
};

/// Asks the kernel for the route; nothing where what is sent so would reach no other machine.
Known<std::optional<Route>> routeFor(const RouteQuestion& question, const Until& until);

/// The same for what this program sends to the address over the interface.
Known<std::optional<Route>> routeOver(const Link& link, const IPAddress& destination, const Until& until);

/// How the interface leads beyond its own network in one family: its default route.
struct WayOut {
    bool isIPv4 = true;
    std::optional<IPAddress> router;  ///< absent: every address is looked for on the link itself
};
/// What ends the reason where there is no router, behind the interface's name.
inline constexpr const char* kNoRouter = "'s default route names no router";
/// One for each family that it leads out by, IPv4 first.
Known<std::vector<WayOut>> gatherWaysOut(const Link& link, const Until& until);

}  // namespace wp
