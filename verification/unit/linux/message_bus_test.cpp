#include <gtest/gtest.h>
#include <stdlib.h>

#include <algorithm>
#include <thread>

#include "linux/dbus/bluez.h"
#include "linux/dbus/connman.h"
#include "linux/dbus/iwd.h"
#include "linux/dbus/network_manager.h"
#include "linux/dbus/network_records.h"
#include "linux/dbus/resolved.h"
#include "linux/dbus/supplicant.h"
#include "linux/gather_setup.h"
#include "linux/manager_scan.h"
#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/linux/fakes/child_process.h"
#include "verification/unit/linux/stop.h"
#include "verification/unit/places.h"
#include "verification/unit/service/addresses.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

/// A message bus of the tests' own, with a stand-in for each service.
class MessageBus : public ::testing::Test {
  protected:
    static void SetUpTestSuite() {
        folder_ = new fakes::TemporaryFolder;
        address_ = "unix:path=" + *folder_ / "bus";
        daemon_ = new ChildProcess({"dbus-daemon", "--session", "--nofork", "--nopidfile", "--print-address",
                                    "--address=" + address_});
        setenv("DBUS_SYSTEM_BUS_ADDRESS", address_.c_str(), 1);
        services_ = new ChildProcess(
            {"/usr/bin/python3", sourceFolder() + "/verification/unit/linux/fakes/bus_services.py", address_,
             "nm", "supplicant", "iwd", "bluez", "connman", "resolved", "broken"});
    }
    static void TearDownTestSuite() {
        unsetenv("DBUS_SYSTEM_BUS_ADDRESS");
        delete services_;
        delete daemon_;
        delete folder_;
    }

    Bus bus() const {
        auto known = Bus::at(address_);
        EXPECT_TRUE(known);
        return std::move(*known);
    }

    inline static fakes::TemporaryFolder* folder_ = nullptr;
    inline static std::string address_;
    inline static ChildProcess *daemon_ = nullptr, *services_ = nullptr;
};

int codeOf(Reason reason) {
    return static_cast<int>(reason);
}

/// One line per network: name, security, and the first letters of what is set.
std::string linesOf(const SavedNetworks& saved) {
    std::string lines = saved.store + "\n";
    for (const SavedNetwork& each : saved.networks) {
        lines += textFromName(each.name) + " " + std::to_string(static_cast<int>(each.security));
        lines += std::string(each.enabled ? " enabled" : "") + (each.hidden ? " hidden" : "") +
                 (each.seenSeveralAPs ? " several" : "");
        if (each.lastJoined)
            lines += " " + std::to_string(static_cast<std::int64_t>(each.lastJoined->secondsSinceReference));
        lines += "\n";
    }
    return lines;
}

TEST_F(MessageBus, ReadsValuesOfEveryKind) {
    Bus bus = this->bus();
    const auto reply = bus.call({"org.example.broken", "/"}, "org.example.broken", "Numbers", {}, patience());
    ASSERT_TRUE(reply) << reply.error().text();
    const auto& values = reply->list();
    ASSERT_EQ(values.size(), 10U);
    EXPECT_EQ(values[0].number(), 200);
    EXPECT_EQ(values[1].number(), -5);
    EXPECT_EQ(values[2].number(), 65535);
    EXPECT_EQ(values[3].number(), -7);
    EXPECT_EQ(values[5].number(), -9);
    EXPECT_EQ(values[6].number(), std::nullopt);
    EXPECT_EQ(*values[7].as<double>(), 0.5);
    EXPECT_TRUE(values[8].flag());
    EXPECT_EQ(values[9]["7"].text(), "seven");
    EXPECT_TRUE(values[9]["8"].empty());
    EXPECT_EQ(values[0].text("none"), "none");
}

TEST_F(MessageBus, ErrorsTellWhoIsMissingAndWhoRefuses) {
    Bus bus = this->bus();
    const BusObject broken{"org.example.broken", "/"};
    const auto absent = bus.call({"org.example.absent", "/"}, "a.b", "C", {}, patience());
    const auto refused = bus.call(broken, "org.example.broken", "Fail", {}, patience());
    const auto unknown = bus.call(broken, "org.example.broken", "Nothing", {}, patience());
    const auto deep = bus.call(broken, "org.example.broken", "Deep", {}, patience());
    ASSERT_TRUE(!absent && !refused && !unknown && !deep);
    EXPECT_EQ(absent.error().code, codeOf(Reason::unavailable)) << absent.error().text();
    EXPECT_EQ(refused.error().code, codeOf(Reason::notPermitted)) << refused.error().text();
    EXPECT_EQ(unknown.error().code, codeOf(Reason::notFound)) << unknown.error().text();
    EXPECT_EQ(deep.error().code, codeOf(Reason::malformed)) << deep.error().text();
}

