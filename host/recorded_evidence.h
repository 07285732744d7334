#pragma once

#include "exchange/recording.h"
#include "host/arguments.h"
#include "host/report/evidence.h"

namespace wp::host {

/// The evidence of the run that was recorded: its answers are replayed as a run without the list, with the network and the
/// age that they name, also where no request may name them. How a run with the list found its network, and why it ended
/// before its tests, are read off the recording instead, as far as it holds them: a chosen name that opts out of tests
/// leaves no trace there. Throws `Exit` where the replay cannot come to an end. *Main*, for one recording after another.
Evidence evidenceFromRecording(Recording recording, const ReportOptions& options);

}  // namespace wp::host
