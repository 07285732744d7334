#pragma once

#include <string>

#include "linux/dbus/bus.h"
#include "service/saved_networks.h"

namespace wp {

/// All objects that iwd keeps. Fails as `unavailable` where it does not run.
Known<BusValue> iwdObjects(Bus& bus, const Until& until);

/// The path of iwd's device for the interface; empty where it does not manage the interface.
std::string iwdDevice(const BusValue& objects, const std::string& interfaceName);
/// The networks that iwd remembers.
SavedNetworks iwdNetworks(const BusValue& objects);

/// Asks for a scan; it answers at once, the scan comes later.
Known<bool> requestIwdScan(Bus& bus, const std::string& devicePath, const Until& until);

}  // namespace wp
