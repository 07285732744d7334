#pragma once

#include <optional>
#include <string>

#include "platform/extension.h"

extern "C" {
/// The parameter key under which a request names a network, and the result key of a network's name:
/// "networkName". Exported.
extern WP_EXPORT const char kNetworkName[];
}

namespace wp {

/// Whether the owner of the network asks by its name not to be measured: the name ends in "_nomap", in any
/// mix of upper and lower case. An absent name does not. *Any* thread.
bool isNoMapName(const std::optional<std::string>& name);

}  // namespace wp
