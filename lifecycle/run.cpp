#include <chrono>
#include <utility>

#include "lifecycle/network_name.h"
#include "lifecycle/wifi_profile_view_controller.h"
#include "platform/localization.h"

namespace wp {
namespace {

// Long enough for a viewer to see the full bar.
constexpr std::chrono::milliseconds kDelayBeforeEnd(500);
constexpr int kLogCategory = 3;

constexpr int kCurrentNetworkIsNoMap = -6;
constexpr int kSelectedNetworkIsNoMap = -7;

}  // namespace

void WiFiProfileViewController::setupWithInputs(std::shared_ptr<DiagnosticInputs> inputs,
                                                DiagnosticResponder*) {
    inputs_ = std::dynamic_pointer_cast<WiFiProfileInputs>(std::move(inputs));
    completedTests_ = 0;
    refreshEnabled_ = false;
    progressScreenVisible_ = false;
    scanFinished_ = false;
    currentNetworkConfiguration_ = Dictionary::make();
    if (inputs_->maxScanCacheAge())
        currentNetworkConfiguration_->setValue("MaxScanCacheAge", *inputs_->maxScanCacheAge());
    freshScanConfiguration_ = Dictionary::make({{"MaxScanCacheAge", 0}});
    deviceData_ = Dictionary::make();
    currentNetworkData_ = Dictionary::make();
    selectedNetworkData_ = Dictionary::make();
    if (platform_.testAutomation.isEnabled()) {
        platform_.testAutomation.postConfiguration(
            Dictionary::make({{"parameters", inputs_->parameters()},
                              {"predicates", Dictionary::make()},
                              {"specifications", Dictionary::make()}}));
    }
}

void WiFiProfileViewController::start() {
    bool withList = inputs_->reprofileWithNetworksListUI();
    if (!withList) {
        determineCurrentNetwork();
        inputs_->setSelectedNetworkNameIfAbsent(currentNetworkName());
        runTests();
    } else if (setupWiFi()) {
        if (wifiPoweredOn_) {
            if (!scanFinished_) showSpinner();
            displayNetworkList();
        } else {
            presentWiFiPoweredOffAlert();
        }
    }
    setupViewWithNetworkList(withList);
}

void WiFiProfileViewController::teardown() {
    cleanUp();
}

std::optional<std::string> WiFiProfileViewController::currentNetworkName() const {
    WiFiStatusPointer status = wifiStatus();
    return status ? status->ssid : std::nullopt;
}

void WiFiProfileViewController::determineCurrentNetwork() {
    DiagnosticsStatusResponse response = platform_.diagnosticsClient.queryStatus();
    if (response.error && response.error->code != 0) {
        if (platform_.log.isErrorEnabled(kLogCategory)) {
            platform_.log.error(kLogCategory,
                                formatted("[ERROR] - Wi-Fi Profile: Query Status failed with error: %@",
                                          response.error->text()));
        }
        return;
    }
    setWifiStatus(std::move(response.status));
}

void WiFiProfileViewController::nextTapped(const void*) {
    runTests();
}

void WiFiProfileViewController::runTests() {
    if (ended_ || testRunStarted_.exchange(true)) return;
    showProgress();
    platform_.backgroundQueue.async([self = self()] { self->performTestRun(); });
}

WiFiProfileViewController::Scope WiFiProfileViewController::determineScope() const {
    Scope scope;
    std::optional<std::string> current = currentNetworkName();
    scope.selectedName = inputs_->selectedNetworkName();
    bool isCurrentNoMap = isNoMapName(current);
    bool isSelectedNoMap = isNoMapName(scope.selectedName);
    scope.runsCurrent = current && !isCurrentNoMap;
    scope.runsSelected = scope.selectedName && !isSelectedNoMap && scope.selectedName != current;
    if (isCurrentNoMap) scope.statusCode = kCurrentNetworkIsNoMap;
    if (isSelectedNoMap) scope.statusCode = kSelectedNetworkIsNoMap;
    return scope;
}

DictionaryPointer WiFiProfileViewController::makeConfiguration(const Scope& scope) const {
    if (!scope.selectedName) return currentNetworkConfiguration_;
    DictionaryPointer configuration = Dictionary::make(currentNetworkConfiguration_->entries());
    configuration->setValue("NetworkName", *scope.selectedName);
    return configuration;
}

void WiFiProfileViewController::performTestRun() {
    Scope scope = determineScope();
    totalTests_ = testCount(scope);
    configuration_ = makeConfiguration(scope);
    runDeviceConfigurationDiagnosticsTests();
    if (scope.runsCurrent) runCurrentNetworkDiagnosticsTests();
    if (scope.runsSelected) runSelectedNetworkDiagnosticsTests();
    platform_.backgroundQueue.after(kDelayBeforeEnd, [self = self(), statusCode = scope.statusCode] {
        self->endTestWithStatusCode(statusCode);
    });
}

void WiFiProfileViewController::endTestWithStatusCode(int statusCode) {
    if (ended_.exchange(true)) return;
    cleanUp();
    result().seal(statusCode, Dictionary::make({{"device", deviceData_},
                                                {"currentNetwork", currentNetworkData_},
                                                {"selectedNetwork", selectedNetworkData_}}));
    finishTest();
}

void WiFiProfileViewController::cleanUp() {
    platform_.backgroundQueue.sync([this] {
        platform_.diagnosticsClient.cancelAllRequests();
        std::shared_ptr<WiFiDeviceClient> device = device_.exchange(nullptr);
        // First of all no callback must find a handle on its way out.
        if (device) device->registerPowerCallback({});
        manager_.set(nullptr);
    });
}

void WiFiProfileViewController::finishTest() {
    setFinished();
}

std::shared_ptr<WiFiProfileViewController> WiFiProfileViewController::self() {
    return std::static_pointer_cast<WiFiProfileViewController>(shared_from_this());
}

std::weak_ptr<WiFiProfileViewController> WiFiProfileViewController::weakSelf() {
    return self();
}

}  // namespace wp
