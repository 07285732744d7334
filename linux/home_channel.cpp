#include "linux/home_channel.h"

#include <sys/eventfd.h>
#include <unistd.h>

#include <algorithm>
#include <cstdint>
#include <utility>

namespace wp {
namespace {

// Who comes while the radio is away looks this often whether it is back.
constexpr std::chrono::milliseconds kBetweenLooks{5};

}  // namespace

HomeChannel::HomeChannel() : changed_(eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {}

Wait HomeChannel::leave(Visit visit, const Until& until) {
    const Clock::time_point begin = Clock::now();
    for (Clock::time_point time;;) {
        {
            const std::lock_guard lock(mutex_);
            std::uint64_t changes = 0;
            [[maybe_unused]] const ssize_t size = read(changed_.number(), &changes, sizeof changes);
            const Clock::time_point now = Clock::now();
            time = leaveTime(visit);
            if (time <= now) {
                isAway_ = true;
                leftAt_ = now;
                timeWaited_ += now - begin;
                return Wait::ready;
            }
        }
        const Wait wait = waitReadable(changed_.number(), {until.stop, std::min(time, until.deadline)});
        if (wait == Wait::stopped || (wait == Wait::timeout && Clock::now() >= until.deadline)) return wait;
    }
}

void HomeChannel::leftByOthers() {
    const std::lock_guard lock(mutex_);
    isAway_ = true;
    leftAt_ = Clock::now();
}

void HomeChannel::returned() {
    const std::lock_guard lock(mutex_);
    isAway_ = false;
    returnedAt_ = Clock::now();
    timeAway_ += returnedAt_ - leftAt_;
}

Clock::duration HomeChannel::timeWaited() const {
    const std::lock_guard lock(mutex_);
    return timeWaited_;
}

Clock::time_point HomeChannel::leaveTime(Visit visit) const {
    Clock::time_point time = Clock::time_point::min();
    for (const Stay* each : stays_)
        if (visit == Visit::lengthy || each->isNeeding_) time = std::max(time, each->end_);
    return time;
}

bool HomeChannel::isSettled() const {
    const std::lock_guard lock(mutex_);
    return !isAway_ && Clock::now() >= returnedAt_ + kAtHome;
}

void HomeChannel::tellVisitor() {
    const std::uint64_t one = 1;
    [[maybe_unused]] const ssize_t written = write(changed_.number(), &one, sizeof one);
}

HomeChannel::Stay::Stay(HomeChannel& channel, Clock::duration atMost)
    : channel_(channel), end_(Clock::now() + atMost) {
    const std::lock_guard lock(channel_.mutex_);
    channel_.stays_.push_back(this);
}

Wait HomeChannel::Stay::begin(const Until& until) {
    {
        const std::lock_guard lock(channel_.mutex_);
        isNeeding_ = true;
    }
    while (!channel_.isSettled()) {
        if (waitReadable(-1, until.within(kBetweenLooks)) == Wait::stopped) return Wait::stopped;
        if (Clock::now() >= until.deadline) return Wait::timeout;
    }
    return Wait::ready;
}

void HomeChannel::Stay::prolong(Clock::duration atLeast) {
    const std::lock_guard lock(channel_.mutex_);
    end_ = std::max(end_, Clock::now() + atLeast);
}

void HomeChannel::Stay::pause() {
    const std::lock_guard lock(channel_.mutex_);
    if (std::exchange(isNeeding_, false)) channel_.tellVisitor();
}

void HomeChannel::Stay::end() {
    const std::lock_guard lock(channel_.mutex_);
    if (std::erase(channel_.stays_, this) > 0) channel_.tellVisitor();
}

Clock::duration HomeChannel::Stay::timeAtHome() const {
    const std::lock_guard lock(channel_.mutex_);
    const Clock::time_point now = channel_.isAway_ ? channel_.leftAt_ : Clock::now();
    return now - channel_.startedAt_ - channel_.timeAway_;
}

}  // namespace wp
