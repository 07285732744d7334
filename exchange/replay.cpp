#include "exchange/replay.h"

#include <algorithm>
#include <atomic>

#include "exchange/fresh_copy.h"
#include "exchange/power_callbacks.h"
#include "exchange/request_list.h"
#include "exchange/wifi_radio.h"
#include "exchange/wire.h"

namespace wp {

ReplayDiagnosticsClient::ReplayDiagnosticsClient(RecordingPointer recording)
    : recording_(std::move(recording)), book_(recording_->answers) {}

DiagnosticsTestResponse ReplayDiagnosticsClient::runTestRequests(
    const std::vector<DiagnosticsTestRequest>& requests) {
    return answerInTurn(requests, [this](const DiagnosticsTestRequest& request) { return answer(request); });
}

DiagnosticsTestResponse ReplayDiagnosticsClient::answer(const DiagnosticsTestRequest& request) {
    std::unique_lock lock(mutex_);
    if (isCancelled_) return {std::nullopt, cancelledError()};
    const RecordedAnswer* entry = book_.next(request.testID, request.configuration);
    if (!entry) {
        constexpr int notRecorded = -1;
        return {std::nullopt,
                Error{notRecorded, "no recorded answer for test " + std::to_string(request.testID)}};
    }
    bool isCancelled =
        entry->delay.count() > 0 && cancelling_.wait_for(lock, entry->delay, [this] { return isCancelled_; });
    lock.unlock();
    if (isCancelled) return {std::nullopt, cancelledError()};
    return freshCopy(entry->response);
}

DiagnosticsStatusResponse ReplayDiagnosticsClient::queryStatus() {
    std::lock_guard lock(mutex_);
    if (isCancelled_) return {nullptr, cancelledError()};
    if (recording_->status.empty()) return {std::make_shared<const WiFiStatus>(), std::nullopt};
    std::size_t last = recording_->status.size() - 1;
    return recording_->status[std::min(statusQueries_++, last)];
}

void ReplayDiagnosticsClient::cancelAllRequests() {
    {
        std::lock_guard lock(mutex_);
        isCancelled_ = true;
    }
    cancelling_.notify_all();
}

/// The one radio of the recording, shared by all clients and devices.
class ReplayWiFiManagerService::Radio final : public WiFiRadio, public std::enable_shared_from_this<Radio> {
  public:
    Radio(RecordingPointer recording, MainQueue& mainQueue)
        : recording_(std::move(recording)), mainQueue_(mainQueue), power_(description().power) {}

    const WiFiDescription& description() const { return recording_->wifi; }

    std::vector<std::string> devices() override { return description().devices; }
    bool power() override { return power_; }
    void setRunLoop(Queue& runLoop) override { runLoop_ = &runLoop; }

    void setPower(bool power) override {
        if (description().setPower == WiFiDescription::SetPower::ignored) return;
        if (power_.exchange(power) == power) return;
        runLoop_.load()->async([weak = weak_from_this()] {
            if (auto radio = weak.lock()) radio->callbacks_.call();
        });
    }

    void setCallback(const void* device, std::function<void()> callback) override {
        bool isFirst = callback && !hasBegun_.exchange(true);
        callbacks_.set(device, std::move(callback));
        if (!isFirst) return;
        for (const RecordedPowerEvent& event : recording_->events) scheduleEvent(event);
    }

  private:
    void scheduleEvent(const RecordedPowerEvent& event) {
        mainQueue_.scheduleEvent(event.after, [weak = weak_from_this(), power = event.power] {
            auto radio = weak.lock();
            if (!radio) return;
            radio->power_ = power;
            radio->callbacks_.call();
        });
    }

    RecordingPointer recording_;
    MainQueue& mainQueue_;
    std::atomic<Queue*> runLoop_ = &mainQueue_;
    std::atomic<bool> power_;
    std::atomic<bool> hasBegun_ = false;
    PowerCallbacks callbacks_;
};

ReplayWiFiManagerService::ReplayWiFiManagerService(RecordingPointer recording, MainQueue& mainQueue)
    : radio_(std::make_shared<Radio>(std::move(recording), mainQueue)) {}

ReplayWiFiManagerService::~ReplayWiFiManagerService() = default;

bool ReplayWiFiManagerService::hasRadio() {
    return radio_->description().radio;
}

std::shared_ptr<WiFiManagerClient> ReplayWiFiManagerService::createClient(int) {
    if (!radio_->description().radio || !radio_->description().client) return nullptr;
    return makeWiFiManagerClient(radio_);
}

bool ReplayCapabilityQuery::booleanAnswer(std::string_view capability) const {
    auto found = recording_->capabilities.find(capability);
    return found != recording_->capabilities.end() && found->second;
}

}  // namespace wp
