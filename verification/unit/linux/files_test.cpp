#include <gtest/gtest.h>

#include "linux/files/address_list.h"
#include "linux/files/dhcp_clients.h"
#include "linux/files/folder.h"
#include "linux/files/iwd_settings.h"
#include "linux/files/leases.h"
#include "linux/files/networkd.h"
#include "linux/files/octets.h"
#include "linux/files/proxy_settings.h"
#include "linux/files/user_folder.h"
#include "linux/utc_time.h"
#include "service/bytes.h"
#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/service/addresses.h"

namespace wp {
namespace {

/// A folder that stands for the root of a system, gone with the test.
class Root : public ::testing::Test {
  protected:
    void write(const std::string& path, const std::string& content) const { folder_.write(path, content); }

    fakes::TemporaryFolder folder_;
    const std::string& root_ = folder_.path();
};

/// A process of a program with arguments, as /proc shows it.
std::string commandOf(const std::vector<std::string>& words) {
    std::string command;
    for (const std::string& word : words) command += word + '\0';
    return command;
}

constexpr const char* kLeases = R"(default-duid "\000\001";
lease {
  interface "wlan0";
  fixed-address 192.168.1.20;
  option domain-name-servers 192.168.1.1, 192.168.1.2;
  expire 5 2026/11/20 18:30:00;
}
lease {
  interface "eth0";
  fixed-address 10.0.0.20;
  option domain-name-servers 10.0.0.1;
  expire never;
}
lease {
  interface "wlan0";
  fixed-address 192.168.1.21;
  option domain-name-servers 192.168.1.3;
  option vendor-encapsulated-options "EXAMPLE_METERED";
  option unknown-114 "https://p.example/api";
  expire 5 2026/11/20 19:30:00;
}
)";
constexpr std::int64_t kSixThirtyPm = 1'795'199'400;  // 2026-11-20 18:30:00 UTC

std::optional<Lease> lease4(const std::string& text, const char* interfaceName, const char* address,
                            std::int64_t now) {
    return readDhclientLeases(text, interfaceName, {*IPAddress::fromText(address)}, now);
}

TEST(Leases, TheLastLeaseOfTheInterfaceCounts) {
    const auto lease = lease4(kLeases, "wlan0", "192.168.1.21", kSixThirtyPm);
    ASSERT_TRUE(lease);
    EXPECT_EQ(textsOf(lease->servers), "192.168.1.3 ");
    EXPECT_EQ(lease->vendorText, "EXAMPLE_METERED");
    EXPECT_EQ(lease->portalApi, "https://p.example/api");
    EXPECT_EQ(textsOf(lease4(kLeases, "eth0", "10.0.0.20", kSixThirtyPm)->servers), "10.0.0.1 ");
    EXPECT_FALSE(lease4(kLeases, "wlan1", "192.168.1.21", kSixThirtyPm));
}

TEST(Leases, OneOfAnAddressThatTheInterfaceDoesNotHaveIsNone) {
    EXPECT_FALSE(lease4(kLeases, "wlan0", "192.168.1.22", kSixThirtyPm));
    EXPECT_FALSE(lease4(kLeases, "wlan0", "192.168.1.20", 0)) << "another was granted since";
    EXPECT_FALSE(readDhclientLeases(kLeases, "wlan0", {}, kSixThirtyPm));
    EXPECT_FALSE(lease4("lease {\ninterface \"w\";\nexpire never;\n}\n", "w", "0.0.0.0", 0));
}

TEST(Leases, OneThatHasEndedIsNone) {
    const auto ending = [](const std::string& expiry, std::int64_t now) {
        const std::string head = "lease {\ninterface \"w\";\nfixed-address 10.0.0.2;\nexpire ";
        return lease4(head + expiry + ";\n}\n", "w", "10.0.0.2", now).has_value();
    };
    EXPECT_TRUE(ending("5 2026/11/20 19:30:00", kSixThirtyPm + 3599));
    EXPECT_FALSE(ending("5 2026/11/20 19:30:00", kSixThirtyPm + 3600));
    EXPECT_TRUE(ending("never", std::int64_t{1} << 40));
    EXPECT_TRUE(ending("epoch 102; # old", 101));
    EXPECT_FALSE(ending("epoch 100; # old", 101));
    EXPECT_FALSE(ending("5 2026/13/40 1:2:3", 0));
    EXPECT_FALSE(ending("5 2026/11/20 999999998:0:0", 0));
    EXPECT_FALSE(ending("5 2026/11/20 -1:0:0", 0));
}

TEST(Leases, CutAndBrokenFilesAreReadAsFarAsTheyGo) {
    const std::string whole = kLeases;
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_EQ(lease4(whole.substr(0, size), "wlan0", "192.168.1.21", 0).has_value(),
                  size + 1 >= whole.size())
            << size;
    EXPECT_FALSE(lease4("}\n}\nlease {\nlease {\n", "wlan0", "10.0.0.2", 0));
}

/// As dhclient 4.4 writes it.
constexpr const char* kLeases6 = R"(default-duid "\000\001\000\0012\225\206 \276\342\311\230\276\211";
lease6 {
  interface "wlan0";
  ia-na c9:98:be:89 {
    starts 1795199400;
    renew 1800;
    rebind 3150;
    iaaddr 2001:db8::6 {
      starts 1795199400;
      preferred-life 3600;
      max-life 7200;
    }
    iaaddr 2001:db8::7 {
      starts 1795199400;
      preferred-life 1800;
      max-life 3600;
    }
  }
  ia-pd c9:98:be:89 {
    starts 1795199400;
    iaprefix 2001:db8:9::/56 {
      starts 1795199400;
      preferred-life 86400;
      max-life 86400;
    }
  }
  option dhcp6.client-id 0:1:0:1:32:95:86:20:be:e2:c9:98:be:89;
  option dhcp6.name-servers 2001:db8::53,2001:db8::54;
  option dhcp6.v6-captive-portal "https://p.example/six";
  option dhcp6.status-code success "success";
}
lease6 {
  interface "eth0";
  ia-na 1:2:3:4 {
    iaaddr 2001:db8:1::7 {
      starts 1795199400;
      max-life 4294967295;
    }
  }
  option dhcp6.name-servers fe80::1;
}
lease6 {
  interface "wlan1";
  option dhcp6.name-servers 2001:db8::55;
}
)";

