#include "linux/link_master.h"

#include <gtest/gtest.h>
#include <linux/if_link.h>
#include <linux/rtnetlink.h>

#include "linux/gather.h"
#include "linux/radio_messages.h"
#include "verification/unit/linux/captured.h"

namespace wp {
namespace {

using Content = std::vector<std::uint8_t>;

void append(Content& to, const void* from, std::size_t size) {
    const auto* bytes = static_cast<const std::uint8_t*>(from);
    to.insert(to.end(), bytes, bytes + size);
    to.resize((to.size() + 3) & ~std::size_t{3});
}

void putAttribute(Content& to, std::uint16_t type, const Content& value) {
    const std::uint16_t header[] = {static_cast<std::uint16_t>(value.size() + 4), type};
    append(to, header, sizeof header);
    append(to, value.data(), value.size());
}

Content wordOf(const std::string& text) {
    return {text.c_str(), text.c_str() + text.size() + 1};
}

/// The kernel's message on one interface. \param partOf the kind of the master, \param state as a part of that
Content interfaceMessage(int index, const std::string& name, const std::string& kind,
                         std::uint32_t master = 0, const std::string& partOf = "", std::uint8_t state = 0) {
    Content info, inner, attributes;
    if (!kind.empty()) putAttribute(info, IFLA_INFO_KIND, wordOf(kind));
    if (!partOf.empty()) putAttribute(info, IFLA_INFO_SLAVE_KIND, wordOf(partOf));
    putAttribute(inner, 1, {state});  // first of all attributes of a bond's and of a bridge's part
    if (!partOf.empty()) putAttribute(info, IFLA_INFO_SLAVE_DATA, inner);
    putAttribute(attributes, IFLA_IFNAME, wordOf(name));
    Content number;
    append(number, &master, sizeof master);
    if (master != 0) putAttribute(attributes, IFLA_MASTER, number);
    putAttribute(attributes, IFLA_LINKINFO, info);
    Content message;
    ifinfomsg body{};
    body.ifi_index = index;
    nlmsghdr header{};
    header.nlmsg_len = static_cast<std::uint32_t>(sizeof header + sizeof body + attributes.size());
    header.nlmsg_type = RTM_NEWLINK;
    append(message, &header, sizeof header);
    append(message, &body, sizeof body);
    append(message, attributes.data(), attributes.size());
    return message;
}

Content operator+(Content left, const Content& right) {
    left.insert(left.end(), right.begin(), right.end());
    return left;
}

/// "NAME INDEX", and whether the interface 3 only stands by in it.
std::string masterIn(const Content& messages) {
    const auto master = readMaster(messages, 3);
    if (!master) return "none";
    return master->name + " " + std::to_string(master->index) + (master->sendsElsewhere ? " elsewhere" : "");
}

constexpr std::uint8_t kActive = 0, kBackup = 1, kForwarding = 3, kBlocking = 4;

TEST(LinkMaster, IsTheBridgeOrBondThatAnInterfaceIsPartOf) {
    EXPECT_EQ(masterIn({}), "none");
    EXPECT_EQ(masterIn(interfaceMessage(3, "wlan0", "")), "none");
    EXPECT_EQ(masterIn(interfaceMessage(3, "wlan0", "", 7, "bridge", kForwarding) +
                       interfaceMessage(7, "br0", "bridge")),
              "br0 7");
    EXPECT_EQ(
        masterIn(interfaceMessage(7, "bond0", "bond") + interfaceMessage(3, "wlan0", "", 7, "bond", kActive) +
                 interfaceMessage(2, "eth0", "", 7, "bond", kBackup)),
        "bond0 7");
    EXPECT_EQ(masterIn(interfaceMessage(3, "wlan0", "", 7, "team") + interfaceMessage(7, "team0", "team")),
              "team0 7");
}

TEST(LinkMaster, IsToldByTheKernel) {
    const auto part = readInterfaces(captured("part-of-a-bridge-interface")).at(0);
    const auto master = readMaster(captured("part-of-a-bridge-link"), part.index);
    ASSERT_TRUE(master);
    EXPECT_EQ(master->name, "br0");
    EXPECT_FALSE(master->sendsElsewhere);
    EXPECT_FALSE(readMaster(captured("part-of-a-bridge-link"), master->index));
}

TEST(LinkMaster, IsNoneOfAnInterfaceThatKeepsItsAddresses) {
    EXPECT_EQ(masterIn(interfaceMessage(3, "wlan0", "", 7, "vrf") + interfaceMessage(7, "red", "vrf")),
              "none");
    EXPECT_EQ(masterIn(interfaceMessage(3, "wlan0", "", 7, "bridge", kForwarding)), "none") << "not told of";
    EXPECT_EQ(masterIn(interfaceMessage(2, "eth0", "", 7, "bridge", kForwarding) +
                       interfaceMessage(7, "br0", "bridge") + interfaceMessage(3, "wlan0", "")),
              "none");
}

TEST(LinkMaster, IsTheOutermostOne) {
    const Content bond = interfaceMessage(7, "bond0", "bond", 9, "bridge", kForwarding);
    const Content bridge = interfaceMessage(9, "br0", "bridge");
    EXPECT_EQ(masterIn(interfaceMessage(3, "wlan0", "", 7, "bond", kActive) + bond + bridge), "br0 9");
    EXPECT_EQ(masterIn(interfaceMessage(3, "wlan0", "", 7, "bond", kBackup) + bond + bridge),
              "br0 9 elsewhere");
    const Content circle =
        interfaceMessage(3, "a", "bond", 7, "bond") + interfaceMessage(7, "b", "bond", 3, "bond");
    EXPECT_NE(masterIn(circle), "none") << "it ends";
}

TEST(LinkMaster, MaySendByAnotherOfItsParts) {
    const Content bond = interfaceMessage(7, "bond0", "bond"), bridge = interfaceMessage(7, "br0", "bridge");
    EXPECT_EQ(masterIn(bond + interfaceMessage(3, "wlan0", "", 7, "bond", kBackup)), "bond0 7 elsewhere");
    EXPECT_EQ(masterIn(bridge + interfaceMessage(3, "wlan0", "", 7, "bridge", kBlocking)), "br0 7 elsewhere");
}

TEST(LinkMaster, CutMessagesAreReadAsFarAsTheyGo) {
    const Content part = interfaceMessage(3, "wlan0", "", 7, "bond", kBackup);
    const Content whole = part + interfaceMessage(7, "bond0", "bond");
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_FALSE(readMaster(Bytes(whole).first(size), 3)) << size;
    EXPECT_FALSE(readMaster(captured("good-home-link"), 3));
}

TEST(LinkMaster, StandsInTheInterfacesPlaceWhereAddressesAreAskedFor) {
    Link link;
    link.interfaceName = "wlan0";
    link.interfaceIndex = 3;
    EXPECT_EQ(addressed(link).interfaceName, "wlan0");
    link.master = LinkMaster{"br0", 7};
    EXPECT_EQ(addressed(link).interfaceName, "br0");
    EXPECT_EQ(addressed(link).interfaceIndex, 7U);
}

}  // namespace
}  // namespace wp
