#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

#include "linux/netlink_reader.h"
#include "service/facts.h"

namespace wp {

// What the kernel's messages about radios say. Each takes a buffer of messages, as a dump leaves it, and passes
// over what it does not know or what is broken. Pure functions; *any* thread.

/// The number under which the kernel's Wi-Fi messages go, and those of its multicast groups by name.
struct RadioFamily {
    std::uint16_t number = 0;
    std::map<std::string, std::uint32_t> groups;
};
std::optional<RadioFamily> readFamily(Bytes buffer);

/// One interface of a radio.
struct RadioInterface {
    std::string name;
    std::uint32_t index = 0;
    std::uint32_t radio = 0;
    std::uint32_t type = 0;
    std::optional<std::uint32_t> frequency;  ///< MHz, while it has a channel
    bool isStation() const;
};
std::vector<RadioInterface> readInterfaces(Bytes buffer);

/// The access points of a scan, told apart by what the kernel has of each.
/// @param now ms on the clock that counts suspended time too
std::vector<AccessPoint> readAccessPoints(Bytes buffer, std::int64_t now);

/// The link to the joined access point, with one sample of the signal; nothing when there is no link.
std::optional<Station> readStation(Bytes buffer);

Survey readSurvey(Bytes buffer);
/// What the radio has counted on each channel so far; channels on which it counts no time are left out.
Airtime readAirtime(Bytes buffer);

/// The domain of the radio, where it manages its own or names a country, else that of the whole system.
std::optional<Regulation> readRegulation(Bytes buffer, std::uint32_t radio);

/// One channel that a radio could use.
struct RadioChannel {
    std::uint32_t frequency = 0;  ///< MHz
    bool disabled = false;        ///< by the regulatory domain
    bool passive = false;         ///< nothing may be sent before a beacon was heard
    bool radar = false;
    bool narrow = false;  ///< not allowed for 20 MHz
    /// Whether a network of a home can be there. From 5850 MHz on kernels also list the channels of vehicles, 5 and
    /// 10 MHz wide, between those of 20 MHz (IEEE 802.11, operating class 125), below 1 GHz those of meters, and below
    /// 5 GHz those of rescue services.
    bool carriesNetworks() const;
    /// Whether it is to be looked at when networks are looked for: of 6 GHz those channels alone on which networks of that
    /// band announce themselves, every fourth one of 20 MHz from channel 5 on (IEEE 802.11ax, 26.17.2.3).
    bool isForScanning() const;
};

/// What a radio can do.
struct RadioAbilities {
    std::size_t namesPerScan = 0;  ///< how many names one scan can probe for
    bool scansInSoftware = false;  ///< the kernel (mac80211) leads it from channel to channel
    std::vector<RadioChannel> channels;
};
std::optional<RadioAbilities> readAbilities(Bytes buffer, std::uint32_t radio);

/// What came over the multicast group "scan". Events are in their order.
struct ScanEvent {
    enum class Kind { started, finished, aborted };
    Kind kind = Kind::finished;
    std::uint32_t interfaceIndex = 0;        ///< 0 of a peer-to-peer device, which has none
    std::vector<std::uint32_t> frequencies;  ///< MHz, of the channels that the scan was to visit
    bool probedForAll = false;               ///< whether it asked for networks of any name
    std::uint32_t radio = 0;
};
std::vector<ScanEvent> readScanEvents(Bytes buffer);

}  // namespace wp