std::optional<Lease> lease6(const char* interfaceName, const char* address, std::int64_t now,
                            const std::string& text = kLeases6) {
    return readDhclient6Leases(text, interfaceName, {*IPAddress::fromText(address)}, now);
}

TEST(Leases6, NameServersAndPortalOfTheAddressThatTheInterfaceHas) {
    const auto lease = lease6("wlan0", "2001:db8::7", kSixThirtyPm + 3599);
    ASSERT_TRUE(lease);
    EXPECT_EQ(textsOf(lease->servers), "2001:db8::53 2001:db8::54 ");
    EXPECT_EQ(lease->portalApi, "https://p.example/six");
    EXPECT_EQ(textsOf(lease->addresses), "2001:db8::7 ") << "of two the one that the interface has";
    EXPECT_EQ(textsOf(lease6("eth0", "2001:db8:1::7", std::int64_t{1} << 40)->servers), "fe80::1 ");
}

std::string replaced(std::string text, const std::string& old, const std::string& with) {
    return text.replace(text.find(old), old.size(), with);
}

TEST(UnixTime, IsOfMomentsThatTheCalendarHas) {
    EXPECT_EQ(unixTime({2026, 11, 20, 18, 30, 0}), 1795199400);
    EXPECT_EQ(unixTime({1970, 1, 1, 0, 0, 0}), 0);
    EXPECT_EQ(unixTime({2016, 12, 31, 23, 59, 60}), 1483228800) << "a leap second";
    EXPECT_EQ(unixTime({2026, 2, 29, 0, 0, 0}), std::nullopt);
    EXPECT_EQ(unixTime({2026, 1, 1, 24, 0, 0}), std::nullopt);
    EXPECT_EQ(unixTime({2026, 1, 1, 0, -1, 0}), std::nullopt);
    EXPECT_EQ(unixTime({10000, 1, 1, 0, 0, 0}), std::nullopt);
}

TEST(Leases, APortalsAddressIsReadWholeOrNotAtAll) {
    const std::string start = "https://p.example/", longest = start + std::string(2048 - start.size(), 'a');
    for (const std::string& each : {longest, longest + "a"}) {
        const std::string expected = each.size() > 2048 ? "" : each;
        const auto lease =
            lease4(replaced(kLeases, "https://p.example/api", each), "wlan0", "192.168.1.21", kSixThirtyPm);
        ASSERT_TRUE(lease);
        EXPECT_EQ(lease->portalApi, expected);
        const auto six =
            lease6("wlan0", "2001:db8::7", kSixThirtyPm, replaced(kLeases6, "https://p.example/six", each));
        ASSERT_TRUE(six);
        EXPECT_EQ(six->portalApi, expected);
    }
}

