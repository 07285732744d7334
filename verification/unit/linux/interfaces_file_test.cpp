#include "linux/files/interfaces_file.h"

#include <gtest/gtest.h>

#include "linux/files/ifupdown.h"
#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/service/addresses.h"

namespace wp {
namespace {

InterfacesFile interfacesIn(const std::string& text) {
    InterfacesFile file;
    readInterfaces(text, file);
    return file;
}

/// "METHOD ADDRESSES" of both families, and the name servers.
std::string planned(const InterfacePlan& plan) {
    const auto family = [](const FamilyPlan& each) {
        return each.method + (each.addresses.empty() ? "" : " ") + textsOf(each.addresses);
    };
    return family(plan.ipv4) + "|" + family(plan.ipv6) + "|" + textsOf(plan.servers);
}

std::string planOf(const std::string& text, const char* name = "wlan0") {
    return planned(planIn(interfacesIn(text), name));
}

TEST(InterfacesFile, SaysHowEachFamilyIsSetUp) {
    EXPECT_EQ(planOf("iface wlan0 inet dhcp\niface wlan0 inet6 auto\n"), "auto|auto|");
    EXPECT_EQ(planOf("iface wlan0 inet6 dhcp\n"), "|auto|");
    EXPECT_EQ(planOf("iface wlan0 inet static\n  address 10.0.0.7/24\n  gateway 10.0.0.1\n"
                     "iface wlan0 inet6 static\n\taddress\t2001:db8::7\n\tnetmask 64\n"),
              "manual 10.0.0.7 |manual 2001:db8::7 |");
    EXPECT_EQ(planOf("iface wlan0 inet ipv4ll\n"), "link-local||");
    EXPECT_EQ(planOf("iface wlan0 inet bootp\n"), "auto||");
    EXPECT_EQ(planOf("iface wlan0 inet manual\n  wpa-ssid Northlight\niface wlan0 inet6 manual\n"), "||");
    EXPECT_EQ(planOf("iface eth0 inet static\n  address 10.0.0.7\n"), "||");
    EXPECT_EQ(planOf(""), "||");
}

TEST(InterfacesFile, CountsWhatWasEnteredBesideWhatComesByItself) {
    EXPECT_EQ(planOf("iface wlan0 inet dhcp\niface wlan0 inet static\n  address 10.0.0.7\n"
                     "iface wlan0 inet static\n  address 10.0.0.8\niface wlan0 inet dhcp\n"),
              "manual 10.0.0.7 10.0.0.8 ||");
    EXPECT_EQ(planOf("iface wlan0 inet static\n  address box.example\n"), "manual||");
}

TEST(InterfacesFile, HasCommentsAndLinesThatGoOn) {
    EXPECT_EQ(planOf("#iface wlan0 inet static\n  # \\\niface wlan0 \\\n  inet\\\n dhcp\n"), "auto||");
    EXPECT_EQ(planOf("iface wlan0 inet static\r\n  address 10.0.0.7\r\n"), "manual 10.0.0.7 ||");
}

TEST(InterfacesFile, NamesServersThatWereEntered) {
    EXPECT_EQ(planOf("iface wlan0 inet dhcp\n  dns-nameservers 9.9.9.9 2620:fe::9 none\n"
                     "  dns-nameservers 149.112.112.112\n  up ip route add default\n  up true\n"
                     "iface wlan0 inet6 auto\n  dns-nameserver 2620:fe::10\n"),
              "auto|auto|9.9.9.9 2620:fe::9 149.112.112.112 2620:fe::10 ");
}

TEST(InterfacesFile, OptionsBelongToTheStanzaBeforeThem) {
    EXPECT_EQ(planOf("address 10.0.0.9\niface wlan0 inet static\nauto wlan0\n  address 10.0.0.9\n"),
              "manual||");
    EXPECT_EQ(planOf("iface wlan0 inet static\nmapping eth0\n  script x\n  address 10.0.0.9\n"), "manual||");
}

TEST(InterfacesFile, AStanzaInheritsOptionsAndWithoutAMethodThatToo) {
    const std::string base = "iface base inet static\n  dns-nameservers 9.9.9.9\n  address 10.0.0.1\n";
    EXPECT_EQ(planOf(base + "iface wlan0 inet static inherits base\n  address 10.0.0.7\n"),
              "manual 10.0.0.7 ||9.9.9.9 ");
    EXPECT_EQ(planOf(base + "iface wlan0 inet dhcp inherits base\n"), "auto||9.9.9.9 ");
    EXPECT_EQ(planOf(base + "iface more inherits base\niface wlan0 inherits more\n"),
              "manual 10.0.0.1 ||9.9.9.9 ");
    EXPECT_EQ(planOf("iface wlan0 inherits wlan0\niface wlan0 inherits\niface\niface wlan0 inet\n"), "||");
    EXPECT_EQ(planOf("iface a inherits b\niface b inherits a\niface wlan0 inet dhcp inherits a\n"), "auto||");
}

TEST(InterfacesFile, OfIfupdownNgNamesAddressesOfBothFamiliesAndProgramsToUse) {
    EXPECT_EQ(planOf("iface wlan0\n  use wifi\n  use dhcp\n"), "auto||");
    EXPECT_EQ(planOf("iface wlan0\n  address 10.0.0.7/24\n  address 2001:db8::7/64\n  gateway 10.0.0.1\n"
                     "  dns-nameservers 9.9.9.9\n"),
              "manual 10.0.0.7 |manual 2001:db8::7 |9.9.9.9 ");
    EXPECT_EQ(planOf("template home\n  address 10.0.0.7\niface wlan0\n  inherit home\n  use dhcp\n"),
              "manual 10.0.0.7 ||")
        << "what was entered counts beside what comes by itself";
    EXPECT_EQ(planOf("iface wlan0\n  use\n  address\n  inherit\n"), "||");
}

TEST(InterfacesFile, CutOrTwistedIsReadAsFarAsItGoes) {
    const std::string text =
        "auto /wlan*=home\nsource x/*\niface base inet static\n  address 10.0.0.1\\\n/24\n"
        "iface home inherits base\n";
    for (std::size_t size = 0; size <= text.size(); ++size) {
        const InterfacesFile file = interfacesIn(text.substr(0, size));
        const InterfacePlan plan = planIn(file, "home");
        EXPECT_EQ(plan.ipv4.method, size + 1 >= text.size() ? "manual" : "") << size;
    }
    std::string many;
    for (int i = 0; i < 3000; ++i)
        many += "iface wlan0 inet static\naddress 10.0.0.7\nauto a b c d\nsource a b\n";
    EXPECT_EQ(interfacesIn(many).stanzas.size(), 1000U);
    EXPECT_LE(interfacesIn(many).includes.size(), 256U);
}

/// A folder that stands for the root of a system.
class Ifupdown : public ::testing::Test {
  protected:
    void write(const std::string& path, const std::string& content) const { folder_.write(path, content); }
    std::string plan() const { return planned(ifupdownPlan("wlan0", folder_.path())); }

