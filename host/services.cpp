#include "host/services.h"

#include <chrono>
#include <mutex>
#include <optional>
#include <set>
#include <string>

#include "exchange/anonymise.h"
#include "exchange/live.h"
#include "exchange/recorder.h"
#include "exchange/replay.h"

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

/// A radio is up within a second of the switch; one that does not obey must not keep a script waiting for good.
constexpr std::chrono::seconds kLongestPowerChange{10};

LiveServiceOptions liveOptions(MainQueue& mainQueue, DiagnosticsLog& log) {
    LiveServiceOptions live;
    live.expectPowerChange = [&mainQueue] { return mainQueue.expectEvent(kLongestPowerChange); };
    live.note = [&log](std::string_view text) { log.note(text); };
    return live;
}

class LiveServices final : public Services {
  public:
    LiveServices(Preparation& prepared, MainQueue& mainQueue, DiagnosticsLog& log)
        : service_(std::move(*prepared.service), liveOptions(mainQueue, log)),
          capabilities_(prepared.configuration.capabilities) {}

    DiagnosticsClient& diagnosticsClient() override { return service_.diagnostics(); }
    WiFiManagerService& wifiManager() override { return service_.wifi(); }
    CapabilityQuery& capabilities() override { return capabilities_; }
    bool isAutomated() const override { return false; }

  private:
    LiveService service_;
    StatedCapabilities capabilities_;
};

/// Writes down what other services answer.
class RecordedServices final : public Services {
  public:
    RecordedServices(std::unique_ptr<Services> services, const RunOptions& options,
                     const Preparation& prepared)
        : services_(std::move(services)),
          recorder_(services_->diagnosticsClient(), services_->wifiManager(), services_->capabilities()),
          file_(*prepared.record),
          isAnonymous_(options.anonymise),
          replayed_(prepared.recording) {
        recorder_.setAutomation(isAutomated() || options.automationFile);
        if (replayed_) recorder_.setDescription(replayed_->description);
    }

    DiagnosticsClient& diagnosticsClient() override { return recorder_.diagnostics(); }
    WiFiManagerService& wifiManager() override { return recorder_.wifi(); }
    CapabilityQuery& capabilities() override { return recorder_.capabilities(); }
    bool isAutomated() const override { return services_->isAutomated(); }
    void stopRecording() override {
        std::lock_guard lock(mutex_);
        if (!stopped_) stopped_ = recorder_.recording();
    }
    void writeRecording() override {
        stopRecording();
        const Recording& recording = *stopped_;
        file_.write(recordingText(isAnonymous_ ? withoutNames(recording) : recording));
    }

  private:
    /// The description may tell of networks that this run did not come upon.
    Recording withoutNames(const Recording& recording) const {
        return anonymised(recording, replayed_ ? networkNamesIn(*replayed_) : std::set<std::string>());
    }

    std::unique_ptr<Services> services_;
    Recorder recorder_;
    OutputFile file_;
    bool isAnonymous_;
    std::shared_ptr<const Recording> replayed_;  ///< null: the run is live
    std::mutex mutex_;
    std::optional<Recording> stopped_;
};

std::unique_ptr<Services> answeringServices(Preparation& prepared, MainQueue& mainQueue,
                                            DiagnosticsLog& log) {
    if (prepared.recording) return std::make_unique<ReplayServices>(prepared.recording, mainQueue);
    return std::make_unique<LiveServices>(prepared, mainQueue, log);
}

}  // namespace

std::unique_ptr<Services> makeServices(const RunOptions& options, Preparation& prepared, MainQueue& mainQueue,
                                       DiagnosticsLog& log) {
    std::unique_ptr<Services> services = answeringServices(prepared, mainQueue, log);
    if (!prepared.record) return services;
    return std::make_unique<RecordedServices>(std::move(services), options, prepared);
}

}  // namespace wp::host