TEST_F(MessageBus, WithoutABusThereIsNothingToAsk) {
    auto none = Bus::at("unix:path=" + *folder_ / "none");
    if (none) {
        const auto reply = none->call({"a.b", "/"}, "a.b", "C", {}, patience());
        ASSERT_FALSE(reply);
        EXPECT_EQ(reply.error().code, codeOf(Reason::unavailable));
    } else {
        EXPECT_EQ(none.error().code, codeOf(Reason::unavailable));
    }
}

TEST_F(MessageBus, ASilentServiceIsLeftAtTheDeadlineAndWhenStopped) {
    const ChildProcess silent({"/usr/bin/python3", "-c",
                               "import dbus, sys, time\n"
                               "bus = dbus.bus.BusConnection(sys.argv[1])\n"
                               "bus.request_name('org.example.silent')\n"
                               "print('ready', flush=True)\n"
                               "time.sleep(3600)",
                               address_});
    Bus bus = this->bus();
    const BusObject object{"org.example.silent", "/"};
    const auto late = bus.call(object, "a.b", "C", {}, patience(50ms));
    const auto stop = std::make_shared<StopSignal>();
    stop->raise();
    const auto stopped = bus.call(object, "a.b", "C", {}, patience(20s, stop));
    ASSERT_TRUE(!late && !stopped);
    EXPECT_EQ(late.error().code, codeOf(Reason::timeout));
    EXPECT_EQ(stopped.error().code, codeOf(Reason::cancelled));
}

TEST_F(MessageBus, NetworkManagerTellsOfTheLinkThatItManages) {
    Bus bus = this->bus();
    const auto link = readNetworkManagerLink(bus, "wlan0", patience());
    ASSERT_TRUE(link) << link.error().text();
    ASSERT_TRUE(link->settings);
    EXPECT_EQ((*link->settings)["ipv4"]["method"].text(), "manual");
    EXPECT_EQ((*link->settings)["ipv6"]["method"].text(), "auto");
    EXPECT_TRUE(link->offerRead);
    EXPECT_EQ(link->lease4.at("domain_name_servers"), "192.168.1.1 192.168.1.2");
    EXPECT_EQ(textsOf(link->servers), "192.168.1.1 2001:db8::53 ");
    EXPECT_EQ(textsOf(manualServers(*link->settings)), "9.9.9.9 2620:fe::9 ");
    EXPECT_EQ(proxyOf(*link->settings), "NetworkManager profile: pac-url");
}

TEST_F(MessageBus, AnInterfaceThatNetworkManagerLeavesAloneIsNotItsOwn) {
    Bus bus = this->bus();
    const auto link = readNetworkManagerLink(bus, "wlan1", patience());
    ASSERT_FALSE(link);
    EXPECT_EQ(link.error().code, codeOf(Reason::notFound));
}

TEST_F(MessageBus, ThePortalIsTheOneOfTheLeaseOfIPv4OrElseOfIPv6) {
    const auto both = gatherSetup({"wlan0", 9990, 0, true, {}}, patience());
    const auto alone = gatherSetup({"wlan11", 9999, 0, true, {}}, patience());
    ASSERT_TRUE(both && alone);
    EXPECT_EQ(both->portalApi, "https://p.example/api");
    EXPECT_EQ(alone->portalApi, "https://p.example/six");
}

TEST_F(MessageBus, WithoutAnActiveConnectionNothingIsSetUpByHand) {
    const auto setup = gatherSetup({"wlan6", 9996, 0, true, {}}, patience());
    ASSERT_TRUE(setup) << setup.error().text();
    ASSERT_TRUE(!setup->methods.ipv4 && !setup->methods.ipv6 && !setup->nameServers);
    EXPECT_EQ(setup->methods.ipv4.error().code, codeOf(Reason::notJoined));
    EXPECT_EQ(setup->nameServers.error().code, codeOf(Reason::notJoined));
    EXPECT_TRUE(setup->proxies);
}

