#include <array>

#include "lifecycle/wifi_profile_view_controller.h"
#include "platform/date_formatter.h"

namespace wp {
namespace {

using Controller = WiFiProfileViewController;

constexpr std::array kDeviceTests = {
    &Controller::runDeviceConfigurationCustomIPv4,
    &Controller::runDeviceConfigurationCustomIPv6,
    &Controller::runDeviceConfigurationCustomDNS,
    &Controller::runDeviceConfigurationCustomWebProxy,
    &Controller::runDeviceConfigurationHalvoRealTimeMode,
    &Controller::runDeviceConfigurationBluetoothConnected,
    &Controller::runDeviceConfigurationBluetoothPaired,
    &Controller::runDeviceConfigurationBTCoex,
    &Controller::runDeviceConfigurationLargePNL,
    &Controller::runDeviceConfigurationPNLContainsHidden,
    &Controller::runDeviceConfigurationConflictingSecurityTypeInPNL,
};

constexpr std::array kCurrentNetworkTests = {
    &Controller::runCurrentNetworkDetectDoubleNATWithConfiguration,
    &Controller::runCurrentNetworkLongBeaconIntervalWithConfiguration,
    &Controller::runCurrentNetworkLongDTIMIntervalWithConfiguration,
    &Controller::runCurrentNetworkNoSecurityWithConfiguration,
    &Controller::runCurrentNetworkLegacySecurityWEPWithConfiguration,
    &Controller::runCurrentNetworkLegacySecurityWPAWithConfiguration,
    &Controller::runCurrentNetworkLegacyRates11bWithConfiguration,
    &Controller::runCurrentNetworkAmbiguousNetworkNameWithConfiguration,
    &Controller::runCurrentNetworkHiddenNetworkWithConfiguration,
    &Controller::runCurrentNetworkPyloPersonalHotspotWithConfiguration,
    &Controller::runCurrentNetworkCaptivePortalWithConfiguration,
    &Controller::runCurrentNetworkPasspointWithConfiguration,
    &Controller::runCurrentNetworkConflictingPHYMode11ACWithConfiguration,
    &Controller::runCurrentNetworkConflictingPHYMode11NWithConfiguration,
    &Controller::runCurrentNetworkMarlixBaseStationWithConfiguration,
    &Controller::runCurrentNetworkPingLANWithConfiguration,
    &Controller::runCurrentNetworkPingWANWithConfiguration,
    &Controller::runCurrentNetworkIPv4AssignedWithConfiguration,
    &Controller::runCurrentNetworkIPv6AssignedWithConfiguration,
    &Controller::runCurrentNetworkResolveDNSWithConfiguration,
    &Controller::runCurrentNetworkReachVantorWithConfiguration,
    &Controller::runCurrentNetworkRetrieveVantorWithConfiguration,
    &Controller::runCurrentNetworkCongestedChannelWithConfiguration,
    &Controller::runCurrentNetworkCongested2GHzWithConfiguration,
    &Controller::runCurrentNetworkCongested5GHzWithConfiguration,
    &Controller::runCurrentNetworkHT402GHzChannelWithConfiguration,
    &Controller::runCurrentNetworkConflictingCountryCodeWithConfiguration,
    &Controller::runCurrentNetworkPoorSignalWithConfiguration,
    &Controller::runCurrentNetworkHiddenScanResultsWithConfiguration,
};

constexpr std::array kSelectedNetworkTests = {
    &Controller::runSelectedNetworkLongBeaconInterval,
    &Controller::runSelectedNetworkNoSecurity,
    &Controller::runSelectedNetworkLegacySecurityWEP,
    &Controller::runSelectedNetworkLegacySecurityWPA,
    &Controller::runSelectedNetworkLegacyRates11b,
    &Controller::runSelectedNetworkAmbiguousNetworkName,
    &Controller::runSelectedNetworkHiddenNetwork,
    &Controller::runSelectedNetworkPyloPersonalHotspot,
    &Controller::runSelectedNetworkCaptivePortal,
    &Controller::runSelectedNetworkPasspoint,
    &Controller::runSelectedNetworkConflictingPHYMode11AC,
    &Controller::runSelectedNetworkConflictingPHYMode11N,
    &Controller::runSelectedNetworkMarlixBaseStation,
    &Controller::runSelectedNetworkCongestedChannel,
    &Controller::runSelectedNetworkConflictingCountryCode,
    &Controller::runSelectedNetworkPoorSignal,
};

}  // namespace

std::int32_t WiFiProfileViewController::testCount(const Scope& scope) {
    std::size_t count = kDeviceTests.size();
    if (scope.runsCurrent) count += kCurrentNetworkTests.size();
    if (scope.runsSelected) count += kSelectedNetworkTests.size();
    return static_cast<std::int32_t>(count);
}

void WiFiProfileViewController::runDeviceConfigurationDiagnosticsTests() {
    for (auto test : kDeviceTests) {
        (this->*test)();
        updateProgress();
    }
}

void WiFiProfileViewController::runCurrentNetworkDiagnosticsTests() {
    for (auto test : kCurrentNetworkTests) {
        (this->*test)(currentNetworkConfiguration_, currentNetworkData_);
        updateProgress();
    }
}

void WiFiProfileViewController::runSelectedNetworkDiagnosticsTests() {
    for (auto test : kSelectedNetworkTests) {
        (this->*test)();
        updateProgress();
    }
}

std::string WiFiProfileViewController::timestampFormattedInISO8601(Date date) const {
    return iso8601Text(date);
}

}  // namespace wp
