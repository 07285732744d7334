#include "linux/dbus/supplicant.h"

#include "linux/dbus/network_records.h"

namespace wp {
namespace {

const std::string kService = "fi.w1.wpa_supplicant1";
const BusObject kRoot{kService, "/fi/w1/wpa_supplicant1"};
constexpr std::size_t kMostNetworks = 2000;

}  // namespace

Known<BusObject> supplicantInterface(Bus& bus, const std::string& interfaceName, const Until& until) {
    const auto path = bus.call(kRoot, kService, "GetInterface", {interfaceName}, until);
    if (!path) return path.error();
    return BusObject{kService, path->text()};
}

std::optional<SavedNetwork> savedFromSupplicant(const BusValue& properties, bool enabled) {
    const auto name = nameFromSupplicant(properties["ssid"].text());
    // Other modes are networks that the device itself offers or that have no access point.
    if (!name || properties["mode"].text("0") != "0") return std::nullopt;
    SavedNetwork network;
    network.name = *name;
    SupplicantSecrets secrets;
    for (const char* key : {"wep_key0", "wep_key1", "wep_key2", "wep_key3"})
        secrets.wepKey |= !properties[key].empty();
    secrets.eapMethods = !properties["eap"].empty();
    network.security =
        securityFromSupplicant(properties["key_mgmt"].text(), properties["proto"].text(), secrets);
    network.enabled = enabled && properties["disabled"].text("0") == "0";
    network.hidden = properties["scan_ssid"].text("0") == "1";
    return network;
}

Known<SavedNetworks> supplicantNetworks(Bus& bus, const BusObject& interface, const Until& until) {
    const auto paths = bus.property(interface, kService + ".Interface", "Networks", until);
    if (!paths) return paths.error();
    if (paths->list().size() > kMostNetworks)
        return failure(Reason::malformed, "wpa_supplicant lists more networks than can be real");
    SavedNetworks saved{"wpa_supplicant", {}};
    for (const BusValue& path : paths->list()) {
        const auto network = bus.properties({kService, path.text()}, kService + ".Network", until);
        if (!network && network.error().code == static_cast<int>(Reason::notFound)) continue;
        if (!network) return network.error();
        if (auto read = savedFromSupplicant((*network)["Properties"], (*network)["Enabled"].flag(true)))
            saved.networks.push_back(*read);
    }
    return saved;
}

Known<bool> requestSupplicantScan(Bus& bus, const BusObject& interface, SupplicantScan manner,
                                  const std::optional<NetworkName>& named, const Until& until) {
    const bool active = manner == SupplicantScan::active;
    BusOptions options{{"Type", active ? "active" : "passive"}};
    if (active && named) options.push_back({"SSIDs", namesCalled(*named)});
    const auto reply = bus.call(interface, kService + ".Interface", "Scan", {options}, until);
    if (!reply) return reply.error();
    return true;
}

}  // namespace wp
