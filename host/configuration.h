#pragma once

#include <optional>
#include <string>

#include "exchange/object_reader.h"
#include "exchange/service_process.h"
#include "platform/capabilities.h"
#include "platform/value.h"

namespace wp::host {

/// What the service tells of the configuration that it works with; the rest of it is the service's alone.
struct Configuration {
    Flags capabilities;
    DictionaryPointer thresholds;  ///< the service's, by their names in a configuration
    DictionaryPointer
        endpoints;  ///< whom a live run would contact, in the form in which a configuration sets them
};

/// The service, which has told its configuration and waits for requests.
struct StartedService {
    ServiceProcess process;
    Configuration configuration;
};

/// Starts the service that stands beside the program. It reads and checks the configuration of the system, the
/// user's over it, and over both the named file, the parts that the host does not take too. Throws `Exit`: with
/// status 2, file, place and reason where the configuration is not acceptable, with status 1 where the service
/// cannot be had. *Main*.
StartedService startService(const std::optional<std::string>& named,
                            const std::optional<std::string>& interfaceName);

/// The configuration alone, as `startService` has it. *Main*.
Configuration readConfiguration(const std::optional<std::string>& named);

/// The device's capabilities as the configuration states them.
class StatedCapabilities final : public CapabilityQuery {
  public:
    explicit StatedCapabilities(Flags capabilities) : capabilities_(std::move(capabilities)) {}
    bool booleanAnswer(std::string_view capability) const override;

  private:
    Flags capabilities_;
};

}  // namespace wp::host
