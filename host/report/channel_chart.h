#pragma once

#include <string>
#include <vector>

#include "host/report/evidence.h"
#include "host/report/texts.h"

namespace wp::host {

/// A picture in text of each band with the networks that were heard, a line each over the channels that it
/// occupies, at most 80 columns wide; no lines where the evidence names no network. *Any*.
std::vector<std::string> channelChart(const Evidence& evidence, const Texts& texts);

}  // namespace wp::host