TEST_F(MessageBus, WhatTheProfileKeepsToItselfIsNotTakenForEmpty) {
    Bus bus = this->bus();
    const auto link = readNetworkManagerLink(bus, "wlan5", patience());
    ASSERT_TRUE(link) << link.error().text();
    EXPECT_FALSE(link->offerRead);  // its lease is not there

    const auto setup = gatherSetup({"wlan5", 9995, 0, true, {}}, patience());
    ASSERT_TRUE(setup) << setup.error().text();
    ASSERT_TRUE(!setup->methods.ipv4 && !setup->nameServers);
    EXPECT_EQ(setup->methods.ipv4.error().code, codeOf(Reason::notPermitted));
    EXPECT_EQ(setup->nameServers.error().code, codeOf(Reason::notPermitted));
    // This machine itself may have one.
    EXPECT_TRUE(setup->proxies ? !setup->proxies->empty()
                               : setup->proxies.error().code == codeOf(Reason::notPermitted));
}

TEST_F(MessageBus, TheStoreOfASilentManagerIsNotReplacedByItsSupplicants) {
    const auto saved = gatherSaved({"wlan7", 9997, 0, true, {}}, patience());
    ASSERT_FALSE(saved);
    EXPECT_EQ(saved.error().code, codeOf(Reason::timeout));
    const auto iwds = gatherSaved({"wlan2", 9992, 0, true, {}}, patience());
    ASSERT_TRUE(iwds) << iwds.error().text();
    EXPECT_EQ(iwds->store, "iwd");
}

TEST_F(MessageBus, WhatASilentManagerWasToldIsNotReadFromAddresses) {
    const auto setup = gatherSetup({"wlan7", 9997, 0, true, {}}, patience());
    ASSERT_TRUE(setup) << setup.error().text();
    ASSERT_TRUE(!setup->methods.ipv4 && !setup->methods.ipv6 && !setup->nameServers && !setup->leaseText);
    EXPECT_EQ(setup->methods.ipv4.error().code, codeOf(Reason::timeout));
    EXPECT_EQ(setup->methods.ipv6.error().code, codeOf(Reason::timeout));
    EXPECT_EQ(setup->nameServers.error().code, codeOf(Reason::timeout));
    // This machine's own environment may set a proxy, which is an answer.
    EXPECT_TRUE(setup->proxies ? !setup->proxies->empty()
                               : setup->proxies.error().code == codeOf(Reason::timeout));
}

TEST_F(MessageBus, ConnmanTellsWhatWasChosenForTheNetworkThatItConnected) {
    Bus bus = this->bus();
    const auto home = readConnmanLink(bus, "wlan12", patience());
    ASSERT_TRUE(home) << home.error().text();
    EXPECT_EQ(*home->methods.ipv4, "dhcp") << "though it came to another";
    EXPECT_EQ(*home->methods.ipv6, "disabled");
    EXPECT_EQ(textsOf(home->manualServers), "9.9.9.9 ");
    EXPECT_EQ(textsOf(home->servers), "9.9.9.9 ");
    EXPECT_EQ(textsOf(home->serversElsewhere), "192.168.1.1 2001:db8::53 10.0.0.1 192.168.1.1 ");
    EXPECT_EQ(home->proxy, "ConnMan service: manual");
    const auto odd = readConnmanLink(bus, "wlan14", patience());
    ASSERT_TRUE(odd) << odd.error().text();
    EXPECT_EQ(*odd->methods.ipv4, "manual");
    EXPECT_FALSE(odd->methods.ipv6);
    const auto absent = readConnmanLink(bus, "wlan99", patience());
    ASSERT_FALSE(absent);
    EXPECT_EQ(absent.error().code, codeOf(Reason::notFound));
}

