#pragma once

#include "host/arguments.h"
#include "host/preparation.h"
#include "host/report/evidence.h"

namespace wp::host {

/// One run from its arguments to its printed result. Returns the exit status; throws `Exit` for what keeps
/// the run from beginning or its result from being written. *Main*, once in a process.
int runDiagnostic(const RunOptions& options);

/// Replays the prepared recording without a screen, a log or a wait, and hands over its result with all
/// answers. Throws `Exit` where the replay cannot come to an end. *Main*, once in a process.
Evidence replayedEvidence(const RunOptions& options, Preparation& prepared);

}  // namespace wp::host
