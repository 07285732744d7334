#include "service/ip_address.h"

#include <gtest/gtest.h>

#include "verification/unit/service/addresses.h"

namespace wp {
namespace {

std::string written(std::string_view text) {
    const auto read = IPAddress::fromText(text);
    return read ? read->text() : "no address";
}

TEST(IPAddress, ReadsAndWritesBothFamiliesInTheirShortestForm) {
    EXPECT_EQ(written("192.0.2.7"), "192.0.2.7");
    EXPECT_EQ(written("2001:0db8:0000:0000:0000:0000:0000:0001"), "2001:db8::1");
    EXPECT_EQ(written("::"), "::");
    EXPECT_EQ(written("::1"), "::1");
    EXPECT_EQ(written("fe80::"), "fe80::");
    EXPECT_EQ(written("2001:db8:0:1:0:0:0:1"), "2001:db8:0:1::1");
    EXPECT_EQ(written("2001:db8:0:1:1:1:1:1"), "2001:db8:0:1:1:1:1:1");
    EXPECT_EQ(written("2001:0:0:1:0:0:1:1"), "2001::1:0:0:1:1");
}

TEST(IPAddress, DropsAZoneAndUnwrapsAMappedAddress) {
    EXPECT_EQ(written("fe80::1%wlan0"), "fe80::1");
    EXPECT_EQ(written("::ffff:192.0.2.7"), "192.0.2.7");
    EXPECT_TRUE(address("::ffff:10.0.0.1").isIPv4());
}

TEST(IPAddress, RefusesWhatIsNoAddress) {
    for (const char* text : {"", "1.2.3", "1.2.3.4.5", "1.2.3.256", "1.2.3.-4", "1.2.3.0x4", " 1.2.3.4",
                             "1..2.3", ":", ":::", "1:2:3:4:5:6:7", "1:2:3:4:5:6:7:8:9",
                             "12345::", "g::", "::1::2", "1:2:3:4:5:6:7::8:9", "192.0.2.1:80", "::1.2.3"})
        EXPECT_EQ(written(text), "no address") << text;
    EXPECT_FALSE(IPAddress::fromBytes(std::vector<std::uint8_t>(5)));
    EXPECT_FALSE(IPAddress::fromBytes({}));
}

TEST(IPAddress, TellsTheRangesApart) {
    EXPECT_TRUE(address("10.255.0.1").privateUse());
    EXPECT_TRUE(address("172.31.255.255").privateUse());
    EXPECT_FALSE(address("172.32.0.0").privateUse());
    EXPECT_TRUE(address("192.168.0.1").privateUse());
    EXPECT_FALSE(address("192.169.0.1").privateUse());
    EXPECT_TRUE(address("fd00::1").privateUse());
    EXPECT_TRUE(address("100.127.255.255").sharedUse());
    EXPECT_FALSE(address("100.128.0.0").sharedUse());
    EXPECT_TRUE(address("169.254.1.1").linkLocal());
    EXPECT_TRUE(address("febf::1").linkLocal());
    EXPECT_FALSE(address("fec0::1").linkLocal());
    EXPECT_TRUE(address("127.0.0.53").loopback());
    EXPECT_TRUE(address("::1").loopback());
    EXPECT_TRUE(address("239.255.255.250").multicast());
    EXPECT_TRUE(address("ff02::1").multicast());
    EXPECT_TRUE(address("0.0.0.0").unspecified());
    for (const char* text : {"9.9.9.9", "100.63.255.255", "2620:fe::9"})
        EXPECT_TRUE(address(text).global()) << text;
    for (const char* text : {"100.64.0.1", "10.0.0.1", "::", "fe80::1", "224.0.0.1"})
        EXPECT_FALSE(address(text).global()) << text;
}

TEST(IPAddress, ComparesPrefixesBitByBit) {
    EXPECT_TRUE(address("192.168.5.1").sharesPrefix(address("192.168.4.9"), 23));
    EXPECT_FALSE(address("192.168.6.1").sharesPrefix(address("192.168.4.9"), 23));
    EXPECT_TRUE(address("10.0.0.1").sharesPrefix(address("192.168.4.9"), 0));
    EXPECT_FALSE(address("10.0.0.1").sharesPrefix(address("10.0.0.1"), 33));
    EXPECT_FALSE(address("::").sharesPrefix(address("0.0.0.0"), 0));
}

}  // namespace
}  // namespace wp
