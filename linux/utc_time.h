#pragma once

#include <array>
#include <cstdint>
#include <optional>

namespace wp {

/// Seconds since 1970 of a moment in UTC: year, month, day, hour, minute and second, whose leap second counts. Nothing where
/// the calendar has no such moment, or its year has more than four digits. *Any* thread.
std::optional<std::int64_t> unixTime(const std::array<int, 6>& parts);

}  // namespace wp
