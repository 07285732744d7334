#pragma once

#include <string>

namespace wp {

/// Whether a DHCP client runs that looks after the interface. Some clients write no lease down; that they run is
/// then all that tells an automatic address from one that was entered. \param root a root folder
bool dhcpClientRuns(const std::string& interfaceName, const std::string& root = "");

}  // namespace wp
