#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>

#include "linux/files/dhcp_packet.h"
#include "linux/files/dhcpcd_leases.h"
#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/service/addresses.h"

namespace wp {
namespace {

using Frame = std::vector<std::uint8_t>;

Frame operator+(Frame left, const Frame& right) {
    left.insert(left.end(), right.begin(), right.end());
    return left;
}

Frame bytesOf(std::string_view text) {
    return {text.begin(), text.end()};
}

Frame option(std::uint8_t number, const Frame& value) {
    return Frame{number, static_cast<std::uint8_t>(value.size())} + value;
}

constexpr std::size_t kServerName = 44, kFile = 108;
const Frame kGranted = option(53, {5}) + option(51, {0, 0, 0x0E, 0x10});

/// A packet that grants 192.168.1.20, with these options.
Frame packet(const Frame& options) {
    Frame head(236, 0);
    head[0] = 2;
    const Frame own{192, 168, 1, 20};
    std::copy(own.begin(), own.end(), head.begin() + 16);
    return head + Frame{0x63, 0x82, 0x53, 0x63} + options;
}

Frame option6(unsigned number, const Frame& value) {
    return Frame{static_cast<std::uint8_t>(number >> 8), static_cast<std::uint8_t>(number),
                 static_cast<std::uint8_t>(value.size() >> 8), static_cast<std::uint8_t>(value.size())} +
           value;
}

Frame address6(std::uint8_t last) {
    Frame address{0x20, 0x01, 0x0D, 0xB8};
    address.resize(16);
    address[15] = last;
    return address;
}

/// A group of addresses that holds this one for so many seconds.
Frame group6(std::uint8_t last, std::uint8_t seconds) {
    return option6(3, Frame(12, 0) + option6(5, address6(last) + Frame{0, 0, 0, 1, 0, 0, 0, seconds}));
}

TEST(DhcpPacket, GrantsAnAddressForATimeAndNamesServersPortalAndVendor) {
    const auto read =
        readDhcpPacket(packet(option(0, {}) + kGranted + option(6, {192, 168, 1, 1, 9, 9, 9, 9, 1}) +
                              option(43, bytesOf("EXAMPLE_METERED")) +
                              option(114, bytesOf("https://p.example/api")) + Frame{255, 6, 4, 1}));
    ASSERT_TRUE(read);
    EXPECT_EQ(textsOf(read->lease.addresses), "192.168.1.20 ");
    EXPECT_EQ(read->seconds, 3600U);
    EXPECT_EQ(textsOf(read->lease.servers), "192.168.1.1 9.9.9.9 ");
    EXPECT_EQ(read->lease.vendorText, "EXAMPLE_METERED");
    EXPECT_EQ(read->lease.portalApi, "https://p.example/api");
}

TEST(DhcpPacket, HasOptionsInPartsAndInTheFieldsForFileAndServer) {
    Frame whole = packet(kGranted + option(52, {3}) + option(114, bytesOf("https://")));
    const Frame inFile = option(114, bytesOf("p.example/")), inName = option(114, bytesOf("api"));
    std::copy(inFile.begin(), inFile.end(), whole.begin() + kFile);
    std::copy(inName.begin(), inName.end(), whole.begin() + kServerName);
    ASSERT_TRUE(readDhcpPacket(whole));
    EXPECT_EQ(readDhcpPacket(whole)->lease.portalApi, "https://p.example/api");
    EXPECT_EQ(
        readDhcpPacket(packet(kGranted + option(160, bytesOf("https://old.example/"))))->lease.portalApi,
        "https://old.example/");
}

TEST(DhcpPacket, NamesAPortalWholeOrNotAtAll) {
    const Frame part = option(114, bytesOf(std::string(128, 'a')));
    Frame parts;
    for (int i = 0; i < 16; ++i) parts = parts + part;
    EXPECT_EQ(readDhcpPacket(packet(kGranted + parts))->lease.portalApi, std::string(2048, 'a'));
    EXPECT_EQ(readDhcpPacket(packet(kGranted + parts + option(114, bytesOf("a"))))->lease.portalApi, "");
}

TEST(DhcpPacket, ThatGrantsNothingIsNoLease) {
    EXPECT_FALSE(readDhcpPacket({}));
    EXPECT_FALSE(readDhcpPacket(packet({})));
    EXPECT_FALSE(readDhcpPacket(packet(option(53, {2}) + option(51, {0, 0, 0x0E, 0x10}))));
    EXPECT_FALSE(readDhcpPacket(packet(option(53, {5}))));
    EXPECT_FALSE(readDhcpPacket(packet(option(53, {5}) + option(51, {1, 2, 3}))));
    Frame other = packet(kGranted);
    other[236] = 0x62;
    EXPECT_FALSE(readDhcpPacket(other));
}

TEST(DhcpPacket, ThatBreaksOffIsReadAsFarAsItGoes) {
    const Frame whole = packet(kGranted + option(114, bytesOf("https://p.example/api")));
    for (std::size_t size = 0; size < whole.size(); ++size) readDhcpPacket(Bytes(whole).first(size));
    const auto cut = readDhcpPacket(Bytes(whole).first(whole.size() - 1));
    ASSERT_TRUE(cut);
    EXPECT_EQ(cut->lease.portalApi, "");
}

TEST(Dhcp6Message, GrantsAddressesAndNamesServersAndPortal) {
    const Frame reply = Frame{7, 1, 2, 3} + group6(1, 60) + group6(2, 90) + group6(3, 0) +
                        option6(23, address6(0x53)) + option6(103, bytesOf("https://p.example/api"));
    const auto read = readDhcp6Message(reply);
    ASSERT_TRUE(read);
    EXPECT_EQ(textsOf(read->lease.addresses), "2001:db8::1 2001:db8::2 ");
    EXPECT_EQ(read->seconds, 90U);
    EXPECT_EQ(textsOf(read->lease.servers), "2001:db8::53 ");
    EXPECT_EQ(read->lease.portalApi, "https://p.example/api");
    for (std::size_t size = 0; size < reply.size(); ++size) readDhcp6Message(Bytes(reply).first(size));
}

TEST(Dhcp6Message, WithoutAddressesIsNoLease) {
    EXPECT_FALSE(readDhcp6Message({}));
    EXPECT_FALSE(readDhcp6Message(Frame{7, 1, 2, 3} + option6(103, bytesOf("https://p.example/"))));
    EXPECT_FALSE(readDhcp6Message(Frame{2, 1, 2, 3} + group6(1, 60)));
    EXPECT_FALSE(readDhcp6Message(Frame{7, 1, 2, 3} + option6(3, Frame(11, 0))));
}

/// A folder that stands for the root of a system, with leases in it that came at a moment of the test's choice.
class DhcpcdLeasesOf : public ::testing::Test {
  protected:
    DhcpcdLeasesOf() { std::filesystem::create_directories(root_ + "/var/lib/dhcpcd"); }

