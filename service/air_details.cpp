#include <algorithm>
#include <map>

#include "service/congestion.h"
#include "service/detail_values.h"
#include "service/judged.h"
#include "service/radio_tests.h"
#include "service/scan_tests.h"

namespace wp {
namespace {

AirFacts airOf(const Facts& facts) {
    return {facts.nearby, facts.airtime, facts.allowedChannels};
}

const AccessPoint* ownAccessPoint(const Facts& facts) {
    return facts.link && facts.link->joined ? &*facts.link->joined : nullptr;
}

std::string_view wordOf(ChannelJudgement::Basis basis) {
    switch (basis) {
        case ChannelJudgement::Basis::measuredLoad:
            return "measuredLoad";
        case ChannelJudgement::Basis::advertisedLoad:
            return "advertisedLoad";
        case ChannelJudgement::Basis::overlap:
            break;
    }
    return "overlap";
}

void addCongestionThresholds(Details& details, const CongestionLimits& limits) {
    addThresholds(details, {{"measuredLoad", limits.load},
                            {"advertisedLoad", rounded(limits.advertisedLoad / 255.0)},
                            {"overlap", limits.overlap}});
}

void addJudgement(Details& details, const Known<ChannelJudgement>& judged) {
    if (!judged) return;
    details.emplace("judgedBy", wordOf(judged->basis));
    details.emplace("value", rounded(judged->value));
    details.emplace("full", judged->full);
}

DictionaryPointer networkEntry(const AccessPoint& each) {
    const ChannelUse use = channelUseOf(each);
    Details entry{{"bssid", textOf(each.address)},
                  {"channel", channelOf(each.frequency)},
                  {"frequency", each.frequency},
                  {"centreFrequencies", listOf(use.centres, [](std::uint32_t centre) { return centre; })},
                  {"width", use.width},
                  {"band", wordOf(each.band())},
                  {"security", nameOf(securityOf(each.says.security))},
                  {"modes", phyModesOf(each)},
                  {"joined", each.joined}};
    if (!each.says.name.absent()) entry.emplace("ssid", textFromName(each.says.name));
    addKnown(entry, "rssi", each.signal);
    if (each.says.load) entry.emplace("advertisedLoad", rounded(*each.says.load / 255.0));
    return Dictionary::make(std::move(entry));
}

DictionaryPointer channelEntry(const AllowedChannel& channel, const Facts& facts) {
    const AirFacts air = airOf(facts);
    Details entry{{"channel", channelOf(channel.frequency)},
                  {"frequency", channel.frequency},
                  {"band", wordOf(bandOf(channel.frequency))},
                  {"radar", channel.radar},
                  {"listensOnly", channel.listensOnly}};
    if (air.nearby)
        entry.emplace("strongNeighbours",
                      strongOverlaps(channel.frequency, *air.nearby, ownAccessPoint(facts)));
    addJudgement(entry, judgeChannelAt(channel.frequency, air, ownAccessPoint(facts),
                                       facts.settings.thresholds.congestion));
    return Dictionary::make(std::move(entry));
}

Details bandDetails(Band band, const Facts& facts) {
    Details details;
    addCongestionThresholds(details, facts.settings.thresholds.congestion);
    if (!facts.allowedChannels) return details;
    const std::vector<std::uint32_t> frequencies = choosableIn(band, *facts.allowedChannels);
    Array full;
    for (const std::uint32_t frequency : frequencies) {
        const auto judged = judgeChannelAt(frequency, airOf(facts), ownAccessPoint(facts),
                                           facts.settings.thresholds.congestion);
        if (judged && judged->full) full.emplace_back(channelOf(frequency));
    }
    details.emplace("consideredChannels", listOf(frequencies, channelOf));
    details.emplace("fullChannels", std::move(full));
    return details;
}

}  // namespace

Details channelDetails(const Facts& facts) {
    Details details;
    addCongestionThresholds(details, facts.settings.thresholds.congestion);
    if (const auto judged = judgedAsHeardLast(facts))
        addJudgement(details, judgeChannelOf(**judged, airOf(facts), facts.settings.thresholds.congestion));
    if (facts.nearby) details.emplace("networks", listOf(*facts.nearby, networkEntry));
    if (facts.allowedChannels)
        details.emplace("channels", listOf(*facts.allowedChannels, [&](const AllowedChannel& channel) {
                            return channelEntry(channel, facts);
                        }));
    return details;
}

Details band2Details(const Facts& facts) {
    return bandDetails(Band::ghz2, facts);
}

Details band5Details(const Facts& facts) {
    return bandDetails(Band::ghz5, facts);
}

Details widthDetails(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return {};
    return {{"width", channelUseOf(**judged).width}, {"band", wordOf((*judged)->band())}};
}

Details countryDetails(const Facts& facts) {
    Details details;
    addThresholds(details, {{"weakestSignal", kWeakestCountrySignal}, {"accessPoints", kCountryWitnesses}});
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return details;
    const auto& own = (*judged)->says.country;
    if (own) details.emplace("advertised", std::string(own->begin(), own->end()));
    details.emplace(
        "countries", listOf(countryWitnesses(facts, **judged), [](const auto& entry) {
            return Dictionary::make({{"code", std::string(entry.first.begin(), entry.first.end())},
                                     {"accessPoints", entry.second.size()}});
        }));
    return details;
}

Details hiddenNetworkDetails(const Facts& facts) {
    if (!facts.nearby || !facts.listened) return {};
    return {{"networks", listOf(hiddenAccessPoints(*facts.nearby, *facts.listened),
                                [](const AccessPoint* each) { return networkEntry(*each); })}};
}

Details scanDetails(const Facts& facts) {
    if (!facts.nearby) return {};
    struct Count {
        int accessPoints = 0, hidden = 0;
    };
    std::map<Band, Count> bands;
    for (const AccessPoint* each : distinctAccessPoints(*facts.nearby)) {
        Count& count = bands[each->band()];
        ++count.accessPoints;
        if (each->says.name.absent()) ++count.hidden;
    }
    return {{"bands", listOf(bands, [](const auto& entry) {
                 return Dictionary::make({{"band", wordOf(entry.first)},
                                          {"accessPoints", entry.second.accessPoints},
                                          {"hidden", entry.second.hidden}});
             })}};
}

Details signalDetails(const Facts& facts) {
    Details details;
    addThresholds(details, {{"RSSI", kWeakestSignal}, {"signalToNoise", kLeastSignalToNoise}});
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return details;
    if (!facts.named && facts.station && !facts.station->signals.empty()) {
        details.emplace("samples", listOf(facts.station->signals, [](int signal) { return signal; }));
    } else if ((*judged)->signal) {
        details.emplace("samples",
                        listOf(std::vector{*(*judged)->signal}, [](int signal) { return signal; }));
    }
    const std::optional<int> noise = noiseOf(facts, **judged);
    const Known<int> signal = signalOf(facts, **judged);
    if (noise) details.emplace("noise", *noise);
    if (noise && signal) details.emplace("signalToNoise", *signal - *noise);
    return details;
}

}  // namespace wp
