#include "linux/scan_row.h"

#include <gtest/gtest.h>
#include <linux/genetlink.h>
#include <linux/nl80211.h>

#include <chrono>
#include <string_view>

namespace wp {
namespace {

using Frequencies = std::vector<std::uint32_t>;
using std::chrono::milliseconds;

constexpr ScanSlicing kJoinedInSoftware{true, 2437};

ScanOrder listeningOn(Frequencies frequencies) {
    return {{}, false, std::move(frequencies)};
}

ScanOrder callingOn(Frequencies frequencies) {
    return {{}, true, std::move(frequencies)};
}

NetworkName nameOf(std::string_view text) {
    return NetworkName({reinterpret_cast<const std::uint8_t*>(text.data()), text.size()});
}

ScanEvent finished(Frequencies frequencies = {}, bool probedForAll = false) {
    return {ScanEvent::Kind::finished, 3, std::move(frequencies), probedForAll};
}

ScanEvent aborted() {
    return {ScanEvent::Kind::aborted, 3, {}, false};
}

/// Each request of a row that nothing disturbs.
std::vector<Frequencies> requestsOf(ScanRow row) {
    std::vector<Frequencies> requests;
    while (!row.isComplete()) {
        requests.push_back(row.next().frequencies);
        row.ended(ScanRow::Whose::own, finished());
    }
    return requests;
}

TEST(ScanRow, AsksForOneChannelAfterTheOtherWhereTheKernelWouldGoHomeBetween) {
    const std::vector<Frequencies> expected = {{2437}, {2412}, {5180}};
    EXPECT_EQ(expected, requestsOf({listeningOn({2437, 2412, 5180}), kJoinedInSoftware}));
}

TEST(ScanRow, IsOneRequestWhereTheRadioScansByItselfOrIsNotJoined) {
    const std::vector<Frequencies> expected = {{2437, 2412, 5180}};
    EXPECT_EQ(expected, requestsOf({listeningOn({2437, 2412, 5180}), {}}));
}

TEST(ScanRow, LeavesHomeBrieflyForEachChannelButItsOwn) {
    ScanRow row(listeningOn({2437, 2412}), kJoinedInSoftware);
    EXPECT_EQ(std::nullopt, row.visit());
    row.ended(ScanRow::Whose::own, finished());
    EXPECT_EQ(HomeChannel::Visit::brief, row.visit());
}

TEST(ScanRow, LeavesHomeForLongWhereTheRadioVisitsAllChannelsInOneGo) {
    EXPECT_EQ(HomeChannel::Visit::lengthy, ScanRow(listeningOn({2437, 2412}), {}).visit());
    EXPECT_EQ(HomeChannel::Visit::lengthy, ScanRow(listeningOn({}), kJoinedInSoftware).visit());
}

TEST(ScanRow, GoesOnWithoutAChannelThatIsRefusedAfterOthers) {
    ScanRow row(listeningOn({2437, 2412, 5180}), kJoinedInSoftware);
    EXPECT_FALSE(row.skip());
    row.ended(ScanRow::Whose::own, finished());

    EXPECT_TRUE(row.skip());
    EXPECT_EQ(Frequencies{5180}, row.next().frequencies);
    row.ended(ScanRow::Whose::own, finished());
    EXPECT_TRUE(row.isComplete());
}

TEST(ScanRow, BlamesNoChannelWhereAllAreAskedForAtOnce) {
    ScanRow row(listeningOn({2437, 2412}), {});
    EXPECT_FALSE(row.skip());
}

TEST(ScanRow, IsOneRequestForAllChannelsWhereNoneIsNamed) {
    for (const ScanSlicing& slicing : {ScanSlicing{}, kJoinedInSoftware})
        EXPECT_EQ(std::vector<Frequencies>{{}}, requestsOf({listeningOn({}), slicing}));
}

TEST(ScanRow, AsksForTheSameNamesOnEachChannel) {
    const NetworkName name = nameOf("Northlight");
    ScanRow row({{name}, true, {2437, 2412}}, kJoinedInSoftware);
    row.ended(ScanRow::Whose::own, finished());

    EXPECT_EQ(Frequencies{2412}, row.next().frequencies);
    EXPECT_EQ(std::vector<NetworkName>{name}, row.next().names);
    EXPECT_TRUE(row.next().probeForAll);
}

TEST(ScanRow, StaysAtHomeForAWhileAfterEachChannelButTheOwn) {
    ScanRow row(listeningOn({2437, 2412, 5180}), kJoinedInSoftware);
    EXPECT_EQ(milliseconds(0), row.pause());
    row.ended(ScanRow::Whose::own, finished());
    EXPECT_EQ(milliseconds(0), row.pause());
    row.ended(ScanRow::Whose::own, finished());
    EXPECT_GE(row.pause(), milliseconds(25));
    EXPECT_LE(row.pause(), milliseconds(60));
}

TEST(ScanRow, NeedsNoStayAtHomeBetweenRequestsForAllChannels) {
    ScanRow row(listeningOn({2437, 2412}), {});
    row.ended(ScanRow::Whose::own, aborted());
    EXPECT_EQ(milliseconds(0), row.pause());
}

TEST(ScanRow, RepeatsAnAbortedRequestOnceAndThenGivesUp) {
    ScanRow row(listeningOn({2412, 5180}), kJoinedInSoftware);
    row.ended(ScanRow::Whose::own, aborted());
    EXPECT_FALSE(row.isGivenUp());
    EXPECT_EQ(Frequencies{2412}, row.next().frequencies);
    row.ended(ScanRow::Whose::own, aborted());
    EXPECT_TRUE(row.isGivenUp());
    EXPECT_FALSE(row.isComplete());
}

TEST(ScanRow, GivesEachChannelItsOwnSecondTry) {
    ScanRow row(listeningOn({2412, 5180}), kJoinedInSoftware);
    for (int channel = 0; channel < 2; ++channel) {
        EXPECT_FALSE(row.isComplete());
        row.ended(ScanRow::Whose::own, aborted());
        row.ended(ScanRow::Whose::own, finished());
        EXPECT_FALSE(row.isGivenUp());
    }
    EXPECT_TRUE(row.isComplete());
}

TEST(ScanRow, GivesUpARadioThatIsBusyWithOthersScansAgainAndAgain) {
    ScanRow row(listeningOn({2412}), kJoinedInSoftware);
    for (int scan = 0; scan < 4; ++scan) {
        EXPECT_FALSE(row.isGivenUp());
        row.ended(ScanRow::Whose::others, finished({2412}, true));
    }
    EXPECT_TRUE(row.isGivenUp());
}

TEST(ScanRow, GoesOnAfterAScanOfOthersThatCalledWhereThisOneListens) {
    ScanRow row(listeningOn({2412, 5180}), kJoinedInSoftware);
    row.ended(ScanRow::Whose::others, finished({2412, 5180}, true));
    EXPECT_EQ(Frequencies{2412}, row.next().frequencies);
}

TEST(ScanRow, LeavesOutTheChannelsThatOthersCalledOnMeanwhile) {
    ScanRow row(callingOn({2412, 2437, 5180}), kJoinedInSoftware);
    row.ended(ScanRow::Whose::others, finished({2412, 5180, 5200}, true));
    EXPECT_EQ(Frequencies{2437}, row.next().frequencies);
    row.ended(ScanRow::Whose::others, finished({2437}, true));
    EXPECT_TRUE(row.isComplete());
}

TEST(ScanRow, TakesNoScanOfOthersForItsOwnThatWasAbortedOrLookedForOneName) {
    ScanRow row(callingOn({2412}), kJoinedInSoftware);
    row.ended(ScanRow::Whose::others, {ScanEvent::Kind::aborted, 3, {2412}, true});
    row.ended(ScanRow::Whose::others, finished({2412}, false));
    EXPECT_FALSE(row.isComplete());
    ScanRow named({{nameOf("Northlight")}, true, {2412}}, kJoinedInSoftware);
    named.ended(ScanRow::Whose::others, finished({2412}, true));
    EXPECT_FALSE(named.isComplete());
}

TEST(LikelyFirst, PutsTheOwnChannelThenTheUsualOnesAndKeepsEachGroupAsItWas) {
    std::vector<RadioChannel> channels;
    for (const std::uint32_t frequency : {2412, 2417, 2437, 5180, 5260, 5500, 5745})
        channels.push_back({frequency, false, false, false});

    putLikelyFirst(channels, 5500);

    Frequencies order;
    for (const RadioChannel& each : channels) order.push_back(each.frequency);
    EXPECT_EQ((Frequencies{5500, 2412, 2437, 5180, 5745, 2417, 5260}), order);
}

/// What a request for a scan of this order says to the kernel, attribute by attribute.
class Request {
  public:
    explicit Request(const ScanOrder& order) : request_(16, 0) {
        request_.header<genlmsghdr>() = {NL80211_CMD_TRIGGER_SCAN, 0, 0};
        putOrder(request_, order);
    }
    Attributes attributes() {
        const auto* const bytes = reinterpret_cast<const std::uint8_t*>(&request_.message());
        return Attributes(Bytes(bytes, request_.message().nlmsg_len).subspan(NLMSG_HDRLEN + GENL_HDRLEN));
    }

