#pragma once

#include <memory>
#include <optional>
#include <string>

#include "exchange/recording.h"
#include "platform/capabilities.h"
#include "platform/diagnostics.h"
#include "platform/wifi_manager.h"

namespace wp {

/// Stands between the diagnostic and any set of services and writes down what they answer. *Any* thread.
///
/// Answers and statuses stand in the order of the requests; an answer notes its network and how long it took,
/// and the age of a scan only where one test was asked about one network with several ages (a recording
/// without ages serves a run that asks with another). Requests that have no answer yet are left out. Power
/// changes count from the registration of the callback; one that `setPower` asked for is left out, and a wish
/// for power that nothing came of makes the recording ignore it. What was never asked for is as in an empty
/// recording.
class Recorder {
  public:
    /// The services must outlive the recorder and the handles that it gives out.
    Recorder(DiagnosticsClient& diagnostics, WiFiManagerService& wifi, const CapabilityQuery& capabilities);
    ~Recorder();

    /// The services to be used in place of the recorded ones.
    DiagnosticsClient& diagnostics();
    WiFiManagerService& wifi();
    CapabilityQuery& capabilities();

    /// What the recording says about itself and about test automation, which is the host's own.
    void setDescription(std::string description);
    void setAutomation(bool isEnabled);

    /// What was answered so far.
    Recording recording() const;

  private:
    class Tape;
    class Diagnostics;
    class WiFi;
    class Capabilities;
    class Client;
    class Device;

    std::shared_ptr<Tape> tape_;
    std::unique_ptr<Diagnostics> diagnostics_;
    std::unique_ptr<WiFi> wifi_;
    std::unique_ptr<Capabilities> capabilities_;
};

}  // namespace wp
