#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "platform/value.h"

namespace wp {

/// The moment that an ISO 8601 text names: `YYYY-MM-DDTHH:MM:SS`, a fraction of any length or none, then `Z`
/// or an offset (`+02:00`, `+0200`, `+02`). Nothing for every other form, for a day that no calendar has, and
/// for a time without a zone, which names no moment. *Any* thread.
std::optional<Date> readISO8601(std::string_view text);

/// The date as ISO 8601 text in UTC with as many digits of a fraction as `readISO8601` needs to come back to
/// it. *Any* thread.
std::string exactISO8601Text(Date date);

}  // namespace wp
