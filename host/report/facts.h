#pragma once

#include "host/report/findings.h"

namespace wp::host {

/// What is worth knowing of the joined and the selected network besides findings, as far as the evidence has
/// it: signal, security, channel, modes, answers' times, quietest channels.
std::vector<ReportedFact> factsOf(const ReportInput& input);

}  // namespace wp::host
