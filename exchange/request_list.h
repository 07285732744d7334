#pragma once

#include <functional>
#include <vector>

#include "platform/diagnostics.h"

namespace wp {

/// Answers a list of requests by answering each of them in its turn: results are joined, and the first error
/// with a code other than 0 ends it. The answer to a list of one is that request's own. *Any* thread.
DiagnosticsTestResponse answerInTurn(
    const std::vector<DiagnosticsTestRequest>& requests,
    const std::function<DiagnosticsTestResponse(const DiagnosticsTestRequest&)>& answer);

}  // namespace wp
