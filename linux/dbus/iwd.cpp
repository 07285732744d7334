#include "linux/dbus/iwd.h"

#include "linux/dbus/network_records.h"

namespace wp {
namespace {

const std::string kService = "net.connman.iwd";

SavedSecurity securityOf(const std::string& type) {
    if (type == "open") return SavedSecurity::open;
    if (type == "wep") return SavedSecurity::wep;
    // A passphrase that serves WPA2 and WPA3 alike.
    if (type == "psk") return SavedSecurity::wpa2Personal;
    if (type == "8021x" || type == "hotspot") return SavedSecurity::enterprise;
    return SavedSecurity::unknown;
}

}  // namespace

Known<BusValue> iwdObjects(Bus& bus, const Until& until) {
    return bus.managedObjects({kService, "/"}, until);
}

std::string iwdDevice(const BusValue& objects, const std::string& interfaceName) {
    for (const auto& [path, interfaces] : objects.map())
        if (interfaces[kService + ".Device"]["Name"].text() == interfaceName) return path;
    return {};
}

SavedNetworks iwdNetworks(const BusValue& objects) {
    SavedNetworks saved{"iwd", {}};
    for (const auto& entry : objects.map()) {
        const BusValue& known = entry.second[kService + ".KnownNetwork"];
        const std::string name = known["Name"].text();
        if (name.empty() || name.size() > NetworkName::kMaximumSize) continue;
        SavedNetwork network;
        network.name = NetworkName(Bytes(reinterpret_cast<const std::uint8_t*>(name.data()), name.size()));
        network.security = securityOf(known["Type"].text());
        network.passpoint = known["Type"].text() == "hotspot";
        network.enabled = known["AutoConnect"].flag(true);
        network.hidden = known["Hidden"].flag();
        network.lastJoined = dateFromText(known["LastConnectedTime"].text());
        saved.networks.push_back(network);
    }
    return saved;
}

Known<bool> requestIwdScan(Bus& bus, const std::string& devicePath, const Until& until) {
    const auto reply = bus.call({kService, devicePath}, kService + ".Station", "Scan", {}, until);
    if (!reply) return reply.error();
    return true;
}

}  // namespace wp
