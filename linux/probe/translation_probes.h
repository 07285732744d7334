#pragma once

#include <optional>
#include <string>
#include <vector>

#include "linux/probe/ip_socket.h"
#include "service/double_translation.h"

namespace wp {

/// Asks a server outside, by STUN, which address it sees. *Any* thread.
Known<IPAddress> askMappedAddress(const IPAddress& server, std::uint16_t port,
                                  const std::string& interfaceName, const Until& until);

/// Asks the router for its outer address, by NAT-PMP, and by PCP where it wants that. *Any* thread.
/// \param own the interface's address, which PCP wants to know
Known<IPAddress> askExternalAddress(const IPAddress& router, std::uint16_t port, const IPAddress& own,
                                    const std::string& interfaceName, const Until& until);

/// Who answers at each of the first distances on the way to the target: datagrams whose life ends on the way
/// make routers tell their addresses. All are sent at once. *Any* thread.
Known<std::vector<std::optional<IPAddress>>> listHops(const IPAddress& target,
                                                      const std::string& interfaceName, const Until& until);

}  // namespace wp
