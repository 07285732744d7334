#pragma once

#include <memory>
#include <optional>
#include <vector>

#include "platform/error.h"
#include "platform/records.h"
#include "platform/value.h"

namespace wp {

/// One numbered test to be run.
struct DiagnosticsTestRequest {
    int testID = 0;
    DictionaryPointer configuration;  ///< passed on as it is; may be null
};

/// The outcome of one numbered test.
struct DiagnosticsTestResult {
    bool result = false;     ///< the test's verdict; what true means is the test's own
    bool didPass = false;    ///< whether the service counts the outcome as good
    DictionaryPointer info;  ///< null when absent
};

using DiagnosticsTestResultPointer = std::shared_ptr<const DiagnosticsTestResult>;
/// Elements may be null: a result that is absent.
using DiagnosticsTestResults = std::vector<DiagnosticsTestResultPointer>;

/// What one call of `runTestRequests` returned. Results and error do not exclude each other.
struct DiagnosticsTestResponse {
    std::optional<DiagnosticsTestResults> results;
    std::optional<Error> error;
};

/// What one status query returned. Status and error do not exclude each other; a null status is an absent
/// one.
struct DiagnosticsStatusResponse {
    WiFiStatusPointer status;
    std::optional<Error> error;
};

/// The Wi-Fi diagnostics service. *Any* thread; calls may overlap.
class DiagnosticsClient {
  public:
    virtual ~DiagnosticsClient() = default;

    /// Runs the tests on this device, without progress callbacks, and blocks until they are done, failed or
    /// cancelled.
    virtual DiagnosticsTestResponse runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) = 0;

    /// Asks for the status of this device's Wi-Fi interface; blocks.
    virtual DiagnosticsStatusResponse queryStatus() = 0;

    /// Ends all outstanding requests at once: each returns with a "cancelled" error. Harmless when nothing is
    /// outstanding, and when called again.
    virtual void cancelAllRequests() = 0;
};

}  // namespace wp
