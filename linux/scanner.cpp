#include "linux/scanner.h"

#include <algorithm>
#include <cerrno>

namespace wp {
namespace {

using std::chrono::milliseconds;

// A network that hides its name is often missed by one visit of 30 ms on its channel.
constexpr int kListenAttempts = 3;
constexpr int kStartAttempts = 4;

/// One row of scans for one wish.
class ScanRun {
  public:
    ScanRun(RadioSocket& radio, const ScanWish& wish, const Until& until)
        : radio_(radio), wish_(wish), until_(until), startedAt_(bootMilliseconds()) {
        if (const Known<RadioAbilities> abilities = radio_.abilities(wish_.radio, until_))
            abilities_ = *abilities;
    }

    Known<ScanReport> run() {
        if (const Known<RadioAbilities> abilities = radio_.abilities(wish_.radio, until_))
            abilities_ = *abilities;
        if (std::optional<Error> error = complete(fullOrder())) return *error;
        const std::int64_t completedAt = bootMilliseconds();
        Known<std::vector<AccessPoint>> found = results();
        if (!found) return found.error();
        if (wish_.named) found = withBeacons(std::move(*found));
        if (!found) return found.error();
        return ScanReport{std::move(*found), completedAt};
    }

    /// Listens on the channels that a scan visits briefly. On the others a scan only listens anyway.
    Known<ScanReport> listen() {
        ScanOrder order{{}, false, {}};
        for (const RadioChannel& channel : abilities_.channels) {
            if (!channel.disabled && !channel.passive) order.frequencies.push_back(channel.frequency);
        }
        if (std::optional<Error> error = complete(order)) return *error;
        const std::int64_t completedAt = bootMilliseconds();
        Known<std::vector<AccessPoint>> found = results();
        if (!found) return found.error();
        return ScanReport{std::move(*found), completedAt};
    }

  private:
    ScanOrder fullOrder() const {
        ScanOrder order;
        if (wish_.named) order.names.push_back(*wish_.named);
        // A radio that can ask for one name only asks for the one that is wanted; all others are heard all the same.
        order.probeForAll = order.names.size() < std::max<std::size_t>(abilities_.namesPerScan, 1);
        return order;
    }

    std::size_t usableChannels() const {
        return static_cast<std::size_t>(std::ranges::count_if(
            abilities_.channels, [](const RadioChannel& channel) { return !channel.disabled; }));
    }

    bool isAsGood(const ScanEvent& event, const ScanOrder& order) const {
        return order.probeForAll && order.names.empty() && event.probedForAll &&
               event.frequencies >= usableChannels();
    }

    /// Scans until a scan of this order, or as good a one of somebody else, is complete.
    std::optional<Error> complete(const ScanOrder& order) {
        bool aborted = false;
        for (int attempt = 0; attempt < kStartAttempts; ++attempt) {
            const int error = radio_.startScan(wish_.interfaceIndex, order, until_);
            if (error != 0 && error != EBUSY) return startFailure(error);
            const Known<ScanEvent> event = radio_.nextScanEnd(wish_.interfaceIndex, until_);
            if (!event) {
                if (error == 0) radio_.abortScan(wish_.interfaceIndex);
                return event.error();
            }
            const bool finished = event->kind == ScanEvent::Kind::finished;
            if (finished && (error == 0 || isAsGood(*event, order))) return std::nullopt;
            if (!finished && error == 0 && std::exchange(aborted, true)) break;
        }
        return failure(Reason::timeout, "scans were aborted or the radio was busy with others'");
    }

    static Error startFailure(int error) {
        if (error == EPERM) return failure(Reason::notPermitted, "no permission to scan (CAP_NET_ADMIN)");
        return failureOf(error, "scan");
    }

    /// What was heard since the run began, and the joined access point, which the kernel keeps up to date.
    Known<std::vector<AccessPoint>> results() {
        Known<std::vector<AccessPoint>> found = radio_.accessPoints(wish_.interfaceIndex, until_);
        if (!found) return found;
        std::erase_if(*found, [&](const AccessPoint& each) {
            return !each.joined && each.lastSeen && *each.lastSeen < startedAt_;
        });
        return found;
    }

