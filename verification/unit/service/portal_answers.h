#pragma once

#include <string>

#include "service/captive_portal.h"

namespace wp {

inline PortalAnswer answered(int status, std::size_t bodySize = 0, std::string location = {}) {
    return {PortalAnswer::End::answered, status, bodySize, std::move(location), std::nullopt, {}};
}

}  // namespace wp
