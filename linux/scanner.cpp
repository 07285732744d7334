#include "linux/scanner.h"

#include <algorithm>
#include <cerrno>
#include <utility>

#include "linux/manager_scan.h"
#include "linux/scan_row.h"

namespace wp {
namespace {

using std::chrono::milliseconds;

// A network that hides its name is often missed by one visit of 30 ms on its channel.
constexpr int kListenAttempts = 3;
// Managers put a scan off for some seconds when another one has just ended.
constexpr std::chrono::seconds kManagersDelay{10};
// A scan of others mostly calls: 30 to 110 ms on each of some 40 channels, more slowly while the radio is joined.
constexpr std::chrono::seconds kLongestRunningScan{8};
// What keeps firmware busy that is no scan of the kernel's: joining a network, or a search of its own.
constexpr std::chrono::seconds kBusyFirmware{2};

bool is(const Error& error, Reason reason) {
    return error.code == static_cast<int>(reason);
}

bool hearsOthers(const std::vector<AccessPoint>& found) {
    return std::ranges::any_of(found, [](const AccessPoint& each) { return !each.joined; });
}

/// Has the radio away from its home channel for as long as it lives, beginning when nobody minds.
class Away {
  public:
    explicit Away(HomeChannel& home) : home_(home) {}
    ~Away() {
        if (isAway_) home_.returned();
    }
    Away(const Away&) = delete;
    Away& operator=(const Away&) = delete;

    Wait leave(HomeChannel::Visit visit, const Until& until) {
        const Wait wait = home_.leave(visit, until);
        isAway_ = wait == Wait::ready;
        return wait;
    }
    void takenByOthers() {
        if (!std::exchange(isAway_, true)) home_.leftByOthers();
    }

  private:
    HomeChannel& home_;
    bool isAway_ = false;
};

/// One row of scans for one wish.
class ScanRun {
  public:
    ScanRun(RadioSocket& radio, HomeChannel& home, const ScanWish& wish, const Until& until)
        : radio_(radio), home_(home), wish_(wish), until_(until), startedAt_(bootMilliseconds()) {
        if (const Known<RadioAbilities> abilities = radio_.abilities(wish_.radio, until_))
            abilities_ = *abilities;
        std::erase_if(abilities_.channels,
                      [](const RadioChannel& each) { return each.disabled || !each.carriesNetworks(); });
        slicing_.home = homeOfRadio();
        slicing_.wanted = slicing_.home && abilities_.scansInSoftware;
        // A radio that scans by itself is told so by a flag instead.
        if (slicing_.wanted)
            std::erase_if(abilities_.channels,
                          [](const RadioChannel& each) { return !each.isForScanning(); });
        putLikelyFirst(abilities_.channels, slicing_.home);
    }

    Known<ScanReport> run() {
        Known<ScanReport> report = complete(fullOrder());
        if (!report) return wasCutShort_ ? cutShort(report.error()) : report;
        if (wish_.named) return withBeacons(std::move(*report));
        return report;
    }

    /// Listens on the channels that a calling scan visits briefly. On the others it only listens anyway.
    Known<ScanReport> listen() {
        ScanOrder order{{}, false, {}};
        for (const RadioChannel& channel : abilities_.channels) {
            if (!channel.passive) order.frequencies.push_back(channel.frequency);
        }
        return complete(order);
    }

    /// What a scan found that whatever manages the interface was asked for, and who that was.
    Known<ScanReport> runByManager(bool listening, AskedManager& manager) {
        Away away(home_);
        const Wait wait = away.leave(HomeChannel::Visit::lengthy, until_);
        if (wait != Wait::ready) return waitFailure(wait, "scan");
        Known<Bus> bus = Bus::system();
        const auto asked = askManagerForScan(bus, {wish_.interfaceName, wish_.named, listening}, until_);
        if (!asked) return asked.error();
        manager = *asked;
        const Known<ScanEvent> end = asked->refusal ? runningScansEnd(*asked->refusal) : nextScansEnd();
        if (!end) return end.error();
        if (end->kind == ScanEvent::Kind::aborted)
            return failure(Reason::timeout, "a scan by " + manager.name + " was aborted");
        return reportNow();
    }

