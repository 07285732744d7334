#include "lifecycle/wifi_profile_view_controller.h"
#include "tests/test_row.h"

namespace wp {
namespace {

using enum InfoGate;
constexpr std::string_view none;

}  // namespace

// clang-format off
// operation                                                                                          ID  verdict                                  read       information key     result key                   name when missing            name on failure
void WiFiProfileViewController::runDeviceConfigurationCustomIPv4()                   { runDeviceTest({14, "isUsingCustomIPv4",                     notPassed, "IPv4ConfigMethod", "IPv4ConfigMethod",          "IPv4ConfigMethod",          "Custom IPv4"}); }
void WiFiProfileViewController::runDeviceConfigurationCustomIPv6()                   { runDeviceTest({15, "isUsingCustomIPv6",                     notPassed, "IPv6ConfigMethod", "IPv6ConfigMethod",          "IPv6ConfigMethod",          "Custom IPv6"}); }
void WiFiProfileViewController::runDeviceConfigurationCustomDNS()                    { runDeviceTest({16, "isUsingCustomDNS",                      never,     none,               none,                        none,                        "Custom DNS"}); }
void WiFiProfileViewController::runDeviceConfigurationCustomWebProxy()               { runDeviceTest({17, "isUsingCustomWebProxy",                 never,     none,               none,                        none,                        "Custom Web Proxy"}); }
void WiFiProfileViewController::runDeviceConfigurationHalvoRealTimeMode()            { runDeviceTest({22, "isHalvoInRealTimeMode",                 never,     none,               none,                        none,                        "Halvo Real Time Mode"}); }
void WiFiProfileViewController::runDeviceConfigurationBluetoothConnected()           { runDeviceTest({19, "isLargeConnectedBT",                    always,    "BTConnectedCount", "bluetoothConnectedCount",   "BluetoothConnectedCount",   "Bluetooth Connected"}); }
void WiFiProfileViewController::runDeviceConfigurationBluetoothPaired()              { runDeviceTest({18, "isLargePairedBT",                       always,    "BTPairedCount",    "bluetoothPairedCount",      "BluetoothPairedCount",      "Bluetooth Paired"}); }
void WiFiProfileViewController::runDeviceConfigurationBTCoex()                       { runDeviceTest({20, "isHYBRIDBTCoexistenceMode",             never,     none,               none,                        none,                        "Bluetooth Coex"}); }
void WiFiProfileViewController::runDeviceConfigurationLargePNL()                     { runDeviceTest({47, "isLargePNL",                            always,    "PNLCount",         "preferredNetworkListCount", "PreferredNetworkListCount", "Large PNL"}); }
void WiFiProfileViewController::runDeviceConfigurationPNLContainsHidden()            { runDeviceTest({48, "doesPNLContainHiddenNetworks",          never,     none,               none,                        none,                        "PNL Contains Hidden"}); }
void WiFiProfileViewController::runDeviceConfigurationConflictingSecurityTypeInPNL() { runDeviceTest({29, "doesPNLContainConflictingSecurityType", never,     none,               none,                        none,                        "Conflicting Security Type in PNL"}); }
// clang-format on

void WiFiProfileViewController::runDeviceTest(const TestRow& row) const {
    runTest(row, configuration_, deviceData_);
}

}  // namespace wp
