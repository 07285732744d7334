#pragma once

#include "platform/records.h"
#include "service/facts.h"
#include "service/outcome.h"

namespace wp {

// The verdicts on whether the joined network carries traffic. All are pure functions; *any* thread.

/// 3. "PingResult".
Outcome gatewayAnswers(const Facts& facts);
/// 12.
Outcome hasIPv4Address(const Facts& facts);
/// 13.
Outcome hasIPv6Address(const Facts& facts);

/// Loss as a fraction, times in ms; without any answer all times are NaN. *Any* thread.
PingStatistics statisticsOf(const Echo& echo);

}  // namespace wp