  private:
    /// What ends before a scan has started is one of before.
    Known<ScanEvent> nextScansEnd() {
        const Known<ScanEvent> start =
            radio_.nextScanStart(wish_.interfaceIndex, until_.within(kManagersDelay));
        return start ? radio_.nextScanEnd(wish_.interfaceIndex, until_) : start;
    }

    /// A manager that refuses is most likely scanning; where it is not, its refusal stands.
    Known<ScanEvent> runningScansEnd(const Error& refusal) {
        const Known<ScanEvent> end =
            radio_.nextScanEnd(wish_.interfaceIndex, until_.within(kLongestRunningScan));
        return end || is(end.error(), Reason::cancelled) ? end : Known<ScanEvent>(refusal);
    }

    ScanOrder fullOrder() const {
        ScanOrder order;
        if (wish_.named) order.names.push_back(*wish_.named);
        // A radio that can ask for one name only asks for the one that is wanted; all others are heard all the same.
        order.probeForAll = order.names.size() < std::max<std::size_t>(abilities_.namesPerScan, 1);
        if (!wish_.named && wish_.manner == ScanWish::Manner::listening) order.probeForAll = false;
        for (const RadioChannel& channel : abilities_.channels)
            order.frequencies.push_back(channel.frequency);
        return order;
    }

    /// The channel on which an interface of the radio is joined to a network.
    std::optional<std::uint32_t> homeOfRadio() {
        const Known<std::vector<RadioInterface>> interfaces = radio_.interfaces(until_);
        if (!interfaces) return std::nullopt;
        for (const RadioInterface& each : *interfaces) {
            if (each.radio != wish_.radio || !each.isStation()) continue;
            const Known<std::optional<AccessPoint>> joined = radio_.joined(each.index, until_);
            if (joined && *joined) return (*joined)->frequency;
        }
        return std::nullopt;
    }

    /// What a scan of this order found, and when it was over.
    Known<ScanReport> complete(const ScanOrder& order) {
        if (const std::optional<Error> error = scan(order)) return *error;
        return reportNow();
    }

    /// What was heard before scans were cut short has to do, where that is more than the joined access point and,
    /// where a network is looked for, that one; otherwise the reason stands.
    Known<ScanReport> cutShort(const Error& why) {
        Known<ScanReport> report = reportNow();
        if (!report || !hearsOthers(report->accessPoints)) return why;
        const auto isNamed = [this](const AccessPoint& each) { return each.says.name == *wish_.named; };
        if (wish_.named && std::ranges::none_of(report->accessPoints, isNamed)) return why;
        report->completedAt.reset();
        return report;
    }

    Known<ScanReport> reportNow() {
        const std::int64_t completedAt = bootMilliseconds();
        Known<std::vector<AccessPoint>> found = results();
        if (!found) return found.error();
        return ScanReport{std::move(*found), completedAt};
    }

    /// Scans until a scan of this order, or as good a one of somebody else, is complete.
    std::optional<Error> scan(const ScanOrder& order) {
        for (ScanRow row(order, slicing_); !row.isComplete();) {
            wasCutShort_ = row.isGivenUp();
            if (wasCutShort_)
                return failure(Reason::timeout, "scans were aborted or the radio was busy with others'");
            if (waitReadable(-1, until_.within(row.pause())) == Wait::stopped)
                return waitFailure(Wait::stopped, "scan");
            if (std::optional<Error> error = visit(row)) {
                wasCutShort_ = is(*error, Reason::timeout);
                return error;
            }
        }
        return std::nullopt;
    }

    /// Makes the row's next request as soon as nobody minds, and waits until the scan, or the one that is in its way, has
    /// ended.
    std::optional<Error> visit(ScanRow& row) {
        Away away(home_);
        if (const Wait wait = leave(row, away); wait != Wait::ready) return waitFailure(wait, "scan");
        const int error = radio_.startScan(wish_.interfaceIndex, row.next(), until_);
        if (error == EINVAL && row.skip()) return std::nullopt;
        if (error == EBUSY) return waitForOthers(row, away, kLongestRunningScan);
        if (error == EAGAIN) return waitForOthers(row, away, kBusyFirmware);
        if (error != 0) return startFailure(error);
        const Known<ScanEvent> end = radio_.nextScanEnd(wish_.interfaceIndex, until_);
        if (end) {
            row.ended(ScanRow::Whose::own, *end);
            return std::nullopt;
        }
        radio_.abortScan(wish_.interfaceIndex);
        return end.error();
    }

