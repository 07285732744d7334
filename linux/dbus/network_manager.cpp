#include "linux/dbus/network_manager.h"

#include <strings.h>

#include <algorithm>
#include <functional>

#include "linux/dbus/network_records.h"
#include "linux/files/address_list.h"
#include "service/access_point.h"

namespace wp {
namespace {

const std::string kService = "org.freedesktop.NetworkManager";
const BusObject kManager{kService, "/org/freedesktop/NetworkManager"};
const BusObject kSettings{kService, "/org/freedesktop/NetworkManager/Settings"};
/// Beyond these a store is broken rather than full.
constexpr std::size_t kMostConnections = 2000;

/// Whether two texts name one hardware address, in capitals or not.
bool isSameHardware(const std::string& one, const std::string& other) {
    return ::strcasecmp(one.c_str(), other.c_str()) == 0;
}

bool isPath(const std::string& path) {
    return !path.empty() && path != "/";
}

BusObject objectAt(const BusValue& path) {
    return {kService, path.text()};
}

Known<BusValue> managedProperties(Bus& bus, const BusObject& device, const std::string& interfaceName,
                                  const Until& until) {
    auto properties = bus.properties(device, kService + ".Device", until);
    if (properties && !(*properties)["Managed"].flag())
        return failure(Reason::notFound, "NetworkManager does not manage " + interfaceName);
    return properties;
}

Known<BusObject> deviceOf(Bus& bus, const std::string& interfaceName, const Until& until) {
    const auto path = bus.call(kManager, kService, "GetDeviceByIpIface", {interfaceName}, until);
    if (!path) return path.error();
    return objectAt(*path);
}

Known<BusValue> activeSettings(Bus& bus, const std::string& activePath, const Until& until) {
    const Error inactive =
        failure(Reason::notJoined, "NetworkManager has no active connection on the interface");
    if (!isPath(activePath)) return inactive;
    const auto connection =
        bus.property({kService, activePath}, kService + ".Connection.Active", "Connection", until);
    if (!connection) return connection.error();
    if (!isPath(connection->text())) return inactive;
    return bus.call(objectAt(*connection), kService + ".Settings.Connection", "GetSettings", {}, until);
}

/// Whether the lease could be read; none is a lease without options.
bool readLease(Bus& bus, const std::string& path, const std::string& kind, const Until& until,
               std::map<std::string, std::string>& options) {
    if (!isPath(path)) return true;
    const auto read = bus.property({kService, path}, kService + "." + kind, "Options", until);
    if (!read) return false;
    for (const auto& [name, value] : read->map())
        if (const auto* text = value.as<std::string>()) options.emplace(name, *text);
    return true;
}

/// Whether the servers could be read.
bool readServers(Bus& bus, const std::string& path, const std::string& kind, const Until& until,
                 std::vector<IPAddress>& servers) {
    if (!isPath(path)) return true;
    const auto config = bus.properties({kService, path}, kService + "." + kind, until);
    if (!config) return false;
    for (const BusValue& each : (*config)["NameserverData"].list())
        if (const auto address = IPAddress::fromText(each["address"].text())) servers.push_back(*address);
    if (kind == "IP6Config")
        for (const BusValue& each : (*config)["Nameservers"].list())
            if (const auto address = IPAddress::fromBytes(each.bytes())) servers.push_back(*address);
    return true;
}

/// In `dns` an IPv4 address is a number in network order as it lies in memory, an IPv6 one 16 bytes;
/// `dns-data` has both as texts.
void addManual(const BusValue& family, std::vector<IPAddress>& servers) {
    for (const BusValue& each : family["dns-data"].list())
        if (const auto address = serverFrom(each.text())) servers.push_back(*address);
    if (!family["dns-data"].list().empty()) return;
    for (const BusValue& each : family["dns"].list()) {
        std::optional<IPAddress> address;
        if (const auto number = each.number()) {
            const auto raw = static_cast<std::uint32_t>(*number);
            std::uint8_t bytes[4];
            std::copy_n(reinterpret_cast<const std::uint8_t*>(&raw), 4, bytes);
            address = IPAddress::fromBytes(bytes);
        } else {
            address = IPAddress::fromBytes(each.bytes());
        }
        if (address) servers.push_back(*address);
    }
}

/// The radio's own hardware address: the one in use may be made up anew each time. Empty where it is not known.
Known<std::string> permanentAddress(Bus& bus, const std::string& interfaceName, const Until& until) {
    const auto device = deviceOf(bus, interfaceName, until);
    if (!device) return device.error();
    const auto address = bus.property(*device, kService + ".Device.Wireless", "PermHwAddress", until);
    if (!address && address.error().code == static_cast<int>(Reason::notFound)) return std::string();
    if (!address) return address.error();
    return address->text();
}

bool allowsOnlyFirstWpa(const BusValue& protocols) {
    const auto& list = protocols.list();
    return !list.empty() &&
           std::all_of(list.begin(), list.end(), [](const BusValue& each) { return each.text() == "wpa"; });
}

SavedSecurity securityIn(const BusValue& settings) {
    const BusValue& security = settings["802-11-wireless-security"];
    if (security.empty()) return SavedSecurity::open;
    const std::string management = security["key-mgmt"].text();
    if (management == "none" || management == "ieee8021x") return SavedSecurity::wep;
    if (management == "owe") return SavedSecurity::owe;
    if (management == "sae") return SavedSecurity::sae;
    if (management.starts_with("wpa-eap")) return SavedSecurity::enterprise;
    if (management == "wpa-psk")
        return allowsOnlyFirstWpa(security["proto"]) ? SavedSecurity::wpaPersonal
                                                     : SavedSecurity::wpa2Personal;
    return SavedSecurity::unknown;
}

}  // namespace

Known<BusObject> networkManagerDevice(Bus& bus, const std::string& interfaceName, const Until& until) {
    auto device = deviceOf(bus, interfaceName, until);
    if (!device) return device;
    const auto properties = managedProperties(bus, *device, interfaceName, until);
    return properties ? device : properties.error();
}

Known<NetworkManagerLink> readNetworkManagerLink(Bus& bus, const std::string& interfaceName,
                                                 const Until& until) {
    const auto device = deviceOf(bus, interfaceName, until);
    if (!device) return device.error();
    const auto properties = managedProperties(bus, *device, interfaceName, until);
    if (!properties) return properties.error();
    NetworkManagerLink link;
    link.device = *device;
    link.settings = activeSettings(bus, (*properties)["ActiveConnection"].text(), until);
    const auto path = [&properties](const char* name) { return (*properties)[name].text(); };
    const bool read[] = {readLease(bus, path("Dhcp4Config"), "DHCP4Config", until, link.lease4),
                         readLease(bus, path("Dhcp6Config"), "DHCP6Config", until, link.lease6),
                         readServers(bus, path("Ip4Config"), "IP4Config", until, link.servers),
                         readServers(bus, path("Ip6Config"), "IP6Config", until, link.servers)};
    link.offerRead = std::ranges::all_of(read, std::identity());
    if (until.stop->raised()) return waitFailure(Wait::stopped, kService);
    return link;
}

std::vector<IPAddress> manualServers(const BusValue& settings) {
    std::vector<IPAddress> servers;
    addManual(settings["ipv4"], servers);
    addManual(settings["ipv6"], servers);
    return servers;
}

Known<std::vector<IPAddress>> networkManagerGlobalServers(Bus& bus, const Until& until) {
    std::vector<IPAddress> servers;
    const auto global = bus.property(kManager, kService, "GlobalDnsConfiguration", until);
    // An old one that does not know the property has no such servers.
    if (!global && global.error().code == static_cast<int>(Reason::notFound)) return servers;
    if (!global) return global.error();
    for (const BusValue& each : (*global)["domains"]["*"]["servers"].list())
        if (const auto address = serverFrom(each.text())) servers.push_back(*address);
    return servers;
}

Known<std::vector<IPAddress>> networkManagerServersElsewhere(Bus& bus, const std::string& interfaceName,
                                                             const Until& until) {
    std::vector<IPAddress> servers, here;
    const BusObject manager{kService, "/org/freedesktop/NetworkManager/DnsManager"};
    const auto all = bus.property(manager, kService + ".DnsManager", "Configuration", until);
    if (!all) return all.error();
    for (const BusValue& each : all->list()) {
        const std::string of = each["interface"].text();
        // Servers for all interfaces name none.
        for (const BusValue& text : each["nameservers"].list())
            if (const auto address = serverFrom(text.text()))
                (of.empty() || of == interfaceName ? here : servers).push_back(*address);
    }
    std::erase_if(servers, [&](const IPAddress& each) {
        return std::find(here.begin(), here.end(), each) != here.end();
    });
    return servers;
}

std::string proxyOf(const BusValue& settings) {
    const BusValue& proxy = settings["proxy"];
    // 1 is "auto": only with a script of its own is it the person's setting rather than the network's offer.
    if (proxy["method"].number().value_or(0) != 1) return {};
    if (!proxy["pac-url"].text().empty()) return "NetworkManager profile: pac-url";
    if (!proxy["pac-script"].text().empty()) return "NetworkManager profile: pac-script";
    return {};
}

std::optional<SavedNetwork> savedFromNetworkManager(const BusValue& settings) {
    const BusValue& wireless = settings["802-11-wireless"];
    const std::string mode = wireless["mode"].text("infrastructure");
    if (wireless["ssid"].bytes().empty() || mode != "infrastructure") return std::nullopt;
    SavedNetwork network;
    network.name = NetworkName(wireless["ssid"].bytes());
    network.security = securityIn(settings);
    network.enabled = settings["connection"]["autoconnect"].flag(true);
    network.hidden = wireless["hidden"].flag();
    network.seenSeveralAPs = wireless["seen-bssids"].list().size() > 1;
    const std::int64_t joined = settings["connection"]["timestamp"].number().value_or(0);
    if (joined > 0) network.lastJoined = dateFromUnix(joined);
    return network;
}

bool isBoundElsewhere(const BusValue& settings, const std::string& interfaceName,
                      const std::string& hardwareAddress) {
    const std::string name = settings["connection"]["interface-name"].text();
    if (!name.empty() && name != interfaceName) return true;
    if (hardwareAddress.empty()) return false;
    const BusValue& wireless = settings["802-11-wireless"];
    const auto& wanted = wireless["mac-address"].bytes();
    MacAddress address{};
    if (wanted.size() == address.size()) {
        std::ranges::copy(wanted, address.begin());
        if (!isSameHardware(textOf(address), hardwareAddress)) return true;
    }
    // The second is the name of newer versions, which tell both.
    for (const char* list : {"mac-address-blacklist", "mac-address-denylist"})
        for (const BusValue& each : wireless[list].list())
            if (isSameHardware(each.text(), hardwareAddress)) return true;
    return false;
}

Known<SavedNetworks> networkManagerNetworks(Bus& bus, const std::string& interfaceName, const Until& until) {
    const auto paths = bus.call(kSettings, kService + ".Settings", "ListConnections", {}, until);
    if (!paths) return paths.error();
    if (paths->list().size() > kMostConnections)
        return failure(Reason::malformed, "NetworkManager lists more connections than can be real");
    const auto hardwareAddress = permanentAddress(bus, interfaceName, until);
    if (!hardwareAddress) return hardwareAddress.error();
    SavedNetworks saved{"NetworkManager", {}};
    for (const BusValue& path : paths->list()) {
        const auto settings =
            bus.call(objectAt(path), kService + ".Settings.Connection", "GetSettings", {}, until);
        // One that was deleted meanwhile is not remembered any more.
        if (!settings && settings.error().code == static_cast<int>(Reason::notFound)) continue;
        if (!settings) return settings.error();
        if (isBoundElsewhere(*settings, interfaceName, *hardwareAddress)) continue;
        if (auto network = savedFromNetworkManager(*settings)) saved.networks.push_back(*network);
    }
    return saved;
}

Known<WirelessPower> networkManagerPower(Bus& bus, const Until& until) {
    const auto properties = bus.properties(kManager, kService, until);
    if (!properties) return properties.error();
    return WirelessPower{(*properties)["WirelessEnabled"].flag(),
                         (*properties)["WirelessHardwareEnabled"].flag(true)};
}

Known<bool> setNetworkManagerPower(Bus& bus, bool on, const Until& until) {
    const auto reply = bus.call(kManager, "org.freedesktop.DBus.Properties", "Set",
                                {kService, std::string("WirelessEnabled"), BusFlagVariant{on}}, until);
    if (!reply) return reply.error();
    return on;
}

Known<bool> requestNetworkManagerScan(Bus& bus, const BusObject& device,
                                      const std::optional<NetworkName>& named, const Until& until) {
    const BusOptions options = named ? BusOptions{{"ssids", namesCalled(*named)}} : BusOptions();
    const auto reply = bus.call(device, kService + ".Device.Wireless", "RequestScan", {options}, until);
    if (!reply) return reply.error();
    return true;
}

}  // namespace wp
