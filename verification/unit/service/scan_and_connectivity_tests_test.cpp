#include <cmath>

#include "platform/records.h"
#include "service/connectivity_tests.h"
#include "service/scan_tests.h"
#include "verification/unit/service/frames.h"
#include "verification/unit/service/verdict.h"

namespace wp {
namespace {

using Scan = std::vector<std::shared_ptr<const WiFiScanResult>>;

Scan scanIn(int number, const Facts& facts) {
    const Value value = infoOf(number, facts, "ScanResults");
    Scan scan;
    if (const ArrayPointer* array = value.as<ArrayPointer>()) {
        for (const Value& each : **array) scan.push_back(each.asRecord<WiFiScanResult>());
    }
    return scan;
}

TEST(ScanTests, ListAllAccessPointsHiddenOnesToo) {
    const AccessPoint home = heard(nameElement("Home"), 2412, -40);
    const AccessPoint hidden = heard(nameElement(""), 2412, -60);

    const Facts facts = joinedTo({home, hidden});
    const Scan scan = scanIn(31, facts);

    EXPECT_FALSE(resultOf(31, facts));
    ASSERT_EQ(2U, scan.size());
    EXPECT_EQ("Home", scan[0]->ssid);
    EXPECT_EQ(-40, scan[0]->rssi);
    EXPECT_EQ(textOf(home.address), scan[0]->bssid);
    EXPECT_FALSE(scan[1]->ssid);
}

TEST(ScanTests, FindNoNetworksInAnEmptyScan) {
    Facts facts;
    facts.nearby = std::vector<AccessPoint>();
    facts.listened = std::vector<AccessPoint>();

    EXPECT_TRUE(resultOf(31, facts));
    EXPECT_FALSE(verdictOf(31, facts)->didPass);
    EXPECT_FALSE(resultOf(30, facts));
}

TEST(ScanTests, CountHiddenAccessPointsThatHaveNotToldTheirName) {
    const AccessPoint first = heard(nameElement(""));
    AccessPoint revealed = heard(nameElement("Secret"));
    AccessPoint revealedBeacon = heard(nameElement(std::string_view("\0\0\0", 3)));
    revealedBeacon.address = revealed.address;

    const Facts facts = joinedTo({heard(nameElement("Home")), first, revealed, revealedBeacon});

    EXPECT_TRUE(resultOf(30, facts));
    ASSERT_EQ(1U, scanIn(30, facts).size());
    EXPECT_EQ(textOf(first.address), scanIn(30, facts)[0]->bssid);
    EXPECT_EQ(3U, scanIn(31, facts).size());
}

TEST(ScanTests, CountHiddenAccessPointsThatOnlyListeningHeardOnce) {
    const AccessPoint scanned = heard(nameElement(""));
    const AccessPoint listenedTo = heard(nameElement(""));
    Facts facts = joinedTo({heard(nameElement("Home")), scanned});
    facts.listened = std::vector<AccessPoint>{scanned, listenedTo};

    EXPECT_EQ(2U, scanIn(30, facts).size());
    EXPECT_EQ(2U, scanIn(31, facts).size());
}

TEST(ScanTests, TakeNoNodeOfAMeshAndNoAdHocNetworkForAnAccessPoint) {
    AccessPoint node = heard(nameElement("")), adHoc = heard(nameElement("Home"), 5180, -30);
    node.directOnly = adHoc.directOnly = true;
    const AccessPoint home = heard(nameElement("Home"), 5200, -60);
    Facts facts = joinedTo({home, node, adHoc});
    facts.listened = std::vector<AccessPoint>{node};

    EXPECT_FALSE(resultOf(30, facts));
    EXPECT_EQ(1U, scanIn(31, facts).size());
    EXPECT_EQ(Value(-60), infoOf(32, askedAbout("Home", *facts.nearby), "RSSI"));
    EXPECT_EQ(3, errorOf(32, askedAbout("Home", {node, adHoc})));
}

TEST(ScanTests, CannotTellAboutHiddenNetworksWithoutListening) {
    Facts facts = joinedTo({heard(nameElement("Home"))});
    facts.listened = failure(Reason::timeout, "listening took too long");

    EXPECT_EQ(7, errorOf(30, facts));
    EXPECT_FALSE(resultOf(31, facts));
}

TEST(ScanTests, CannotTellWithoutAScan) {
    Facts facts;
    facts.nearby = failure(Reason::notPermitted, "no permission to scan");

    EXPECT_EQ(6, errorOf(30, facts));
    EXPECT_EQ(6, errorOf(31, facts));
}

Address address(Address::Family family, std::vector<std::uint8_t> bytes) {
    return {family, std::move(bytes), true, true};
}

Facts withAddress(const Address& address) {
    Facts facts = joinedTo({heard(nameElement("Home"))});
    facts.addresses = Addresses{address};
    return facts;
}

TEST(ConnectivityTests, CountOnlyAddressesThatCarryTraffic) {
    const auto v4 = Address::Family::ipv4;
    EXPECT_TRUE(resultOf(12, withAddress(address(v4, {10, 0, 0, 5}))));
    EXPECT_FALSE(resultOf(13, withAddress(address(v4, {10, 0, 0, 5}))));
    EXPECT_FALSE(resultOf(12, withAddress(address(v4, {169, 254, 3, 4}))));
    EXPECT_FALSE(resultOf(12, withAddress(address(v4, {0, 0, 0, 0}))));
    Address tentative = address(v4, {10, 0, 0, 5});
    tentative.usable = false;
    EXPECT_FALSE(resultOf(12, withAddress(tentative)));
    Address host = address(v4, {10, 0, 0, 5});
    host.global = false;
    EXPECT_FALSE(resultOf(12, withAddress(host)));
}

TEST(ConnectivityTests, CountUniqueLocalIPv6AddressesButNoLinkLocalOnes) {
    std::vector<std::uint8_t> bytes(16, 0);
    const auto with = [&](std::uint8_t first, std::uint8_t second) {
        bytes[0] = first;
        bytes[1] = second;
        return withAddress(address(Address::Family::ipv6, bytes));
    };

    EXPECT_TRUE(resultOf(13, with(0x20, 0x01)));
    EXPECT_TRUE(resultOf(13, with(0xFD, 0x00)));
    EXPECT_FALSE(resultOf(13, with(0xFE, 0x80)));
    EXPECT_FALSE(resultOf(13, with(0xFE, 0xBF)));
}

TEST(ConnectivityTests, AskForAJoinedNetwork) {
    Facts facts = withAddress(address(Address::Family::ipv4, {10, 0, 0, 5}));
    facts.link->joined.reset();

    EXPECT_EQ(2, errorOf(12, facts));
    EXPECT_EQ(2, errorOf(13, facts));
}

/// 1 - 4.0 / 5 is not the number that is written 0.2.
TEST(ConnectivityTests, TellALossOfOneInFiveWithoutARestOfRounding) {
    Facts facts;
    facts.gatewayEcho = Echo{"wlan0", "10.0.0.1", {1.0, 1.0, std::nullopt, 1.0, 1.0}, 0};
    EXPECT_EQ(0.2, infoOf(3, facts, "PingResult").asRecord<PingStatistics>()->packetLoss);
}

TEST(ConnectivityTests, PassThePingWithOneAnswer) {
    Facts facts;
    facts.gatewayEcho = Echo{"wlan0", "10.0.0.1", {std::nullopt, 4.0, std::nullopt, 2.0, 6.0}, 1000.5};

    const auto statistics = infoOf(3, facts, "PingResult").asRecord<PingStatistics>();

    EXPECT_TRUE(verdictOf(3, facts)->didPass);
    ASSERT_TRUE(statistics);
    EXPECT_EQ("wlan0", statistics->interfaceName);
    EXPECT_EQ(5, statistics->count);
    EXPECT_DOUBLE_EQ(0.4, statistics->packetLoss);
    EXPECT_EQ(2.0, statistics->min);
    EXPECT_EQ(6.0, statistics->max);
    EXPECT_EQ(4.0, statistics->avg);
    EXPECT_NEAR(1.63299, statistics->stddev, 1e-5);
    EXPECT_EQ(1000.5, statistics->timestamp);
}

TEST(ConnectivityTests, GiveNoTimesWithoutAnAnswer) {
    Facts facts;
    facts.gatewayEcho = Echo{"wlan0", "10.0.0.1", std::vector<std::optional<double>>(5), 0};

    const auto statistics = infoOf(3, facts, "PingResult").asRecord<PingStatistics>();

    EXPECT_FALSE(resultOf(3, facts));
    EXPECT_FALSE(verdictOf(3, facts)->didPass);
    EXPECT_EQ(1.0, statistics->packetLoss);
    EXPECT_TRUE(std::isnan(statistics->min) && std::isnan(statistics->max) && std::isnan(statistics->avg));
}

TEST(ConnectivityTests, SayWhyThereIsNoGateway) {
    Facts facts;
    facts.gatewayEcho = failure(Reason::notJoined, "wlan0 has no default route");

    EXPECT_EQ(2, errorOf(3, facts));
}

TEST(Catalogue, HoldsThe41TestsInOrder) {
    const int wanted[] = {3,  6,  7,  8,  9,  11, 12, 13, 14, 15, 16, 17, 18, 19, 20, 22, 24, 25, 26, 27, 28,
                          29, 30, 31, 32, 33, 34, 35, 36, 37, 38, 39, 40, 41, 42, 43, 44, 45, 46, 47, 48};
    ASSERT_EQ(std::size(wanted), numberedTests().size());
    for (std::size_t i = 0; i < std::size(wanted); ++i) EXPECT_EQ(wanted[i], numberedTests()[i].number);
    EXPECT_EQ(nullptr, findTest(1));
    EXPECT_EQ(nullptr, findTest(49));
    EXPECT_EQ(34, findTest(34)->number);
}

TEST(Catalogue, AnswersATestThatIsNotMeasuredWithAnError) {
    for (const NumberedTest& test : numberedTests()) {
        if (test.verdict != nullptr) continue;
        EXPECT_EQ(5, errorOf(test.number, Facts()));
    }
}

TEST(Catalogue, NeverGuessesWithoutFacts) {
    for (const NumberedTest& test : numberedTests())
        EXPECT_NE(0, errorOf(test.number, Facts())) << test.number;
}

}  // namespace
}  // namespace wp
