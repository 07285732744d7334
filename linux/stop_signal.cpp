#include "linux/stop_signal.h"

#include <poll.h>
#include <sys/eventfd.h>

#include <algorithm>
#include <cerrno>
#include <climits>
#include <cstdint>

namespace wp {
namespace {

int millisecondsUntil(Clock::time_point deadline) {
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - Clock::now()).count();
    return static_cast<int>(std::clamp<std::int64_t>(left, 0, INT_MAX));
}

}  // namespace

StopSignal::StopSignal() : event_(eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {}

void StopSignal::raise() {
    raised_ = true;
    const std::uint64_t one = 1;
    // A counter that cannot grow any more is raised already.
    [[maybe_unused]] const ssize_t written = write(event_.number(), &one, sizeof one);
}

Wait waitReadable(int descriptor, const Until& until) {
    for (;;) {
        pollfd entries[] = {{until.stop->descriptor(), POLLIN, 0}, {descriptor, POLLIN, 0}};
        const int ready = poll(entries, 2, millisecondsUntil(until.deadline));
        if (ready < 0 && errno == EINTR) continue;
        if (entries[0].revents != 0) return Wait::stopped;
        if (entries[1].revents != 0) return Wait::ready;
        if (Clock::now() >= until.deadline) return Wait::timeout;
    }
}

Error waitFailure(Wait wait, const std::string& what) {
    if (wait == Wait::stopped) return failure(Reason::cancelled, "cancelled");
    return failure(Reason::timeout, what + " took too long");
}

}  // namespace wp
