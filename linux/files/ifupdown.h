#pragma once

#include <string>

#include "service/address_configuration.h"

namespace wp {

/// What `/etc/network/interfaces`, and the files that it includes, say of an interface under the logical name under which
/// ifupdown (or busybox) keeps it as started. ifupdown does so from the moment when it begins, and also where no address came of
/// it. Nothing where it was not started: the file may be left from before. *Any* thread.
/// \param root a root folder
InterfacePlan ifupdownPlan(const std::string& interfaceName, const std::string& root = "");

}  // namespace wp
