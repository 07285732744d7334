#include "service/congestion.h"

#include <gtest/gtest.h>

#include "platform/records.h"
#include "verification/unit/service/finding.h"
#include "verification/unit/service/frames.h"

namespace wp {
namespace {

AllowedChannels allChannels() {
    AllowedChannels channels;
    for (std::uint32_t frequency = 2412; frequency <= 2472; frequency += 5)
        channels.push_back({frequency, false, false});
    for (const std::uint32_t number : {36, 40, 44, 48, 52, 56, 149, 153})
        channels.push_back({5000 + 5 * number, false, number == 52 || number == 56});
    return channels;
}

AccessPoint at(std::uint32_t frequency, int signal, const Frame& more = {}) {
    return heard(nameElement("Other") + more, frequency, signal);
}

AirFacts air(std::vector<AccessPoint> nearby) {
    return {std::move(nearby), failure(Reason::unsupported, "no survey"), allChannels()};
}

std::int64_t channelIn(const Outcome& outcome, std::string_view key) {
    const auto record = informationOf(outcome, key).asRecord<WiFiChannel>();
    return record != nullptr ? record->channel : -1;
}

ChannelTime counted(std::uint32_t frequency, std::uint64_t time, std::uint64_t busy,
                    std::uint64_t transmit = 0, std::uint64_t own = 0) {
    return {frequency, true, time, busy, transmit, own, -95};
}

TEST(ChannelLoad, LeavesOutWhatTheDeviceItselfSentAndReceived) {
    EXPECT_NEAR(*foreignLoad(counted(2412, 1000, 700, 200, 100)), 0.5, 1e-9);
    EXPECT_NEAR(*foreignLoad(counted(2412, 1000, 100, 200, 0)), 0.0, 1e-9);
    EXPECT_FALSE(foreignLoad(counted(2412, 10, 5)));
    EXPECT_FALSE(foreignLoad(counted(2412, 100, 100, 100)));
    ChannelTime silent = counted(2412, 1000, 0);
    silent.busy.reset();
    EXPECT_FALSE(foreignLoad(silent));
}

TEST(ChannelLoad, DifferencesLeaveOutCountersThatRanBackwards) {
    const Airtime before = {counted(2412, 5000, 1000, 10, 20), counted(2437, 5000, 1000),
                            counted(2462, 1, 1)};
    const Airtime after = {counted(2412, 6000, 1600, 30, 50), counted(2437, 100, 10), counted(5180, 9, 1)};

    const Airtime difference = airtimeBetween(before, after);

    ASSERT_EQ(difference.size(), 1U);
    EXPECT_EQ(difference[0].frequency, 2412U);
    EXPECT_EQ(difference[0].time, 1000U);
    EXPECT_EQ(difference[0].busy, 600U);
    EXPECT_EQ(difference[0].transmit, 20U);
    EXPECT_EQ(difference[0].receiveOwn, 30U);
}

TEST(ChannelLoad, AWideNetworkOccupiesItsWholeWidth) {
    AccessPoint wide = at(5180, -50, element(192, {1, 42, 0, 0, 0}));
    EXPECT_EQ(occupiedBy(wide), (std::vector<Span>{{5170, 5250}}));
    wide = at(5180, -50, element(192, {1, 42, 50, 0, 0}));
    EXPECT_EQ(occupiedBy(wide), (std::vector<Span>{{5170, 5330}}));
    wide = at(5180, -50, element(192, {1, 42, 155, 0, 0}));
    EXPECT_EQ(occupiedBy(wide), (std::vector<Span>{{5170, 5250}, {5735, 5815}}));
    wide = at(5180, -50, element(192, {0, 0, 0, 0, 0}));
    EXPECT_EQ(occupiedBy(wide), (std::vector<Span>{{5170, 5190}}));
    AccessPoint forty = at(2412, -50);
    forty.says.htSecondary = 1;
    EXPECT_EQ(occupiedBy(forty), (std::vector<Span>{{2402, 2442}}));
    forty.says.htSecondary = 3;
    forty.frequency = 2437;
    EXPECT_EQ(occupiedBy(forty), (std::vector<Span>{{2407, 2447}}));
}

TEST(ChannelLoad, NearOnesWeighFullFarOnesHalfOrNothing) {
    const std::vector<AccessPoint> nearby = {at(2412, -67), at(2417, -68), at(2427, -82), at(2412, -83),
                                             at(2437, -30)};
    EXPECT_DOUBLE_EQ(overlapWeight(2412, nearby, nullptr), 2.0);
    EXPECT_DOUBLE_EQ(overlapWeight(2412, nearby, &nearby[0]), 1.0);
}

TEST(ChannelLoad, TheOwnRadioDoesNotCompeteWithItselfUnderItsOtherNames) {
    const AccessPoint home = at(2412, -40);
    AccessPoint guests = at(2412, -42), elsewhere = at(2437, -40), stranger = at(2412, -60);
    guests.address = elsewhere.address = home.address;
    guests.address.back() += 15;
    elsewhere.address.front() |= 8;
    AccessPoint strangersGuests = at(2412, -70);
    strangersGuests.address = stranger.address;
    strangersGuests.address.front() |= 4;
    AccessPoint neighbour = home;
    neighbour.address.back() += 16;

    const std::vector<AccessPoint> nearby = {home, guests, elsewhere, strangersGuests, stranger};
    EXPECT_DOUBLE_EQ(overlapWeight(2412, nearby, &home), 1.5);
    EXPECT_DOUBLE_EQ(overlapWeight(2412, nearby, nullptr), 3.5);
    EXPECT_EQ(strongOverlaps(2412, nearby, nullptr), 3U);
    EXPECT_DOUBLE_EQ(overlapWeight(2437, nearby, &home), 1.0) << "another radio of the same device";
    EXPECT_DOUBLE_EQ(overlapWeight(2412, {home, neighbour}, &home), 1.0);
}

TEST(ChannelLoad, AnAccessPointThatIsKeptTwiceCountsOnce) {
    const AccessPoint hidden = at(2412, -50);
    AccessPoint named = hidden;
    named.says.name = NetworkName();

    EXPECT_DOUBLE_EQ(overlapWeight(2412, {hidden, named}, nullptr), 1.0);
    EXPECT_EQ(strongOverlaps(2412, {hidden, named}, nullptr), 1U);
}

TEST(ChannelLoad, TheOwnAccessPointIsLeftOutWhereItHasChangedItsChannelMeanwhile) {
    const AccessPoint before = at(2412, -40);
    AccessPoint after = before;
    after.frequency = 2437;

    EXPECT_DOUBLE_EQ(overlapWeight(2437, {after}, &before), 0.0);
}

TEST(Congestion, MeasuredAirtimeDecidesForTheJoinedNetwork) {
    AccessPoint joined = at(2412, -40, element(11, {1, 0, 200, 0, 0}));
    joined.joined = true;
    AirFacts facts = air({joined});
    facts.airtime = Airtime{counted(2412, 1000, 400)};
    EXPECT_FALSE(found(channelIsCongested(joined, facts, &joined)));
    facts.airtime = Airtime{counted(2412, 1000, 500)};
    EXPECT_TRUE(found(channelIsCongested(joined, facts, &joined)));
}

TEST(Congestion, TheAdvertisedLoadDecidesForAnotherNetworkAndWithoutASurvey) {
    const AccessPoint full = at(2412, -40, element(11, {1, 0, 128, 0, 0})),
                      half = at(2412, -40, element(11, {1, 0, 127, 0, 0}));
    AirFacts facts = air({full, half});
    EXPECT_TRUE(found(channelIsCongested(full, facts, nullptr)));
    EXPECT_FALSE(found(channelIsCongested(half, facts, nullptr)));
    facts.airtime = Airtime{counted(2412, 1000, 10)};
    EXPECT_TRUE(found(channelIsCongested(full, facts, nullptr)));
}

TEST(Congestion, TheOverlapCountDecidesWhereNothingWasMeasured) {
    const AccessPoint judged = at(2412, -40);
    AirFacts facts = air({judged, at(2412, -50), at(2417, -50), at(2422, -75)});
    EXPECT_FALSE(found(channelIsCongested(judged, facts, nullptr)));
    facts.nearby->push_back(at(2412, -80));
    EXPECT_TRUE(found(channelIsCongested(judged, facts, nullptr)));
    facts.nearby = failure(Reason::timeout, "no scan");
    EXPECT_TRUE(cannotTell(channelIsCongested(judged, facts, nullptr), Reason::timeout));
}

TEST(Congestion, CannotBeToldWhereTheDriverTellsNoStrengths) {
    AirFacts unweighed = air({at(2412, 0), at(2412, 0), at(2437, 0)});
    unweighed.nearby->back().signal.reset();
    const AccessPoint own = at(2412, -40);

    EXPECT_TRUE(cannotTell(channelIsCongested(own, unweighed, &own), Reason::unsupported));
    EXPECT_TRUE(cannotTell(band2IsCongested(unweighed, &own), Reason::unsupported));
    EXPECT_FALSE(recommend(unweighed, &own).ghz2);
    unweighed.nearby->back().signal = -90;
    EXPECT_FALSE(found(channelIsCongested(own, unweighed, &own)));
}

TEST(Congestion, ABandIsCongestedOnlyWhereNoChannelIsLeft) {
    std::vector<AccessPoint> nearby;
    for (const std::uint32_t frequency : {2412U, 2437U, 2462U})
        for (int i = 0; i < 3; ++i) nearby.push_back(at(frequency, -50));
    EXPECT_TRUE(found(band2IsCongested(air(nearby), nullptr)));
    EXPECT_FALSE(found(band5IsCongested(air(nearby), nullptr)));
    nearby.pop_back();
    EXPECT_FALSE(found(band2IsCongested(air(nearby), nullptr)));
}

TEST(Congestion, ARadioWithoutTheBandCannotTell) {
    AirFacts facts = air({});
    facts.allowed = AllowedChannels{{2412, false, false}};
    EXPECT_TRUE(cannotTell(band5IsCongested(facts, nullptr), Reason::unsupported));
    const Outcome outcome = band2IsCongested(facts, nullptr);
    EXPECT_EQ(channelIn(outcome, "2GHzChannel"), 1);
    EXPECT_EQ(channelIn(outcome, "5GHzChannel"), -1);
}

TEST(Congestion, RecommendsTheEmptiestChannelsAndKeepsOnesOwnAmongEquals) {
    const AccessPoint joined = at(2437, -40);
    const std::vector<AccessPoint> nearby = {joined,        at(2412, -50), at(5180, -50),
                                             at(5200, -50), at(5220, -75), at(5745, -70)};
    const Outcome outcome = channelIsCongested(joined, air(nearby), &joined);
    EXPECT_EQ(channelIn(outcome, "CurrentChannel"), 6);
    EXPECT_EQ(channelIn(outcome, "2GHzChannel"), 6);
    EXPECT_EQ(channelIn(outcome, "5GHzChannel"), 48);
    EXPECT_EQ(channelIn(outcome, "5GHz40MHzChannel"), 52);
    EXPECT_EQ(channelIn(outcome, "5GHzNonDFSChannel"), 48);
}

TEST(Congestion, ACompleteSurveyComesBeforeTheScan) {
    AirFacts facts = air({at(2412, -30)});
    facts.airtime = Airtime{counted(2412, 100, 1), counted(2437, 100, 50), counted(2462, 100, 40)};
    EXPECT_EQ(recommend(facts, nullptr).ghz2, 1);
    facts.airtime = Airtime{counted(2412, 100, 1), counted(2437, 100, 50)};
    EXPECT_EQ(recommend(facts, nullptr).ghz2, 6);
}

TEST(Congestion, WithoutAnyLookAtTheAirNothingIsRecommended) {
    AirFacts facts = air({});
    facts.nearby = failure(Reason::timeout, "no scan");
    const Recommendation none = recommend(facts, nullptr);
    EXPECT_FALSE(none.ghz2 || none.ghz5 || none.ghz5Wide || none.ghz5NoRadar);
}

}  // namespace
}  // namespace wp