  private:
    NetlinkRequest request_;
};

TEST(ScanOrder, NamesItsChannelsInTheirOrderAndNoNameWhereItListens) {
    Request request(listeningOn({2437, 2412}));

    Frequencies named;
    request.attributes().nested(NL80211_ATTR_SCAN_FREQUENCIES).forEach([&](std::uint16_t, Bytes content) {
        named.push_back(Attributes::numberIn<std::uint32_t>(content).value_or(0));
    });
    EXPECT_EQ((Frequencies{2437, 2412}), named);
    EXPECT_FALSE(request.attributes().has(NL80211_ATTR_SCAN_SSIDS));
    EXPECT_FALSE(request.attributes().has(NL80211_ATTR_SCAN_FLAGS));
}

TEST(ScanOrder, LeavesItToTheKernelWhichChannelsOf6GHzAnnounceNetworks) {
    for (const std::uint32_t frequency : {5955, 7115}) {
        const auto flags = Request(listeningOn({2412, frequency}))
                               .attributes()
                               .number<std::uint32_t>(NL80211_ATTR_SCAN_FLAGS);
        EXPECT_EQ(NL80211_SCAN_FLAG_COLOCATED_6GHZ, flags) << frequency;
    }
    EXPECT_FALSE(Request(listeningOn({5885})).attributes().has(NL80211_ATTR_SCAN_FLAGS));
}

}  // namespace
}  // namespace wp
