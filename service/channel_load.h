#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "service/channel_use.h"

namespace wp {

/// A channel of 20 MHz on which the radio may work.
struct AllowedChannel {
    std::uint32_t frequency = 0;  ///< MHz, of its centre
    bool listensOnly = false;     ///< may not send first
    bool radar = false;           ///< shared with radar: to be left when one is heard
};
using AllowedChannels = std::vector<AllowedChannel>;

/// What the radio counted on one channel between two looks at its counters.
struct ChannelTime {
    std::uint32_t frequency = 0;  ///< MHz
    bool inUse = false;
    std::uint64_t time = 0;             ///< ms that the radio was on the channel
    std::optional<std::uint64_t> busy;  ///< ms of it that the medium was busy
    std::uint64_t transmit = 0;         ///< ms of it that this device sent
    std::uint64_t receiveOwn = 0;       ///< ms of it that the device received from its own network
    std::optional<int> noise;           ///< dBm
};
using Airtime = std::vector<ChannelTime>;

/// The difference of two looks at the same counters; channels that only one of them holds, or whose counters
/// ran backwards (a driver that starts again from zero), are left out. *Any* thread.
Airtime airtimeBetween(const Airtime& before, const Airtime& after);

/// The share of the time, 0 to 1, that others kept the channel busy; nothing where the radio does not count
/// it, or was there for less than 20 ms, which is no more than a few frames. *Any* thread.
std::optional<double> foreignLoad(const ChannelTime& channel);

/// How much the access points weigh on the 20 MHz around the frequency: each that overlaps counts 1 where its frames are
/// decoded well (-67 dBm and more), one half down to -82 dBm, at which 20 MHz receivers stop deferring to it (802.11,
/// 17.3.10.6), and nothing below. Each name of a radio counts, as it has beacons of its own.
/// \param own its radio is left out, other names and all: it does not compete with itself.
double overlapWeight(std::uint32_t frequency, const std::vector<AccessPoint>& nearby, const AccessPoint* own);
/// How many of them are decoded well there.
std::size_t strongOverlaps(std::uint32_t frequency, const std::vector<AccessPoint>& nearby,
                           const AccessPoint* own);

/// The interference factor by which access points choose their channel: noise floor and foreign load in one
/// number; smaller is better. Nothing where the survey lacks noise, time or busy time.
std::optional<double> interferenceFactor(const ChannelTime& channel, int lowestNoise);

}  // namespace wp
