#include "linux/wait_any.h"

#include <algorithm>
#include <cerrno>
#include <vector>

namespace wp {

std::chrono::milliseconds timeLeft(const Until& until) {
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(until.deadline - Clock::now());
    return std::max(left, std::chrono::milliseconds(0));
}

Wait waitAny(std::span<pollfd> descriptors, const Until& until) {
    std::vector<pollfd> all(descriptors.begin(), descriptors.end());
    all.push_back({until.stop->descriptor(), POLLIN, 0});
    while (true) {
        const auto patience = std::min<std::int64_t>(timeLeft(until).count(), 60'000);
        const int count = ::poll(all.data(), all.size(), static_cast<int>(patience));
        if (count < 0 && errno != EINTR) return Wait::timeout;
        if (count > 0 && all.back().revents != 0) return Wait::stopped;
        if (count > 0) break;
        if (Clock::now() >= until.deadline) return Wait::timeout;
    }
    std::copy(all.begin(), all.end() - 1, descriptors.begin());
    return Wait::ready;
}

}  // namespace wp
