#pragma once

#include <cstdint>

#include "service/band.h"
#include "service/outcome.h"
#include "service/thresholds.h"

namespace wp {

/// What the device's Bluetooth controllers carry.
struct Bluetooth {
    unsigned controllers = 0;
    bool powered = false;  ///< at least one controller is
    unsigned paired = 0;
    unsigned connected = 0;
};

/// Test 19: whether more devices are connected than `limits` says. Information: "BTConnectedCount".
Outcome hasManyConnectedBluetooth(const Known<Bluetooth>& bluetooth, const BluetoothLimits& limits = {});
/// Test 18: the same for paired ones. Information: "BTPairedCount".
Outcome hasManyPairedBluetooth(const Known<Bluetooth>& bluetooth, const BluetoothLimits& limits = {});

/// Test 20: whether the Wi-Fi driver shares airtime with Bluetooth, and there is something to share: a
/// connected device, and a station on 2.4 GHz. One of the three that is known to be false decides; where none
/// is and one is not known, the test cannot tell.
/// \param driverShares the driver's switch; \param band the band of the joined network, `none` when not
/// joined
Outcome sharesAirtimeWithBluetooth(const Known<bool>& driverShares, const Known<Bluetooth>& bluetooth,
                                   const Known<Band>& band);

}  // namespace wp
