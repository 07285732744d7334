#pragma once

#include <string>
#include <vector>

#include "linux/stop_signal.h"
#include "service/address_configuration.h"
#include "service/double_translation.h"

namespace wp {

/// An address as the kernel tells it in full.
struct AddressDetails {
    AssignedAddress assigned;
    unsigned prefixLength = 0;
    bool bringsRoute =
        true;  ///< to its network; a program that sets up all routes itself asks the kernel for none
};

/// The addresses of one interface in a buffer of the kernel's messages; passes over what it does not know or what
/// is broken. *Any* thread.
std::vector<AddressDetails> readAddressDetails(Bytes buffer, std::uint32_t interfaceIndex);

/// How they were assigned. iwd and dhcpcd set what an advertisement or a lease grants without an end just as what was
/// entered, all without a route. But they leave advertised routes behind. iwd looks at advertisements only where no address of
/// IPv6 was entered; what was entered for dhcpcd stands in its file. *Any* thread.
/// \param byClient whether one of them manages the interface, and it has such a route
/// \param granted by a lease of DHCPv6: these came by themselves, too
std::vector<AssignedAddress> assignedOf(const std::vector<AddressDetails>& details, bool byClient,
                                        const std::vector<IPAddress>& granted = {});

/// Asks the kernel for them.
Known<std::vector<AddressDetails>> gatherAddressDetails(std::uint32_t interfaceIndex, const Until& until);

/// What the routes of all tables give away.
struct RouteSigns {
    bool elsewhere = false;   ///< whether a default route leads over another interface
    bool advertised = false;  ///< whether a router advertised one of the interface's routes of IPv6
};
Known<RouteSigns> gatherRouteSigns(std::uint32_t interfaceIndex, const Until& until);

}  // namespace wp