TEST_F(MessageBus, AnInterfaceThatConnmanConnectedIsJudgedByItsWord) {
    const auto setup = gatherSetup({"wlan13", 9913, 0, true, {}}, patience());
    ASSERT_TRUE(setup) << setup.error().text();
    EXPECT_EQ(setup->toldBy, "ConnMan");
    EXPECT_EQ(*setup->methods.ipv4, "manual");
    EXPECT_EQ(*setup->methods.ipv6, "auto");
    ASSERT_TRUE(setup->nameServers);
    EXPECT_EQ(textsOf(setup->nameServers->manual), "");
    EXPECT_EQ(textsOf(setup->nameServers->offered), "2001:db8::53 ") << "none of IPv4 with addresses by hand";
    EXPECT_EQ(textsOf(setup->servers), "192.168.1.1 2001:db8::53 ");
    ASSERT_FALSE(setup->leaseText);
    // What it hands to the supplicant is not its store.
    const auto saved = gatherSaved({"wlan13", 9913, 0, true, {}}, patience());
    ASSERT_FALSE(saved);
    EXPECT_EQ(saved.error().code, codeOf(Reason::unavailable));
}

TEST_F(MessageBus, NetworkManagerTellsItsNetworks) {
    Bus bus = this->bus();
    const auto saved = networkManagerNetworks(bus, "wlan0", patience());
    ASSERT_TRUE(saved) << saved.error().text();
    EXPECT_EQ(linesOf(*saved),
              "NetworkManager\n"
              "Home \\xFF 5 enabled several 721692800\n"
              "Cellar 0 hidden\n");
}

TEST(NetworkManagerSettings, NameServersAsAPersonMayWriteThem) {
    using Map = BusValue::Map;
    BusValue::List servers;
    for (const char* each : {"9.9.9.9#dns.example", "dns+tls://[2620:fe::9]:853#dns.example", "bogus"})
        servers.emplace_back(std::string(each));
    const BusValue settings(Map{{"ipv4", BusValue(Map{{"dns-data", BusValue(std::move(servers))}})}});
    EXPECT_EQ(textsOf(manualServers(settings)), "9.9.9.9 2620:fe::9 ");
}

TEST(NetworkManagerSettings, BindAConnectionByNameAndByHardware) {
    using Map = BusValue::Map;
    const auto isBound = [](const char* section, const char* key, BusValue value,
                            const char* hardware = "02:00:00:00:0A:00") {
        const BusValue settings(Map{{section, BusValue(Map{{key, std::move(value)}})}});
        return isBoundElsewhere(settings, "wlan0", hardware);
    };
    const auto text = [](const char* content) { return BusValue(std::string(content)); };
    const auto list = [&](const char* content) { return BusValue(BusValue::List{text("x"), text(content)}); };
    const BusValue own(BusValue::Bytes{2, 0, 0, 0, 10, 0}), other(BusValue::Bytes{2, 0, 0, 0, 10, 1});
    EXPECT_FALSE(isBound("connection", "interface-name", text("")));
    EXPECT_FALSE(isBound("connection", "interface-name", text("wlan0")));
    EXPECT_TRUE(isBound("connection", "interface-name", text("wlan1")));
    EXPECT_FALSE(isBound("802-11-wireless", "mac-address", own));
    EXPECT_TRUE(isBound("802-11-wireless", "mac-address", other));
    EXPECT_FALSE(isBound("802-11-wireless", "mac-address", other, "")) << "its own is not known";
    EXPECT_FALSE(isBound("802-11-wireless", "mac-address", BusValue(BusValue::Bytes{2, 0})));
    EXPECT_TRUE(isBound("802-11-wireless", "mac-address-blacklist", list("02:00:00:00:0a:00")));
    EXPECT_TRUE(isBound("802-11-wireless", "mac-address-denylist", list("02:00:00:00:0A:00")));
    EXPECT_FALSE(isBound("802-11-wireless", "mac-address-denylist", list("02:00:00:00:0A:01")));
}

TEST_F(MessageBus, NetworkManagerSwitchesWiFi) {
    Bus bus = this->bus();
    ASSERT_TRUE(networkManagerPower(bus, patience()));
    EXPECT_TRUE(networkManagerPower(bus, patience())->software);
    EXPECT_TRUE(setNetworkManagerPower(bus, false, patience()));
    EXPECT_FALSE(networkManagerPower(bus, patience())->software);
    EXPECT_TRUE(setNetworkManagerPower(bus, true, patience()));
}

