#pragma once

#include <string>

#include "service/address_configuration.h"

namespace wp {

/// What `/etc/network/interfaces`, and the files that it includes, say of an interface. Its logical name is the one under which
/// ifupdown (or busybox) keeps it as started, else the one under which it would be started. Nothing is planned where the
/// file leaves the interface out. *Any* thread.
/// \param root a root folder
InterfacePlan ifupdownPlan(const std::string& interfaceName, const std::string& root = "");

}  // namespace wp