    /// Waits until the scan that is in the way has ended, on whichever interface of the radio. Where nobody tells its end
    /// the row asks again.
    std::optional<Error> waitForOthers(ScanRow& row, Away& away, std::chrono::seconds atMost) {
        away.takenByOthers();
        keepHeard();
        const Known<ScanEvent> end = radio_.nextScanEndOfRadio(wish_.radio, until_.within(atMost));
        const bool isUntold = !end && is(end.error(), Reason::timeout) && Clock::now() < until_.deadline;
        if (!end && !isUntold) return end.error();
        row.ended(ScanRow::Whose::others, end ? *end : ScanEvent{ScanEvent::Kind::aborted, 0, {}, false, 0});
        return std::nullopt;
    }

    Wait leave(const ScanRow& row, Away& away) {
        const std::optional<HomeChannel::Visit> visit = row.visit();
        if (!visit) return Wait::ready;
        const Wait atOnce = away.leave(*visit, until_.within(milliseconds(0)));
        if (atOnce != Wait::timeout) return atOnce;
        // There is time for a whole scan of somebody else.
        keepHeard();
        return away.leave(*visit, until_);
    }

    static Error startFailure(int error) {
        if (error == EPERM) return failure(Reason::notPermitted, "no permission to scan (CAP_NET_ADMIN)");
        return failureOf(error, "scan");
    }

    /// What was heard since the run began or is young enough, and the joined access point, which the kernel keeps up
    /// to date.
    Known<std::vector<AccessPoint>> results() {
        Known<std::vector<AccessPoint>> found = radio_.accessPoints(wish_.interfaceIndex, until_);
        if (!found) return found;
        const std::int64_t oldest = std::min(startedAt_, wish_.freshSince);
        std::erase_if(*found, [&](const AccessPoint& each) {
            return !each.joined && each.lastSeen && *each.lastSeen < oldest;
        });
        addForgotten(*found, heard_);
        return found;
    }

    /// Whoever scans between two requests may have the kernel forget what was heard before.
    void keepHeard() {
        if (!slicing_.wanted) return;
        Known<std::vector<AccessPoint>> heard = results();
        if (!heard) return;
        heard_ = std::move(*heard);
        for (AccessPoint& each : heard_) each.joined = false;
    }

    /// Listens on the channels of the named network until a beacon of each of its access points was heard: only a
    /// beacon tells whether the name is hidden.
    Known<ScanReport> withBeacons(ScanReport report) {
        for (int attempt = 0; attempt < kListenAttempts; ++attempt) {
            ScanOrder order{{}, false, {}};
            for (const AccessPoint& each : report.accessPoints) {
                const bool lacksBeacon = each.says.name == *wish_.named && !each.says.hidesName;
                const bool isListed = std::ranges::count(order.frequencies, each.frequency) > 0;
                if (lacksBeacon && !isListed) order.frequencies.push_back(each.frequency);
            }
            if (order.frequencies.empty()) break;
            Known<ScanReport> again = complete(order);
            if (!again) break;
            report = std::move(*again);
        }
        return report;
    }