TEST_F(MessageBus, TheSupplicantTellsItsNetworks) {
    Bus bus = this->bus();
    const auto interface = supplicantInterface(bus, "wlan0", patience());
    ASSERT_TRUE(interface) << interface.error().text();
    const auto saved = supplicantNetworks(bus, *interface, patience());
    ASSERT_TRUE(saved) << saved.error().text();
    EXPECT_EQ(linesOf(*saved), std::string("wpa_supplicant\nHome 4 enabled\n\xC3\xBF\0 2 hidden\n", 43));
    const auto other = supplicantInterface(bus, "wlan7", patience());
    ASSERT_FALSE(other);
    EXPECT_EQ(other.error().code, codeOf(Reason::notFound));
}

TEST_F(MessageBus, IwdTellsItsNetworks) {
    Bus bus = this->bus();
    const auto objects = iwdObjects(bus, patience());
    ASSERT_TRUE(objects) << objects.error().text();
    EXPECT_EQ(iwdDevice(*objects, "wlan0"), "/net/connman/iwd/0/3");
    EXPECT_EQ(iwdDevice(*objects, "wlan1"), "");
    EXPECT_EQ(linesOf(iwdNetworks(*objects)), "iwd\nHome 4 enabled 721692800\nCafe 0 hidden\n");
}

TEST_F(MessageBus, AScanIsAskedOfWhateverManagesTheInterface) {
    Known<Bus> bus = this->bus();
    const auto asked = [&](const char* interface) {
        const auto manager = askManagerForScan(bus, {interface, std::nullopt, true}, patience());
        if (!manager) return manager.error().text();
        if (manager->refusal) return manager->name + " refuses: " + manager->refusal->text();
        return manager->name + (manager->listens ? " listens" : "");
    };
    EXPECT_EQ(asked("wlan0"), "NetworkManager");
    EXPECT_EQ(asked("wlan2"), "iwd");
    EXPECT_EQ(asked("wlan3"), "wpa_supplicant listens");
    EXPECT_EQ(asked("wlan4"),
              "no permission to scan (CAP_NET_ADMIN), and NetworkManager would not either: "
              "org.freedesktop.NetworkManager answered: Not authorized (code 6)");
    EXPECT_EQ(
        asked("wlan8"),
        "NetworkManager refuses: NetworkManager would not scan now: org.freedesktop.NetworkManager answered: "
        "Scanning not allowed while already scanning (code 4)");
    EXPECT_EQ(asked("wlan10"),
              "iwd refuses: iwd would not scan now: net.connman.iwd answered: Operation already in progress "
              "(code 4)");
    EXPECT_EQ(asked("wlan9"),
              "no permission to scan (CAP_NET_ADMIN), and no connection manager to ask for a scan (code 6)");
    bus = failure(Reason::unavailable, "there is no message bus");
    EXPECT_EQ(asked("wlan0"),
              "no permission to scan (CAP_NET_ADMIN), and no connection manager to ask for a scan (code 6)");
}

/// The options of the latest call of a stand-in's method.
BusValue latestOptions(Bus& bus, const BusObject& object, const std::string& method) {
    const auto calls = bus.call(object, "org.freedesktop.DBus.Mock", "GetMethodCalls", {method}, patience());
    if (!calls || calls->list().empty()) return {};
    return calls->list().back().list().at(1).list().at(0);  // (time, [arguments])
}

TEST_F(MessageBus, ManagersCallTheNetworkThatIsLookedForAndAllOthers) {
    Known<Bus> bus = this->bus();
    const auto name = nameFromText("Cellar\\xFF");
    ASSERT_TRUE(askManagerForScan(bus, {"wlan0", name, false}, patience()));
    ASSERT_TRUE(askManagerForScan(bus, {"wlan3", name, false}, patience()));
    const BusValue ofManager = latestOptions(
        *bus, {"org.freedesktop.NetworkManager", "/org/freedesktop/NetworkManager/Devices/1"}, "RequestScan");
    const BusValue ofSupplicant =
        latestOptions(*bus, {"fi.w1.wpa_supplicant1", "/fi/w1/wpa_supplicant1/Interfaces/0"}, "Scan");
    for (const BusValue* names : {&ofManager["ssids"], &ofSupplicant["SSIDs"]}) {
        ASSERT_EQ(names->list().size(), 2U);
        EXPECT_EQ(NetworkName(names->list()[0].bytes()), *name);
        EXPECT_TRUE(names->list()[1].bytes().empty());
    }
    EXPECT_EQ(ofSupplicant["Type"].text(), "active");
}

