#include <gtest/gtest.h>

#include "linux/files/dhcpcd_settings.h"
#include "linux/files/dnsmasq.h"
#include "linux/files/resolver_records.h"
#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/service/addresses.h"

namespace wp {
namespace {

/// A folder that stands for the root of a system whose resolver is dnsmasq.
class DnsmasqOf : public ::testing::Test {
  protected:
    void write(const std::string& path, const std::string& content) const { folder_.write(path, content); }
    /// A process with this command line.
    void runs(int process, const std::vector<std::string>& words) const {
        std::string command;
        for (const std::string& word : words) command += word + '\0';
        write("/proc/" + std::to_string(process) + "/cmdline", command);
    }
    /// "asked | entered"
    std::string found() const {
        const auto servers = dnsmasqServers(folder_.path());
        return servers ? textsOf(servers->asked) + "| " + textsOf(servers->entered) : "nothing";
    }

    fakes::TemporaryFolder folder_;
};

TEST_F(DnsmasqOf, ADeviceAsksWhomTheResolversFileNamesBesideItself) {
    write("/etc/resolv.conf", "nameserver 127.0.0.1\nnameserver 192.168.1.1\n");
    EXPECT_EQ(found(), "nothing") << "nobody answers there";
    runs(12, {"/usr/sbin/dnsmasq"});
    EXPECT_EQ(found(), "192.168.1.1 | ");
    runs(13, {"/usr/sbin/dnsmasq"});
    EXPECT_EQ(found(), "192.168.1.1 | ") << "a helper of the same";
    write("/etc/dnsmasq.conf",
          "# resolv-file=/none\nresolv-file = /run/dnsmasq/resolv.conf # resolvconf's\n");
    EXPECT_EQ(found(), "nothing") << "the file is not there";
    write("/run/dnsmasq/resolv.conf", "nameserver 192.168.1.2\nnameserver 2001:db8::53\n");
    EXPECT_EQ(found(), "192.168.1.2 2001:db8::53 | ");
}

TEST_F(DnsmasqOf, ADeviceAsksWhomItsSettingsName) {
    write("/etc/resolv.conf", "nameserver 127.0.0.1\n");
    write("/etc/dnsmasq.conf",
          "no-resolv\nserver=9.9.9.9#53\nserver=/home.example/10.0.0.1\nserver=2620:fe::9\n"
          "server=/#/149.112.112.112\nserver=\nconf-dir=/etc/dnsmasq.d/,*.conf\n");
    write("/etc/dnsmasq.d/more.conf", "server=1.1.1.1\nconf-file=/etc/dnsmasq.conf\n");
    write("/etc/dnsmasq.d/README", "server=10.9.9.9\n");
    runs(12, {"dnsmasq", "-k"});
    const std::string all = "9.9.9.9 2620:fe::9 149.112.112.112 1.1.1.1 ";
    EXPECT_EQ(found(), all + "| " + all);
}

TEST_F(DnsmasqOf, ADeviceAloneAsksAServerAtAnotherPortOrOverOneInterface) {
    write("/etc/dnsmasq.conf", "no-resolv\nserver=10.8.0.1@tun0\nserver=192.168.1.2#5335\n");
    runs(12, {"dnsmasq"});
    EXPECT_EQ(found(), "| 10.8.0.1 192.168.1.2 ");
    runs(12, {"dnsmasq", "-S", "1.1.1.1", "-C", "/etc/dnsmasq.conf"});
    EXPECT_EQ(found(), "1.1.1.1 | 1.1.1.1 10.8.0.1 192.168.1.2 ");
}

TEST_F(DnsmasqOf, ADeviceIsToldByItsCommandLineToo) {
    write("/etc/dnsmasq.conf", "server=10.9.9.9\n");
    write("/run/dnsmasq/resolv.conf", "nameserver 192.168.1.2\n");
    write("/etc/dnsmasq.d/a", "server=1.1.1.1\n");
    write("/etc/dnsmasq.d/a.dpkg-old", "server=10.9.9.9\n");
    runs(12, {"/usr/sbin/dnsmasq", "-x", "/run/dnsmasq/dnsmasq.pid", "-u", "dnsmasq", "-r",
              "/run/dnsmasq/resolv.conf", "-7", "/etc/dnsmasq.d,.dpkg-dist,.dpkg-old", "--local-service"});
    EXPECT_EQ(found(), "10.9.9.9 1.1.1.1 192.168.1.2 | 10.9.9.9 1.1.1.1 ");
    runs(12, {"dnsmasq", "--conf-file=/dev/null", "-R", "-S8.8.8.8", "--server", "8.8.4.4",
              "--server=/x/10.0.0.1"});
    EXPECT_EQ(found(), "8.8.8.8 8.8.4.4 | 8.8.8.8 8.8.4.4 ");
    runs(12, {"dnsmasq", "-C", "/dev/null", "--no-resolv", "--enable-dbus=org.example"});
    EXPECT_EQ(found(), "nothing") << "it is told over the bus";
    runs(12, {"dnsmasq", "-C", "/dev/null", "--no-resolv", "-1", "-S", "8.8.8.8"});
    ASSERT_TRUE(dnsmasqServers(folder_.path()));
    EXPECT_TRUE(dnsmasqServers(folder_.path())->heedsBus);
}

TEST_F(DnsmasqOf, ADeviceReadsAFileOfServersBesideItsSettings) {
    write("/etc/dnsmasq.conf", "no-resolv\nserver=1.1.1.1\n");
    write("/etc/servers", "server=9.9.9.9\n");
    runs(12, {"dnsmasq", "--servers-file=/etc/servers"});
    EXPECT_EQ(found(), "9.9.9.9 1.1.1.1 | 9.9.9.9 1.1.1.1 ");
    runs(12, {"dnsmasq", "--servers-file=/etc/servers", "-R", "--conf-file=/dev/null"});
    EXPECT_EQ(found(), "9.9.9.9 | 9.9.9.9 ");
    runs(12, {"dnsmasq"});
    write("/etc/dnsmasq.conf", "no-resolv\nservers-file=/etc/servers\n");
    EXPECT_EQ(found(), "9.9.9.9 | 9.9.9.9 ");
}

TEST_F(DnsmasqOf, ADeviceIsTheOneThatAnswersHere) {
    write("/etc/resolv.conf", "nameserver 192.168.1.1\n");
    runs(12, {"dnsmasq", "--conf-file=/var/lib/libvirt/dnsmasq/default.conf"});
    write("/var/lib/libvirt/dnsmasq/default.conf",
          "except-interface=lo\nbind-dynamic\ninterface=virbr0\nserver=10.9.9.9\n");
    runs(13, {"dnsmasq", "--conf-file=/dev/null", "--listen-address=10.42.0.1", "--bind-interfaces"});
    runs(14, {"dnsmasq", "--conf-file=/dev/null", "--port=0"});
    EXPECT_EQ(found(), "nothing");
    runs(15, {"dnsmasq", "-C", "/dev/null", "-a", "192.168.1.7", "-a", "127.0.0.1,192.168.1.8"});
    EXPECT_EQ(found(), "192.168.1.1 | ");
    runs(16, {"dnsmasq", "-C", "/dev/null", "--no-resolv", "--address=/#/10.0.0.1"});
    EXPECT_EQ(found(), "192.168.1.1 | ") << "that one asks nobody";
    runs(17, {"dnsmasq", "-C", "/dev/null", "--no-resolv", "-1"});
    EXPECT_EQ(found(), "nothing") << "either may answer";
}

TEST_F(DnsmasqOf, ADeviceGoesByTheResolversFileThatWasWrittenLast) {
    write("/a", "nameserver 192.168.1.1\n");
    write("/b", "nameserver 192.168.1.2\n");
    runs(12, {"dnsmasq", "-r/a", "-r", "/b", "--resolv-file=/none"});
    const auto now = std::filesystem::last_write_time(folder_ / "a");
    std::filesystem::last_write_time(folder_ / "b", now - std::chrono::seconds(9));
    EXPECT_EQ(found(), "192.168.1.1 | ");
    std::filesystem::last_write_time(folder_ / "b", now + std::chrono::seconds(9));
    EXPECT_EQ(found(), "192.168.1.2 | ");
}

TEST_F(DnsmasqOf, ADeviceHasFormsOfTheirOwn) {
    write("/etc/resolv.conf", "nameserver 192.168.1.1\n");
    write("/etc/dnsmasq.conf", "no-resolv\t# x\n  # server=10.9.9.9\nlocal=\"9.9.9.9\"\t# y\nlocal=/lan/\n");
    runs(12, {"dnsmasq", "-k"});
    EXPECT_EQ(found(), "9.9.9.9 | 9.9.9.9 ");
    runs(12, {"dnsmasq", "-kRS1.1.1.1", "--conf-file"});
    EXPECT_EQ(found(), "1.1.1.1 | 1.1.1.1 ");
    runs(12, {"dnsmasq", "--conf-file", "--no-resolv", "-kS", "1.1.1.1"});
    EXPECT_EQ(found(), "1.1.1.1 | 1.1.1.1 ");
}

TEST_F(DnsmasqOf, ADeviceAnswerOnLoopbackBesideInterfacesThatAreNamedAndAtTheUsualPort) {
    write("/etc/resolv.conf", "nameserver 192.168.1.1\n");
    runs(12, {"dnsmasq", "-C", "/dev/null", "-a", "10.42.0.1"});
    EXPECT_EQ(found(), "nothing");
    runs(12, {"dnsmasq", "-C", "/dev/null", "-a", "10.42.0.1", "-i", "eth0"});
    EXPECT_EQ(found(), "192.168.1.1 | ");
    runs(12, {"dnsmasq", "-C", "/dev/null", "-p", "5353"});
    EXPECT_EQ(found(), "nothing") << "another answers at the usual one";
    runs(12, {"dnsmasq", "-C", "/dev/null", "--port=53"});
    EXPECT_EQ(found(), "192.168.1.1 | ");
}

TEST(DnsmasqSettings, CutOrTwistedAreReadAsFarAsTheyGo) {
    const std::string text = "no-resolv\nserver=9.9.9.9\nconf-dir=/x,*.y\nlisten-address=::1,\nport=0\n";
    for (std::size_t size = 0; size <= text.size(); ++size) {
        DnsmasqSettings settings;
        readDnsmasqFile(text.substr(0, size), settings);
        EXPECT_EQ(settings.servers.size(), size >= text.find("\nconf") ? 1U : 0U) << size;
    }
    DnsmasqSettings none;
    readDnsmasqFile("=\n = x\nserver\nserver=/#/\nserver=#@\n#\n", none);
    readDnsmasqCommand({"dnsmasq", "-", "--", "-S", "-r"}, none);
    readDnsmasqCommand({""}, none);
    EXPECT_TRUE(none.servers.empty());
}

/// A folder that stands for the root of a system where resolvconf, or openresolv, writes the resolver's file.
class RecordsOf : public ::testing::Test {
  protected:
    RecordsOf() { folder_.write("/sys/class/net/eth0/mtu", "1500\n"); }
    void write(const std::string& path, const std::string& servers) const {
        folder_.write("/run/resolvconf/" + path, "nameserver " + servers + "\n");
    }
    /// "offered | entered | elsewhere", and whether the offer is known.
    std::string found() const {
        const ResolverRecords all = resolverRecords("wlan0", folder_.path());
        return textsOf(all.offered) + "| " + textsOf(all.entered) + "| " + textsOf(all.elsewhere) +
               (all.offerKnown ? "known" : "");
    }