    void write(const std::string& name, const Frame& content, std::int64_t at) const {
        const std::string path = root_ + "/var/lib/dhcpcd/" + name;
        std::ofstream(path, std::ios::binary)
            .write(reinterpret_cast<const char*>(content.data()),
                   static_cast<std::streamsize>(content.size()));
        const timespec times[2] = {{at, 0}, {at, 0}};
        EXPECT_EQ(0, ::utimensat(AT_FDCWD, path.c_str(), times, 0));
    }
    /// The portals of the leases of both families.
    std::string found(const char* interfaceName, std::int64_t now) const {
        const DhcpcdLeases leases = findDhcpcdLeases(
            interfaceName, {*IPAddress::fromText("192.168.1.20"), *IPAddress::fromText("2001:db8::1")}, now,
            root_);
        return (leases.ipv4 ? leases.ipv4->portalApi : "none") + std::string(" ") +
               (leases.ipv6 ? leases.ipv6->portalApi : "none");
    }

    fakes::TemporaryFolder folder_;
    const std::string& root_ = folder_.path();
};

Frame named(const char* portal) {
    return packet(kGranted + option(114, bytesOf(portal)));
}

TEST_F(DhcpcdLeasesOf, AnInterfaceAreThoseOfItsNetworks) {
    write("wlan0-Northlight.lease", named("n"), 1000);
    write("wlan0-Northlight.lease6", Frame{7, 0, 0, 0} + group6(1, 60) + option6(103, bytesOf("six")), 1000);
    write("wlan01.lease", named("other"), 2000);
    write("eth0.lease", named("wired"), 2000);
    EXPECT_EQ(found("wlan0", 1050), "n six");
    EXPECT_EQ(found("wlan0", 1060), "n none");
    EXPECT_EQ(found("wlan1", 1050), "none none");
    EXPECT_EQ(found("eth0", 2000), "wired none");
}

TEST_F(DhcpcdLeasesOf, SeveralNetworksCountTheLatestThatIsInForce) {
    write("wlan0-Old.lease", named("old"), 1000);
    write("wlan0-New.lease", named("new"), 2000);
    Frame elsewhere = named("elsewhere");
    elsewhere[16] = 10;
    write("wlan0-Elsewhere.lease", elsewhere, 3000);
    EXPECT_EQ(found("wlan0", 3000), "new none");
    EXPECT_EQ(found("wlan0", 2000 + 3600), "none none");
}

TEST_F(DhcpcdLeasesOf, ALeaseWithoutAnEndDoesNotEnd) {
    write("wlan0.lease",
          packet(option(53, {5}) + option(51, {255, 255, 255, 255}) + option(114, bytesOf("p"))), 1);
    EXPECT_EQ(found("wlan0", std::int64_t{1} << 40), "p none");
}

}  // namespace
}  // namespace wp
