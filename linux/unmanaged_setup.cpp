#include "linux/unmanaged_setup.h"

#include <cstdlib>
#include <ctime>

#include "linux/address_details.h"
#include "linux/asked_servers.h"
#include "linux/dbus/iwd.h"
#include "linux/files/dhcp_clients.h"
#include "linux/files/dhcpcd_leases.h"
#include "linux/files/dhcpcd_settings.h"
#include "linux/files/ifupdown.h"
#include "linux/files/iwd_settings.h"
#include "linux/files/key_value_file.h"
#include "linux/files/resolver_records.h"
#include "linux/route_query.h"

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

/// Where iwd sets addresses, it looks at routers' advertisements itself and has the kernel leave them alone.
bool iwdSetsAddresses(Known<Bus>& bus, const Link& link, const Until& until) {
    if (!iwdMaySetAddresses()) return false;
    const Known<BusValue> objects = bus ? iwdObjects(*bus, until) : bus.error();
    return objects && !iwdDevice(*objects, link.interfaceName).empty();
}

/// What DHCP clients without a manager wrote down.
struct ClientLeases {
    std::optional<Lease> ipv4, ipv6;
    bool ofDhcpcd = false;  ///< dhcpcd is among those who did
};

ClientLeases readClientLeases(const Link& link, const std::vector<AddressDetails>& details) {
    std::vector<IPAddress> addresses;
    for (const AddressDetails& each : details) addresses.push_back(each.assigned.address);
    const std::time_t now = std::time(nullptr);
    DhcpcdLeases kept = findDhcpcdLeases(link.interfaceName, addresses, now);
    const bool ofDhcpcd = kept.ipv4 || kept.ipv6;
    if (!kept.ipv4) kept.ipv4 = findLease(link.interfaceName, addresses, now);
    if (!kept.ipv6) kept.ipv6 = findLease6(link.interfaceName, addresses, now);
    return {std::move(kept.ipv4), std::move(kept.ipv6), ofDhcpcd};
}

/// All that tells how the interface was set up.
struct Evidence {
    std::vector<AssignedAddress> assigned;
    Known<RouteSigns> signs;
    std::vector<IPAddress> routers;
    bool isIwds = false;
    ClientLeases leases;
    DhcpClients clients;
    InterfacePlan plan;
    const char* toldBy = "addresses";
    ResolverRecords records;

    bool mayHaveLease() const { return leases.ipv4 || clients.ipv4; }
};

/// Whether dhcpcd set up the interface. One that ended left its addresses behind.
bool isByDhcpcd(const Evidence& evidence, const InterfacePlan& plan) {
    return evidence.clients.dhcpcd || evidence.leases.ofDhcpcd || isAssigned(plan.ipv4, evidence.assigned) ||
           isAssigned(plan.ipv6, evidence.assigned);
}

/// What the files of those say who set up the interface: ifupdown's; dhcpcd's, of a family of which it set an address that
/// stands there.
void readPlans(const Link& link, Evidence& evidence) {
    InterfacePlan& plan = evidence.plan;
    plan = ifupdownPlan(link.interfaceName);
    if (!plan.ipv4.method.empty() || !plan.ipv6.method.empty()) evidence.toldBy = "ifupdown";
    const std::string network = link.joined ? textFromName(link.joined->says.name) : "";
    const InterfacePlan dhcpcds = dhcpcdPlan(link.interfaceName, network);
    if (!isByDhcpcd(evidence, dhcpcds)) return;
    for (const auto family : {&InterfacePlan::ipv4, &InterfacePlan::ipv6}) {
        const bool isIfupdowns = isAssigned(plan.*family, evidence.assigned);
        if (isIfupdowns || !isAssigned(dhcpcds.*family, evidence.assigned)) continue;
        plan.*family = dhcpcds.*family;
        evidence.toldBy = "dhcpcd";
    }
    add(plan.servers, dhcpcds.servers);
}