    /// Listens on the channels of the named network until a beacon of each of its access points was heard: only a
    /// beacon tells whether the name is hidden.
    Known<std::vector<AccessPoint>> withBeacons(std::vector<AccessPoint> found) {
        for (int attempt = 0; attempt < kListenAttempts; ++attempt) {
            ScanOrder order{{}, false, {}};
            for (const AccessPoint& each : found) {
                const bool lacksBeacon = each.says.name == *wish_.named && !each.says.hidesName;
                const bool isListed = std::ranges::count(order.frequencies, each.frequency) > 0;
                if (lacksBeacon && !isListed) order.frequencies.push_back(each.frequency);
            }
            if (order.frequencies.empty()) break;
            if (const std::optional<Error> error = complete(order)) break;
            Known<std::vector<AccessPoint>> again = results();
            if (!again) return again;
            found = std::move(*again);
        }
        return found;
    }

    RadioSocket& radio_;
    const ScanWish& wish_;
    const Until& until_;
    RadioAbilities abilities_;
    std::int64_t startedAt_;
};

bool sees(const std::vector<AccessPoint>& found, const std::optional<NetworkName>& name) {
    return !name || std::ranges::any_of(found, [&](const AccessPoint& each) {
        return each.says.name == *name && each.says.hidesName;
    });
}

/// Without permission to scan, what the system itself has heard lately may do, if it is young enough.
Known<std::vector<AccessPoint>> withoutScan(RadioSocket& radio, const ScanWish& wish, const Error& denied,
                                            const Until& until) {
    Known<std::vector<AccessPoint>> known = radio.accessPoints(wish.interfaceIndex, until);
    if (!known) return known;
    const std::int64_t oldest = bootMilliseconds() - wish.oldest.count();
    std::erase_if(*known, [&](const AccessPoint& each) {
        return !each.joined && (!each.lastSeen || *each.lastSeen < oldest);
    });
    const bool heardOthers =
        std::ranges::any_of(*known, [](const AccessPoint& each) { return !each.joined; });
    if (wish.oldest.count() == 0 || !heardOthers) return denied;
    return known;
}

/// A socket that is told when scans are over.
Known<RadioSocket> openRadio(const Until& until) {
    Known<RadioSocket> radio = RadioSocket::open(until);
    if (radio && !radio->listenForScans()) {
        return failure(Reason::unavailable, "the kernel does not tell when a scan is over");
    }
    return radio;
}

}  // namespace

bool Scanner::Remembered::serves(const ScanWish& wish) const {
    return wish.oldest.count() > 0 && interfaceIndex == wish.interfaceIndex &&
           bootMilliseconds() - report.completedAt <= wish.oldest.count();
}

Known<std::vector<AccessPoint>> Scanner::scan(const ScanWish& wish, const Until& until) {
    const std::lock_guard lock(scanning_);
    if (scanned_ && scanned_->serves(wish) && sees(scanned_->report.accessPoints, wish.named)) {
        return scanned_->report.accessPoints;
    }
    Known<RadioSocket> radio = openRadio(until);
    if (!radio) return radio.error();
    const Known<ScanReport> report = ScanRun(*radio, wish, until).run();
    if (!report && report.error().code == static_cast<int>(Reason::notPermitted)) {
        return withoutScan(*radio, wish, report.error(), until);
    }
    if (!report) return report.error();
    scanned_ = Remembered{wish.interfaceIndex, *report};
    return report->accessPoints;
}

Known<std::vector<AccessPoint>> Scanner::listen(const ScanWish& wish, const Until& until) {
    const std::lock_guard lock(scanning_);
    if (listened_ && listened_->serves(wish)) return listened_->report.accessPoints;
    Known<RadioSocket> radio = openRadio(until);
    if (!radio) return radio.error();
    const Known<ScanReport> report = ScanRun(*radio, wish, until).listen();
    if (!report) return report.error();
    listened_ = Remembered{wish.interfaceIndex, *report};
    return report->accessPoints;
}

}  // namespace wp
