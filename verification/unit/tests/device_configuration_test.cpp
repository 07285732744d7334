#include "verification/unit/tests/catalogue_fixture.h"

namespace wp::rows {
namespace {

using fakes::outcome;
using Entries = Dictionary::Entries;
using Lines = std::vector<std::string>;

TEST_F(CatalogueTest, KeepsTheAddressMethodOutWhenTheCustomAddressTestPassed) {
    service.setOutcome(14, outcome(false, true, Dictionary::make({{"IPv4ConfigMethod", "DHCP"}})));

    controller.runDeviceConfigurationCustomIPv4();

    EXPECT_EQ(controller.deviceData()->entries(), (Entries{{"isUsingCustomIPv4", false}}));
}

TEST_F(CatalogueTest, StoresTheAddressMethodWhenTheCustomAddressTestDidNotPass) {
    service.setOutcome(14, outcome(true, false, Dictionary::make({{"IPv4ConfigMethod", "Manual"}})));

    controller.runDeviceConfigurationCustomIPv4();

    EXPECT_EQ(controller.deviceData()->entries(),
              (Entries{{"isUsingCustomIPv4", true}, {"IPv4ConfigMethod", "Manual"}}));
}

TEST_F(CatalogueTest, LogsThatTheCustomAddressTestHasNoInformation) {
    service.setOutcome(14, outcome(true, false));

    controller.runDeviceConfigurationCustomIPv4();

    EXPECT_EQ(controller.deviceData()->entries(), (Entries{{"isUsingCustomIPv4", true}}));
    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: Info not found."});
}

TEST_F(CatalogueTest, StoresTheCountOfConnectedBluetoothDevicesAlsoWhenTheTestPassed) {
    service.setOutcome(19, outcome(false, true, Dictionary::make({{"BTConnectedCount", 2}})));

    controller.runDeviceConfigurationBluetoothConnected();

    EXPECT_EQ(controller.deviceData()->entries(),
              (Entries{{"isLargeConnectedBT", false}, {"bluetoothConnectedCount", 2}}));
}

TEST_F(CatalogueTest, NamesTheMissingCountOfPreferredNetworksInFull) {
    service.setOutcome(47, outcome(true, false, Dictionary::make()));

    controller.runDeviceConfigurationLargePNL();

    EXPECT_EQ(controller.deviceData()->entries(), (Entries{{"isLargePNL", true}}));
    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: PreferredNetworkListCount not found."});
}

TEST_F(CatalogueTest, LeavesTheRealTimeModeOutOnAServiceError) {
    service.setOutcome(22, fakes::failure(2, "no peer link"));

    controller.runDeviceConfigurationHalvoRealTimeMode();

    EXPECT_FALSE(controller.deviceData()->value("isHalvoInRealTimeMode"));
    EXPECT_EQ(
        logLines(),
        Lines{"[ERROR] - Wi-Fi Profile: Halvo Real Time Mode failed with error: no peer link (code 2)"});
}

}  // namespace
}  // namespace wp::rows
