#pragma once

#include <cstdint>
#include <limits>
#include <memory>
#include <optional>
#include <string>

#include "platform/value.h"

namespace wp {

/// One access point that a scan heard. Entries are shared, never copied, and found again by identity.
struct WiFiScanResult final : Record {
    std::optional<std::string> ssid;  ///< absent when the network is hidden
    std::optional<std::string> bssid;
    std::int64_t rssi = 0;  ///< dBm; greater is stronger
};

/// The network that the device is joined to; both absent when it is joined to none.
struct WiFiStatus final : Record {
    std::optional<std::string> ssid;
    std::optional<std::string> bssid;
};

/// One remembered network.
struct PreferredNetworkRecord final : Record {
    std::optional<std::string> ssid;
    std::int64_t security = 0;  ///< the service's number of the security type
    bool passpoint = false;
    bool enabled = false;
    bool captive = false;
    bool hidden = false;
    bool multiAP = false;
    std::optional<Date> lastJoined;
};

/// The outcome of one run of echo requests.
struct PingStatistics final : Record {
    static constexpr double unknown = std::numeric_limits<double>::quiet_NaN();

    std::optional<std::string> interfaceName;
    std::int64_t count = 0;       ///< requests sent
    double packetLoss = unknown;  ///< fraction, 0 to 1
    double min = unknown;         ///< round-trip times in ms
    double max = unknown;
    double avg = unknown;
    double stddev = unknown;
    double timestamp = 0;  ///< seconds since 2001-01-01 00:00:00 UTC
};

/// One radio channel; only its number is of interest.
struct WiFiChannel final : Record {
    explicit WiFiChannel(std::int64_t number = 0) : channel(number) {}
    std::int64_t channel;
};

using WiFiScanResultPointer = std::shared_ptr<const WiFiScanResult>;
using WiFiStatusPointer = std::shared_ptr<const WiFiStatus>;

}  // namespace wp
