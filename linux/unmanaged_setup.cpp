#include "linux/unmanaged_setup.h"

#include <algorithm>
#include <cstdlib>
#include <ctime>

#include "linux/address_details.h"
#include "linux/asked_servers.h"
#include "linux/dbus/iwd.h"
#include "linux/files/dhcp_clients.h"
#include "linux/files/dhcpcd_leases.h"
#include "linux/files/ifupdown.h"
#include "linux/files/key_value_file.h"

namespace wp {
namespace {

KernelIPv6 kernelSwitches(const std::string& interfaceName) {
    const auto number = [&](const char* name) {
        const auto text = readSmallFile("/proc/sys/net/ipv6/conf/" + interfaceName + "/" + name, 64);
        return text ? std::atoi(text->c_str()) : -1;
    };
    // Without the folder the kernel has no IPv6 at all.
    return {number("disable_ipv6") != 0, number("accept_ra") > 0};
}

/// iwd looks at routers' advertisements itself and has the kernel leave them alone.
bool iwdManages(Known<Bus>& bus, const Link& link, const Until& until) {
    const Known<BusValue> objects = bus ? iwdObjects(*bus, until) : bus.error();
    return objects && !iwdDevice(*objects, link.interfaceName).empty();
}

/// What DHCP clients without a manager wrote down.
struct ClientLeases {
    std::optional<Lease> ipv4, ipv6;
};

ClientLeases readClientLeases(const Link& link, const std::vector<AssignedAddress>& assigned) {
    std::vector<IPAddress> addresses;
    for (const AssignedAddress& each : assigned) addresses.push_back(each.address);
    const std::time_t now = std::time(nullptr);
    DhcpcdLeases kept = findDhcpcdLeases(link.interfaceName, addresses, now);
    if (!kept.ipv4) kept.ipv4 = findLease(link.interfaceName, addresses, now);
    if (!kept.ipv6) kept.ipv6 = findLease6(link.interfaceName, addresses, now);
    return {std::move(kept.ipv4), std::move(kept.ipv6)};
}

/// All that tells how the interface was set up.
struct Evidence {
    std::vector<AssignedAddress> assigned;
    Known<WaysOut> ways;
    bool isIwds = false;
    ClientLeases leases;
    DhcpClients clients;
    InterfacePlan plan;

    bool hasClientOfIPv4() const { return leases.ipv4 || clients.ipv4; }
};

Known<Evidence> gatherEvidence(Known<Bus>& bus, const Link& link, const Until& until) {
    const auto details = gatherAddressDetails(link.interfaceIndex, until);
    if (!details) return details.error();
    Evidence evidence;
    evidence.ways = gatherWaysOut(link.interfaceIndex, until);
    evidence.isIwds = iwdManages(bus, link, until);
    evidence.assigned = assignedOf(*details, evidence.isIwds && evidence.ways && evidence.ways->advertised);
    evidence.leases = readClientLeases(link, evidence.assigned);
    evidence.clients = dhcpClientsOf(link.interfaceName);
    evidence.plan = ifupdownPlan(link.interfaceName);
    return evidence;
}

AddressMethods methodsFrom(const Evidence& evidence, const std::string& interfaceName) {
    KernelIPv6 switches = kernelSwitches(interfaceName);
    switches.setByClient = evidence.clients.asksRouters;
    switches.acceptsAdvertisements |= evidence.clients.asksRouters || evidence.isIwds;
    return {methodFromIPv4Addresses(evidence.assigned, evidence.hasClientOfIPv4(), evidence.plan.ipv4),
            methodFromIPv6Addresses(evidence.assigned, switches, evidence.plan.ipv6)};
}

/// The name servers where no manager tells: by the leases, else by who can have named them at all.
/// \param effective those that are asked
NameServers serversFrom(const Evidence& evidence, const Servers& effective) {
    NameServers names;
    names.effective = effective;
    const ClientLeases& leases = evidence.leases;
    for (const auto* lease : {&leases.ipv4, &leases.ipv6})
        if (*lease) add(names.offered, (*lease)->servers);
    // The file does nothing by itself: what it names must have come to be asked.
    for (const IPAddress& each : evidence.plan.servers)
        if (std::ranges::find(effective, each) != effective.end()) names.manual.push_back(each);
    names.offerKnown = leases.ipv4.has_value();
    // What a router advertised is written down nowhere.
    names.advertisementsKnown = false;
    if (!evidence.ways) return names;
    names.routers = evidence.ways->gateways;
    if (leases.ipv4) return names;
    // Nobody offers anything to an interface that was set up by hand; another one may have brought the servers along.
    names.offerKnown = names.advertisementsKnown =
        !evidence.clients.any && !evidence.ways->elsewhere && allSetByHand(evidence.assigned);
    return names;
}

}  // namespace

Known<LinkSetup> setupWithoutManager(Known<Bus>& bus, const Link& link, const Until& until) {
    const auto evidence = gatherEvidence(bus, link, until);
    if (!evidence) return evidence.error();
    const ClientLeases& leases = evidence->leases;
    const InterfacePlan& plan = evidence->plan;
    LinkSetup setup;
    setup.toldBy = plan.ipv4.method.empty() && plan.ipv6.method.empty() ? "addresses" : "ifupdown";
    setup.methods = methodsFrom(*evidence, link.interfaceName);
    const Servers effective = effectiveServers(bus, link, {}, until);
    setup.nameServers = serversFrom(*evidence, effective);
    setup.servers = leases.ipv4 && !leases.ipv4->servers.empty() ? leases.ipv4->servers : effective;
    setup.leaseText =
        failure(Reason::unavailable, evidence->hasClientOfIPv4()
                                         ? "the DHCP client left no lease of IPv4 that can be read"
                                         : "no lease of IPv4 was found");
    if (leases.ipv4) setup.leaseText = leases.ipv4->vendorText;
    for (const auto* lease : {&leases.ipv4, &leases.ipv6})
        if (*lease && setup.portalApi.empty()) setup.portalApi = (*lease)->portalApi;
    return setup;
}

}  // namespace wp
