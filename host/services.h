#pragma once

#include <memory>

#include "host/arguments.h"
#include "host/diagnostics_log.h"
#include "host/preparation.h"
#include "platform/capabilities.h"
#include "platform/diagnostics.h"
#include "platform/main_queue.h"
#include "platform/wifi_manager.h"

namespace wp::host {

/// Where a run's answers come from: this machine or a recording; and where they are kept, if they are. *Main*.
class Services {
  public:
    virtual ~Services() = default;

    virtual DiagnosticsClient& diagnosticsClient() = 0;
    virtual WiFiManagerService& wifiManager() = 0;
    virtual CapabilityQuery& capabilities() = 0;
    /// Whether a recording says that test automation was enabled.
    virtual bool isAutomated() const = 0;
    /// What is answered from now on is not recorded: the run is broken off, and what still runs gets errors that
    /// say nothing about the device. *Any*.
    virtual void stopRecording() {}
    /// Writes what was recorded where that was asked for. Throws `Exit` (status 1) on failure.
    virtual void writeRecording() {}
};

/// The services that the options ask for; a live run's take over the process that was prepared. The queue and the log,
/// which takes the service's notes, must outlive them.
std::unique_ptr<Services> makeServices(const RunOptions& options, Preparation& prepared, MainQueue& mainQueue,
                                       DiagnosticsLog& log);

}  // namespace wp::host
