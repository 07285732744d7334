#pragma once

#include "linux/dbus/bus.h"
#include "service/bluetooth.h"

namespace wp {

/// Counts controllers and devices among the objects of the Bluetooth service.
Bluetooth bluetoothFrom(const BusValue& objects);

/// What the Bluetooth service knows. A system without any controller needs no service: then all counts are 0.
/// \param controllerExists whether the kernel has a controller
Known<Bluetooth> readBluetooth(Known<Bus>& bus, bool controllerExists, const Until& until);

/// Whether the kernel has a Bluetooth controller. \param folder its class folder under /sys
bool bluetoothControllerExists(const std::string& folder = "/sys/class/bluetooth");

}  // namespace wp
