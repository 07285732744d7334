#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "service/ip_address.h"

namespace wp {

inline IPAddress address(std::string_view text) {
    return IPAddress::fromText(text).value();
}

/// Each followed by a space.
inline std::string textsOf(const std::vector<IPAddress>& addresses) {
    std::string text;
    for (const IPAddress& each : addresses) text += each.text() + " ";
    return text;
}

}  // namespace wp
