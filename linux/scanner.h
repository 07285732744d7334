#pragma once

#include <mutex>
#include <string>

#include "linux/home_channel.h"
#include "linux/notes.h"
#include "linux/radio_socket.h"

namespace wp {

/// What a scan found, and when it was complete.
struct ScanReport {
    std::vector<AccessPoint> accessPoints;
    /// In ms on the clock that counts suspended time too; nothing where no scan came to its end.
    std::optional<std::int64_t> completedAt;
};

/// Adds those access points of `heard` that `found`, a later list, lacks. *Any* thread.
void addForgotten(std::vector<AccessPoint>& found, const std::vector<AccessPoint>& heard);

/// What is asked of the scanner.
struct ScanWish {
    std::string interfaceName;
    std::uint32_t interfaceIndex = 0;
    std::uint32_t radio = 0;
    /// A scan that was complete at this time or later will do, in ms on the clock that counts suspended time too.
    std::int64_t freshSince = 0;
    /// `calling` asks who is there and hears slow and faint access points too. `listening` stays on each channel
    /// as long as access points take between two beacons, and so hears those that hide and answer nobody.
    enum class Manner { calling, listening };
    Manner manner = Manner::calling;
    /// A network that must be called by name, and whose beacon is wanted.
    std::optional<NetworkName> named;
};

/// The last scan of a kind. One thread at a time.
class ScanMemory {
  public:
    /// A report without a scan takes the place of none.
    void keep(std::uint32_t interfaceIndex, const ScanReport& report);
    /// The scan, where it is of that interface and fresh enough; else null.
    const ScanReport* serving(const ScanWish& wish) const;

  private:
    std::uint32_t interfaceIndex_ = 0;
    std::optional<ScanReport> report_;
};

/// Scans, and remembers the last scan longer than the kernel does. Without the permission to scan it asks whatever
/// manages the interface, and what that costs is told once. A scan leaves the channel only while nobody needs it.
/// *Any* thread; one scan at a time.
class Scanner {
  public:
    Scanner(Notes& notes, HomeChannel& home) : notes_(notes), home_(home) {}

    /// What the latest scan that is fresh enough found, or a new scan. A scan that somebody else has started is
    /// joined when it covers the radio's channels. An error says why there can be none.
    Known<std::vector<AccessPoint>> scan(const ScanWish& wish, const Until& until);

    /// What the latest listening that is fresh enough heard, or what is now heard on the channels that a calling scan
    /// visits too briefly. Manner and name of the wish play no part.
    Known<std::vector<AccessPoint>> listen(const ScanWish& wish, const Until& until);

  private:
    Known<ScanReport> scanNow(RadioSocket& radio, const ScanWish& wish, const Until& until);
    Known<ScanReport> scanWithoutPermission(RadioSocket& radio, const ScanWish& wish, const Until& until);

    Notes& notes_;
    HomeChannel& home_;
    std::mutex scanning_;
    ScanMemory scanned_, listened_;
};

}  // namespace wp
