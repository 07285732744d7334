#pragma once

#include <string>

namespace wp {

/// The DHCP clients that run and look after an interface. Some write no lease down; that they run is then all that tells
/// an automatic address from one that was entered.
struct DhcpClients {
    bool any = false;
    bool ipv4 = false;         ///< one asks for addresses of IPv4, and may set them without an end or a lease
    bool leavesLease = false;  ///< one asks for addresses of IPv4, and leaves a lease of any without an end
    bool asksRouters = false;  ///< one looks at advertisements itself, and has the kernel leave them alone
    bool dhcpcd = false;       ///< dhcpcd is among them
};

/// Where ConnMan answers it has said that the interface is none of its own; else that it runs is all that is known.
enum class Connman { answers, silent };

/// The clients among the processes that this user sees. *Any* thread.
/// \param root a root folder
DhcpClients dhcpClientsOf(const std::string& interfaceName, Connman connman, const std::string& root = "");

}  // namespace wp
