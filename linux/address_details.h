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
};

/// The addresses of one interface in a buffer of the kernel's messages; passes over what it does not know or what
/// is broken. *Any* thread.
std::vector<AddressDetails> readAddressDetails(Bytes buffer, std::uint32_t interfaceIndex);

/// Asks the kernel for them.
Known<std::vector<AddressDetails>> gatherAddressDetails(std::uint32_t interfaceIndex, const Until& until);

/// The next hops of the interface's default routes, those in use first, IPv4 before IPv6.
Known<std::vector<IPAddress>> gatherGatewayAddresses(std::uint32_t interfaceIndex, const Until& until);

}  // namespace wp
