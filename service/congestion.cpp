#include "service/congestion.h"

#include <algorithm>
#include <tuple>

#include "platform/records.h"

namespace wp {
namespace {

struct Candidate {
    AllowedChannel channel;
    double score = 0;
    int number() const { return channelOf(channel.frequency); }
};
using Candidates = std::vector<Candidate>;

const ChannelTime* measured(const AirFacts& air, std::uint32_t frequency) {
    if (!air.airtime) return nullptr;
    for (const ChannelTime& each : *air.airtime)
        if (each.frequency == frequency) return &each;
    return nullptr;
}

std::optional<double> measuredLoad(const AirFacts& air, std::uint32_t frequency) {
    const ChannelTime* channel = measured(air, frequency);
    return channel != nullptr ? foreignLoad(*channel) : std::nullopt;
}

bool isChoosable(Band band, std::uint32_t frequency) {
    const int number = channelOf(frequency);
    const bool apart = number == 1 || number == 6 || number == 11;
    return bandOf(frequency) == band && (band != Band::ghz2 || apart);
}

Candidates candidatesOf(const AirFacts& air, Band band) {
    Candidates candidates;
    if (!air.allowed) return candidates;
    for (const AllowedChannel& channel : *air.allowed)
        if (isChoosable(band, channel.frequency)) candidates.push_back({channel, 0});
    std::sort(candidates.begin(), candidates.end(),
              [](const Candidate& a, const Candidate& b) { return a.number() < b.number(); });
    return candidates;
}

/// Scores all by what was measured, if that is complete; false otherwise.
bool scoreByAirtime(Candidates& candidates, const AirFacts& air) {
    if (!air.airtime) return false;
    int lowest = 0;
    for (const ChannelTime& each : *air.airtime) lowest = std::min(lowest, each.noise.value_or(0));
    for (Candidate& candidate : candidates) {
        const ChannelTime* channel = measured(air, candidate.channel.frequency);
        const auto factor = channel != nullptr ? interferenceFactor(*channel, lowest) : std::nullopt;
        if (!factor) return false;
        candidate.score = *factor;
    }
    return true;
}

/// Whether what was heard can be weighed: some drivers tell no strength in dBm.
bool hasLevels(const std::vector<AccessPoint>& nearby) {
    return nearby.empty() || std::ranges::any_of(nearby, [](const AccessPoint& each) {
               return each.signal && isLevel(*each.signal);
           });
}

/// Nothing where neither a survey nor a scan tells the channels apart.
Candidates scored(const AirFacts& air, Band band, const AccessPoint* own) {
    Candidates candidates = candidatesOf(air, band);
    if (scoreByAirtime(candidates, air)) return candidates;
    if (!air.nearby || !hasLevels(*air.nearby)) return {};
    for (Candidate& candidate : candidates)
        candidate.score = overlapWeight(candidate.channel.frequency, *air.nearby, own);
    return candidates;
}

/// Smaller is better, then one's own, then the lower number.
std::optional<int> best(const Candidates& candidates, const AccessPoint* own) {
    const int kept = own != nullptr ? channelOf(own->frequency) : 0;
    const auto rank = [kept](const Candidate& each) {
        return std::tuple(each.score, each.number() != kept, each.number());
    };
    const auto found =
        std::min_element(candidates.begin(), candidates.end(),
                         [&](const Candidate& a, const Candidate& b) { return rank(a) < rank(b); });
    return found == candidates.end() ? std::nullopt : std::optional(found->number());
}

/// Whether a channel of 40 MHz may be made of this one and the next.
bool beginsPair(int channel) {
    return (channel >= 36 && channel <= 144 && channel % 8 == 4) ||
           (channel >= 149 && channel <= 173 && channel % 8 == 5);
}

std::optional<int> bestOfBestPair(const Candidates& candidates, const AccessPoint* own) {
    Candidates pair;
    for (std::size_t i = 0; i + 1 < candidates.size(); ++i) {
        const Candidate &lower = candidates[i], &upper = candidates[i + 1];
        if (!beginsPair(lower.number()) || upper.number() != lower.number() + 4) continue;
        const double sum = lower.score + upper.score;
        if (pair.empty() || sum < pair[0].score + pair[1].score) pair = {lower, upper};
    }
    return best(pair, own);
}

Candidates withoutRadar(Candidates candidates) {
    std::erase_if(candidates, [](const Candidate& each) { return each.channel.radar; });
    return candidates;
}

void add(Dictionary::Entries& info, const char* key, std::optional<int> channel) {
    if (channel) info.insert({key, std::make_shared<WiFiChannel>(*channel)});
}

Dictionary::Entries information(const AirFacts& air, const AccessPoint* own) {
    const Recommendation recommended = recommend(air, own);
    Dictionary::Entries info;
    add(info, "2GHzChannel", recommended.ghz2);
    add(info, "5GHzChannel", recommended.ghz5);
    add(info, "5GHz40MHzChannel", recommended.ghz5Wide);
    add(info, "5GHzNonDFSChannel", recommended.ghz5NoRadar);
    return info;
}

using Basis = ChannelJudgement::Basis;

Known<ChannelJudgement> byOverlap(std::uint32_t frequency, const AirFacts& air, const AccessPoint* own,
                                  const CongestionLimits& limits) {
    if (!air.nearby) return air.nearby.error();
    if (!hasLevels(*air.nearby))
        return failure(Reason::unsupported, "the driver does not tell the signal strengths in dBm");
    const double weight = overlapWeight(frequency, *air.nearby, own);
    return ChannelJudgement{Basis::overlap, weight, weight >= limits.overlap};
}

Outcome bandIsCongested(Band band, const AirFacts& air, const AccessPoint* own,
                        const CongestionLimits& limits) {
    if (!air.allowed) return air.allowed.error();
    const std::vector<std::uint32_t> frequencies = choosableIn(band, *air.allowed);
    if (frequencies.empty()) return failure(Reason::unsupported, "the radio has no channel of this band");
    bool all = true;
    for (const std::uint32_t frequency : frequencies) {
        const auto judged = judgeChannelAt(frequency, air, own, limits);
        if (!judged) return judged.error();
        all = all && judged->full;
    }
    return problem(all, information(air, own));
}

}  // namespace

Recommendation recommend(const AirFacts& air, const AccessPoint* own) {
    const Candidates low = scored(air, Band::ghz2, own), high = scored(air, Band::ghz5, own);
    return {best(low, own), best(high, own), bestOfBestPair(high, own), best(withoutRadar(high), own)};
}

std::vector<std::uint32_t> choosableIn(Band band, const AllowedChannels& allowed) {
    std::vector<std::uint32_t> frequencies;
    for (const Candidate& each : candidatesOf({{}, {}, allowed}, band))
        frequencies.push_back(each.channel.frequency);
    return frequencies;
}

Known<ChannelJudgement> judgeChannelAt(std::uint32_t frequency, const AirFacts& air, const AccessPoint* own,
                                       const CongestionLimits& limits) {
    const auto load = measuredLoad(air, frequency);
    if (load) return ChannelJudgement{Basis::measuredLoad, *load, *load >= limits.load};
    return byOverlap(frequency, air, own, limits);
}

Known<ChannelJudgement> judgeChannelOf(const AccessPoint& judged, const AirFacts& air,
                                       const CongestionLimits& limits) {
    const auto load = measuredLoad(air, judged.frequency);
    const auto advertised = judged.says.load;
    if (advertised && !(load && judged.joined))
        return ChannelJudgement{Basis::advertisedLoad, *advertised / 255.0,
                                *advertised >= limits.advertisedLoad};
    return judgeChannelAt(judged.frequency, air, &judged, limits);
}

Outcome channelIsCongested(const AccessPoint& judged, const AirFacts& air, const AccessPoint* own,
                           const CongestionLimits& limits) {
    const Known<ChannelJudgement> channel = judgeChannelOf(judged, air, limits);
    if (!channel) return channel.error();
    Dictionary::Entries info = information(air, own);
    add(info, "CurrentChannel", channelOf(judged.frequency));
    return problem(channel->full, std::move(info));
}

Outcome band2IsCongested(const AirFacts& air, const AccessPoint* own, const CongestionLimits& limits) {
    return bandIsCongested(Band::ghz2, air, own, limits);
}

Outcome band5IsCongested(const AirFacts& air, const AccessPoint* own, const CongestionLimits& limits) {
    return bandIsCongested(Band::ghz5, air, own, limits);
}

}  // namespace wp
