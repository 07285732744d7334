#pragma once

#include <optional>
#include <string>

namespace wp::host {

/// How many tests a run performs: those of the device, those of the joined network, and those of the selected
/// one where it is another; a network whose name ends in "_nomap" is left alone. Absent names: no network.
/// *Any*.
int plannedTests(const std::optional<std::string>& joined, const std::optional<std::string>& selected);

}  // namespace wp::host
