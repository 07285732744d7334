#pragma once

#include <functional>
#include <mutex>
#include <optional>
#include <string>

#include "platform/diagnostics.h"

namespace wp::host {

/// How many tests a run performs: those of the device, those of the joined network, and those of the selected
/// one where it is another; a network whose name ends in "_nomap" is left alone. Absent names: no network.
/// *Any*.
int plannedTests(const std::optional<std::string>& joined, const std::optional<std::string>& selected);

/// A test that begins, as the how-manieth of how many.
struct TestStep {
    int testID = 0;
    const char* name = "";  ///< the catalogue's
    int number = 0;         ///< from 1
    int count = 0;          ///< never below the number
};

/// Passes every call on, and tells of each test of the run before it begins. *Any* thread, the observer on the
/// caller's.
class ProgressClient final : public DiagnosticsClient {
  public:
    using Observer = std::function<void(const TestStep&)>;

    ProgressClient(DiagnosticsClient& client, Observer observer)
        : client_(client), observer_(std::move(observer)) {}

    DiagnosticsTestResponse runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) override;
    DiagnosticsStatusResponse queryStatus() override;
    void cancelAllRequests() override { client_.cancelAllRequests(); }

  private:
    void tell(const DiagnosticsTestRequest& request);

    DiagnosticsClient& client_;
    Observer observer_;
    std::mutex mutex_;
    std::optional<std::string> joined_;
    int begun_ = 0;
    int planned_ = 0;
};

}  // namespace wp::host
