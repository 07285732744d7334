#pragma once

#include <functional>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "host/report/evidence.h"
#include "platform/diagnostics.h"

namespace wp::host {

/// A test that begins, as the how-manieth of how many.
struct TestStep {
    int testID = 0;
    const char* name = "";  ///< the catalogue's
    int number = 0;         ///< from 1
    int count = 0;          ///< never below the number
};

/// Passes every call on, tells of each test of the run before it begins, and keeps what was answered, for the
/// report at the end. *Any* thread, the observer on the caller's.
class Journal final : public DiagnosticsClient {
  public:
    using Observer = std::function<void(const TestStep&)>;

    /// The client must outlive the journal.
    Journal(DiagnosticsClient& client, Observer observer) : client_(client), observer_(std::move(observer)) {}

    DiagnosticsTestResponse runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) override;
    DiagnosticsStatusResponse queryStatus() override;
    void cancelAllRequests() override { client_.cancelAllRequests(); }

    /// Evidence from the finished run's result and the answers so far.
    Evidence evidence(std::int64_t statusCode, const DictionaryPointer& data) const;

  private:
    void tell(const DiagnosticsTestRequest& request);

    DiagnosticsClient& client_;
    Observer observer_;
    mutable std::mutex mutex_;
    std::vector<Answer> answers_;
    std::optional<std::string> joinedName_;
    std::optional<bool> statusTold_;  ///< once or more; absent: nobody asked
    int begun_ = 0;
    int planned_ = 0;
};

}  // namespace wp::host
