#pragma once

#include <map>
#include <string>
#include <vector>

#include "linux/dbus/bus.h"
#include "service/ip_address.h"
#include "service/saved_networks.h"

namespace wp {

/// What NetworkManager tells of the interface that it manages.
struct NetworkManagerLink {
    BusObject device;
    /// Of the active connection: section, then key. Fails as `notJoined` where none is active.
    Known<BusValue> settings;
    std::map<std::string, std::string> lease4;  ///< options of the DHCPv4 lease by their names
    std::map<std::string, std::string> lease6;
    std::vector<IPAddress> servers;  ///< name servers in effect, of both families
    bool offerRead = true;           ///< whether leases and servers are all that there is
};

/// NetworkManager's object for the interface. Fails as `notFound` where it does not manage the interface.
Known<BusObject> networkManagerDevice(Bus& bus, const std::string& interfaceName, const Until& until);

/// Reads all of it. Fails as `notFound` where NetworkManager does not manage the interface. *Any* thread.
Known<NetworkManagerLink> readNetworkManagerLink(Bus& bus, const std::string& interfaceName,
                                                 const Until& until);

/// The name servers and the method that a person entered in the settings of a connection.
std::vector<IPAddress> manualServers(const BusValue& settings);
/// Where the settings of a connection set a proxy; empty where they do not.
std::string proxyOf(const BusValue& settings);
/// The network of a connection's settings; absent for anything that is no network of this kind.
std::optional<SavedNetwork> savedFromNetworkManager(const BusValue& settings);

/// The name servers that a person set for all connections at once.
Known<std::vector<IPAddress>> networkManagerGlobalServers(Bus& bus, const Until& until);
/// The name servers that NetworkManager asks for the sake of other interfaces.
Known<std::vector<IPAddress>> networkManagerServersElsewhere(Bus& bus, const std::string& interfaceName,
                                                             const Until& until);

/// Whether the settings of a connection bind it to another interface, by name or hardware, or exclude this one: it is never joined
/// on it.
/// \param hardwareAddress the interface's permanent one; empty where it is not known
bool isBoundElsewhere(const BusValue& settings, const std::string& interfaceName,
                      const std::string& hardwareAddress);
/// All Wi-Fi networks that NetworkManager remembers for the interface, without those that are bound elsewhere. *Any* thread.
Known<SavedNetworks> networkManagerNetworks(Bus& bus, const std::string& interfaceName, const Until& until);

/// Whether Wi-Fi is switched on, by software and by hardware.
struct WirelessPower {
    bool software = false;
    bool hardware = false;
};
Known<WirelessPower> networkManagerPower(Bus& bus, const Until& until);
/// Switches Wi-Fi on or off.
Known<bool> setNetworkManagerPower(Bus& bus, bool on, const Until& until);
/// Asks for a scan of the device that also calls for the named network; it answers at once, the scan comes later.
Known<bool> requestNetworkManagerScan(Bus& bus, const BusObject& device,
                                      const std::optional<NetworkName>& named, const Until& until);

}  // namespace wp
