#pragma once

#include <map>
#include <string>

#include "platform/capabilities.h"

namespace wp::host {

/// What the host itself takes from the configuration file; the rest of it is the service's.
struct Configuration {
    bool concernsService = false;  ///< whether the service must be handed the file
    std::map<std::string, bool, std::less<>> capabilities;
};

/// Reads the file of `--config`, a JSON object with the objects "capabilities" (flags by name), "endpoints",
/// "vendors" and "thresholds", each of which may be left out. Throws `Exit` (status 2) with place and reason.
/// *Main*.
Configuration readConfiguration(const std::string& file);

/// The device's capabilities as a configuration or a recording states them.
class StatedCapabilities final : public CapabilityQuery {
  public:
    explicit StatedCapabilities(std::map<std::string, bool, std::less<>> capabilities)
        : capabilities_(std::move(capabilities)) {}
    bool booleanAnswer(std::string_view capability) const override;

  private:
    std::map<std::string, bool, std::less<>> capabilities_;
};

}  // namespace wp::host
