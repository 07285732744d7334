#include "linux/utc_time.h"

#include <chrono>

namespace wp {

std::optional<std::int64_t> unixTime(const std::array<int, 6>& parts) {
    constexpr std::array<int, 6> kHighest = {9999, 12, 31, 23, 59, 60};
    for (std::size_t i = 0; i < parts.size(); ++i)
        if (parts[i] < 0 || parts[i] > kHighest[i]) return std::nullopt;
    using namespace std::chrono;
    const year_month_day date{year(parts[0]), month(static_cast<unsigned>(parts[1])),
                              day(static_cast<unsigned>(parts[2]))};
    if (!date.ok()) return std::nullopt;
    const sys_seconds time = sys_days(date) + hours(parts[3]) + minutes(parts[4]) + seconds(parts[5]);
    return time.time_since_epoch().count();
}

}  // namespace wp
