#pragma once

#include <optional>
#include <string>

#include "exchange/object_reader.h"
#include "platform/capabilities.h"
#include "platform/value.h"

namespace wp::host {

/// What the host itself takes from the configuration; the rest of it is the service's.
struct Configuration {
    Flags capabilities;
    DictionaryPointer thresholds;  ///< the service's, by their names in a configuration
};

/// The configuration of the system, the user's over it, and over both the named file. The service reads and
/// checks them, the parts that the host does not take too. Throws `Exit` (status 2) with file, place and reason.
/// *Main*.
Configuration readConfiguration(const std::optional<std::string>& named);

/// What a live run with this configuration would contact, as the service tells it in JSON. Throws `Exit`
/// (status 2) with file, place and reason where the configuration is not acceptable. *Main*.
std::string contactedEndpoints(const std::optional<std::string>& named);

/// The device's capabilities as the configuration states them.
class StatedCapabilities final : public CapabilityQuery {
  public:
    explicit StatedCapabilities(Flags capabilities) : capabilities_(std::move(capabilities)) {}
    bool booleanAnswer(std::string_view capability) const override;

  private:
    Flags capabilities_;
};

}  // namespace wp::host