TEST(Leases6, OneThatHasEndedOrIsOfAnotherNetworkIsNone) {
    EXPECT_FALSE(lease6("wlan0", "2001:db8::7", kSixThirtyPm + 3600));
    EXPECT_TRUE(lease6("wlan0", "2001:db8::6", kSixThirtyPm + 3600)) << "each address has its own time";
    EXPECT_FALSE(lease6("wlan0", "2001:db8:9::", kSixThirtyPm)) << "a prefix is no address of the interface";
    EXPECT_FALSE(lease6("wlan0", "2001:db8::8", kSixThirtyPm));
    EXPECT_FALSE(lease6("eth0", "2001:db8::7", kSixThirtyPm));
    EXPECT_FALSE(lease6("wlan1", "2001:db8::7", kSixThirtyPm)) << "it grants nothing";
}

TEST(Leases6, TheLastLeaseOfTheInterfaceCounts) {
    const std::string whole = kLeases6;
    std::string later =
        whole.substr(whole.find("lease6"), whole.find("lease6 {", 100) - whole.find("lease6"));
    later.replace(later.find("2001:db8::53"), 12, "2001:db8::99");
    EXPECT_EQ(textsOf(lease6("wlan0", "2001:db8::7", kSixThirtyPm, whole + later)->servers),
              "2001:db8::99 2001:db8::54 ");
    later.replace(later.find("iaaddr 2001:db8::7"), 18, "iaaddr 2001:db8::8");
    EXPECT_FALSE(lease6("wlan0", "2001:db8::7", kSixThirtyPm, whole + later));
}

TEST(Leases6, CutAndBrokenFilesAreReadAsFarAsTheyGo) {
    const std::string whole = kLeases6;
    const std::size_t end = whole.find("\n}\n") + 2;
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_EQ(lease6("wlan0", "2001:db8::7", kSixThirtyPm, whole.substr(0, size)).has_value(),
                  size >= end)
            << size;
    EXPECT_FALSE(lease6("w", "::1", 0, "}\nlease6 {\nstarts 1;\n{\n{\n{\nstarts 1;\n}\n}\n}\n}\n"));
    EXPECT_FALSE(lease6("w", "::1", 0,
                        "lease6 {\ninterface \"w\";\nia-na {\niaaddr ::1 {\n"
                        "starts -9223372036854775808;\nmax-life 99999999999;\n}\n}\n}\n"));
}

TEST_F(Root, OfASystemWithDhclientHasItsLeasesOfDhcp6) {
    const std::vector<IPAddress> assigned{*IPAddress::fromText("2001:db8::7")};
    EXPECT_FALSE(findLease6("wlan0", assigned, kSixThirtyPm, root_));
    write("/var/lib/dhclient/dhclient6-wlan0.leases", kLeases6);
    EXPECT_TRUE(findLease6("wlan0", assigned, kSixThirtyPm, root_));
    EXPECT_FALSE(findLease6("wlan0", assigned, kSixThirtyPm + 3600, root_));
    std::filesystem::remove_all(root_ + "/var/lib/dhclient");
    write("/var/lib/dhcp/dhclient6.leases", kLeases6);
    EXPECT_TRUE(findLease6("wlan0", assigned, kSixThirtyPm, root_));
}

TEST(ResolverFile, NamesItsServers) {
    EXPECT_EQ(textsOf(serversFromResolverFile(
                  "# x\nnameserver 192.168.1.1\nsearch a\n\tnameserver\t2001:db8::1%wlan0\n"
                  "nameserver bogus\nnameserver\n")),
              "192.168.1.1 2001:db8::1 ");
}

UnitFile unit(const std::string& text) {
    UnitFile settings;
    readUnitFile(text, settings);
    return settings;
}

std::string methodsOf(const std::string& text) {
    const AddressMethods methods = methodsFromNetworkd(unit(text));
    return *methods.ipv4 + " " + *methods.ipv6;
}

TEST(Networkd, SettingsBecomeMethods) {
    EXPECT_EQ(methodsOf("[Network]\nDHCP=yes\n"), "auto auto");
    EXPECT_EQ(methodsOf("[Network]\nDHCP=ipv4\nIPv6AcceptRA=no\n"), "auto link-local");
    EXPECT_EQ(methodsOf("[Network]\nAddress=192.168.1.5/24\nAddress=2001:db8::5/64\n"), "manual manual");
    EXPECT_EQ(methodsOf("[Network]\nDHCP=ipv6\n[Address]\nAddress=192.168.1.5/24\n"), "manual auto");
    EXPECT_EQ(methodsOf("[Network]\nLinkLocalAddressing=no\n"), "disabled disabled");
    EXPECT_EQ(methodsOf("[Network]\nLinkLocalAddressing=yes\nIPv6AcceptRA=false\n"), "link-local link-local");
    EXPECT_EQ(methodsOf("[Network]\nAddress=192.168.1.5/24\nAddress=\nDHCP=yes\n"), "auto auto");
}

