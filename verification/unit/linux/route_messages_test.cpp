#include "linux/route_messages.h"

#include <gtest/gtest.h>

#include <algorithm>

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
        if (each.global && each.usable) texts.push_back(textOf(each.family, each.bytes));
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

TEST(RouteMessages, TellTheGateway) {
    const auto gateways = readGateways(captured("good-home-route"), interfaceIn("good-home"));

    ASSERT_FALSE(gateways.empty());
    EXPECT_EQ("10.0.0.1", textOf(gateways[0].family, gateways[0].bytes));
}

TEST(RouteMessages, TellAnIPv6GatewayWhereThereIsNoOther) {
    const auto gateways = readGateways(captured("ipv6-only-route"), interfaceIn("ipv6-only"));

    ASSERT_FALSE(gateways.empty());
    EXPECT_EQ(Address::Family::ipv6, gateways[0].family);
}

TEST(RouteMessages, TellNoGatewayWithoutARoute) {
    EXPECT_TRUE(readGateways(captured("not-joined-route"), interfaceIn("not-joined")).empty());
    EXPECT_TRUE(readGateways(captured("good-home-route"), 4711).empty());
}

TEST(RouteMessages, SurviveAnyCutOfADump) {
    const auto dump = captured("good-home-route");
    for (std::size_t size = 0; size <= dump.size(); ++size) {
        const std::vector<std::uint8_t> prefix(dump.begin(),
                                               dump.begin() + static_cast<std::ptrdiff_t>(size));
        EXPECT_LE(readGateways(prefix, 3).size(), 4U);
        EXPECT_LE(readAddresses(prefix, 3).size(), 16U);
    }
}

}  // namespace
}  // namespace wp
