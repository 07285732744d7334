#pragma once

#include <string>

#include "linux/dbus/bus.h"
#include "service/saved_networks.h"

namespace wp {

/// The supplicant's object for the interface. Fails as `notFound` where it does not manage the interface.
Known<BusObject> supplicantInterface(Bus& bus, const std::string& interfaceName, const Until& until);

/// The network of the supplicant's properties of one; absent where it has no name. \param enabled the
/// supplicant's own word for it
std::optional<SavedNetwork> savedFromSupplicant(const BusValue& properties, bool enabled);
/// The networks that the supplicant holds for the interface.
Known<SavedNetworks> supplicantNetworks(Bus& bus, const BusObject& interface, const Until& until);

enum class SupplicantScan { active, passive };

/// Asks for a scan on all channels, an active one also for the named network; it answers at once, the scan comes
/// later.
Known<bool> requestSupplicantScan(Bus& bus, const BusObject& interface, SupplicantScan manner,
                                  const std::optional<NetworkName>& named, const Until& until);

}  // namespace wp