TEST_F(Root, OfASystemWithNetworkdTellsMethodsServersAndLease) {
    write("/run/systemd/netif/links/3",
          "ADMIN_STATE=configured\nNETWORK_FILE=/etc/systemd/network/wlan0.network\n");
    write("/etc/systemd/network/wlan0.network", "[Match]\nName=wlan0\n[Network]\nDHCP=ipv4\n");
    write("/etc/systemd/network/wlan0.network.d/dns.conf", "[Network]\nDNS=9.9.9.9#dns.example 2620:fe::9\n");
    write("/run/systemd/netif/leases/3",
          "ADDRESS=192.168.1.20\nDNS=192.168.1.1\nCAPTIVE_PORTAL=https://p.example/\n");

    const auto link = readNetworkdLink(3, root_);

    ASSERT_TRUE(link);
    EXPECT_EQ(*link->methods.ipv4, "auto");
    EXPECT_EQ(textsOf(link->manualServers), "9.9.9.9 2620:fe::9 ");
    EXPECT_EQ(textsOf(link->offeredServers), "192.168.1.1 ");
    EXPECT_TRUE(link->hasLease);
    EXPECT_EQ(link->portalApi, "https://p.example/");
    EXPECT_FALSE(readNetworkdLink(4, root_));
}

TEST_F(Root, OfASystemWithNetworkdHasSettingsThatAddToAFile) {
    write("/run/systemd/netif/links/3", "NETWORK_FILE=/run/systemd/network/wlan0.network\n");
    write("/run/systemd/network/wlan0.network", "[Network]\nDHCP=yes\nDNS=9.9.9.9\n");
    write("/run/systemd/network/wlan0.network.d/b.conf", "[Network]\nDNS=10.9.9.9\n");
    write("/usr/lib/systemd/network/wlan0.network.d/a.conf", "[Network]\nDNS=\nDNS=1.1.1.1\n");
    write("/etc/systemd/network/wlan0.network.d/b.conf",
          "[Network]\nDNS=8.8.8.8:5353%wlan0#dns.example \\\n; no comment goes on \\\n  [2620:fe::9]:53 \\\n"
          "# nor parts a line\n 2620:fe::10#x\nDHCP=\\\nNO");
    write("/etc/systemd/network/wlan0.network.d/b.dpkg-old", "[Network]\nDNS=10.9.9.8\n");
    const auto link = readNetworkdLink(3, root_);
    ASSERT_TRUE(link);
    EXPECT_EQ(textsOf(link->manualServers), "1.1.1.1 8.8.8.8 2620:fe::9 2620:fe::10 ");
    EXPECT_EQ(*link->methods.ipv4, "disabled");
}

TEST_F(Root, OfASystemWithNetworkdTellsWhatWasAdvertisedAndTheVendorsText) {
    write("/run/systemd/netif/links/3",
          "NETWORK_FILE=/etc/systemd/network/wlan0.network\nDNS=9.9.9.9 10.9.9.9 192.168.1.1 2001:db8::53#x "
          "fe80::1%3\n");
    write("/etc/systemd/network/wlan0.network", "[Network]\nDHCP=TRUE\nDNS=9.9.9.9\n");
    write("/run/systemd/netif/leases/3",
          "ADDRESS=192.168.1.20\nDNS=192.168.1.1\n"
          "VENDOR_SPECIFIC=4558414d504c455f4d45544552454400\n");
    const auto link = readNetworkdLink(3, root_);
    ASSERT_TRUE(link);
    EXPECT_EQ(*link->methods.ipv4, "auto");
    EXPECT_EQ(textsOf(link->offeredServers), "192.168.1.1 2001:db8::53 fe80::1 ");
    EXPECT_TRUE(link->advertisementsKnown);
    EXPECT_EQ(link->vendorText, "EXAMPLE_METERED");
}

TEST_F(Root, OfASystemWithNetworkdTellsThePortalOfAnAdvertisementToo) {
    write("/run/systemd/netif/links/3",
          "NETWORK_FILE=/etc/systemd/network/wlan0.network\nCAPTIVE_PORTAL=https://p.example/six\n");
    write("/etc/systemd/network/wlan0.network", "[Network]\nDHCP=no\n");
    ASSERT_TRUE(readNetworkdLink(3, root_));
    EXPECT_EQ(readNetworkdLink(3, root_)->portalApi, "https://p.example/six");
}

