#pragma once

#include <string>

#include "platform/value.h"

namespace wp {

/// The date as ISO 8601 text in UTC, "YYYY-MM-DDTHH:MM:SSZ"; fractions of a second are cut towards the past.
/// Years outside 0 to 9999, infinities and NaN, which that form cannot express, are held at its first or last
/// second (NaN at 2001-01-01). *Any* thread.
std::string iso8601Text(Date date);

}  // namespace wp
