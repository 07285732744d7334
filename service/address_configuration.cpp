#include "service/address_configuration.h"

#include <algorithm>

namespace wp {
namespace {

bool isOneOf(const std::string& method, std::initializer_list<std::string_view> methods) {
    return std::find(methods.begin(), methods.end(), method) != methods.end();
}

}  // namespace

bool isAssigned(const FamilyPlan& plan, const std::vector<AssignedAddress>& addresses) {
    return std::any_of(addresses.begin(), addresses.end(), [&](const AssignedAddress& each) {
        return each.permanent && contains(plan.addresses, each.address);
    });
}

Known<std::string> methodFromIPv4Addresses(const std::vector<AssignedAddress>& addresses, bool hasLease,
                                           const FamilyPlan& plan) {
    if (isAssigned(plan, addresses)) return plan.method;
    bool any = false, routable = false;
    for (const AssignedAddress& each : addresses) {
        if (!each.address.isIPv4() || each.address.loopback() || each.address.unspecified()) continue;
        any = true;
        routable |= !each.address.linkLocal();
        // A client without a manager may set its address without an end, but it leaves a lease behind.
        if (!each.permanent || each.address.linkLocal() || hasLease) continue;
        if (plan.method == "auto")
            return failure(Reason::unavailable,
                           "the interface was started to ask for an address, but has one without an end, of "
                           "which no DHCP client tells");
        return std::string("static");
    }
    if (!routable && !hasLease && !plan.method.empty()) return plan.method;
    if (any || hasLease) return std::string("dynamic");
    return failure(Reason::unavailable, "no manager tells how IPv4 is set up, and there is no address");
}

Known<std::string> methodFromIPv6Addresses(const std::vector<AssignedAddress>& addresses,
                                           const KernelIPv6& kernel, const FamilyPlan& plan) {
    if (kernel.disabled) return std::string("disabled");
    if (isAssigned(plan, addresses)) return plan.method;
    bool dynamic = false;
    for (const AssignedAddress& each : addresses) {
        if (each.address.isIPv4() || each.address.linkLocal() || each.address.loopback()) continue;
        const bool withoutEnd = each.permanent && !each.byItself;
        if (withoutEnd && kernel.setByClient)
            return failure(Reason::unavailable,
                           "a client sets addresses of IPv6 itself and does not tell whence it has them");
        if (withoutEnd) return std::string("static");
        dynamic = true;
    }
    if (!dynamic && !plan.method.empty()) return plan.method;
    if (dynamic || kernel.acceptsAdvertisements) return std::string("dynamic");
    return std::string("link-local");
}

bool allSetByHand(const std::vector<AssignedAddress>& addresses) {
    bool any = false;
    for (const AssignedAddress& each : addresses) {
        if (each.address.linkLocal() || each.address.loopback() || each.address.unspecified()) continue;
        if (!each.permanent || each.byItself) return false;
        any = true;
    }
    return any;
}

Outcome usesCustomIPv4(const AddressMethods& methods) {
    if (!methods.ipv4) return methods.ipv4.error();
    return problem(!isOneOf(*methods.ipv4, {"auto", "dhcp", "dynamic"}),
                   {{"IPv4ConfigMethod", *methods.ipv4}});
}

Outcome usesCustomIPv6(const AddressMethods& methods) {
    if (!methods.ipv6) return methods.ipv6.error();
    return problem(!isOneOf(*methods.ipv6, {"auto", "dhcp", "dynamic"}),
                   {{"IPv6ConfigMethod", *methods.ipv6}});
}

Outcome usesCustomNameServers(const Known<NameServers>& servers) {
    if (!servers) return servers.error();
    if (!servers->manual.empty()) return problem(true);
    bool hidden = false, unexplained = false;
    for (const IPAddress& server : servers->effective) {
        const bool offerKnown = servers->offerKnown && (server.isIPv4() || servers->advertisementsKnown);
        if (server.loopback())
            hidden = true;
        else if (contains(servers->offered, server))
            continue;
        else if (offerKnown)
            return problem(true);
        else if (!contains(servers->routers, server))
            unexplained = true;
    }
    if (hidden)
        return failure(Reason::unavailable, "a resolver on the device does not tell which servers it asks");
    if (unexplained)
        return failure(Reason::unavailable,
                       "no lease or manager tells which name servers the network offers");
    return problem(false);
}

Outcome usesCustomWebProxy(const Known<WebProxyPlaces>& places) {
    if (!places) return places.error();
    return problem(!places->empty());
}

}  // namespace wp