TEST_F(Root, WithoutANetworkFileIsNotManagedByNetworkd) {
    write("/run/systemd/netif/links/3", "ADMIN_STATE=unmanaged\n");
    EXPECT_FALSE(readNetworkdLink(3, root_));
    write("/run/systemd/netif/links/3",
          "ADMIN_STATE=unmanaged\nNETWORK_FILE=/etc/systemd/network/a.network\n");
    EXPECT_FALSE(readNetworkdLink(3, root_));
}

TEST_F(Root, OfASystemWhereNetworkdWasKilledIsNotManagedByIt) {
    write("/run/systemd/netif/links/3",
          "ADMIN_STATE=configured\nNETWORK_FILE=/etc/systemd/network/a.network\n");
    EXPECT_TRUE(readNetworkdLink(3, root_)) << "others' processes are hidden";
    write("/proc/1/cmdline", commandOf({"/sbin/init"}));
    EXPECT_FALSE(readNetworkdLink(3, root_));
    write("/proc/240/cmdline", commandOf({"/lib/systemd/systemd-networkd"}));
    EXPECT_TRUE(readNetworkdLink(3, root_));
}

TEST_F(Root, OfASystemWithIwdSaysWhetherThatSetsAddresses) {
    EXPECT_FALSE(iwdMaySetAddresses(root_));
    write("/etc/iwd/main.conf", "# [General]\n#EnableNetworkConfiguration=true\n[General]\n");
    EXPECT_FALSE(iwdMaySetAddresses(root_));
    write("/etc/iwd/main.conf", "[General]\nEnableNetworkConfiguration=true\n");
    EXPECT_TRUE(iwdMaySetAddresses(root_));
    write("/etc/iwd/main.conf", "[General]\nenable_network_config = false\n");
    EXPECT_FALSE(iwdMaySetAddresses(root_));
    write("/etc/iwd/main.conf", std::string(300'000, '#'));
    EXPECT_TRUE(iwdMaySetAddresses(root_)) << "it cannot be read";
}

TEST_F(Root, KeepsALeaseWhereItsClientPutsIt) {
    const std::vector<IPAddress> assigned{*IPAddress::fromText("192.168.1.21")};
    write("/var/lib/dhcp/dhclient.wlan0.leases", kLeases);
    EXPECT_TRUE(findLease("wlan0", assigned, kSixThirtyPm, root_));
    EXPECT_FALSE(findLease("wlan0", assigned, kSixThirtyPm + 3600, root_));
    EXPECT_FALSE(findLease("wlan0", {}, kSixThirtyPm, root_));
}

/// A root where ConnMan, should it run, cannot be asked about its interfaces.
class DhcpClientsIn : public Root {
  protected:
    DhcpClients clientsOf(const char* interfaceName) const {
        return dhcpClientsOf(interfaceName, Connman::silent, root_);
    }
};

TEST_F(DhcpClientsIn, ASystemLookAfterTheInterfacesThatTheyName) {
    EXPECT_FALSE(clientsOf("wlan0").any);
    write("/proc/1/cmdline", commandOf({"/sbin/init"}));
    write("/proc/12/cmdline", commandOf({"/bin/busybox", "udhcpc", "-i", "wlan0", "-n"}));
    write("/proc/13/cmdline", commandOf({"/sbin/dhclient", "-iwlan2"}));
    write("/proc/14/cmdline", "");
    write("/proc/self/cmdline", commandOf({"dhclient", "eth0"}));
    EXPECT_TRUE(clientsOf("wlan0").any);
    EXPECT_TRUE(clientsOf("wlan2").any);
    EXPECT_FALSE(clientsOf("wlan").any);
    EXPECT_FALSE(clientsOf("eth0").any);
}

TEST_F(DhcpClientsIn, ASystemLookAfterAllInterfacesWhereTheyNameNone) {
    write("/proc/12/cmdline", commandOf({"dhcpcd", "eth0", "-q"}));
    EXPECT_FALSE(clientsOf("wlan0").any);
    write("/proc/13/cmdline", commandOf({"/usr/sbin/dhcpcd", "-q", "-f", "/etc/dhcpcd.conf"}));
    EXPECT_TRUE(clientsOf("wlan0").any);
    write("/proc/13/cmdline", commandOf({"/usr/sbin/connmand", "-n", "-r"}));
    EXPECT_TRUE(clientsOf("wlan0").any);
    write("/proc/13/cmdline", commandOf({"grep", "connmand.conf"}));
    EXPECT_FALSE(clientsOf("wlan0").any);
}

TEST_F(DhcpClientsIn, ASystemDoNotAskForIPv4WhereTheyAreOfIPv6) {
    const auto asksForIPv4 = [&](const std::string& command) {
        write("/proc/12/cmdline", command);
        const DhcpClients clients = clientsOf("wlan0");
        EXPECT_TRUE(clients.any);
        EXPECT_FALSE(clients.ipv4 && clients.leavesLease);
        return clients.ipv4 || clients.leavesLease;
    };
    EXPECT_TRUE(asksForIPv4(commandOf({"/sbin/dhclient", "-4", "wlan0"})));
    EXPECT_FALSE(asksForIPv4(commandOf({"/sbin/dhclient", "-6", "-S", "wlan0"})));
    EXPECT_TRUE(asksForIPv4(commandOf({"/bin/busybox", "udhcpc", "-i", "wlan0"})));
    EXPECT_FALSE(asksForIPv4(commandOf({"/bin/busybox", "udhcpc6", "-i", "wlan0"})));
    EXPECT_TRUE(asksForIPv4("dhcpcd: wlan0 [ip4] [ip6]"));
    EXPECT_FALSE(asksForIPv4("dhcpcd: wlan0 [ip6]"));
}

TEST_F(DhcpClientsIn, ASystemMayShowATitleInPlaceOfTheirCommandLine) {
    write("/proc/13/cmdline", std::string("dhcpcd: wlan0 [ip4] [ip6]") + std::string(8, '\0'));
    EXPECT_TRUE(clientsOf("wlan0").any);
    EXPECT_FALSE(clientsOf("wlan1").any);
    write("/proc/13/cmdline", "dhcpcd: [manager] [ip4] [ip6]");
    EXPECT_TRUE(clientsOf("wlan1").any);
}

TEST_F(DhcpClientsIn, ASystemAreNoneOfAnInterfaceThatConnmanSaysIsNotItsOwn) {
    write("/proc/13/cmdline", commandOf({"/usr/sbin/connmand", "-n", "-i", "wlan0"}));
    EXPECT_TRUE(clientsOf("wlan0").any);
    EXPECT_FALSE(dhcpClientsOf("wlan0", Connman::answers, root_).any);
}

TEST_F(DhcpClientsIn, ASystemPassOverInterfacesByTheirSettings) {
    write("/proc/13/cmdline", "dhcpcd: [manager] [ip4] [ip6]");
    EXPECT_TRUE(clientsOf("wlan0").dhcpcd);
    write("/etc/dhcpcd.conf", "denyinterfaces eth*,wlan? # not these\n");
    EXPECT_FALSE(clientsOf("wlan0").any);
    EXPECT_TRUE(clientsOf("wlan10").any);
    write("/etc/dhcpcd.conf", "#denyinterfaces wlan0\nallowinterfaces eth0\nallowinterfaces wlan0\n");
    EXPECT_TRUE(clientsOf("wlan0").any);
    EXPECT_FALSE(clientsOf("wlan1").any);
    write("/proc/13/cmdline", "dhcpcd: wlan1 [ip4]");
    EXPECT_TRUE(clientsOf("wlan1").any) << "it was told to on the command line";
}

TEST_F(DhcpClientsIn, ASystemMayLookAtAdvertisementsThemselves) {
    write("/proc/12/cmdline", commandOf({"udhcpc", "-i", "wlan0"}));
    EXPECT_FALSE(clientsOf("wlan0").asksRouters);
    write("/proc/13/cmdline", commandOf({"/usr/sbin/dhcpcd", "wlan0"}));
    EXPECT_TRUE(clientsOf("wlan0").asksRouters);
    EXPECT_FALSE(clientsOf("wlan1").asksRouters);
}

TEST(AddressList, HasNameServersAsResolversWriteThem) {
    const auto read = [](const char* text) {
        const auto server = serverFrom(text);
        return server ? server->text() : "none";
    };
    EXPECT_EQ(read("9.9.9.9"), "9.9.9.9");
    EXPECT_EQ(read("9.9.9.9:53"), "9.9.9.9");
    EXPECT_EQ(read("9.9.9.9%wlan0#dns.example"), "9.9.9.9");
    EXPECT_EQ(read("2620:fe::9#dns.example"), "2620:fe::9");
    EXPECT_EQ(read("fe80::1%wlan0"), "fe80::1");
    EXPECT_EQ(read("[2620:fe::9]:853%wlan0"), "2620:fe::9");
    EXPECT_EQ(read("dns+tls://9.9.9.9:853#dns.example"), "9.9.9.9");
    EXPECT_EQ(read("dns+udp://[fe80::1%25wlan0]:53"), "fe80::1");
    for (const char* none : {"", "#", "[", "[]", "::::", "://", "dns.example:53", "[2620:fe::9", ":53"})
        EXPECT_EQ(read(none), std::string_view(none) == "[2620:fe::9" ? "2620:fe::9" : "none") << none;
}

TEST(Octets, StandInHexadecimalOneAfterAnotherOrByThemselves) {
    EXPECT_EQ(octetsFrom("4558").value_or("none"), "EX");
    EXPECT_EQ(octetsFrom("45:58:a").value_or("none"), "EX\n");
    EXPECT_EQ(octetsFrom("").value_or("none"), "");
    for (const char* none : {"455", "45:", ":45", "45::58", "4g", "0x45", "+4", "045:58", "45 58"})
        EXPECT_FALSE(octetsFrom(none)) << none;
}

TEST(Leases, TextsMayHaveBytesThatAreNone) {
    const auto vendorText = [](const std::string& value) {
        return lease4(
                   "lease {\ninterface \"w\";\nfixed-address 10.0.0.2;\noption vendor-encapsulated-options " +
                       value + ";\nexpire never;\n}\n",
                   "w", "10.0.0.2", 0)
            ->vendorText;
    };
    EXPECT_EQ(vendorText("45:58:41:0:4d:a"), "EXAM");
    EXPECT_EQ(vendorText("\"a\\\"b\\\\c\\303\\277\""), "a\"b\\c\xC3\xBF");
    EXPECT_EQ(vendorText("\"a\\477\\\""), "a477\\");
    EXPECT_EQ(vendorText("\""), "\"");
}

TEST_F(Root, FoldersAreReadInTheOrderOfTheirNamesAsFarAsIsAllowed) {
    for (const char* name : {"b", "a", "c"}) write(std::string("/folder/") + name, "");
    EXPECT_EQ(namesIn(root_ + "/folder"), (std::vector<std::string>{"a", "b", "c"}));
    EXPECT_EQ(namesIn(root_ + "/folder", 2).size(), 2U);
    EXPECT_TRUE(namesIn(root_ + "/none").empty());
}

TEST(AddressList, IsPartedAtBlanksAndCommasAndHoldsNothingButAddresses) {
    EXPECT_EQ(textsOf(addressesIn("10.0.0.1, 10.0.0.2,,\t2001:db8::7/64 fe80::1%wlan0\n")),
              "10.0.0.1 10.0.0.2 2001:db8::7 fe80::1 ");
    EXPECT_EQ(textsOf(addressesIn("auto 10.0.0 10.0.0.256 10.0.0.1;10.0.0.2 / , 10.0.0.3/")), "10.0.0.3 ");
    EXPECT_TRUE(addressesIn("").empty());
    EXPECT_TRUE(addressesIn(" ,").empty());
}

TEST_F(Root, FilesThatAreTooLongOrNoFilesAreNotRead) {
    write("/long", std::string(11, 'x'));
    EXPECT_FALSE(readSmallFile(root_ + "/long", 10));
    EXPECT_EQ(readSmallFile(root_ + "/long", 11), std::string(11, 'x'));
    EXPECT_FALSE(readSmallFile(root_));
    EXPECT_FALSE(readSmallFile("/dev/zero"));
}

TEST(SmallFile, IsReadWholeWhereItTellsNoSize) {
    // A program under a sanitizer has thousands of them.
    const auto mappings = readSmallFile("/proc/self/smaps", 64U << 20);
    ASSERT_TRUE(mappings);
    EXPECT_GT(mappings->size(), 2 * 4096U);
    EXPECT_EQ(mappings->back(), '\n');
    EXPECT_FALSE(readSmallFile("/proc/self/smaps", 4096));
}

const char* noVariable(const char*) {
    return nullptr;
}

TEST_F(Root, ProxiesAreFoundInEnvironmentAndFile) {
    write("/etc/environment",
          "PATH=/bin\n#http_proxy=http://old/\nexport https_proxy=\"http://p:3128\"\nno_proxy=x\n");
    const auto variable = [](const char* name) {
        if (std::string_view(name) == "ALL_PROXY") return "socks5://p";
        return std::string_view(name) == "http_proxy" ? "" : static_cast<const char*>(nullptr);
    };
    EXPECT_EQ(findProxies(variable, root_),
              (std::vector<std::string>{"environment: ALL_PROXY", "/etc/environment: https_proxy"}));
    EXPECT_EQ(findProxies(noVariable, root_ + "/none"), std::vector<std::string>());
}

void put32(std::string& into, std::uint32_t number) {
    for (int shift = 0; shift < 32; shift += 8) into += static_cast<char>(number >> shift);
}

/// A settings database with one key that is chained to a parent.
std::string settingsDatabase(const std::string& mode) {
    const std::string parent = "/org/gnome/system/", child = "proxy/mode";
    const std::string value = mode + std::string("\0\0s", 3);
    const std::uint32_t table = 24 + 8 + 4 + 2 * 24;
    std::string bytes = "GVariant";
    put32(bytes, 0);
    put32(bytes, 0);
    put32(bytes, 24);
    put32(bytes, table);
    put32(bytes, 0);
    put32(bytes, 1);
    put32(bytes, 0);
    const auto item = [&](std::uint32_t parentIndex, std::uint32_t key, std::size_t size, char type,
                          std::uint32_t start, std::uint32_t end) {
        put32(bytes, 0);
        put32(bytes, parentIndex);
        put32(bytes, key);
        bytes += static_cast<char>(size);
        bytes += '\0';
        bytes += type;
        bytes += '\0';
        put32(bytes, start);
        put32(bytes, end);
    };
    const auto parentAt = table, childAt = parentAt + static_cast<std::uint32_t>(parent.size());
    const auto valueAt = childAt + static_cast<std::uint32_t>(child.size());
    item(0xFFFFFFFF, parentAt, parent.size(), 'L', 0, 0);
    item(0, childAt, child.size(), 'v', valueAt, valueAt + static_cast<std::uint32_t>(value.size()));
    return bytes + parent + child + value;
}

TEST(SettingsDatabase, TellsTheProxyMode) {
    EXPECT_EQ(proxyModeInSettingsDatabase(settingsDatabase("manual")), "manual");
    EXPECT_EQ(proxyModeInSettingsDatabase(settingsDatabase("none")), "none");
}

TEST(SettingsDatabase, CutOrTwistedTellsNothingAndReadsNothingBeyond) {
    const std::string whole = settingsDatabase("manual");
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_EQ(proxyModeInSettingsDatabase(whole.substr(0, size)), "") << size;
    for (std::size_t at = 0; at < whole.size(); ++at) {
        std::string twisted = whole;
        twisted[at] = static_cast<char>(~twisted[at]);
        proxyModeInSettingsDatabase(twisted);
    }
    std::string circle = whole;
    circle[36 + 4] = 0;  // the parent of the parent is itself
    circle[36 + 5] = circle[36 + 6] = circle[36 + 7] = 0;
    EXPECT_EQ(proxyModeInSettingsDatabase(circle), "");
}

TEST_F(Root, ADesktopsProxyCountsUnlessItIsNone) {
    const auto variable = [](const char* name) {
        return std::string_view(name) == "HOME" ? "/home/u" : nullptr;
    };
    write("/home/u/.config/dconf/user", settingsDatabase("auto"));
    EXPECT_EQ(findProxies(variable, root_), (std::vector<std::string>{"desktop settings: auto"}));
    write("/home/u/.config/dconf/user", settingsDatabase("none"));
    EXPECT_EQ(findProxies(variable, root_), std::vector<std::string>());
}

TEST_F(Root, AUsersFolderThatIsEmptyOrRelativeCountsAsNone) {
    const auto folder = [](const char* configured, const char* home) {
        return userConfigFolder(
            [=](const char* name) { return std::string_view(name) == "HOME" ? home : configured; });
    };
    EXPECT_EQ(folder("/x", "/home/u"), "/x");
    EXPECT_EQ(folder("", "/home/u"), "/home/u/.config");
    EXPECT_EQ(folder("here", "/home/u"), "/home/u/.config");
    EXPECT_EQ(folder(nullptr, "/home/u"), "/home/u/.config");
    EXPECT_EQ(folder(nullptr, ""), "");
    EXPECT_EQ(folder(nullptr, nullptr), "");

    const auto variable = [](const char* name) { return std::string_view(name) == "HOME" ? "/home/u" : ""; };
    write("/home/u/.config/dconf/user", settingsDatabase("manual"));
    EXPECT_EQ(findProxies(variable, root_), (std::vector<std::string>{"desktop settings: manual"}));
}

}  // namespace
}  // namespace wp
