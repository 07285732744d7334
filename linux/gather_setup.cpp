#include "linux/gather_setup.h"

#include <algorithm>
#include <cstdlib>

#include "linux/address_details.h"
#include "linux/asked_servers.h"
#include "linux/dbus/bluez.h"
#include "linux/dbus/connman.h"
#include "linux/dbus/iwd.h"
#include "linux/dbus/network_manager.h"
#include "linux/dbus/supplicant.h"
#include "linux/files/address_list.h"
#include "linux/files/networkd.h"
#include "linux/files/proxy_settings.h"
#include "linux/probe/portal_api.h"
#include "linux/radio_socket.h"
#include "linux/route_query.h"
#include "linux/unmanaged_setup.h"
#include "service/plain_text.h"

namespace wp {
namespace {

const std::string& optionOf(const std::map<std::string, std::string>& lease, const char* name) {
    static const std::string kNone;
    const auto found = lease.find(name);
    return found == lease.end() ? kNone : found->second;
}

Known<std::string> methodOf(const Known<BusValue>& settings, const char* family) {
    if (!settings) return settings.error();
    const std::string method = (*settings)[family]["method"].text();
    if (!method.empty()) return method;
    return failure(Reason::unavailable, std::string("NetworkManager tells no method of ") + family);
}

Known<NameServers> managedNameServers(Known<Bus>& bus, const Link& link, const NetworkManagerLink& managed,
                                      const Until& until) {
    if (!managed.settings) return managed.settings.error();
    const auto global = networkManagerGlobalServers(*bus, until);
    if (!global) return global.error();
    NameServers names;
    names.manual = manualServers(*managed.settings);
    add(names.manual, *global);
    names.offered = addressesIn(optionOf(managed.lease4, "domain_name_servers"));
    add(names.offered, addressesIn(optionOf(managed.lease6, "dhcp6_name_servers")));
    // What stands in the settings of IPv6 and was not entered came with a router's advertisement.
    for (const IPAddress& each : without(managed.servers, names.manual))
        if (!each.isIPv4()) names.offered.push_back(each);
    // Another interface's servers are no setting of this one.
    const auto elsewhere = networkManagerServersElsewhere(*bus, link.interfaceName, until);
    const AskedServers asked = askedServers(bus, link, managed.servers, until);
    add(names.manual, without(asked.entered, names.offered));
    names.effective = without(without(asked.all, asked.elsewhere), elsewhere ? *elsewhere : Servers());
    names.offerKnown = managed.offerRead && elsewhere;
    return names;
}

LinkSetup setupFromNetworkManager(Known<Bus>& bus, const Link& link, const NetworkManagerLink& managed,
                                  const Until& until) {
    LinkSetup setup;
    setup.toldBy = "NetworkManager";
    setup.methods = {methodOf(managed.settings, "ipv4"), methodOf(managed.settings, "ipv6")};
    setup.servers = managed.servers;
    setup.nameServers = managedNameServers(bus, link, managed, until);
    // Servers for all interfaces may stand in place of each one's own.
    if (setup.servers.empty() && setup.nameServers) setup.servers = setup.nameServers->effective;
    setup.portalApi = portalApiIn(managed.lease4);
    if (setup.portalApi.empty()) setup.portalApi = portalApiIn(managed.lease6);
    setup.leaseText =
        failure(Reason::unavailable, managed.offerRead ? "NetworkManager has no lease of IPv4"
                                                       : "NetworkManager's lease could not be read");
    if (!managed.lease4.empty())
        setup.leaseText = plainText(optionOf(managed.lease4, "vendor_encapsulated_options") + " " +
                                    optionOf(managed.lease4, "vendor_class_identifier"));
    return setup;
}

/// Whether another interface may have brought name servers along.
bool leadsElsewhere(const Link& link, const Until& until) {
    const auto signs = gatherRouteSigns(link.interfaceIndex, until);
    return signs && signs->elsewhere;
}

LinkSetup setupFromNetworkd(Known<Bus>& bus, const Link& link, const NetworkdLink& managed,
                            const Until& until) {
    LinkSetup setup;
    setup.toldBy = "systemd-networkd";
    setup.methods = managed.methods;
    NameServers names{managed.manualServers, {}, managed.offeredServers, true};
    Servers own = managed.manualServers;
    add(own, managed.offeredServers);
    const AskedServers asked = askedServers(bus, link, own, until);
    add(names.manual, without(asked.entered, names.offered));
    names.effective = asked.all;
    names.offerKnown = asked.ofLinkAlone || (asked.elsewhere.empty() && !leadsElsewhere(link, until));
    // Where it does not tell, servers of a router's advertisement stand nowhere but in the list that is asked.
    if (!managed.advertisementsKnown && *managed.methods.ipv6 == "auto")
        for (const IPAddress& each : names.effective)
            if (!each.isIPv4()) names.offered.push_back(each);
    setup.servers = own.empty() ? without(asked.all, asked.elsewhere) : own;
    setup.serversElsewhere = asked.elsewhere;
    setup.nameServers = std::move(names);
    setup.portalApi = managed.portalApi;
    setup.leaseText = failure(Reason::unavailable, "systemd-networkd has no lease of IPv4");
    if (managed.hasLease) setup.leaseText = managed.vendorText;
    return setup;
}

LinkSetup setupFromConnman(Known<Bus>& bus, const Link& link, const ConnmanLink& managed,
                           const Until& until) {
    LinkSetup setup;
    setup.toldBy = "ConnMan";
    setup.methods = managed.methods;
    setup.servers = managed.servers;
    const AskedServers asked = askedServers(bus, link, managed.servers, until);
    NameServers names{managed.manualServers, {}, managed.offeredServers, true};
    add(names.manual, without(asked.entered, names.offered));
    names.effective = without(without(asked.all, asked.elsewhere), managed.serversElsewhere);
    if (setup.servers.empty()) setup.servers = names.effective;
    setup.serversElsewhere = asked.elsewhere;
    setup.nameServers = std::move(names);
    setup.leaseText = failure(Reason::unavailable, "ConnMan does not tell its lease");
    return setup;
}

bool is(const Error& error, Reason reason) {
    return error.code == static_cast<int>(reason);
}

bool isStopped(const Error& error) {
    return is(error, Reason::cancelled);
}

/// A manager that is there and does not answer may have the interface all the same.
bool mayManage(const Error& error) {
    return !is(error, Reason::notFound) && !is(error, Reason::unavailable);
}

/// Its addresses say nothing: a manager that looks at routers' advertisements itself has the kernel leave them alone.
LinkSetup setupOfSilentManager(Known<Bus>& bus, const Link& link, const Error& why, const Until& until) {
    LinkSetup setup;
    setup.methods = {why, why};
    setup.nameServers = why;
    setup.leaseText = why;
    const AskedServers asked = askedServers(bus, link, {}, until);
    setup.servers = without(asked.all, asked.elsewhere);
    setup.serversElsewhere = asked.elsewhere;
    return setup;
}

/// \param ofManager the place in its settings, empty for none. Settings that cannot be read may hold a proxy; without a profile
/// there is none.
Known<WebProxyPlaces> allProxies(const Known<std::string>& ofManager) {
    WebProxyPlaces places = findProxies([](const char* name) -> const char* { return std::getenv(name); });
    if (ofManager && !ofManager->empty()) places.push_back(*ofManager);
    if (!ofManager && places.empty() && !is(ofManager.error(), Reason::notJoined)) return ofManager.error();
    return places;
}

/// Where there is no default route either family may be one of a network that is an island.
FamiliesOut familiesOut(const Link& link, const Until& until) {
    const auto ways = gatherWaysOut(link, until);
    if (!ways || ways->empty()) return {};
    return {ways->front().isIPv4, !ways->back().isIPv4};
}

Known<ConnmanLink> connmanLink(Known<Bus>& bus, const Link& link, const Until& until) {
    return bus ? readConnmanLink(*bus, link.interfaceName, until) : Known<ConnmanLink>(bus.error());
}

bool isPeerLink(std::uint32_t type) {
    // Neighbour awareness has no interface, and the kernel tells no channel of it.
    constexpr std::uint32_t kClient = 8, kOwner = 9;  // nl80211_iftype
    return type == kClient || type == kOwner;
}

}  // namespace

Known<LinkSetup> gatherSetup(const Link& link, const Until& until) {
    Known<Bus> bus = Bus::system();
    Known<NetworkManagerLink> managed =
        bus ? readNetworkManagerLink(*bus, link.interfaceName, until) : bus.error();
    if (!managed && isStopped(managed.error())) return managed.error();
    Known<LinkSetup> setup;
    Known<std::string> proxy = std::string();
    if (managed) {
        setup = setupFromNetworkManager(bus, link, *managed, until);
        proxy =
            managed->settings ? Known<std::string>(proxyOf(*managed->settings)) : managed->settings.error();
    } else if (const auto networkd = readNetworkdLink(link.interfaceIndex)) {
        setup = setupFromNetworkd(bus, link, *networkd, until);
    } else if (mayManage(managed.error())) {
        setup = setupOfSilentManager(bus, link, managed.error(), until);
        proxy = managed.error();
    } else if (const auto connman = connmanLink(bus, link, until); connman) {
        setup = setupFromConnman(bus, link, *connman, until);
        proxy = connman->proxy;
    } else if (mayManage(connman.error())) {
        setup = setupOfSilentManager(bus, link, connman.error(), until);
        proxy = connman.error();
    } else {
        setup = setupWithoutManager(bus, link, until);
    }
    if (!setup) return setup;
    setup->proxies = allProxies(proxy);
    setup->leadsOut = familiesOut(link, until);
    return setup;
}

Known<SavedNetworks> gatherSaved(const Link& link, const Until& until) {
    Known<Bus> bus = Bus::system();
    if (!bus) return bus.error();
    const auto managed = readNetworkManagerLink(*bus, link.interfaceName, until);
    if (managed) return networkManagerNetworks(*bus, link.interfaceName, until);
    // What it hands to the supplicant is not its store.
    if (mayManage(managed.error())) return managed.error();
    const auto connman = readConnmanLink(*bus, link.interfaceName, until);
    if (connman)
        return failure(Reason::unavailable,
                       "ConnMan does not tell the networks that it remembers and that are out of reach");
    if (mayManage(connman.error())) return connman.error();
    const auto objects = iwdObjects(*bus, until);
    if (objects && !iwdDevice(*objects, link.interfaceName).empty()) return iwdNetworks(*objects);
    const auto interface = supplicantInterface(*bus, link.interfaceName, until);
    if (interface) return supplicantNetworks(*bus, *interface, until);
    if (isStopped(interface.error()) || interface.error().code == static_cast<int>(Reason::notPermitted))
        return interface.error();
    return failure(Reason::unavailable,
                   "no connection manager on the message bus keeps networks for " + link.interfaceName);
}

Known<Bluetooth> gatherBluetooth(const Until& until) {
    Known<Bus> bus = Bus::system();
    return readBluetooth(bus, bluetoothControllerExists(), until);
}

Known<PeerLinks> gatherPeerLinks(const Link& link, const std::string& indicator, const Until& until) {
    Known<RadioSocket> radio = RadioSocket::open(until);
    if (!radio) return radio.error();
    const auto interfaces = radio->interfaces(until);
    if (!interfaces) return interfaces.error();
    PeerLinks links;
    links.stationFrequency = link.joined ? link.joined->frequency : 0;
    for (const RadioInterface& each : *interfaces)
        if (each.radio == link.radio && isPeerLink(each.type))
            links.links.push_back({each.name, each.frequency.value_or(0)});
    const auto text = indicator.empty() ? std::nullopt : readSmallFile(indicator, 64);
    if (text) links.indicated = text->starts_with("1");
    return links;
}

}  // namespace wp
