#include "linux/radio_messages.h"

#include <gtest/gtest.h>
#include <linux/genetlink.h>
#include <linux/nl80211.h>

#include <algorithm>

#include "linux/gather.h"
#include "linux/netlink_socket.h"
#include "verification/unit/linux/captured.h"

namespace wp {
namespace {

using Buffer = std::vector<std::uint8_t>;

Bytes messageBytes(NetlinkRequest& message) {
    return {reinterpret_cast<const std::uint8_t*>(&message.message()), message.message().nlmsg_len};
}

/// A message of the kernel's, whose attributes `put` puts in.
template <class Put>
Buffer messageOf(std::uint8_t command, Put put) {
    NetlinkRequest message(0x1C, 0);
    message.header<genlmsghdr>() = {command, 1, 0};
    put(message);
    const auto* const bytes = reinterpret_cast<const std::uint8_t*>(&message.message());
    return {bytes, bytes + message.message().nlmsg_len};
}

const AccessPoint& joinedIn(const std::vector<AccessPoint>& accessPoints) {
    return *std::ranges::find_if(accessPoints, &AccessPoint::joined);
}

TEST(RadioMessages, FindTheFamilyAndItsGroups) {
    const auto family = readFamily(captured("good-home-family"));

    ASSERT_TRUE(family);
    EXPECT_GE(family->number, 0x10);
    EXPECT_TRUE(family->groups.contains("scan"));
    EXPECT_TRUE(family->groups.contains("mlme"));
}

TEST(RadioMessages, TellTheInterfaceAndItsChannel) {
    const auto interfaces = readInterfaces(captured("good-home-interface"));

    ASSERT_EQ(1U, interfaces.size());
    EXPECT_EQ("wlan0", interfaces[0].name);
    EXPECT_TRUE(interfaces[0].isStation());
    EXPECT_EQ(2437U, interfaces[0].frequency);
}

TEST(RadioMessages, TellAnInterfaceThatHasJoinedNothing) {
    const auto interfaces = readInterfaces(captured("not-joined-interface"));

    ASSERT_EQ(1U, interfaces.size());
    EXPECT_FALSE(interfaces[0].frequency);
}

TEST(RadioMessages, TellTheJoinedAccessPoint) {
    const auto accessPoints = readAccessPoints(captured("good-home-scan"), 0);

    ASSERT_TRUE(std::ranges::any_of(accessPoints, &AccessPoint::joined));
    const AccessPoint& home = joinedIn(accessPoints);
    EXPECT_EQ("Northlight", textFromName(home.says.name));
    EXPECT_EQ(2437U, home.frequency);
    EXPECT_EQ(100, home.beaconInterval);
    EXPECT_EQ(2, home.says.dtimPeriod);
    EXPECT_EQ(false, home.says.hidesName);
    EXPECT_EQ(Security::wpa2Personal, securityOf(home.says.security));
    EXPECT_EQ((CountryCode{'U', 'S'}), home.says.country);
    EXPECT_EQ("b/g/n", phyModesOf(home));
    ASSERT_TRUE(home.signal);
    EXPECT_LT(*home.signal, -1);
    EXPECT_TRUE(home.lastSeen);
}

TEST(RadioMessages, TellWhatTheScenariosAccessPointsAre) {
    const std::pair<const char*, Security> scenarios[] = {
        {"open-cafe-slow-beacons", Security::open},
        {"wep", Security::wep},
        {"wpa2-and-wpa3", Security::mixedWpa2Wpa3Personal},
        {"owe", Security::owe},
        {"passpoint", Security::wpa2Personal},
    };
    for (const auto& [scenario, security] : scenarios) {
        const auto accessPoints = readAccessPoints(captured(std::string(scenario) + "-scan"), 0);
        ASSERT_FALSE(accessPoints.empty()) << scenario;
        EXPECT_EQ(security, securityOf(joinedIn(accessPoints).says.security)) << scenario;
    }
}

TEST(RadioMessages, TellSlowBeaconsModesAndHotspots) {
    EXPECT_EQ(1000, joinedIn(readAccessPoints(captured("open-cafe-slow-beacons-scan"), 0)).beaconInterval);
    const auto airport = readAccessPoints(captured("passpoint-scan"), 0);
    EXPECT_EQ(1, std::ranges::count_if(airport, [](const AccessPoint& each) { return each.says.hotspot; }));
    EXPECT_FALSE(joinedIn(airport).says.hotspot);
    const auto wifi6 = readAccessPoints(captured("wifi6-scan"), 0);
    EXPECT_TRUE(joinedIn(wifi6).says.he);
    const auto slow = readAccessPoints(captured("rates-11b-only-scan"), 0);
    EXPECT_EQ(22, joinedIn(slow).says.fastestRate);
    EXPECT_EQ("b", phyModesOf(joinedIn(slow)));
}

TEST(RadioMessages, TellAHiddenNeighbourByItsBeacon) {
    const auto accessPoints = readAccessPoints(captured("hidden-neighbour-scan"), 0);

    EXPECT_TRUE(
        std::ranges::any_of(accessPoints, [](const AccessPoint& each) { return each.says.name.absent(); }));
    EXPECT_TRUE(std::ranges::any_of(accessPoints,
                                    [](const AccessPoint& each) { return each.says.hidesName == true; }));
}

/// One access point as the kernel tells it: its address, and what else `put` puts in.
template <class Put>
Buffer entryOf(Put put) {
    return messageOf(NL80211_CMD_NEW_SCAN_RESULTS, [&](NetlinkRequest& request) {
        const std::uint8_t address[6] = {2};
        nlattr* const bss = request.beginNest(NL80211_ATTR_BSS);
        request.put(NL80211_BSS_BSSID, address);
        put(request);
        request.endNest(bss);
    });
}

template <class Put>
AccessPoint accessPointOf(Put put) {
    return readAccessPoints(entryOf(put), 0).at(0);
}

TEST(RadioMessages, TakeAFrameOfAnUntoldKindForABeaconWhereItHasATrafficMap) {
    const Buffer name = {0, 4, 'C', 'a', 'f', 'e'}, trafficMap = {5, 4, 0, 3, 0, 0};
    const auto told = [](const Buffer& elements, bool isAnswer = false) {
        return accessPointOf([&](NetlinkRequest& request) {
            request.put(NL80211_BSS_INFORMATION_ELEMENTS, elements);
            if (isAnswer) request.put(NL80211_BSS_PRESP_DATA, Bytes());
        });
    };
    Buffer beacon = name;
    beacon.insert(beacon.end(), trafficMap.begin(), trafficMap.end());

    EXPECT_EQ(false, told(beacon).says.hidesName);
    EXPECT_EQ(3, told(beacon).says.dtimPeriod);
    EXPECT_TRUE(told(beacon).beaconElements);
    EXPECT_EQ(std::nullopt, told(name).says.hidesName);
    EXPECT_FALSE(told(name).beaconElements);
    EXPECT_EQ("Cafe", textFromName(told(name).says.name));
    EXPECT_EQ(std::nullopt, told(beacon, true).says.hidesName);
    EXPECT_EQ(true, told(trafficMap).says.hidesName);
}

TEST(RadioMessages, FindTheBeaconOfAnAnswerThatTheDriverKeepsApart) {
    const auto entry = [](std::uint32_t frequency, const Buffer& elements) {
        return entryOf([&](NetlinkRequest& request) {
            request.put(NL80211_BSS_FREQUENCY, frequency);
            request.put(NL80211_BSS_INFORMATION_ELEMENTS, elements);
        });
    };
    Buffer dump;
    for (const Buffer& each : {entry(2412, {0, 4, 'C', 'a', 'f', 'e'}), entry(2437, {0, 1, 'B'}),
                               entry(2412, {0, 0, 5, 4, 0, 3, 0, 0})})
        dump.insert(dump.end(), each.begin(), each.end());

    const auto accessPoints = readAccessPoints(dump, 0);

    EXPECT_EQ("Cafe", textFromName(accessPoints.at(0).says.name));
    EXPECT_EQ(true, accessPoints.at(0).says.hidesName);
    EXPECT_EQ(3, accessPoints.at(0).says.dtimPeriod);
    EXPECT_EQ(std::nullopt, accessPoints.at(1).says.hidesName);
}

TEST(RadioMessages, TellTheLinksOfOneAccessPointByTheAddressOfTheWhole) {
    const std::uint8_t whole[6] = {2, 0xE0};
    const AccessPoint link = accessPointOf(
        [&](NetlinkRequest& request) { request.put(NL80211_BSS_MLD_ADDR, Bytes(whole, sizeof whole)); });

    EXPECT_EQ((MacAddress{2}), link.address);
    EXPECT_EQ((MacAddress{2, 0xE0}), link.peer());
    EXPECT_EQ((MacAddress{2}), accessPointOf([](NetlinkRequest&) {}).peer());
}

TEST(RadioMessages, TellAnAccessPointFromNodesOfAMeshAndAdHocNetworks) {
    const auto isDirectOnly = [](std::uint16_t capability) {
        return accessPointOf([&](NetlinkRequest& request) {
                   request.put(NL80211_BSS_CAPABILITY,
                               Bytes(reinterpret_cast<const std::uint8_t*>(&capability), 2));
               })
            .directOnly;
    };

    EXPECT_FALSE(isDirectOnly(0x0411));
    EXPECT_TRUE(isDirectOnly(0x0002));
    EXPECT_TRUE(isDirectOnly(0x0010));
}

TEST(RadioMessages, TellTheLink) {
    const auto station = readStation(captured("good-home-station"));

    ASSERT_TRUE(station);
    ASSERT_EQ(1U, station->signals.size());
    EXPECT_LT(station->signals[0], -1);
    EXPECT_EQ(2, station->dtimPeriod);
    EXPECT_EQ(100, station->beaconInterval);
    EXPECT_FALSE(readStation(captured("not-joined-station")));
}

TEST(RadioMessages, TellOfALinkTheStrengthThatWasMeasured) {
    using Levels = std::vector<std::pair<std::uint16_t, std::int8_t>>;
    const auto signals = [](const Levels& levels) {
        const Buffer message = messageOf(NL80211_CMD_NEW_STATION, [&](NetlinkRequest& request) {
            nlattr* const info = request.beginNest(NL80211_ATTR_STA_INFO);
            for (const auto& [type, level] : levels)
                request.put(type, Bytes(reinterpret_cast<const std::uint8_t*>(&level), 1));
            request.endNest(info);
        });
        return readStation(message)->signals;
    };

    EXPECT_EQ(std::vector{-61},
              signals({{NL80211_STA_INFO_SIGNAL, -60}, {NL80211_STA_INFO_SIGNAL_AVG, -61}}));
    EXPECT_EQ(std::vector{-60}, signals({{NL80211_STA_INFO_SIGNAL, -60}, {NL80211_STA_INFO_SIGNAL_AVG, 0}}));
    EXPECT_TRUE(signals({{NL80211_STA_INFO_SIGNAL, 0}, {NL80211_STA_INFO_SIGNAL_AVG, 0}}).empty());
}

TEST(RadioMessages, TellTheMeasuredNoiseOfAChannel) {
    const Survey survey = readSurvey(captured("good-home-survey"));

    const auto channel = std::ranges::find(survey, 2437U, &SurveyedChannel::frequency);
    ASSERT_NE(survey.end(), channel);
    EXPECT_EQ(-92, channel->noise);
}

TEST(RadioMessages, TellTheRegulatoryDomainOfTheSystem) {
    const auto regulation = readRegulation(captured("good-home-reg"), 0);

    ASSERT_TRUE(regulation);
    EXPECT_EQ("US", regulation->country);
    EXPECT_FALSE(readRegulation({}, 0));
}

TEST(RadioMessages, TellTheRadiosOwnRegulatoryDomainWhereItNamesACountryOrIsManagedByTheRadio) {
    const auto domain = [](const char* country, std::optional<std::uint32_t> radio,
                           bool managesItself = false) {
        return messageOf(NL80211_CMD_GET_REG, [&](NetlinkRequest& message) {
            message.put(NL80211_ATTR_REG_ALPHA2, Bytes(reinterpret_cast<const std::uint8_t*>(country), 3));
            if (radio) message.put(NL80211_ATTR_WIPHY, *radio);
            if (managesItself) message.put(NL80211_ATTR_WIPHY_SELF_MANAGED_REG, Bytes());
        });
    };
    const auto told = [&](const Buffer& own) {
        Buffer dump = domain("US", std::nullopt);
        dump.insert(dump.end(), own.begin(), own.end());
        return readRegulation(dump, 2)->country;
    };

    EXPECT_EQ("DE", told(domain("DE", 2)));
    EXPECT_EQ("US", told(domain("DE", 3)));
    EXPECT_EQ("US", told(domain("99", 2)));
    EXPECT_EQ("00", told(domain("00", 2, true)));
    EXPECT_EQ("99", readRegulation(domain("99", 2), 2)->country);
}

TEST(RadioMessages, GatherARadioFromItsManyMessages) {
    const Buffer dump = captured("good-home-wiphy");
    const auto interfaces = readInterfaces(captured("good-home-interface"));

    const auto abilities = readAbilities(dump, interfaces.at(0).radio);

    ASSERT_TRUE(abilities);
    EXPECT_GE(abilities->namesPerScan, 1U);
    const auto has = [&](std::uint32_t frequency) {
        return std::ranges::any_of(abilities->channels,
                                   [&](auto& channel) { return channel.frequency == frequency; });
    };
    EXPECT_TRUE(has(2412));
    EXPECT_TRUE(has(5180));
    EXPECT_TRUE(std::ranges::any_of(abilities->channels, &RadioChannel::radar));
    EXPECT_FALSE(readAbilities(dump, 4711));
}

TEST(RadioMessages, KnowARadioThatTheKernelScansFromOneThatScansByItself) {
    for (const bool inSoftware : {true, false}) {
        const std::string scenario = inSoftware ? "good-home" : "radio-scans-by-itself";
        const auto abilities = readAbilities(captured(scenario + "-wiphy"), 0);
        ASSERT_TRUE(abilities) << scenario;
        EXPECT_EQ(inSoftware, abilities->scansInSoftware) << scenario;
    }
}

TEST(RadioMessages, KnowTheChannelsOfVehiclesFromThoseOfNetworks) {
    std::vector<std::uint32_t> leftOut;
    for (std::uint32_t frequency = 5000; frequency <= 7115; ++frequency)
        if (!RadioChannel{frequency, false, false, false}.carriesNetworks()) leftOut.push_back(frequency);

    const auto isLeftOut = [&](std::uint32_t frequency) {
        return std::ranges::find(leftOut, frequency) != leftOut.end();
    };
    for (const std::uint32_t network : {2412, 5180, 5825, 5845, 5865, 5885, 5905, 5955})
        EXPECT_FALSE(isLeftOut(network)) << network;
    for (const std::uint32_t vehicles : {5855, 5860, 5870, 5875, 5880, 5890, 5900, 5920})
        EXPECT_TRUE(isLeftOut(vehicles)) << vehicles;
    EXPECT_GT(leftOut.front(), 5845U);
    EXPECT_LT(leftOut.back(), 5955U);
    for (const std::uint32_t other : {920, 4920, 4980})
        EXPECT_FALSE((RadioChannel{other, false, false, false}.carriesNetworks())) << other;
    for (const std::uint32_t network : {2412, 2484})
        EXPECT_TRUE((RadioChannel{network, false, false, false}.carriesNetworks())) << network;
}

TEST(RadioMessages, TellAChannelThatIsTooNarrowForNetworks) {
    NetlinkRequest message(0x1C, 0);
    message.header<genlmsghdr>() = {NL80211_CMD_NEW_WIPHY, 1, 0};
    message.put(NL80211_ATTR_WIPHY, 0U);
    nlattr* const bands = message.beginNest(NL80211_ATTR_WIPHY_BANDS);
    nlattr* const band = message.beginNest(NL80211_BAND_5GHZ);
    nlattr* const channels = message.beginNest(NL80211_BAND_ATTR_FREQS);
    for (const std::uint16_t number : {0, 1}) {
        nlattr* const channel = message.beginNest(number);
        message.put(NL80211_FREQUENCY_ATTR_FREQ, 5845U + 20 * number);
        if (number == 1) message.put(NL80211_FREQUENCY_ATTR_NO_20MHZ, Bytes());
        message.endNest(channel);
    }
    for (nlattr* const nest : {channels, band, bands}) message.endNest(nest);

    const auto abilities = readAbilities(messageBytes(message), 0);

    ASSERT_TRUE(abilities);
    ASSERT_EQ(2U, abilities->channels.size());
    EXPECT_TRUE(abilities->channels[0].carriesNetworks());
    EXPECT_FALSE(abilities->channels[1].carriesNetworks());
}

TEST(AllowedChannels, AreThoseOnWhichNetworksCanBe) {
    const AllowedChannels allowed = allowedAmong(readAbilities(captured("good-home-wiphy"), 0)->channels);

    std::vector<std::uint32_t> highest;
    for (const auto& each : allowed)
        if (each.frequency > 5805) highest.push_back(each.frequency);
    EXPECT_EQ((std::vector<std::uint32_t>{5825, 5845, 5865, 5885}), highest);
    EXPECT_EQ(2412U, allowed.front().frequency);
}

TEST(RadioMessages, KnowTheFifteenChannelsOf6GHzOnWhichNetworksAnnounceThemselves) {
    std::vector<std::uint32_t> announcing;
    for (std::uint32_t frequency = 5955; frequency <= 7115; frequency += 20)
        if (RadioChannel{frequency, false, false, false}.isForScanning()) announcing.push_back(frequency);

    EXPECT_EQ(announcing.size(), 15U);
    EXPECT_EQ(announcing.front(), 5975U);  // channel 5
    EXPECT_EQ(announcing.back(), 7095U);   // channel 229
    for (const std::uint32_t below : {2412, 2484, 5180, 5885})
        EXPECT_TRUE((RadioChannel{below, false, false, false}.isForScanning())) << below;
}

TEST(RadioMessages, TellStartAndEndOfScans) {
    const auto events = readScanEvents(captured("good-home-scan_events"));

    ASSERT_EQ(4U, events.size());
    EXPECT_EQ(ScanEvent::Kind::started, events[0].kind);
    EXPECT_EQ(ScanEvent::Kind::finished, events[1].kind);
    EXPECT_FALSE(events[1].probedForAll);
    EXPECT_EQ(ScanEvent::Kind::finished, events[3].kind);
    EXPECT_TRUE(events[3].probedForAll);
    EXPECT_GT(events[3].frequencies.size(), 11U);
    EXPECT_EQ(2412U, events[3].frequencies.front());
}

TEST(RadioMessages, TellTheEndOfAScanByAPeerToPeerDeviceThoughItHasNoInterface) {
    NetlinkRequest message(0x1C, 0);
    message.header<genlmsghdr>() = {NL80211_CMD_NEW_SCAN_RESULTS, 1, 0};
    message.put(NL80211_ATTR_WIPHY, 3U);

    const auto events = readScanEvents(messageBytes(message));

    ASSERT_EQ(1U, events.size());
    EXPECT_EQ(3U, events[0].radio);
    EXPECT_EQ(0U, events[0].interfaceIndex);
}

TEST(RadioMessages, SurviveAnyCutOfADump) {
    const Buffer dump = captured("wpa1-other-country-scan");
    for (std::size_t size = 0; size <= dump.size(); ++size) {
        const Buffer prefix(dump.begin(), dump.begin() + static_cast<std::ptrdiff_t>(size));
        EXPECT_LE(readAccessPoints(prefix, 0).size(), 4U);
    }
}

}  // namespace
}  // namespace wp
