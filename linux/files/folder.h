#pragma once

#include <string>
#include <vector>

namespace wp {

/// More files in one place are no configuration of a device, but an attempt to keep its reader busy.
inline constexpr std::size_t kMostFiles = 256;

/// The names of what lies in a folder, in their order; none where it cannot be read. *Any* thread.
/// \param most so many are read, whichever the system tells first
std::vector<std::string> namesIn(const std::string& folder, std::size_t most = kMostFiles);

}  // namespace wp