    fakes::TemporaryFolder folder_;
};

TEST_F(RecordsOf, AnInterfaceTellWhoNamedItsServers) {
    EXPECT_EQ(found(), "| | ");
    write("interface/wlan0.ip6.dhclient", "2001:db8::53");
    EXPECT_EQ(found(), "2001:db8::53 | | ");
    write("interface/wlan0.inet", "9.9.9.9");
    EXPECT_EQ(found(), "2001:db8::53 | 9.9.9.9 | ");
    std::filesystem::remove(folder_ / "run/resolvconf/interface/wlan0.ip6.dhclient");
    write("interface/wlan0.udhcpc", "192.168.1.1");
    EXPECT_EQ(found(), "192.168.1.1 | 9.9.9.9 | known");
}

TEST_F(RecordsOf, OtherInterfacesTellWhichServersAreNotItsOwn) {
    write("interface/wlan0.dhclient", "192.168.1.1");
    write("interface/eth0.dhclient", "192.168.1.1\nnameserver 10.0.0.1");
    write("interface/lo.dnsmasq", "127.0.0.1");
    write("interface/original.resolvconf", "8.8.8.8");
    write("interface/wlan01.dhclient", "10.0.0.2");
    EXPECT_EQ(found(), "192.168.1.1 | | 10.0.0.1 known");
}

TEST_F(RecordsOf, TheLoopbackInterfaceTellWhatWasSetForTheWholeDevice) {
    folder_.write("/sys/class/net/lo/mtu", "65536\n");
    write("interface/lo.inet", "9.9.9.9\nnameserver 192.168.1.1");
    write("interface/lo.inet6", "2620:fe::9");
    write("interface/lo.dnsmasq", "127.0.0.1");
    write("interface/eth0.inet", "9.9.9.9\nnameserver 10.0.0.1");
    write("interface/wlan0.dhclient", "192.168.1.1");
    EXPECT_EQ(found(), "192.168.1.1 | 9.9.9.9 192.168.1.1 2620:fe::9 | 10.0.0.1 known");
}

TEST_F(RecordsOf, OpenresolvAreKeptElsewhereUnderOtherNames) {
    write("interfaces/wlan0", "192.168.1.1");
    write("interfaces/wlan0.inet6", "2001:db8::53");
    write("interfaces/wlan0.ra", "2001:db8::54");
    EXPECT_EQ(found(), "192.168.1.1 2001:db8::54 | | known") << "inet6 may be a lease or the settings";
}

std::string enteredIn(const std::string& text) {
    const InterfacePlan plan = readDhcpcdSettings(text, "wlan0", "Northlight");
    return plan.ipv4.method + " " + textsOf(plan.ipv4.addresses) + "| " + plan.ipv6.method + " " +
           textsOf(plan.ipv6.addresses) + "| " + textsOf(plan.servers);
}

TEST(DhcpcdSettings, SetAddressesAndServersByHand) {
    EXPECT_EQ(enteredIn(""), " |  | ");
    EXPECT_EQ(enteredIn("hostname\nstatic domain_name_servers=9.9.9.9 2620:fe::9\n"),
              " |  | 9.9.9.9 2620:fe::9 ");
    EXPECT_EQ(
        enteredIn("interface wlan0\n\tstatic\tip_address=10.0.0.7/24\nstatic ip6_address=2001:db8::7/64\n"
                  "static routers=10.0.0.1\nstatic domain_name_servers=\"9.9.9.9, 1.1.1.1\"\n"),
        "manual 10.0.0.7 | manual 2001:db8::7 | 9.9.9.9 1.1.1.1 ");
    EXPECT_EQ(enteredIn("inform 10.0.0.8/24\n"), "manual 10.0.0.8 |  | ");
    EXPECT_EQ(
        enteredIn("inform\n#static ip_address=10.0.0.7\nstatic\nstatic ip_address\nstatic ip_address=\n"),
        " |  | ");
}

TEST(DhcpcdSettings, HaveCommentsAndTheLastWordOfEachOption) {
    EXPECT_EQ(enteredIn("static domain_name_servers=9.9.9.9\nstatic dhcp6_name_servers=2620:fe::9\n"
                        "interface wlan0 # the Wi-Fi\nstatic domain_name_servers=1.1.1.1 # 1.0.0.1\n"
                        "inform 10.0.0.6\nstatic ip_address=10.0.0.7/24\n"),
              "manual 10.0.0.7 |  | 1.1.1.1 2620:fe::9 ");
    EXPECT_EQ(enteredIn("static domain_name_servers=9.9.9.9\nstatic domain_name_servers=\n"), " |  | ");
    EXPECT_EQ(enteredIn("interface \"wlan0\"\nstatic ip_address=10.0.0.7\nssid \"Northlight\"\n"
                        "static ip_address=10.0.0.8\n"),
              " |  | ")
        << "these names stand without quotes";
}

TEST(DhcpcdSettings, CountForTheInterfaceAndTheNetworkThatTheyName) {
    EXPECT_EQ(
        enteredIn("interface eth0\nstatic ip_address=10.0.0.7/24\nssid Other\nstatic ip_address=10.0.0.8\n"),
        " |  | ");
    EXPECT_EQ(
        enteredIn(
            "interface eth0\nstatic ip_address=10.0.0.7/24\nssid Northlight\nstatic ip_address=10.0.0.8\n"),
        "manual 10.0.0.8 |  | ");
    EXPECT_EQ(enteredIn("profile home\nstatic ip_address=10.0.0.9/24\nstatic domain_name_servers=10.0.0.1\n"
                        "interface eth0\nfallback home\n"),
              "manual 10.0.0.9 |  | ");
}

}  // namespace
}  // namespace wp
