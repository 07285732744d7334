#include "linux/home_channel.h"

#include <sys/eventfd.h>
#include <unistd.h>

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
    for (;;) {
        {
            const std::lock_guard lock(mutex_);
            std::uint64_t changes = 0;
            [[maybe_unused]] const ssize_t size = read(changed_.number(), &changes, sizeof changes);
            if (mayLeave(visit)) {
                isAway_ = true;
                leftAt_ = Clock::now();
                timeWaited_ += leftAt_ - begin;
                return Wait::ready;
            }
        }
        if (const Wait wait = waitReadable(changed_.number(), until); wait != Wait::ready) return wait;
    }
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

bool HomeChannel::isSettled() const {
    const std::lock_guard lock(mutex_);
    return !isAway_ && Clock::now() >= returnedAt_ + kAtHome;
}

void HomeChannel::tellVisitor() {
    const std::uint64_t one = 1;
    [[maybe_unused]] const ssize_t written = write(changed_.number(), &one, sizeof one);
}

HomeChannel::Stay::Stay(HomeChannel& channel) : channel_(channel) {
    const std::lock_guard lock(channel_.mutex_);
    ++channel_.stays_;
    ++channel_.needing_;
}

Wait HomeChannel::Stay::begin(const Until& until) {
    {
        const std::lock_guard lock(channel_.mutex_);
        if (!hasEnded_ && !std::exchange(isNeeding_, true)) ++channel_.needing_;
    }
    while (!channel_.isSettled()) {
        if (waitReadable(-1, until.within(kBetweenLooks)) == Wait::stopped) return Wait::stopped;
        if (Clock::now() >= until.deadline) return Wait::timeout;
    }
    return Wait::ready;
}

void HomeChannel::Stay::pause() {
    const std::lock_guard lock(channel_.mutex_);
    if (!std::exchange(isNeeding_, false)) return;
    --channel_.needing_;
    channel_.tellVisitor();
}

void HomeChannel::Stay::end() {
    pause();
    const std::lock_guard lock(channel_.mutex_);
    if (std::exchange(hasEnded_, true)) return;
    --channel_.stays_;
    channel_.tellVisitor();
}

Clock::duration HomeChannel::Stay::timeAtHome() const {
    const std::lock_guard lock(channel_.mutex_);
    const Clock::time_point now = channel_.isAway_ ? channel_.leftAt_ : Clock::now();
    return now - channel_.startedAt_ - channel_.timeAway_;
}

}  // namespace wp
