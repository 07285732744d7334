#pragma once

#include <chrono>
#include <cstddef>

namespace wp {

// From when on something is a finding, each with the source of its number. The texts that tell people about a
// finding take the numbers from here.

/// How many Bluetooth devices are many.
struct BluetoothLimits {
    /// Seven active devices is what one controller's network can hold (Bluetooth Core, piconet); from the
    /// fourth on more than half of the slots that Wi-Fi could use are spoken for.
    unsigned connected = 3;
    /// Each paired device is listened for; no source names a limit, this is twice what a living room has.
    unsigned paired = 16;
};

/// More remembered networks than these are many. No source names a limit; a scan of the list at each join
/// stays short below it.
struct SavedNetworkLimits {
    unsigned count = 50;
};

/// When a channel counts as congested.
struct CongestionLimits {
    /// Share of foreign airtime. Guides for voice and video over Wi-Fi plan for less than one half; delays
    /// grow steeply from 40 to 50 % on.
    double load = 0.50;
    /// The same one half on the scale of the BSS Load element, 0 to 255.
    unsigned advertisedLoad = 128;
    /// Sum of overlapping access points, as `overlapWeight` counts them, where nothing was measured: three
    /// that are near share out half of the air in a busy evening. No source names a number.
    double overlap = 3.0;
};

/// Those that a configuration may change.
struct Thresholds {
    BluetoothLimits bluetooth;
    SavedNetworkLimits saved;
    CongestionLimits congestion;
};

/// In units of 1.024 ms. 100 units are every maker's default; the slack is for controllers that are set in
/// milliseconds and round.
inline constexpr int kLongestBeaconInterval = 110;

/// In beacons. Makers of access points advise 1 or 2; many home routers ship 3.
inline constexpr int kLongestDtimPeriod = 3;

/// In units of 500 kb/s: the fastest rate of 802.11b.
inline constexpr int kFastest11bRate = 22;

/// In dBm: phones believe an access point's country from this strength on, and want it from two of them.
inline constexpr int kWeakestCountrySignal = -85;
inline constexpr std::size_t kCountryWitnesses = 2;

/// In dBm and dB: peers call a signal weak from -75 dBm (a strength of 30 in a hundred) or a signal-to-noise
/// ratio of 18 dB on.
inline constexpr int kWeakestSignal = -75;
inline constexpr int kLeastSignalToNoise = 18;

/// Echo requests to the router and to a host outside. Television and desktop systems send three to five.
inline constexpr std::size_t kEchoRequests = 5;

/// How long name servers may take in all: two tries of 2 s each, as a desktop system waits.
inline constexpr std::chrono::seconds kNameTime{4};

/// How long the maker's service may take for a secure connection, and for its content: a desktop system's
/// time limit for such a request.
inline constexpr std::chrono::seconds kServiceTime{5};

/// A name's answer slower than the first is slow, slower than the second a problem; for people only, no
/// verdict goes by them. (A desktop system's own latency check of names.)
inline constexpr std::chrono::milliseconds kSlowName{400}, kVerySlowName{500};

}  // namespace wp
