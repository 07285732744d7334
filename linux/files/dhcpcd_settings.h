#pragma once

#include <string>
#include <string_view>

#include "service/address_configuration.h"

namespace wp {

/// What dhcpcd's file of settings sets by hand for an interface: addresses ("static ip_address", "inform",
/// "static ip6_address") and name servers, for all interfaces, for this one, for the network that it is joined to, and in a
/// profile (of that addresses alone, which an interface may fall back to). *Any* thread.
/// \param networkName of the joined network, as it is in the air
InterfacePlan readDhcpcdSettings(std::string_view text, std::string_view interfaceName,
                                 std::string_view networkName);

/// The same of the file where dhcpcd keeps it. It counts only where dhcpcd set up the interface. \param root a root folder
InterfacePlan dhcpcdPlan(const std::string& interfaceName, const std::string& networkName,
                         const std::string& root = "");

/// Whether its settings have dhcpcd pass over the interface where it looks for interfaces itself. *Any* thread.
/// \param root a root folder
bool dhcpcdPassesOver(const std::string& interfaceName, const std::string& root = "");

}  // namespace wp