TEST_F(MessageBus, BluetoothDevicesAreCounted) {
    Known<Bus> bus = Bus::at(address_);
    const auto bluetooth = readBluetooth(bus, true, patience());
    ASSERT_TRUE(bluetooth) << bluetooth.error().text();
    EXPECT_EQ(bluetooth->controllers, 1U);
    EXPECT_TRUE(bluetooth->powered);
    EXPECT_EQ(bluetooth->paired, 2U);
    EXPECT_EQ(bluetooth->connected, 1U);
}

TEST_F(MessageBus, WithoutABluetoothServiceOnlyALackOfControllersCanBeTold) {
    Known<Bus> bus = failure(Reason::unavailable, "there is no message bus");
    const auto none = readBluetooth(bus, false, patience());
    const auto unknown = readBluetooth(bus, true, patience());
    ASSERT_TRUE(none);
    EXPECT_EQ(none->paired, 0U);
    ASSERT_FALSE(unknown);
    EXPECT_EQ(unknown.error().code, codeOf(Reason::unavailable));
}

TEST_F(MessageBus, TheResolverTellsTheLinksServers) {
    Bus bus = this->bus();
    const auto servers = resolvedServers(bus, 3, patience());
    ASSERT_TRUE(servers) << servers.error().text();
    EXPECT_EQ(textsOf(servers->ofLink), "192.168.1.1 ::1 ");
    EXPECT_FALSE(resolvedServers(bus, 4, patience()));
}

TEST_F(MessageBus, TheResolverTellsTheServersThatAPersonSetForTheWholeDevice) {
    Bus bus = this->bus();
    const auto servers = resolvedServers(bus, 3, patience());
    ASSERT_TRUE(servers) << servers.error().text();
    EXPECT_EQ(textsOf(servers->ofDevice), "203.0.113.10 ");
}

TEST(NetworkRecords, NamesOfTheSupplicantComeInThreeForms) {
    const auto text = [](std::string_view form) {
        const auto name = nameFromSupplicant(form);
        return name ? textFromName(*name) : "none";
    };
    EXPECT_EQ(text("\"a\"b\""), "a\"b");
    EXPECT_EQ(text("416263"), "Abc");
    EXPECT_EQ(text("P\"a\\x41\\\\\\\"\\e\""), "aA\\\"\x1B");
    for (const char* form : {"", "\"", "\"\"", "41626", "zz", "P\"\\q\"", "P\"\\x4\"", "P\"\\\"",
                             "\"123456789012345678901234567890123\""})
        EXPECT_EQ(text(form), "none") << form;
}

TEST(NetworkRecords, KeyManagementBecomesAKindOfSecurity) {
    using enum SavedSecurity;
    EXPECT_EQ(securityFromSupplicant("WPA-EAP IEEE8021X", ""), enterprise);
    EXPECT_EQ(securityFromSupplicant("WPA-PSK WPA-EAP", ""), wpa2Personal);
    EXPECT_EQ(securityFromSupplicant("WPA-PSK WPA-EAP", "", {.eapMethods = true}), enterprise);
    EXPECT_EQ(securityFromSupplicant("SAE", "RSN"), sae);
    EXPECT_EQ(securityFromSupplicant("WPA-PSK", "WPA"), wpaPersonal);
    EXPECT_EQ(securityFromSupplicant("WPA-PSK SAE", "WPA RSN"), wpa2Personal);
    EXPECT_EQ(securityFromSupplicant("OWE", ""), owe);
    EXPECT_EQ(securityFromSupplicant("NONE", ""), open);
    EXPECT_EQ(securityFromSupplicant("NONE", "", {.wepKey = true}), wep);
    EXPECT_EQ(securityFromSupplicant("", ""), unknown);
}

TEST(NetworkRecords, MomentsAreReadInOneFormOnly) {
    EXPECT_EQ(dateFromText("2001-01-01T00:00:00Z"), Date{0});
    EXPECT_EQ(dateFromText("2023-11-14T22:13:20Z"), dateFromUnix(1'700'000'000));
    for (const char* text : {"", "2023-11-14", "2023-11-14T22:13:20", "2023-13-14T22:13:20Z",
                             "2023-11-31T22:13:20Z", "2023-11-14T24:13:20Z", "2023-11-14 22:13:20Z"})
        EXPECT_FALSE(dateFromText(text)) << text;
}

}  // namespace
}  // namespace wp
