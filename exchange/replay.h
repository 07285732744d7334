#pragma once

#include <condition_variable>
#include <memory>
#include <mutex>

#include "exchange/answer_book.h"
#include "exchange/recording.h"
#include "platform/capabilities.h"
#include "platform/diagnostics.h"
#include "platform/main_queue.h"
#include "platform/wifi_manager.h"

namespace wp {

using RecordingPointer = std::shared_ptr<const Recording>;

/// The diagnostics service of a recording. *Any* thread.
///
/// Each answer takes as long as the recording says and consists of new objects. Once requests have been
/// cancelled, the client is cancelled for good: whatever was waiting and whatever is asked later, a test or
/// the status, is answered at once with the error "cancelled (code 8)" and uses up no entry. A run cancels
/// when it ends, and blocks of it that still run must not find a service that answers.
class ReplayDiagnosticsClient final : public DiagnosticsClient {
  public:
    explicit ReplayDiagnosticsClient(RecordingPointer recording);

    DiagnosticsTestResponse runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) override;
    DiagnosticsStatusResponse queryStatus() override;
    void cancelAllRequests() override;

  private:
    DiagnosticsTestResponse answer(const DiagnosticsTestRequest& request);

    RecordingPointer recording_;
    std::mutex mutex_;
    std::condition_variable cancelling_;
    AnswerBook book_;
    std::size_t statusQueries_ = 0;
    bool isCancelled_ = false;
};

/// The Wi-Fi manager of a recording. *Any* thread.
///
/// The recorded events are scheduled on the main queue as events from outside when the first power callback
/// is registered; each sets the power and calls the callbacks that are registered at that moment. `setPower`
/// changes the power at once, where the recording does not ignore it, and a change calls the callbacks from the run
/// loop, after the caller has returned to it. Setting the power that is there already calls nothing. A
/// callback counts as begun when the run loop has taken it up; unregistering does not wait for one that runs.
class ReplayWiFiManagerService final : public WiFiManagerService {
  public:
    /// The queue must outlive the service and its clients.
    ReplayWiFiManagerService(RecordingPointer recording, MainQueue& mainQueue);
    ~ReplayWiFiManagerService() override;

    bool hasRadio() override;
    std::shared_ptr<WiFiManagerClient> createClient(int type) override;

  private:
    class Radio;

    std::shared_ptr<Radio> radio_;
};

/// The capability answers of a recording. *Any* thread.
class ReplayCapabilityQuery final : public CapabilityQuery {
  public:
    explicit ReplayCapabilityQuery(RecordingPointer recording) : recording_(std::move(recording)) {}
    bool booleanAnswer(std::string_view capability) const override;

  private:
    RecordingPointer recording_;
};

}  // namespace wp