    fakes::TemporaryFolder folder_;
};

TEST_F(Ifupdown, ReadsWhatTheFileIncludes) {
    write("/run/network/ifstate", "wlan0=wlan0\n");
    EXPECT_EQ(plan(), "||");
    write("/etc/network/interfaces",
          "source /etc/network/interfaces.d/*\nsource-directory more\nsource interfaces\n");
    write("/etc/network/interfaces.d/wlan0.conf", "iface wlan0 inet dhcp\n");
    write("/etc/network/more/wlan0",
          "iface wlan0 inet6 static\naddress 2001:db8::7\nsource ../../elsewhere\n");
    write("/etc/network/more/wlan0.dpkg-old", "iface wlan0 inet6 static\naddress 2001:db8::8\n");
    write("/etc/elsewhere", "iface wlan0 inet6 auto\n");
    EXPECT_EQ(plan(), "auto|manual 2001:db8::7 |");
}

TEST_F(Ifupdown, GoesByTheNameUnderWhichItStartedAnInterface) {
    write("/etc/network/interfaces",
          "auto wlan0\niface wlan0 inet static\naddress 10.0.0.6\n"
          "mapping wlan*\nscript x\niface home inet static\naddress 10.0.0.7\niface away inet dhcp\n");
    EXPECT_EQ(plan(), "||") << "it never ran";
    write("/run/network/ifstate", "lo=lo\nwlan01=away\n");
    EXPECT_EQ(plan(), "||") << "it leaves the interface alone";
    write("/var/run/ifstate", "wlan0=home\n");
    EXPECT_EQ(plan(), "manual 10.0.0.7 ||") << "as busybox keeps it where /var/run is no link to /run";
    write("/run/ifstate", "lo=lo\nwlan0=away 1\n");
    EXPECT_EQ(plan(), "auto||");
    write("/run/network/ifstate", "lo=lo\nwlan01=away\nwlan0=home\n");
    EXPECT_EQ(plan(), "manual 10.0.0.7 ||");
}

}  // namespace
}  // namespace wp
