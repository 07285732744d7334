#pragma once

#include <condition_variable>
#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

#include "platform/diagnostics.h"

namespace wp::fakes {

/// The one result of a test, as a response of the service.
inline DiagnosticsTestResponse outcome(bool result, bool didPass, DictionaryPointer info = nullptr) {
    DiagnosticsTestResult testResult{result, didPass, std::move(info)};
    return {DiagnosticsTestResults{std::make_shared<const DiagnosticsTestResult>(std::move(testResult))},
            std::nullopt};
}

/// A response of the service that is an error and nothing else.
inline DiagnosticsTestResponse failure(int code, std::string message) {
    return {std::nullopt, Error{code, std::move(message)}};
}

/// A diagnostics service whose answers the test sets. A test without an answer of its own gets one that is
/// false, passed and without information. Once cancelled it answers every request with an error, and every
/// status query too. *Any* thread.
class FakeDiagnosticsClient final : public DiagnosticsClient {
  public:
    void setOutcome(int testID, DiagnosticsTestResponse response) {
        std::lock_guard lock(mutex_);
        outcomes_[testID] = std::move(response);
    }

    /// For every test without an answer of its own.
    void setDefaultOutcome(DiagnosticsTestResponse response) {
        std::lock_guard lock(mutex_);
        defaultOutcome_ = std::move(response);
    }

    void setStatus(DiagnosticsStatusResponse status) {
        std::lock_guard lock(mutex_);
        status_ = std::move(status);
    }

    /// Joined to the network; without a name: joined to none.
    void setJoinedNetwork(std::optional<std::string> ssid, std::optional<std::string> bssid = std::nullopt) {
        auto status = std::make_shared<WiFiStatus>();
        status->ssid = std::move(ssid);
        status->bssid = std::move(bssid);
        setStatus({status, std::nullopt});
    }

    /// Called with each request before it is answered, outside the lock.
    void setRequestHandler(std::function<void(const DiagnosticsTestRequest&)> handler) {
        std::lock_guard lock(mutex_);
        requestHandler_ = std::move(handler);
    }

    /// Called with each status query before it is answered, outside the lock.
    void setStatusHandler(std::function<void()> handler) {
        std::lock_guard lock(mutex_);
        statusHandler_ = std::move(handler);
    }

    /// Requests wait from now on, until they are let go or cancelled.
    void holdRequests() {
        std::lock_guard lock(mutex_);
        isHolding_ = true;
    }

    void letRequestsGo() {
        {
            std::lock_guard lock(mutex_);
            isHolding_ = false;
        }
        changed_.notify_all();
    }

    /// Blocks until so many requests have arrived in all.
    void waitForRequests(std::size_t count) {
        std::unique_lock lock(mutex_);
        changed_.wait(lock, [&] { return requests_.size() >= count; });
    }

    std::vector<DiagnosticsTestRequest> requests() const {
        std::lock_guard lock(mutex_);
        return requests_;
    }

    std::vector<int> requestedTestIDs() const {
        std::vector<int> testIDs;
        for (const DiagnosticsTestRequest& request : requests()) testIDs.push_back(request.testID);
        return testIDs;
    }

    /// How many requests each call brought.
    std::vector<std::size_t> requestListLengths() const {
        std::lock_guard lock(mutex_);
        return requestListLengths_;
    }

    int statusQueries() const {
        std::lock_guard lock(mutex_);
        return statusQueries_;
    }

    int cancellations() const {
        std::lock_guard lock(mutex_);
        return cancellations_;
    }

    DiagnosticsTestResponse runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) override {
        std::unique_lock lock(mutex_);
        requestListLengths_.push_back(requests.size());
        requests_.insert(requests_.end(), requests.begin(), requests.end());
        changed_.notify_all();
        if (auto handler = requestHandler_) {
            lock.unlock();
            for (const DiagnosticsTestRequest& request : requests) handler(request);
            lock.lock();
        }
        changed_.wait(lock, [this] { return !isHolding_ || cancellations_ > 0; });
        if (cancellations_ > 0) return failure(kCancelled, "cancelled");
        auto found = outcomes_.find(requests.front().testID);
        return found == outcomes_.end() ? defaultOutcome_ : found->second;
    }

    DiagnosticsStatusResponse queryStatus() override {
        std::unique_lock lock(mutex_);
        ++statusQueries_;
        if (auto handler = statusHandler_) {
            lock.unlock();
            handler();
            lock.lock();
        }
        if (cancellations_ > 0) return {nullptr, Error{kCancelled, "cancelled"}};
        return status_;
    }

    void cancelAllRequests() override {
        {
            std::lock_guard lock(mutex_);
            ++cancellations_;
        }
        changed_.notify_all();
    }

  private:
    static constexpr int kCancelled = 125;

    mutable std::mutex mutex_;
    std::condition_variable changed_;
    std::map<int, DiagnosticsTestResponse> outcomes_;
    DiagnosticsTestResponse defaultOutcome_ = outcome(false, true);
    DiagnosticsStatusResponse status_{std::make_shared<const WiFiStatus>(), std::nullopt};
    std::function<void(const DiagnosticsTestRequest&)> requestHandler_;
    std::function<void()> statusHandler_;
    std::vector<DiagnosticsTestRequest> requests_;
    std::vector<std::size_t> requestListLengths_;
    int statusQueries_ = 0;
    int cancellations_ = 0;
    bool isHolding_ = false;
};

}  // namespace wp::fakes
