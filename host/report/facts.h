#pragma once

#include <span>

#include "host/report/findings.h"

namespace wp::host {

/// What is worth knowing besides findings, as far as the evidence has it: of the joined and the selected network
/// signal, security, channel, modes, answers' times, quietest channels; and what calls for nothing, as a remark
/// on its part.
/// \param remarks of severity `notice`
std::vector<ReportedFact> factsOf(const ReportInput& input, std::span<const ReportedFinding> remarks);

}  // namespace wp::host
