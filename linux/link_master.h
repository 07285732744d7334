#pragma once

#include <optional>

#include "service/bytes.h"
#include "service/facts.h"

namespace wp {

/// The bridge, bond or team that the interface is part of, by the kernel's messages about all interfaces; where that is part
/// of another, the outermost one. Nothing for an interface that keeps addresses of its own, as one in a VRF does. Passes over
/// what it does not know or what is broken. *Any* thread.
std::optional<LinkMaster> readMaster(Bytes buffer, std::uint32_t interfaceIndex);

}  // namespace wp
