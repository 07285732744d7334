#pragma once

#include <optional>
#include <string>

#include "linux/dbus/bus.h"
#include "service/network_name.h"

namespace wp {

/// Who was asked to scan.
struct AskedManager {
    std::string name;
    bool listens = false;  ///< whether the scan stays on each channel and calls nobody
    /// Why it would not scan now, which is mostly that it is scanning already; nothing where a scan is to come.
    std::optional<Error> refusal;
};

/// A scan that is wanted of a connection manager.
struct ManagerScanWish {
    std::string interfaceName;
    std::optional<NetworkName> named;  ///< to be called by name
    bool listening = false;            ///< where the manager can: stay on each channel and call nobody
};

/// Asks whatever manages the interface (NetworkManager, iwd or wpa_supplicant) for a scan. It answers at once, the
/// scan comes later. Fails as `notPermitted`, with a text that says who is missing or whom the user may not ask.
/// *Any* thread.
Known<AskedManager> askManagerForScan(Known<Bus>& bus, const ManagerScanWish& wish, const Until& until);

}  // namespace wp
