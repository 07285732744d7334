#include "service/channel_load.h"

#include <algorithm>
#include <cmath>

namespace wp {
namespace {

constexpr std::uint64_t kFewFrames = 20;
constexpr int kDecodedWell = -67, kDeferredTo = -82;

std::uint32_t frequencyOf5GHz(unsigned channel) {
    return 5000 + 5 * channel;
}

Span around(std::uint32_t centre, std::uint32_t half) {
    return {centre - half, centre + half};
}

/// The spans of a network of 80 MHz and more, by its VHT operation; empty for narrower ones.
std::vector<Span> wideSpans(Bytes operation) {
    if (operation.size() < 3 || operation[0] == 0 || operation[1] == 0) return {};
    const unsigned first = operation[1], second = operation[2];
    const std::uint32_t centre = frequencyOf5GHz(first);
    const unsigned apart = first > second ? first - second : second - first;
    if (operation[0] == 2) return {around(centre, 80)};
    if (operation[0] == 1 && second != 0 && apart == 8) return {around(frequencyOf5GHz(second), 80)};
    if (second != 0 && apart > 8) return {around(centre, 40), around(frequencyOf5GHz(second), 40)};
    return {around(centre, 40)};
}

double weight(int signal) {
    return signal >= kDecodedWell ? 1.0 : signal >= kDeferredTo ? 0.5 : 0.0;
}

bool ranBackwards(const ChannelTime& before, const ChannelTime& after) {
    return after.time < before.time || after.busy.value_or(0) < before.busy.value_or(0) ||
           after.transmit < before.transmit || after.receiveOwn < before.receiveOwn;
}

}  // namespace

Airtime airtimeBetween(const Airtime& before, const Airtime& after) {
    Airtime differences;
    for (const ChannelTime& now : after) {
        const auto then = std::find_if(before.begin(), before.end(), [&](const ChannelTime& each) {
            return each.frequency == now.frequency;
        });
        if (then == before.end() || ranBackwards(*then, now)) continue;
        ChannelTime difference = now;
        difference.time -= then->time;
        if (now.busy) difference.busy = *now.busy - then->busy.value_or(0);
        difference.transmit -= then->transmit;
        difference.receiveOwn -= then->receiveOwn;
        differences.push_back(difference);
    }
    return differences;
}

std::optional<double> foreignLoad(const ChannelTime& channel) {
    if (!channel.busy || channel.time < kFewFrames || channel.time <= channel.transmit) return std::nullopt;
    const double foreign = static_cast<double>(*channel.busy) - static_cast<double>(channel.transmit) -
                           static_cast<double>(channel.receiveOwn);
    return std::clamp(foreign / static_cast<double>(channel.time - channel.transmit), 0.0, 1.0);
}

std::vector<Span> occupiedBy(const AccessPoint& accessPoint) {
    const Elements elements = decodeElements(accessPoint.elements);
    if (accessPoint.band() == Band::ghz5) {
        const auto wide = wideSpans(elements.vhtOperation.bytes());
        if (!wide.empty()) return wide;
    }
    Span span = around(accessPoint.frequency, 10);
    if (accessPoint.says.htSecondary == 1) span.high += 20;
    if (accessPoint.says.htSecondary == 3) span.low -= 20;
    return {span};
}

double overlapWeight(std::uint32_t frequency, const std::vector<AccessPoint>& nearby, const MacAddress* own) {
    const Span wanted = around(frequency, 10);
    double sum = 0;
    for (const AccessPoint& each : nearby) {
        if (!each.signal || (own != nullptr && each.address == *own)) continue;
        const auto spans = occupiedBy(each);
        const bool overlaps = std::any_of(spans.begin(), spans.end(), [&](const Span& span) {
            return span.low < wanted.high && wanted.low < span.high;
        });
        if (overlaps) sum += weight(*each.signal);
    }
    return sum;
}

std::optional<double> interferenceFactor(const ChannelTime& channel, int lowestNoise) {
    if (!channel.noise || !channel.busy || channel.time < kFewFrames || channel.time <= channel.transmit)
        return std::nullopt;
    const double busy = (static_cast<double>(*channel.busy) - static_cast<double>(channel.transmit)) /
                        static_cast<double>(channel.time - channel.transmit);
    const double floor = std::pow(10.0, *channel.noise / 5.0);
    return floor + std::max(busy, 0.0) * std::pow(2.0, std::pow(10.0, *channel.noise / 10.0) +
                                                           std::pow(10.0, lowestNoise / 10.0));
}

}  // namespace wp
