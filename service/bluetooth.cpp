#include "service/bluetooth.h"

namespace wp {

Outcome hasManyConnectedBluetooth(const Known<Bluetooth>& bluetooth, const BluetoothLimits& limits) {
    if (!bluetooth) return bluetooth.error();
    return problem(bluetooth->connected > limits.connected, {{"BTConnectedCount", bluetooth->connected}});
}

Outcome hasManyPairedBluetooth(const Known<Bluetooth>& bluetooth, const BluetoothLimits& limits) {
    if (!bluetooth) return bluetooth.error();
    return problem(bluetooth->paired > limits.paired, {{"BTPairedCount", bluetooth->paired}});
}

Outcome sharesAirtimeWithBluetooth(const Known<bool>& driverShares, const Known<Bluetooth>& bluetooth,
                                   const Known<Band>& band) {
    const bool quiet = bluetooth && (!bluetooth->powered || bluetooth->connected == 0);
    const bool elsewhere = band && *band != Band::ghz2;
    const bool apart = driverShares && !*driverShares;
    if (quiet || elsewhere || apart) return problem(false);
    if (!bluetooth) return bluetooth.error();
    if (!band) return band.error();
    if (!driverShares) return driverShares.error();
    return problem(true);
}

}  // namespace wp
