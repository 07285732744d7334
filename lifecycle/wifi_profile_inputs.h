#pragma once

#include <optional>
#include <string>

#include "platform/diagnostic.h"
#include "platform/synchronized.h"

namespace wp {

/// What one run is asked to do: the request's parameters, checked and typed. Made by the host, validated
/// once, and kept by the controller for the whole run. Read and written on *Main*, but for the selected name.
class WiFiProfileInputs final : public DiagnosticInputs {
  public:
    /// Reads the three parameters below; every one is read and stored, whatever the others are like. Returns
    /// whether all of them were acceptable.
    ///
    /// - "maxScanCacheAge", required: a number from 0 to 600
    /// - "reprofileWithUI", required: a boolean
    /// - "networkName": a string of at most 32 characters
    bool validateAndInitializeParameters(DictionaryPointer parameters) override;
    std::string failureReason() const override { return failureReason_; }

    /// How old a cached scan may be and still be used, in the service's unit (seconds); absent only when
    /// validation failed. It keeps the kind of number that it came as.
    const std::optional<Value>& maxScanCacheAge() const { return maxScanCacheAge_; }
    void setMaxScanCacheAge(std::optional<Value> age) { maxScanCacheAge_ = std::move(age); }

    /// Whether the user picks the network to test from a list before any test runs.
    bool reprofileWithNetworksListUI() const { return reprofileWithNetworksListUI_; }
    void setReprofileWithNetworksListUI(bool withList) { reprofileWithNetworksListUI_ = withList; }

    /// The name of the network to test as the selected one; absent when there is none (yet). *Any* thread:
    /// the first list sets it on the background queue while the table shows it.
    std::optional<std::string> selectedNetworkName() const { return selectedNetworkName_.get(); }
    void setSelectedNetworkName(std::optional<std::string> name) {
        selectedNetworkName_.set(std::move(name));
    }
    /// Sets the name unless there is one by now. Returns whether it did.
    bool setSelectedNetworkNameIfAbsent(const std::optional<std::string>& name);

    /// The request's parameters exactly as the host handed them over.
    const DictionaryPointer& parameters() const { return parameters_; }
    void setParameters(DictionaryPointer parameters) { parameters_ = std::move(parameters); }

  private:
    std::optional<Value> maxScanCacheAge_;
    bool reprofileWithNetworksListUI_ = false;
    Synchronized<std::optional<std::string>> selectedNetworkName_;
    DictionaryPointer parameters_;
    std::string failureReason_;
};

}  // namespace wp
