#pragma once

#include <string>

#include "host/report/limits.h"
#include "host/report/texts.h"

namespace wp::host {

/// What `wifi-profile tests` prints: each test with its number and key, what it asks, what counts as a finding
/// with the source of its number, what a finding means, what to do about it, and by whom. *Any*.
std::string catalogueText(const Thresholds& thresholds, const Texts& texts);

}  // namespace wp::host
