#include "service/channel_load.h"

#include <algorithm>
#include <cmath>

namespace wp {
namespace {

constexpr std::uint64_t kFewFrames = 20;
constexpr int kDecodedWell = -67, kDeferredTo = -82;

double weight(int signal) {
    return signal >= kDecodedWell ? 1.0 : signal >= kDeferredTo ? 0.5 : 0.0;
}

/// The access point may have changed its channel since it was looked at.
bool isOf(const AccessPoint* own, const AccessPoint& each) {
    return own != nullptr && (each.address == own->address || shareRadio(each, *own));
}

bool overlaps(const AccessPoint& accessPoint, const Span& wanted) {
    const auto spans = occupiedBy(accessPoint);
    return std::any_of(spans.begin(), spans.end(),
                       [&](const Span& span) { return span.low < wanted.high && wanted.low < span.high; });
}

/// The others that overlap the 20 MHz around the frequency, each once: the kernel keeps one that hides twice, with and
/// without its name.
std::vector<const AccessPoint*> overlapping(std::uint32_t frequency, const std::vector<AccessPoint>& nearby,
                                            const AccessPoint* own) {
    const Span wanted{frequency - 10, frequency + 10};
    std::vector<const AccessPoint*> found;
    for (const AccessPoint& each : nearby) {
        const auto isSame = [&](const AccessPoint* other) { return other->address == each.address; };
        const bool counts = each.signal && isLevel(*each.signal) && !isOf(own, each);
        if (counts && overlaps(each, wanted) && std::none_of(found.begin(), found.end(), isSame))
            found.push_back(&each);
    }
    return found;
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

double overlapWeight(std::uint32_t frequency, const std::vector<AccessPoint>& nearby,
                     const AccessPoint* own) {
    double sum = 0;
    for (const AccessPoint* each : overlapping(frequency, nearby, own)) sum += weight(*each->signal);
    return sum;
}

std::size_t strongOverlaps(std::uint32_t frequency, const std::vector<AccessPoint>& nearby,
                           const AccessPoint* own) {
    const auto radios = overlapping(frequency, nearby, own);
    return static_cast<std::size_t>(std::count_if(
        radios.begin(), radios.end(), [](const AccessPoint* each) { return *each->signal >= kDecodedWell; }));
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
