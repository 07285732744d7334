#pragma once

#include <string>

#include "host/arguments.h"

namespace wp::host {

/// `wifi-profile report`: reads a result, or replays a recording, and writes the report. Returns the exit
/// status; throws `Exit` (status 2) with place and reason for a file that is neither. *Main*.
int writeReport(const ReportOptions& options);

/// What `wifi-profile tests` prints, in the language and with the thresholds that the options name. *Main*.
std::string catalogueOf(const ReportOptions& options);

}  // namespace wp::host
