#include "linux/inbox.h"

#include <sys/eventfd.h>

#include <cstdint>

namespace wp {

Inbox::Inbox() : event_(eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {}

void Inbox::post(std::function<void()> step) {
    {
        const std::lock_guard lock(mutex_);
        steps_.push_back(std::move(step));
    }
    const std::uint64_t one = 1;
    [[maybe_unused]] const ssize_t written = write(event_.number(), &one, sizeof one);
}

void Inbox::run() {
    std::uint64_t count = 0;
    [[maybe_unused]] const ssize_t size = read(event_.number(), &count, sizeof count);
    std::vector<std::function<void()>> steps;
    {
        const std::lock_guard lock(mutex_);
        steps.swap(steps_);
    }
    for (const std::function<void()>& step : steps) step();
}

}  // namespace wp
