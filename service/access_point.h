#pragma once

#include <array>
#include <optional>
#include <string>
#include <vector>

#include "service/band.h"
#include "service/network_name.h"
#include "service/security.h"

namespace wp {

using MacAddress = std::array<std::uint8_t, 6>;
/// Two upper-case letters.
using CountryCode = std::array<char, 2>;

/// "02:00:00:00:00:01". *Any* thread.
std::string textOf(const MacAddress& address);

/// Whether a number can be the strength of a signal or of noise, in dBm. Drivers that do not measure name others, above all
/// 0. *Any* thread.
constexpr bool isLevel(int number) {
    constexpr int kLowestLevel = -110, kHighestLevel = -1;
    return number >= kLowestLevel && number <= kHighestLevel;
}

/// What an access point's elements say, in the tests' terms.
struct Advertised {
    NetworkName name;                        ///< empty while no frame has told it
    std::optional<bool> hidesName;           ///< whether its beacon hides the name; unknown without a beacon
    std::optional<std::uint8_t> dtimPeriod;  ///< in beacons; in beacons only
    std::optional<CountryCode> country;      ///< where it names one
    std::optional<std::uint8_t> load;        ///< its channel's utilisation, 255 is full
    std::optional<std::uint8_t> protection;  ///< ERP bits: 1 older stations present, 2 protection in use
    SecuritySuites security;

    std::uint8_t fastestRate = 0;  ///< in 500 kb/s, of the rates before 802.11n; 0 while it names none
    bool directSequence = false;   ///< offers a rate of 802.11b
    bool orthogonal = false;       ///< offers a rate of 802.11a/g
    bool ht = false;               ///< 802.11n
    bool vht = false;              ///< 802.11ac
    bool he = false;               ///< 802.11ax
    bool eht = false;              ///< 802.11be
    std::uint8_t htSecondary = 0;  ///< where the second 20 MHz lie: 0 nowhere, 1 above, 3 below
    bool hotspot = false;          ///< Hotspot 2.0
    bool onlineSignUp = false;     ///< the sign-up network of a hotspot
    bool interworking = false;     ///< 802.11u
    bool malformed = false;        ///< a frame's elements ended too early
};

/// One access point as the radio heard it, and what it says of itself.
struct AccessPoint {
    MacAddress address{};
    std::uint32_t frequency = 0;                  ///< MHz
    std::optional<std::uint16_t> beaconInterval;  ///< in units of 1.024 ms
    std::uint16_t capability = 0;
    std::optional<int> signal;             ///< dBm
    std::optional<std::int64_t> lastSeen;  ///< ms on the clock that counts suspended time too
    bool joined = false;                   ///< this device is joined to it
    /// Of the whole of which it is one link, while this device is joined over several at once (802.11be).
    std::optional<MacAddress> multiLinkAddress;
    bool directOnly = false;  ///< none: a node of a mesh or an ad-hoc network, which shares the air
    std::vector<std::uint8_t> elements;  ///< of the latest probe response, else of the latest beacon
    std::optional<std::vector<std::uint8_t>> beaconElements;  ///< absent while no beacon was heard
    Advertised says;

    Band band() const { return bandOf(frequency); }
    /// Whom a device that is joined to it takes for its access point.
    const MacAddress& peer() const { return multiLinkAddress ? *multiLinkAddress : address; }
};

/// Whether the two are most likely names that one radio works under: makers count up the last byte of its address or
/// change bits of the first one. *Any* thread.
bool shareRadio(const AccessPoint& one, const AccessPoint& other);

/// Reads the elements of the latest frame, as far as the kernel tells, and of a beacon, where one was heard. They complete
/// each other, and the beacon comes first: once a probe was answered the kernel keeps that answer for the latest frame
/// however many beacons follow, hours later too where the access point is the joined one. *Any* thread.
Advertised decodeAdvertised(std::uint16_t capability, Bytes latest, std::optional<Bytes> beacon);

/// All elements of its beacon and of what else it sent, in the same order, as places in the access point. *Any* thread.
Elements elementsOf(const AccessPoint& accessPoint);

/// The modes that the access point offers, oldest first, for example "b/g/n" or "a/n/ac". 802.11ac has no
/// place below 5 GHz and is not counted there.
std::string phyModesOf(const AccessPoint& accessPoint);

}  // namespace wp
