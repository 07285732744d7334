#pragma once

#include <mutex>
#include <optional>
#include <string>

#include "host/diagnostics_log.h"
#include "platform/diagnostics.h"

namespace wp::host {

/// How many tests a run performs: those of the device, those of the joined network, and those of the selected
/// one where it is another; a network whose name ends in "_nomap" is left alone. Absent names: no network.
/// *Any*.
int plannedTests(const std::optional<std::string>& joined, const std::optional<std::string>& selected);

/// Passes every call on, and shows on the log's progress line which test runs as the how-manieth of how many.
/// *Any* thread.
class ProgressClient final : public DiagnosticsClient {
  public:
    ProgressClient(DiagnosticsClient& client, DiagnosticsLog& log) : client_(client), log_(log) {}

    DiagnosticsTestResponse runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) override;
    DiagnosticsStatusResponse queryStatus() override;
    void cancelAllRequests() override { client_.cancelAllRequests(); }

  private:
    void show(const DiagnosticsTestRequest& request);

    DiagnosticsClient& client_;
    DiagnosticsLog& log_;
    std::mutex mutex_;
    std::optional<std::string> joined_;
    int begun_ = 0;
    int planned_ = 0;
};

}  // namespace wp::host
