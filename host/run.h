#pragma once

#include "host/arguments.h"

namespace wp::host {

/// One run from its arguments to its printed result. Returns the exit status; throws `Exit` for what keeps
/// the run from beginning or its result from being written. *Main*, once in a process.
int runDiagnostic(const RunOptions& options);

}  // namespace wp::host
