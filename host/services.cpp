#include "host/services.h"

#include "exchange/replay.h"
#include "host/exit.h"

namespace wp::host {
namespace {

class ReplayServices final : public Services {
  public:
    ReplayServices(const std::shared_ptr<const Recording>& recording, MainQueue& mainQueue)
        : client_(recording),
          wifi_(recording, mainQueue),
          capabilities_(recording),
          isAutomated_(recording->automation) {}

    DiagnosticsClient& diagnosticsClient() override { return client_; }
    WiFiManagerService& wifiManager() override { return wifi_; }
    CapabilityQuery& capabilities() override { return capabilities_; }
    bool isAutomated() const override { return isAutomated_; }

  private:
    ReplayDiagnosticsClient client_;
    ReplayWiFiManagerService wifi_;
    ReplayCapabilityQuery capabilities_;
    bool isAutomated_;
};

}  // namespace

std::unique_ptr<Services> makeServices(const RunOptions& options, const Preparation& prepared,
                                       MainQueue& mainQueue, DiagnosticsLog&) {
    if (options.recordFile) refuse("--record: this build cannot record yet");
    if (!prepared.recording) refuse("this build cannot run live yet; give --replay FILE");
    return std::make_unique<ReplayServices>(prepared.recording, mainQueue);
}

}  // namespace wp::host
