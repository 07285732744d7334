#pragma once

#include <string_view>

namespace wp {

/// What the device can do, asked by name. *Any* thread.
class CapabilityQuery {
  public:
    virtual ~CapabilityQuery() = default;

    /// The boolean answer for the capability; false for one that the device does not know.
    virtual bool booleanAnswer(std::string_view capability) const = 0;
};

}  // namespace wp
