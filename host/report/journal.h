#pragma once

#include <mutex>
#include <optional>
#include <vector>

#include "host/report/evidence.h"
#include "platform/diagnostics.h"

namespace wp::host {

/// Passes every call on and keeps what was answered, for the report at the end of the run. *Any* thread.
class Journal final : public DiagnosticsClient {
  public:
    /// The client must outlive the journal.
    explicit Journal(DiagnosticsClient& client) : client_(client) {}

    DiagnosticsTestResponse runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) override;
    DiagnosticsStatusResponse queryStatus() override;
    void cancelAllRequests() override { client_.cancelAllRequests(); }

    /// Evidence from the finished run's result and the answers so far.
    Evidence evidence(std::int64_t statusCode, const DictionaryPointer& data) const;

  private:
    DiagnosticsClient& client_;
    mutable std::mutex mutex_;
    std::vector<Answer> answers_;
    std::optional<std::string> joinedName_;
};

}  // namespace wp::host
