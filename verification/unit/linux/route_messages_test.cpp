#include "linux/route_messages.h"

#include <gtest/gtest.h>
#include <linux/if_addr.h>
#include <linux/neighbour.h>
#include <linux/rtnetlink.h>
#include <sys/socket.h>

#include <algorithm>

#include "linux/address_details.h"
#include "linux/netlink_socket.h"
#include "linux/radio_messages.h"
#include "verification/unit/linux/captured.h"

namespace wp {
namespace {

std::uint32_t interfaceIn(const std::string& scenario) {
    return readInterfaces(captured(scenario + "-interface")).at(0).index;
}

std::vector<std::string> texts(const Addresses& addresses) {
    std::vector<std::string> texts;
    for (const Address& each : addresses) {
        if (each.global && each.usable) texts.push_back(IPAddress::fromBytes(each.bytes)->text());
    }
    return texts;
}

TEST(RouteMessages, TellTheAddressesOfOneInterface) {
    const Addresses addresses = readAddresses(captured("good-home-addr"), interfaceIn("good-home"));
    const std::vector<std::string> found = texts(addresses);

    ASSERT_EQ(2U, found.size());
    EXPECT_TRUE(found[0].starts_with("10.0.0.")) << found[0];
    EXPECT_EQ("2001:db8:1::7", found[1]);
}

TEST(RouteMessages, TellALinkLocalAddressByItsScope) {
    const Addresses addresses = readAddresses(captured("good-home-addr"), interfaceIn("good-home"));

    EXPECT_TRUE(std::ranges::any_of(addresses, [](const Address& each) {
        return each.family == Address::Family::ipv6 && !each.global && each.bytes[0] == 0xFE;
    }));
}

TEST(RouteMessages, TellNoAddressOfAnotherInterface) {
    EXPECT_TRUE(readAddresses(captured("good-home-addr"), 4711).empty());
    EXPECT_TRUE(texts(readAddresses(captured("not-joined-addr"), interfaceIn("not-joined"))).empty());
}

/// The kernel's message on 2001:db8::5/64 of interface 3. \param origin who made it, \param life in seconds
std::vector<std::uint8_t> addressMessage(std::uint8_t origin, std::uint32_t life, std::uint32_t flags = 0) {
    const std::uint8_t address[] = {0x20, 1, 0xD, 0xB8, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 5};
    const ifa_cacheinfo times{life, life, 0, 0};
    NetlinkRequest message(RTM_NEWADDR, 0);
    message.header<ifaddrmsg>() = {AF_INET6, 64, 0, 0, 3};
    message.put(IFA_ADDRESS, address);
    if (life == 0xFFFF'FFFF) flags |= IFA_F_PERMANENT;
    message.put(IFA_FLAGS, flags);
    message.put(11, Bytes(&origin, 1));
    message.put(IFA_CACHEINFO, Bytes(reinterpret_cast<const std::uint8_t*>(&times), sizeof times));
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(&message.message());
    return {bytes, bytes + message.message().nlmsg_len};
}

TEST(RouteMessages, CallAnIPv6AddressUsableThatIsNeitherInDoubtNorDeprecated) {
    const auto usable = [](std::uint32_t flags) {
        return !texts(readAddresses(addressMessage(0, 3600, flags), 3)).empty();
    };

    EXPECT_TRUE(usable(0));
    EXPECT_FALSE(usable(IFA_F_DEPRECATED));
    EXPECT_FALSE(usable(IFA_F_TENTATIVE));
    EXPECT_FALSE(usable(IFA_F_DADFAILED));
}

/// The kernel's message on the neighbour 10.0.0.1 of interface 3.
std::vector<std::uint8_t> neighbourMessage(std::uint16_t state) {
    const std::uint8_t address[] = {10, 0, 0, 1};
    NetlinkRequest message(RTM_NEWNEIGH, 0);
    message.header<ndmsg>() = {AF_INET, 0, 0, 3, state, 0, 0};
    message.put(NDA_DST, address);
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(&message.message());
    return {bytes, bytes + message.message().nlmsg_len};
}

TEST(RouteMessages, TellANeighbourThatWasHeardOf) {
    const std::uint8_t address[] = {10, 0, 0, 1}, other[] = {10, 0, 0, 2};
    const auto reachable = neighbourMessage(NUD_REACHABLE);

    EXPECT_TRUE(isReachable(reachable, 3, address));
    EXPECT_FALSE(isReachable(reachable, 4, address));
    EXPECT_FALSE(isReachable(reachable, 3, other));
    EXPECT_FALSE(isReachable(neighbourMessage(NUD_FAILED), 3, address));
    for (std::size_t size = 0; size < reachable.size(); ++size)
        EXPECT_FALSE(isReachable(Bytes(reachable).first(size), 3, address));
}

TEST(RouteMessages, TellWhetherAnotherInterfaceLeadsOut) {
    const auto routes = captured("good-home-route");

    EXPECT_FALSE(leadsElsewhere(routes, interfaceIn("good-home")));
    EXPECT_TRUE(leadsElsewhere(routes, 4711));
}

std::vector<std::uint8_t> wholeOf(NetlinkRequest& message) {
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(&message.message());
    return {bytes, bytes + message.message().nlmsg_len};
}

/// The kernel's message on a route over interface 3 to 2001:db8::/64.
std::vector<std::uint8_t> routeMessage(unsigned char family, unsigned char protocol) {
    const std::uint8_t network[] = {0x20, 1, 0xD, 0xB8, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0};
    NetlinkRequest message(RTM_NEWROUTE, 0);
    message.header<rtmsg>() = {family, 64, 0, 0, RT_TABLE_MAIN, protocol, RT_SCOPE_UNIVERSE, RTN_UNICAST, 0};
    message.put(RTA_DST, network);
    message.put(RTA_OIF, std::uint32_t{3});
    return wholeOf(message);
}

/// On a default route of IPv4 of that type over interface 3. \param router its attribute, and what stands in it
std::vector<std::uint8_t> defaultRouteMessage(unsigned char type, std::uint16_t router = 0,
                                              std::vector<std::uint8_t> content = {}) {
    NetlinkRequest message(RTM_NEWROUTE, 0);
    message.header<rtmsg>() = {AF_INET, 0, 0, 0, RT_TABLE_MAIN, RTPROT_DHCP, RT_SCOPE_UNIVERSE, type, 0};
    message.put(RTA_OIF, std::uint32_t{3});
    if (router != 0) message.put(router, content);
    return wholeOf(message);
}

/// Prefix, then each hop's interface and router.
std::string textOf(const std::optional<Route>& route) {
    if (!route) return "none";
    std::string text = "/" + std::to_string(route->prefixLength);
    for (const NextHop& each : route->hops)
        text += " " + std::to_string(each.interfaceIndex) + (each.router ? " " + each.router->text() : "");
    return text;
}

TEST(RouteMessages, TellARouteAndItsRouter) {
    const std::vector<std::uint8_t> router = {10, 0, 0, 1};
    const std::vector<std::uint8_t> ofIPv6 = {AF_INET6, 0, 0xFE, 0x80, 0, 0, 0, 0, 0,
                                              0,        0, 0,    0,    0, 0, 0, 0, 1};
    EXPECT_EQ("/0 3 10.0.0.1", textOf(readRoute(defaultRouteMessage(RTN_UNICAST, RTA_GATEWAY, router))));
    EXPECT_EQ("/0 3 fe80::1", textOf(readRoute(defaultRouteMessage(RTN_UNICAST, RTA_VIA, ofIPv6))));
    EXPECT_EQ("/0 3", textOf(readRoute(defaultRouteMessage(RTN_UNICAST)))) << "on the link itself";
    EXPECT_EQ("/64 3", textOf(readRoute(routeMessage(AF_INET6, RTPROT_RA))));
    EXPECT_EQ("none", textOf(readRoute(defaultRouteMessage(RTN_LOCAL))));
    EXPECT_EQ("none", textOf(readRoute(defaultRouteMessage(RTN_UNREACHABLE))));
    EXPECT_EQ("none", textOf(readRoute({})));
}

TEST(RouteMessages, TellEachHopOfARouteThatHasSeveral) {
    struct Hop {
        rtnexthop header;
        nlattr attribute;
        std::uint8_t router[4];
    };
    const Hop hops[] = {{{sizeof(Hop), 0, 0, 3}, {8, RTA_GATEWAY}, {10, 0, 0, 1}},
                        {{sizeof(Hop), 0, 0, 4}, {8, RTA_GATEWAY}, {10, 0, 1, 1}}};
    const auto* const bytes = reinterpret_cast<const std::uint8_t*>(hops);
    NetlinkRequest message(RTM_NEWROUTE, 0);
    message.header<rtmsg>() = {AF_INET, 0, 0, 0, RT_TABLE_MAIN, 0, RT_SCOPE_UNIVERSE, RTN_UNICAST, 0};
    message.put(RTA_MULTIPATH, Bytes(bytes, sizeof hops));
    const auto whole = wholeOf(message);
    const auto route = readRoute(whole);

    EXPECT_EQ("/0 3 10.0.0.1 4 10.0.1.1", textOf(route));
    ASSERT_TRUE(route && route->over(4));
    EXPECT_EQ("10.0.1.1", route->over(4)->router->text());
    EXPECT_EQ(nullptr, route->over(5));
    EXPECT_TRUE(leadsElsewhere(whole, 3));
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_EQ("none", textOf(readRoute(Bytes(whole).first(size))));
}

TEST(RouteMessages, TellWhetherARouterAdvertisedARoute) {
    const auto advertised = routeMessage(AF_INET6, RTPROT_RA);

    EXPECT_TRUE(hasAdvertisedRoute(advertised, 3));
    EXPECT_FALSE(hasAdvertisedRoute(advertised, 4));
    EXPECT_FALSE(hasAdvertisedRoute(routeMessage(AF_INET6, RTPROT_STATIC), 3));
    EXPECT_FALSE(hasAdvertisedRoute(routeMessage(AF_INET, RTPROT_RA), 3));
    for (std::size_t size = 0; size < advertised.size(); ++size)
        EXPECT_FALSE(hasAdvertisedRoute(Bytes(advertised).first(size), 3));
}

/// Address, length of its network, and what is special: it lasts forever, the kernel made it
/// of a router's advertisement.
std::string linesOf(const std::vector<AddressDetails>& details) {
    std::string lines;
    for (const AddressDetails& each : details) {
        if (each.assigned.address.linkLocal()) continue;  // made of the radio's address
        lines += each.assigned.address.text() + "/" + std::to_string(each.prefixLength);
        lines += std::string(each.assigned.permanent ? " forever" : "") +
                 (each.assigned.byItself ? " advertised" : "") + "\n";
    }
    return lines;
}

TEST(AddressDetails, TellAddressAndNetwork) {
    const auto details = readAddressDetails(captured("ipv6-only-addr"), interfaceIn("ipv6-only"));
    EXPECT_EQ(linesOf(details), "2001:db8:1::7/64 forever\n");
    EXPECT_TRUE(readAddressDetails(captured("ipv6-only-addr"), 9999).empty());
}

TEST(AddressDetails, TellLifetimeAndOrigin) {
    EXPECT_EQ(linesOf(readAddressDetails(addressMessage(0, 0xFFFF'FFFF), 3)), "2001:db8::5/64 forever\n");
    EXPECT_EQ(linesOf(readAddressDetails(addressMessage(2, 3600), 3)), "2001:db8::5/64 advertised\n");
    EXPECT_EQ(linesOf(readAddressDetails(addressMessage(0, 3600), 3)), "2001:db8::5/64\n");
}

TEST(AddressDetails, OfIwdOrDhcpcdWereEnteredUnlessARouteIsAdvertised) {
    auto details = readAddressDetails(addressMessage(0, 0xFFFF'FFFF, IFA_F_NOPREFIXROUTE), 3);
    const auto ofAPerson = readAddressDetails(addressMessage(0, 0xFFFF'FFFF), 3);
    details.insert(details.end(), ofAPerson.begin(), ofAPerson.end());
    ASSERT_EQ(details.size(), 2U);
    EXPECT_FALSE(details[0].bringsRoute);

    const auto advertised = assignedOf(details, true), entered = assignedOf(details, false);

    EXPECT_TRUE(advertised[0].byItself);
    EXPECT_FALSE(advertised[1].byItself) << "set beside the client, with a route of its own";
    EXPECT_FALSE(entered[0].byItself);
    EXPECT_TRUE(entered[0].permanent);
}

TEST(AddressDetails, OfALeaseWereNotEnteredThoughTheyHaveNoEnd) {
    const auto details = readAddressDetails(addressMessage(0, 0xFFFF'FFFF), 3);
    EXPECT_TRUE(assignedOf(details, false, {*IPAddress::fromText("2001:db8::5")})[0].byItself);
    EXPECT_FALSE(assignedOf(details, false, {*IPAddress::fromText("2001:db8::6")})[0].byItself);
}

TEST(AddressDetails, SurviveAnyCutOfADump) {
    const auto whole = captured("good-home-addr");
    const std::uint32_t interface = interfaceIn("good-home");
    const std::size_t all = readAddressDetails(whole, interface).size();
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_LE(readAddressDetails(Bytes(whole).first(size), interface).size(), all);
}

TEST(RouteMessages, SurviveAnyCutOfADump) {
    const auto dump = captured("good-home-route");
    for (std::size_t size = 0; size <= dump.size(); ++size) {
        const std::vector<std::uint8_t> prefix(dump.begin(),
                                               dump.begin() + static_cast<std::ptrdiff_t>(size));
        readRoute(prefix);
        leadsElsewhere(prefix, 3);
        EXPECT_LE(readAddresses(prefix, 3).size(), 16U);
    }
}

}  // namespace
}  // namespace wp
