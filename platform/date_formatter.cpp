#include "platform/date_formatter.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>

namespace wp {
namespace {

using std::chrono::sys_days;
using std::chrono::year;

constexpr sys_days kReference = sys_days(year(2001) / 1 / 1);
constexpr sys_days kFirst = sys_days(year(0) / 1 / 1);
constexpr sys_days kEnd = sys_days(year(10000) / 1 / 1);

double seconds(sys_days days) {
    return std::chrono::duration<double>(days - kReference).count();
}

}  // namespace

std::string iso8601Text(Date date) {
    double since = std::isnan(date.secondsSinceReference) ? 0 : std::floor(date.secondsSinceReference);
    since = std::clamp(since, seconds(kFirst), seconds(kEnd) - 1);
    auto moment = kReference + std::chrono::seconds(static_cast<long long>(since));
    sys_days day = std::chrono::floor<std::chrono::days>(moment);
    std::chrono::year_month_day calendar(day);
    std::chrono::hh_mm_ss clock(moment - day);
    char text[48];
    std::snprintf(text, sizeof text, "%04d-%02u-%02uT%02d:%02d:%02dZ", int(calendar.year()),
                  unsigned(calendar.month()), unsigned(calendar.day()), int(clock.hours().count()),
                  int(clock.minutes().count()), int(clock.seconds().count()));
    return text;
}

}  // namespace wp
