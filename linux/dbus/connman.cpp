#include "linux/dbus/connman.h"

namespace wp {
namespace {

const std::string kService = "net.connman";

bool isConnected(const BusValue& properties) {
    const std::string state = properties["State"].text();
    return state == "configuration" || state == "ready" || state == "online";
}

/// The method that was chosen; the one in force may be what it came to: a link-local address where DHCP failed.
Known<std::string> methodOf(const BusValue& properties, const std::string& family) {
    std::string method = properties[family + ".Configuration"]["Method"].text();
    if (method.empty()) method = properties[family]["Method"].text();
    if (method == "dhcp" || method == "auto" || method == "manual") return method;
    if (method == "off") return std::string("disabled");
    // It was provided for the device, and nobody can change it there.
    if (method == "fixed") return std::string("manual");
    // A tunnel that is there without having been chosen.
    if (method == "6to4") return std::string("auto");
    return failure(Reason::unavailable, "ConnMan tells no method of " + family + " that is known");
}

std::vector<IPAddress> serversIn(const BusValue& list) {
    std::vector<IPAddress> servers;
    for (const BusValue& each : list.list())
        if (const auto address = IPAddress::fromText(each.text())) servers.push_back(*address);
    return servers;
}

ConnmanLink linkOf(const BusValue& properties) {
    ConnmanLink link;
    link.methods = {methodOf(properties, "IPv4"), methodOf(properties, "IPv6")};
    link.manualServers = serversIn(properties["Nameservers.Configuration"]);
    link.servers = serversIn(properties["Nameservers"]);
    // ConnMan does not say of servers that were provided for the device that the network did not name them. Nobody names
    // servers of a family whose addresses were entered.
    for (const IPAddress& each : link.servers) {
        const Known<std::string>& method = each.isIPv4() ? link.methods.ipv4 : link.methods.ipv6;
        const bool mayBeOffered = !method || *method == "dhcp" || *method == "auto";
        if (mayBeOffered && !contains(link.manualServers, each)) link.offeredServers.push_back(each);
    }
    // What is in force without having been entered is the network's own.
    const std::string proxy = properties["Proxy.Configuration"]["Method"].text();
    if (proxy == "manual" || proxy == "auto") link.proxy = "ConnMan service: " + proxy;
    return link;
}

}  // namespace

std::optional<ConnmanLink> connmanLinkIn(const BusValue& services, const std::string& interfaceName) {
    std::optional<ConnmanLink> link;
    std::vector<IPAddress> elsewhere;
    for (const BusValue& each : services.list()) {
        const auto& entry = each.list();  // path and properties
        if (entry.size() < 2 || !isConnected(entry[1])) continue;
        if (entry[1]["Ethernet"]["Interface"].text() == interfaceName) {
            if (!link) link = linkOf(entry[1]);
        } else {
            for (const IPAddress& server : serversIn(entry[1]["Nameservers"])) elsewhere.push_back(server);
        }
    }
    if (!link) return link;
    link->serversElsewhere = without(std::move(elsewhere), link->servers);
    return link;
}

Known<ConnmanLink> readConnmanLink(Bus& bus, const std::string& interfaceName, const Until& until) {
    const auto services = bus.call({kService, "/"}, kService + ".Manager", "GetServices", {}, until);
    if (!services) return services.error();
    auto link = connmanLinkIn(*services, interfaceName);
    if (!link) return failure(Reason::notFound, "ConnMan has not connected " + interfaceName);
    return std::move(*link);
}

}  // namespace wp
