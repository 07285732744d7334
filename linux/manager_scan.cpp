#include "linux/manager_scan.h"

#include "linux/dbus/iwd.h"
#include "linux/dbus/network_manager.h"
#include "linux/dbus/supplicant.h"

namespace wp {
namespace {

bool isStopped(const Error& error) {
    return error.code == static_cast<int>(Reason::cancelled);
}

/// A manager that has the interface, and what became of asking it; nothing where it has not.
using Asked = std::optional<Known<AskedManager>>;

Asked askedOf(const std::string& name, bool listens, const Known<bool>& accepted) {
    if (accepted) return AskedManager{name, listens, std::nullopt};
    const Error& error = accepted.error();
    if (isStopped(error)) return error;
    if (error.code == static_cast<int>(Reason::notPermitted))
        return failure(Reason::notPermitted, "no permission to scan (CAP_NET_ADMIN), and " + name +
                                                 " would not either: " + error.message);
    return AskedManager{name, false,
                        failure(Reason::unavailable, name + " would not scan now: " + error.message)};
}

Asked askNetworkManager(Bus& bus, const ManagerScanWish& wish, const Until& until) {
    const auto device = networkManagerDevice(bus, wish.interfaceName, until);
    if (!device) return isStopped(device.error()) ? Asked(device.error()) : std::nullopt;
    return askedOf("NetworkManager", false, requestNetworkManagerScan(bus, *device, wish.named, until));
}

Asked askIwd(Bus& bus, const ManagerScanWish& wish, const Until& until) {
    const auto objects = iwdObjects(bus, until);
    if (!objects) return isStopped(objects.error()) ? Asked(objects.error()) : std::nullopt;
    const std::string device = iwdDevice(*objects, wish.interfaceName);
    if (device.empty()) return std::nullopt;
    return askedOf("iwd", false, requestIwdScan(bus, device, until));
}

Asked askSupplicant(Bus& bus, const ManagerScanWish& wish, const Until& until) {
    const auto interface = supplicantInterface(bus, wish.interfaceName, until);
    if (!interface) {
        const bool runs = interface.error().code == static_cast<int>(Reason::notPermitted);
        return runs || isStopped(interface.error()) ? askedOf("wpa_supplicant", false, interface.error())
                                                    : std::nullopt;
    }
    const SupplicantScan manner = wish.listening ? SupplicantScan::passive : SupplicantScan::active;
    return askedOf("wpa_supplicant", wish.listening,
                   requestSupplicantScan(bus, *interface, manner, wish.named, until));
}

}  // namespace

Known<AskedManager> askManagerForScan(Known<Bus>& bus, const ManagerScanWish& wish, const Until& until) {
    if (bus)
        for (const auto ask : {askNetworkManager, askIwd, askSupplicant})
            if (const Asked asked = ask(*bus, wish, until)) return *asked;
    return failure(Reason::notPermitted,
                   "no permission to scan (CAP_NET_ADMIN), and no connection manager to ask for a scan");
}

}  // namespace wp
