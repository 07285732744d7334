#pragma once

#include <optional>
#include <vector>

#include "service/channel_load.h"
#include "service/outcome.h"
#include "service/thresholds.h"

namespace wp {

/// What the radio knows of the air around.
struct AirFacts {
    Known<std::vector<AccessPoint>> nearby;
    Known<Airtime> airtime;
    Known<AllowedChannels> allowed;
};

/// The channels that would be better, by number; a band that the radio does not have, or that was not heard,
/// has none.
struct Recommendation {
    std::optional<int> ghz2;
    std::optional<int> ghz5;
    std::optional<int> ghz5Wide;  ///< primary channel of the best pair of 40 MHz
    std::optional<int> ghz5NoRadar;
};

/// The least occupied channels. Of equals the joined network's own channel is kept, then the lower number
/// wins. \param own the access point that is joined; null where none is
Recommendation recommend(const AirFacts& air, const AccessPoint* own);

/// Whether a channel is full, and by what: `value` is a share of airtime for the two loads, else the weight of
/// what overlaps.
struct ChannelJudgement {
    enum class Basis { measuredLoad, advertisedLoad, overlap };
    Basis basis = Basis::overlap;
    double value = 0;
    bool full = false;
};

/// The judged access point's channel. *Any* thread.
Known<ChannelJudgement> judgeChannelOf(const AccessPoint& judged, const AirFacts& air,
                                       const CongestionLimits& limits);
/// Any channel, by what the radio measured there, else by what overlaps. \param own is left out. *Any* thread.
Known<ChannelJudgement> judgeChannelAt(std::uint32_t frequency, const AirFacts& air, const AccessPoint* own,
                                       const CongestionLimits& limits);
/// The frequencies that come into question in a band: the three of 2.4 GHz that do not overlap, and all of the
/// others, the lowest first. *Any* thread.
std::vector<std::uint32_t> choosableIn(Band band, const AllowedChannels& allowed);

/// Test 24: whether the judged access point's channel is congested. For the joined network what the radio
/// measured on its channel comes first, for another one what its access point advertises. Information:
/// "CurrentChannel" and the four recommendations.
Outcome channelIsCongested(const AccessPoint& judged, const AirFacts& air, const AccessPoint* own,
                           const CongestionLimits& limits = {});
/// Test 25: whether every one of the channels 1, 6 and 11 is congested. Information: the recommendations.
Outcome band2IsCongested(const AirFacts& air, const AccessPoint* own, const CongestionLimits& limits = {});
/// Test 26: the same for every channel of 5 GHz that is allowed here.
Outcome band5IsCongested(const AirFacts& air, const AccessPoint* own, const CongestionLimits& limits = {});

}  // namespace wp
