#include <gtest/gtest.h>

#include "service/address_configuration.h"
#include "service/bluetooth.h"
#include "service/peer_link.h"
#include "verification/unit/service/addresses.h"
#include "verification/unit/service/finding.h"

namespace wp {
namespace {

AddressMethods methods(std::string ipv4, std::string ipv6) {
    return {std::move(ipv4), std::move(ipv6)};
}

TEST(AddressConfiguration, OnlyAutomaticIPv4CountsAsUncustomised) {
    EXPECT_FALSE(found(usesCustomIPv4(methods("auto", "auto"))));
    EXPECT_FALSE(found(usesCustomIPv4(methods("dynamic", "auto"))));
    for (const char* method : {"manual", "link-local", "shared", "disabled", "static"}) {
        const Outcome outcome = usesCustomIPv4(methods(method, "auto"));
        EXPECT_TRUE(found(outcome)) << method;
        EXPECT_FALSE(outcome->didPass);
        EXPECT_EQ(informationOf(outcome, "IPv4ConfigMethod"), Value(method));
    }
}

TEST(AddressConfiguration, IPv6ThatIsSwitchedOffOrIgnoredCountsAsCustom) {
    for (const char* method : {"auto", "dhcp", "dynamic"})
        EXPECT_FALSE(found(usesCustomIPv6(methods("auto", method))));
    for (const char* method : {"ignore", "disabled", "manual", "link-local"}) {
        const Outcome outcome = usesCustomIPv6(methods("auto", method));
        EXPECT_TRUE(found(outcome)) << method;
        EXPECT_EQ(informationOf(outcome, "IPv6ConfigMethod"), Value(method));
    }
}

TEST(AddressConfiguration, AMethodThatNobodyTellsIsAnError) {
    const AddressMethods unknown{failure(Reason::unavailable, "no manager"),
                                 failure(Reason::timeout, "silent")};
    EXPECT_TRUE(cannotTell(usesCustomIPv4(unknown), Reason::unavailable));
    EXPECT_TRUE(cannotTell(usesCustomIPv6(unknown), Reason::timeout));
}

TEST(AddressConfiguration, AnEndlessIPv4AddressWithoutALeaseIsStatic) {
    const AssignedAddress endless{address("192.168.1.20"), true, false},
        ending{address("192.168.1.21"), false, false};
    EXPECT_EQ(*methodFromIPv4Addresses({endless}, false), "static");
    EXPECT_EQ(*methodFromIPv4Addresses({endless}, true), "dynamic");
    EXPECT_EQ(*methodFromIPv4Addresses({ending}, false), "dynamic");
    EXPECT_EQ(*methodFromIPv4Addresses({{address("169.254.7.7"), true, false}}, false), "dynamic");
    EXPECT_FALSE(methodFromIPv4Addresses({{address("127.0.0.1"), true, false}}, false));
    EXPECT_FALSE(methodFromIPv4Addresses({}, false));
}

TEST(AddressConfiguration, AFileSaysHowIPv4IsSetUpWhereThereIsNoAddress) {
    const AssignedAddress local{address("169.254.7.7"), true, false};
    EXPECT_EQ(*methodFromIPv4Addresses({}, false, {"auto", {}}), "auto");
    EXPECT_EQ(*methodFromIPv4Addresses({}, false, {"manual", {address("10.0.0.7")}}), "manual");
    EXPECT_EQ(*methodFromIPv4Addresses({local}, false, {"link-local", {}}), "link-local");
    EXPECT_EQ(*methodFromIPv4Addresses({}, true, {"manual", {address("10.0.0.7")}}), "dynamic")
        << "a client looks for one";
}

TEST(AddressConfiguration, AnAddressThatStandsInAFileWasEnteredThere) {
    const FamilyPlan plan{"manual", {address("10.0.0.7"), address("2001:db8::7")}};
    const AssignedAddress four{address("10.0.0.7"), true, false}, six{address("2001:db8::7"), true, false},
        granted{address("10.0.0.8"), false, false};
    EXPECT_EQ(*methodFromIPv4Addresses({four}, false, plan), "manual");
    EXPECT_EQ(*methodFromIPv4Addresses({four}, true, plan), "manual") << "a client runs beside it";
    EXPECT_EQ(*methodFromIPv4Addresses({granted}, false, plan), "dynamic") << "the file is not in force";
    const AssignedAddress lent{address("10.0.0.7"), false, false};
    EXPECT_EQ(*methodFromIPv4Addresses({lent}, true, plan), "dynamic") << "the same address by a lease";
    EXPECT_EQ(*methodFromIPv6Addresses({six}, {.setByClient = true}, plan), "manual");
}

TEST(AddressConfiguration, AnEndlessAddressOfAnInterfaceThatAsksForOneTellsNothing) {
    const AssignedAddress endless{address("10.0.0.7"), true, false};
    EXPECT_EQ(methodFromIPv4Addresses({endless}, false, {"auto", {}}).error().code,
              static_cast<int>(Reason::unavailable));
    EXPECT_EQ(*methodFromIPv4Addresses({endless}, true, {"auto", {}}), "dynamic");
    EXPECT_EQ(*methodFromIPv4Addresses({endless}, false), "static");
}

TEST(AddressConfiguration, AFileSaysHowIPv6IsSetUpWhereThereIsNoGlobalAddress) {
    const AssignedAddress local{address("fe80::5"), true, true}, byHand{address("2001:db8::6"), true, false};
    EXPECT_EQ(*methodFromIPv6Addresses({local}, {}, {"manual", {address("2001:db8::7")}}), "manual");
    EXPECT_EQ(*methodFromIPv6Addresses({local}, {false, false}, {"auto", {}}), "auto");
    EXPECT_EQ(*methodFromIPv6Addresses({byHand}, {}, {"auto", {}}), "static");
    EXPECT_EQ(*methodFromIPv6Addresses({local}, {true, false}, {"auto", {}}), "disabled");
}

TEST(AddressConfiguration, IPv6OfARoutersAdvertisementIsDynamicEvenWithoutAnEnd) {
    const AssignedAddress advertised{address("2001:db8::5"), true, true},
        byHand{address("2001:db8::6"), true, false};
    const AssignedAddress local{address("fe80::5"), true, true};
    EXPECT_EQ(*methodFromIPv6Addresses({local, advertised}, {}), "dynamic");
    EXPECT_EQ(*methodFromIPv6Addresses({local, advertised, byHand}, {}), "static");
    EXPECT_EQ(*methodFromIPv6Addresses({local}, {}), "dynamic");
    EXPECT_EQ(*methodFromIPv6Addresses({local}, {false, false}), "link-local");
    EXPECT_EQ(*methodFromIPv6Addresses({byHand}, {true, false}), "disabled");
}

TEST(AddressConfiguration, IPv6WithoutAnEndThatAClientMayHaveSetTellsNothing) {
    const AssignedAddress withoutEnd{address("2001:db8::6"), true, false},
        granted{address("2001:db8::7"), false, false};
    const KernelIPv6 kernel{.setByClient = true};

    EXPECT_EQ(methodFromIPv6Addresses({granted, withoutEnd}, kernel).error().code,
              static_cast<int>(Reason::unavailable));
    EXPECT_EQ(*methodFromIPv6Addresses({granted}, kernel), "dynamic");
}

NameServers servers(std::vector<IPAddress> manual, std::vector<IPAddress> effective,
                    std::vector<IPAddress> offered) {
    return {std::move(manual), std::move(effective), std::move(offered), true, {}};
}

TEST(NameServers, OnlyServersThatTheNetworkDidNotOfferAreCustom) {
    const IPAddress router = address("192.168.1.1"), own = address("9.9.9.9");
    EXPECT_FALSE(found(usesCustomNameServers(servers({}, {router}, {router}))));
    EXPECT_FALSE(found(usesCustomNameServers(servers({}, {}, {}))));
    EXPECT_TRUE(found(usesCustomNameServers(servers({}, {router, own}, {router}))));
    EXPECT_TRUE(found(usesCustomNameServers(servers({router}, {router}, {router}))));
}

TEST(NameServers, AResolverOnTheDeviceHidesWhatItAsks) {
    const IPAddress stub = address("127.0.0.53"), own = address("9.9.9.9"), router = address("192.168.1.1");
    EXPECT_TRUE(cannotTell(usesCustomNameServers(servers({}, {stub}, {router})), Reason::unavailable));
    EXPECT_TRUE(found(usesCustomNameServers(servers({}, {stub, own}, {router}))));
}

TEST(NameServers, WithoutAnOfferToCompareWithOnlyManualOnesAreKnown) {
    NameServers unknown{{}, {address("192.168.1.1")}, {}, false, {}};
    EXPECT_TRUE(cannotTell(usesCustomNameServers(unknown), Reason::unavailable));
    unknown.manual = {address("9.9.9.9")};
    EXPECT_TRUE(found(usesCustomNameServers(unknown)));
    EXPECT_TRUE(cannotTell(usesCustomNameServers(failure(Reason::timeout, "silent")), Reason::timeout));
}

TEST(NameServers, TheNetworksOwnRouterNeedsNoOffer) {
    const IPAddress router = address("192.168.1.1"), own = address("9.9.9.9");
    EXPECT_FALSE(found(usesCustomNameServers(NameServers{{}, {router}, {}, false, {router}})));
    EXPECT_TRUE(cannotTell(usesCustomNameServers(NameServers{{}, {router, own}, {}, false, {router}}),
                           Reason::unavailable));
    EXPECT_TRUE(found(usesCustomNameServers(NameServers{{}, {router}, {}, true, {router}})));
}

TEST(NameServers, OfIPv6MayComeWithAnAdvertisementThatNobodyWroteDown) {
    const IPAddress router = address("192.168.1.1"), other = address("2001:db8::53");
    NameServers leased = servers({}, {router, other}, {router});
    leased.advertisementsKnown = false;
    EXPECT_TRUE(cannotTell(usesCustomNameServers(leased), Reason::unavailable));
    leased.routers = {other};
    EXPECT_FALSE(found(usesCustomNameServers(leased)));
    leased.effective.push_back(address("9.9.9.9"));
    EXPECT_TRUE(found(usesCustomNameServers(leased)));
}

TEST(NameServers, NobodyOffersAnyWhereAllAddressesWereSetByHand) {
    const AssignedAddress byHand{address("192.168.1.20"), true, false}, local{address("fe80::5"), true, true};
    EXPECT_TRUE(allSetByHand({byHand, local}));
    EXPECT_FALSE(allSetByHand({byHand, {address("2001:db8::5"), true, true}}));
    EXPECT_FALSE(allSetByHand({byHand, {address("192.168.1.21"), false, false}}));
    EXPECT_FALSE(allSetByHand({local}));
    EXPECT_FALSE(allSetByHand({}));
}

TEST(WebProxy, AnyPlaceWhereOneIsSetIsAFinding) {
    EXPECT_FALSE(found(usesCustomWebProxy(WebProxyPlaces{})));
    EXPECT_TRUE(found(usesCustomWebProxy(WebProxyPlaces{"environment: https_proxy"})));
}

TEST(Bluetooth, CountsAreToldWhateverTheVerdict) {
    const Outcome few = hasManyConnectedBluetooth(Bluetooth{1, true, 5, 3});
    const Outcome many = hasManyConnectedBluetooth(Bluetooth{1, true, 5, 4});
    EXPECT_FALSE(found(few));
    EXPECT_TRUE(few->didPass);
    EXPECT_EQ(informationOf(few, "BTConnectedCount"), Value(3U));
    EXPECT_TRUE(found(many));
    EXPECT_FALSE(found(hasManyPairedBluetooth(Bluetooth{1, true, 16, 0})));
    const Outcome paired = hasManyPairedBluetooth(Bluetooth{1, true, 17, 0});
    EXPECT_TRUE(found(paired));
    EXPECT_EQ(informationOf(paired, "BTPairedCount"), Value(17U));
    EXPECT_TRUE(found(hasManyPairedBluetooth(Bluetooth{1, true, 3, 0}, {.connected = 3, .paired = 2})));
    EXPECT_TRUE(
        cannotTell(hasManyPairedBluetooth(failure(Reason::unavailable, "no service")), Reason::unavailable));
}

TEST(Bluetooth, AirtimeIsSharedWhereAllThreeConditionsHold) {
    const Bluetooth busy{1, true, 2, 1};
    EXPECT_TRUE(found(sharesAirtimeWithBluetooth(true, busy, Band::ghz2)));
    EXPECT_FALSE(found(sharesAirtimeWithBluetooth(false, busy, Band::ghz2)));
    EXPECT_FALSE(found(sharesAirtimeWithBluetooth(true, busy, Band::ghz5)));
    EXPECT_FALSE(found(sharesAirtimeWithBluetooth(true, busy, Band::none)));
    EXPECT_FALSE(found(sharesAirtimeWithBluetooth(true, Bluetooth{1, true, 2, 0}, Band::ghz2)));
    EXPECT_FALSE(found(sharesAirtimeWithBluetooth(true, Bluetooth{1, false, 2, 1}, Band::ghz2)));
}

TEST(Bluetooth, AnUnknownDriverIsNoGuessUnlessTheRestDecides) {
    const Known<bool> unknown = failure(Reason::unsupported, "no switch");
    EXPECT_TRUE(cannotTell(sharesAirtimeWithBluetooth(unknown, Bluetooth{1, true, 2, 1}, Band::ghz2),
                           Reason::unsupported));
    EXPECT_FALSE(found(sharesAirtimeWithBluetooth(unknown, Bluetooth{}, Band::ghz2)));
    EXPECT_FALSE(found(sharesAirtimeWithBluetooth(unknown, failure(Reason::timeout, "silent"), Band::ghz5)));
    EXPECT_TRUE(cannotTell(sharesAirtimeWithBluetooth(true, failure(Reason::timeout, "silent"), Band::ghz2),
                           Reason::timeout));
}

TEST(PeerLink, OnlyAnActiveLinkOnAnotherChannelTakesTurns) {
    const auto with = [](std::uint32_t link, std::uint32_t station) {
        return peerLinkIsInRealTimeMode(PeerLinks{{{"p2p-wlan0-0", link}}, station, std::nullopt});
    };
    EXPECT_TRUE(found(with(5180, 2412)));
    EXPECT_FALSE(found(with(2412, 2412)));
    EXPECT_FALSE(found(with(0, 2412)));
    EXPECT_FALSE(found(with(5180, 0)));
    EXPECT_FALSE(found(peerLinkIsInRealTimeMode(PeerLinks{})));
    EXPECT_TRUE(found(peerLinkIsInRealTimeMode(PeerLinks{{}, 2412, true})));
    EXPECT_FALSE(found(peerLinkIsInRealTimeMode(PeerLinks{{}, 2412, false})));
    EXPECT_TRUE(
        cannotTell(peerLinkIsInRealTimeMode(failure(Reason::noInterface, "none")), Reason::noInterface));
}

}  // namespace
}  // namespace wp