Known<Evidence> gatherEvidence(Known<Bus>& bus, const Link& link, const Until& until) {
    const auto details = gatherAddressDetails(link.interfaceIndex, until);
    if (!details) return details.error();
    Evidence evidence;
    evidence.signs = gatherRouteSigns(link.interfaceIndex, until);
    if (const auto ways = gatherWaysOut(link, until))
        for (const WayOut& each : *ways)
            if (each.router) evidence.routers.push_back(*each.router);
    evidence.isIwds = iwdSetsAddresses(bus, link, until);
    evidence.clients = dhcpClientsOf(link.interfaceName, bus ? Connman::answers : Connman::silent);
    evidence.leases = readClientLeases(link, *details);
    const bool byClient = evidence.isIwds || evidence.clients.asksRouters;
    evidence.assigned = assignedOf(*details, byClient && evidence.signs && evidence.signs->advertised,
                                   evidence.leases.ipv6 ? evidence.leases.ipv6->addresses : Servers());
    readPlans(link, evidence);
    evidence.records = resolverRecords(link.interfaceName);
    return evidence;
}

AddressMethods methodsFrom(const Evidence& evidence, const std::string& interfaceName) {
    KernelIPv6 switches = kernelSwitches(interfaceName);
    switches.setByClient = evidence.clients.asksRouters;
    switches.acceptsAdvertisements |= evidence.clients.asksRouters || evidence.isIwds;
    FamilyPlan ipv4 = evidence.plan.ipv4;
    // A client whose lease would have been read asks for an address, but did not set the one that is there.
    if (evidence.clients.leavesLease && (ipv4.method.empty() || ipv4.method == "auto")) ipv4 = {"auto", {}};
    return {methodFromIPv4Addresses(evidence.assigned, evidence.mayHaveLease(), ipv4),
            methodFromIPv6Addresses(evidence.assigned, switches, evidence.plan.ipv6)};
}

/// The name servers where no manager tells: by the leases, else by who can have named them at all.
NameServers serversFrom(const Evidence& evidence, const AskedServers& asked) {
    const ResolverRecords& records = evidence.records;
    NameServers names;
    names.effective = asked.all;
    std::erase_if(names.effective, [&](const IPAddress& each) { return contains(records.elsewhere, each); });
    const ClientLeases& leases = evidence.leases;
    for (const auto* lease : {&leases.ipv4, &leases.ipv6})
        if (*lease) add(names.offered, (*lease)->servers);
    add(names.offered, records.offered);
    names.manual = without(asked.entered, names.offered);
    // Files do nothing by themselves: what they name must have come to be asked.
    for (const auto* entered : {&evidence.plan.servers, &records.entered})
        for (const IPAddress& each : *entered)
            if (contains(asked.all, each)) add(names.manual, {each});
    names.offerKnown = leases.ipv4 || records.offerKnown;
    // What a router advertised is written down nowhere.
    names.advertisementsKnown = false;
    names.routers = evidence.routers;
    if (!evidence.signs) return names;
    // Another interface may have brought along what is not explained here, unless records tell the interfaces apart.
    const bool isBrought = evidence.signs->elsewhere || !asked.elsewhere.empty();
    if (isBrought && !asked.ofLinkAlone && records.elsewhere.empty()) names.offerKnown = false;
    if (names.offerKnown) return names;
    // Nobody offers anything to an interface that was set up by hand; another one may have brought the servers along.
    names.offerKnown = names.advertisementsKnown =
        !evidence.clients.any && !isBrought && allSetByHand(evidence.assigned);
    return names;
}

}  // namespace

Known<LinkSetup> setupWithoutManager(Known<Bus>& bus, const Link& link, const Until& until) {
    const auto evidence = gatherEvidence(bus, link, until);
    if (!evidence) return evidence.error();
    const ClientLeases& leases = evidence->leases;
    LinkSetup setup;
    setup.toldBy = evidence->toldBy;
    setup.methods = methodsFrom(*evidence, link.interfaceName);
    const AskedServers asked = askedServers(bus, link, {}, until);
    NameServers names = serversFrom(*evidence, asked);
    setup.servers = without(names.effective.empty() ? asked.all : names.effective, asked.elsewhere);
    setup.serversElsewhere = asked.elsewhere;
    if (leases.ipv4 && !leases.ipv4->servers.empty()) setup.servers = leases.ipv4->servers;
    setup.nameServers = std::move(names);
    setup.leaseText = failure(Reason::unavailable,
                              evidence->clients.any ? "the DHCP client left no lease of IPv4 that can be read"
                                                    : "no lease of IPv4 was found");
    if (leases.ipv4) setup.leaseText = leases.ipv4->vendorText;
    for (const auto* lease : {&leases.ipv4, &leases.ipv6})
        if (*lease && setup.portalApi.empty()) setup.portalApi = (*lease)->portalApi;
    return setup;
}

}  // namespace wp
