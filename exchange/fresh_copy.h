#pragma once

#include "platform/diagnostics.h"
#include "platform/value.h"

namespace wp {

/// A copy of the response that shares no dictionary, array or record with it, as a service makes new objects
/// for each answer. *Any* thread.
DiagnosticsTestResponse freshCopy(const DiagnosticsTestResponse& response);

}  // namespace wp
