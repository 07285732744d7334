#pragma once

#include <mutex>

#include "linux/radio_socket.h"

namespace wp {

/// What a scan found, and when it was complete.
struct ScanReport {
    std::vector<AccessPoint> accessPoints;
    std::int64_t completedAt = 0;  ///< ms on the clock that counts suspended time too
};

/// What is asked of the scanner.
struct ScanWish {
    std::uint32_t interfaceIndex = 0;
    std::uint32_t radio = 0;
    std::chrono::milliseconds oldest{0};  ///< how old a scan may be; 0: a new one
    std::optional<NetworkName>
        named;  ///< a network that must be looked for by name, and whose beacon is wanted
};

/// Scans, and remembers the last scan longer than the kernel does. *Any* thread; one scan at a time.
class Scanner {
  public:
    /// What the latest scan of at most this age found, or a new scan. A scan that somebody else has started is
    /// joined when it covers the radio's channels. An error says why there can be none.
    Known<std::vector<AccessPoint>> scan(const ScanWish& wish, const Until& until);

    /// What the latest listening of at most this age heard, or a new one: as long on each channel as access points
    /// take between two beacons, where a scan would only call briefly. The wish's name plays no part.
    Known<std::vector<AccessPoint>> listen(const ScanWish& wish, const Until& until);

  private:
    struct Remembered {
        std::uint32_t interfaceIndex = 0;
        ScanReport report;
        bool serves(const ScanWish& wish) const;
    };

    std::mutex scanning_;
    std::optional<Remembered> scanned_;
    std::optional<Remembered> listened_;
};

}  // namespace wp