    RadioSocket& radio_;
    HomeChannel& home_;
    const ScanWish& wish_;
    const Until& until_;
    RadioAbilities abilities_;  ///< with only the channels that may be used and that carry networks
    std::int64_t startedAt_;
    ScanSlicing slicing_;
    std::vector<AccessPoint> heard_;  ///< before others scanned meanwhile
    bool wasCutShort_ = false;
};

bool sees(const std::vector<AccessPoint>& found, const std::optional<NetworkName>& name) {
    return !name || std::ranges::any_of(found, [&](const AccessPoint& each) {
        return each.says.name == *name && each.says.hidesName;
    });
}

bool isNotPermitted(const Known<ScanReport>& report) {
    return !report && is(report.error(), Reason::notPermitted);
}

/// What the system itself has heard lately, where that is young enough and more than the joined access point.
std::optional<ScanReport> heardLately(RadioSocket& radio, const ScanWish& wish, const Until& until) {
    Known<std::vector<AccessPoint>> known = radio.accessPoints(wish.interfaceIndex, until);
    if (!known) return std::nullopt;
    std::erase_if(*known, [&](const AccessPoint& each) {
        return !each.joined && (!each.lastSeen || *each.lastSeen < wish.freshSince);
    });
    if (!hearsOthers(*known)) return std::nullopt;
    return ScanReport{std::move(*known), std::nullopt};
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

void addForgotten(std::vector<AccessPoint>& found, const std::vector<AccessPoint>& heard) {
    // The kernel keeps those that hide twice, by their beacon and with the name that they told when they were called.
    const auto isSame = [](const AccessPoint& one, const AccessPoint& other) {
        return one.address == other.address && one.frequency == other.frequency &&
               one.says.name.absent() == other.says.name.absent();
    };
    const std::size_t known = found.size();
    for (const AccessPoint& each : heard) {
        const auto end = found.begin() + static_cast<std::ptrdiff_t>(known);
        if (std::none_of(found.begin(), end, [&](const AccessPoint& other) { return isSame(each, other); }))
            found.push_back(each);
    }
}

void ScanMemory::keep(std::uint32_t interfaceIndex, const ScanReport& report) {
    if (!report.completedAt) return;
    interfaceIndex_ = interfaceIndex;
    report_ = report;
}

const ScanReport* ScanMemory::serving(const ScanWish& wish) const {
    const bool serves =
        report_ && interfaceIndex_ == wish.interfaceIndex && report_->completedAt >= wish.freshSince;
    return serves ? &*report_ : nullptr;
}

Known<ScanReport> Scanner::scanNow(RadioSocket& radio, const ScanWish& wish, const Until& until) {
    Known<ScanReport> report = ScanRun(radio, home_, wish, until).run();
    if (isNotPermitted(report)) return scanWithoutPermission(radio, wish, until);
    if (report && !report->completedAt)
        notes_.once("scans were cut short: other networks are judged by what was heard until then");
    else if (report && !wish.named && wish.manner == ScanWish::Manner::listening)
        listened_.keep(wish.interfaceIndex, *report);
    return report;
}

/// By whatever manages the interface; else what the system itself has heard lately must do.
Known<ScanReport> Scanner::scanWithoutPermission(RadioSocket& radio, const ScanWish& wish,
                                                 const Until& until) {
    AskedManager manager;
    const bool listening = wish.manner == ScanWish::Manner::listening && !wish.named;
    Known<ScanReport> report = ScanRun(radio, home_, wish, until).runByManager(listening, manager);
    if (report) {
        if (manager.listens) listened_.keep(wish.interfaceIndex, *report);
        notes_.once("no permission to scan (CAP_NET_ADMIN): " + manager.name + " was asked to scan instead" +
                    (manager.listens ? "" : ", which does not count networks that hide"));
        return report;
    }
    const std::optional<ScanReport> lately = heardLately(radio, wish, until);
    if (!lately) return report;
    notes_.once("heard lately",
                report.error().message + ": other networks are judged by what the system has heard lately");
    return *lately;
}

Known<std::vector<AccessPoint>> Scanner::scan(const ScanWish& wish, const Until& until) {
    const std::lock_guard lock(scanning_);
    const ScanReport* const kept = scanned_.serving(wish);
    if (kept != nullptr && sees(kept->accessPoints, wish.named)) return kept->accessPoints;
    Known<RadioSocket> radio = openRadio(until);
    if (!radio) return radio.error();
    const Known<ScanReport> report = scanNow(*radio, wish, until);
    if (!report) return report.error();
    scanned_.keep(wish.interfaceIndex, *report);
    return report->accessPoints;
}

Known<std::vector<AccessPoint>> Scanner::listen(const ScanWish& wish, const Until& until) {
    const std::lock_guard lock(scanning_);
    if (const ScanReport* const kept = listened_.serving(wish)) return kept->accessPoints;
    Known<RadioSocket> radio = openRadio(until);
    if (!radio) return radio.error();
    const Known<ScanReport> report = ScanRun(*radio, home_, wish, until).listen();
    if (isNotPermitted(report))
        return failure(Reason::notPermitted,
                       "no permission to listen (CAP_NET_ADMIN), and no connection manager that could");
    if (!report) return report.error();
    listened_.keep(wish.interfaceIndex, *report);
    return report->accessPoints;
}

}  // namespace wp
